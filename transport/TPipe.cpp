#include "transport/TPipe.h"

#include <fcntl.h>
#include <sys/socket.h>
#include <sys/time.h>
#include <sys/un.h>
#include <thrift/transport/TTransportException.h>

#include <cerrno>
#include <chrono>
#include <cstring>

#include "contract/TransportConfiguration.h"
#include "platform/Diagnostic.h"
#include "platform/Syscalls.h"
#include "transport/SocketAddress.h"
#include "transport/TLocalAuthException.h"
#include "transport/TNamedPipeImpl.h"
#include "transport/TWaitableNamedPipeImpl.h"

namespace hsdig::transport {

namespace {

using apache::thrift::transport::TTransportException;

std::shared_ptr<apache::thrift::TConfiguration> orContract(
    std::shared_ptr<apache::thrift::TConfiguration> config) {
  return config ? std::move(config) : contract::makeTransportConfiguration();
}

[[noreturn]] void openFailed(int error) {
  platform::reportErrno("TPipe::open ::CreateFile errored GLE=", error);
  throw TTransportException(TTransportException::NOT_OPEN, "Unable to open pipe");
}

int setSendTimeout(int fd, std::chrono::milliseconds timeout) {
  timeval value{};
  value.tv_sec = static_cast<time_t>(timeout.count() / 1000);
  value.tv_usec = static_cast<suseconds_t>((timeout.count() % 1000) * 1000);
  return ::setsockopt(fd, SOL_SOCKET, SO_SNDTIMEO, &value, sizeof value) == 0 ? 0 : errno;
}

int setBlocking(int fd, bool blocking) {
  const int flags = ::fcntl(fd, F_GETFL);
  if (flags < 0) return errno;
  const int wanted = blocking ? (flags & ~O_NONBLOCK) : (flags | O_NONBLOCK);
  return ::fcntl(fd, F_SETFL, wanted) == 0 ? 0 : errno;
}

// The server's backlog is full. A blocking connect on a Unix-domain socket
// sleeps in the kernel until the backlog has room, bounded by the socket's
// send time-out, so the wait and the retry are one call that wakes as soon as
// a place is free. Returns 0 once connected, else the errno of the wait.
int waitForRoomAndConnect(int fd, const SocketAddress& address, int32_t waitTimeoutMs) {
  if (waitTimeoutMs < 1) return EAGAIN;
  using Clock = std::chrono::steady_clock;
  const auto deadline = Clock::now() + std::chrono::milliseconds(waitTimeoutMs);
  if (const int error = setBlocking(fd, true); error != 0) return error;
  int result = 0;
  for (;;) {
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - Clock::now());
    if (left.count() <= 0) {
      result = EAGAIN;
      break;
    }
    if (const int error = setSendTimeout(fd, left); error != 0) {
      result = error;
      break;
    }
    if (platform::sys::connect(fd, address.get(), address.length()) == 0) break;
    if (errno != EINTR) {
      result = errno;
      break;
    }
  }
  if (result == 0) {
    if (const int error = setSendTimeout(fd, std::chrono::milliseconds(0)); error != 0)
      return error;
    if (const int error = setBlocking(fd, false); error != 0) return error;
  }
  return result;
}

}  // namespace

TPipe::TPipe(const std::string& pipeName, std::shared_ptr<apache::thrift::TConfiguration> config)
    : TVirtualTransport(orContract(std::move(config))), path_(resolvePipePath(pipeName)) {}

TPipe::TPipe(platform::UniqueFd connection, std::shared_ptr<apache::thrift::TConfiguration> config)
    : TVirtualTransport(orContract(std::move(config))),
      impl_(std::make_shared<TWaitableNamedPipeImpl>(std::move(connection))) {}

TPipe::~TPipe() = default;

void TPipe::open() {
  if (isOpen()) return;
  if (path_.error != 0) openFailed(path_.error);
  const SocketAddress address(path_.path);

  platform::UniqueFd socket(
      platform::sys::socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
  if (!socket) openFailed(errno);
  int error = 0;
  do {
    error = platform::sys::connect(socket.get(), address.get(), address.length()) == 0 ? 0 : errno;
  } while (error == EINTR);
  if (error == EAGAIN) error = waitForRoomAndConnect(socket.get(), address, waitTimeoutMs_);
  if (error != 0) openFailed(error);

  if (!verifier_->verify(socket.get())) throw TLocalAuthException("Server isn't trusted!");
  impl_ = std::make_shared<TNamedPipeImpl>(std::move(socket));
}

void TPipe::close() {
  impl_.reset();
}

uint32_t TPipe::read(uint8_t* buffer, uint32_t length) {
  if (!impl_)
    throw TTransportException(TTransportException::NOT_OPEN, "Called read on non-open pipe");
  return impl_->read(buffer, length);
}

void TPipe::write(const uint8_t* buffer, uint32_t length) {
  if (!impl_)
    throw TTransportException(TTransportException::NOT_OPEN, "Called write on non-open pipe");
  impl_->write(buffer, length);
}

void TPipe::setAccessVerifier(const TPureAccessVerifier* verifier) {
  verifier_ = verifier ? verifier : &defaultVerifier_;
}

void TPipe::setTimeouts(int32_t readTimeoutMs, int32_t writeTimeoutMs) {
  if (impl_) impl_->setTimeouts(readTimeoutMs, writeTimeoutMs);
}

}  // namespace hsdig::transport
