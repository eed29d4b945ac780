#include "transport/TNamedPipeServer.h"

#include <poll.h>
#include <sys/epoll.h>
#include <sys/socket.h>
#include <thrift/concurrency/Exception.h>
#include <thrift/transport/TTransportException.h>

#include <cerrno>
#include <string>

#include "platform/Diagnostic.h"
#include "platform/Identity.h"
#include "platform/Syscalls.h"
#include "transport/TPipe.h"
#include "transport/WaitSet.h"

namespace hsdig::transport {

namespace {

using apache::thrift::transport::TTransportException;

int acceptOne(int listener) {
  return platform::sys::accept4(listener, nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC);
}

// Failures that leave the pending client in the backlog and concern only
// this process's resources; the next accept meets them again and reports.
bool isResourceShortage(int error) {
  return error == EMFILE || error == ENFILE || error == ENOBUFS || error == ENOMEM;
}

}  // namespace

TNamedPipeServer::TNamedPipeServer(const PipePath& path, int backlog,
                                   const TPurePermissionManager& manager)
    : manager_(manager), listener_(path, manager, backlog) {
  if (const int error = listenEvent_.create(); error != 0) eventCreationFailed(error);
  waitSet_.reset(platform::sys::epoll_create1(EPOLL_CLOEXEC));
  if (!waitSet_) eventCreationFailed(errno);
  addToWaitSet(waitSet_.get(), listener_.fd());
  addToWaitSet(waitSet_.get(), listenEvent_.fd());
  std::lock_guard lock(mutex_);
  initiateNextConnection();
}

TNamedPipeServer::~TNamedPipeServer() = default;

void TNamedPipeServer::interrupt() {
  std::lock_guard lock(mutex_);
  cachedClient_.reset();
  stopping_ = true;
  cancelled_ = true;
  updateListenEvent();
}

void TNamedPipeServer::close() {
  {
    std::lock_guard lock(mutex_);
    cachedClient_.reset();
    stopping_ = true;
    cancelled_ = true;
    closed_ = true;
    updateListenEvent();
  }
  listener_.removeFile();
}

void TNamedPipeServer::updateListenEvent() {
  if (cachedClient_ || cancelled_)
    listenEvent_.set();
  else
    listenEvent_.reset();
}

bool TNamedPipeServer::admits(int client) const {
  platform::PeerCredentials peer;
  if (const int error = platform::peerCredentials(client, peer); error != 0) {
    platform::reportErrno("TPipeServer refused a client whose credentials are unknown, ", error);
    return false;
  }
  if (manager_.admitsPeer(peer)) return true;
  platform::reportLine(
      ("TPipeServer refused a client of user " + std::to_string(peer.uid)).c_str());
  return false;
}

void TNamedPipeServer::initiateNextConnection() {
  for (;;) {
    platform::UniqueFd client(acceptOne(listener_.fd()));
    if (client) {
      if (!admits(client.get())) continue;
      cachedClient_ = std::move(client);
      break;
    }
    const int error = errno;
    if (error == EINTR || error == ECONNABORTED) continue;
    if (error == EAGAIN || error == EWOULDBLOCK || isResourceShortage(error)) break;
    platform::reportErrno("TPipeServer ConnectNamedPipe failed, GLE=", error);
    throw TTransportException(TTransportException::NOT_OPEN,
                              " TPipeServer ConnectNamedPipe failed");
  }
  updateListenEvent();
}

void TNamedPipeServer::acceptFailed(int error) {
  std::lock_guard lock(mutex_);
  platform::reportErrno("TPipeServer ConnectNamedPipe GLE=", error);
  throw TTransportException(TTransportException::NOT_OPEN, "TPipeServer: client connection failed");
}

std::shared_ptr<TPipe> TNamedPipeServer::acceptImpl() {
  {
    std::lock_guard lock(mutex_);
    if (cachedClient_) {
      platform::UniqueFd client = std::move(cachedClient_);
      if (!stopping_) initiateNextConnection();
      updateListenEvent();
      return std::make_shared<TPipe>(std::move(client));
    }
    if (closed_)
      throw TTransportException(TTransportException::NOT_OPEN,
                                "TNamedPipeServer: someone called accept on a closed pipe server");
  }
  for (;;) {
    {
      std::lock_guard lock(mutex_);
      if (cancelled_) {
        platform::reportErrno("TPipeServer ConnectNamedPipe GLE=", ECANCELED);
        throw TTransportException(TTransportException::NOT_OPEN,
                                  "TPipeServer: client connection failed");
      }
    }
    platform::UniqueFd client(acceptOne(listener_.fd()));
    if (client) {
      if (!admits(client.get())) continue;
      std::lock_guard lock(mutex_);
      if (!stopping_) initiateNextConnection();
      return std::make_shared<TPipe>(std::move(client));
    }
    const int error = errno;
    if (error == EINTR || error == ECONNABORTED) continue;
    if (error != EAGAIN && error != EWOULDBLOCK) acceptFailed(error);
    // Nobody is pending: wait for a client or for an interruption.
    pollfd waits[2] = {{listener_.fd(), POLLIN, 0}, {listenEvent_.fd(), POLLIN, 0}};
    if (platform::sys::poll(waits, 2, -1) < 0 && errno != EINTR) acceptFailed(errno);
  }
}

}  // namespace hsdig::transport
