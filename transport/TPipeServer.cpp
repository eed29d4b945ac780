#include "transport/TPipeServer.h"

#include <sys/socket.h>
#include <thrift/transport/TTransportException.h>

#include "transport/TPipe.h"

namespace hsdig::transport {

using apache::thrift::transport::TTransportException;

TPipeServer::TPipeServer(const std::string& pipeName) : path_(resolvePipePath(pipeName)) {}

TPipeServer::~TPipeServer() {
  close();
}

bool TPipeServer::isOpen() const {
  return currentImpl() != nullptr;
}

void TPipeServer::listen() {
  std::lock_guard lock(mutex_);
  if (impl_) return;
  // The backlog takes the part of the waiting pipe instances: clients beyond
  // it find the server busy and wait in TPipe::open.
  impl_ = std::make_shared<TNamedPipeServer>(path_, SOMAXCONN, *manager_);
}

void TPipeServer::interrupt() {
  if (auto impl = currentImpl()) impl->interrupt();
}

void TPipeServer::close() {
  std::shared_ptr<TNamedPipeServer> impl;
  {
    std::lock_guard lock(mutex_);
    impl = std::move(impl_);
  }
  if (impl) impl->close();
}

void TPipeServer::setPermissionManager(const TPurePermissionManager* manager) {
  std::lock_guard lock(mutex_);
  manager_ = manager ? manager : &defaultManager_;
}

std::shared_ptr<TPipe> TPipeServer::acceptPipe() {
  auto impl = currentImpl();
  if (!impl)
    throw TTransportException(TTransportException::NOT_OPEN,
                              "TNamedPipeServer: someone called accept on a closed pipe server");
  return impl->acceptImpl();
}

std::shared_ptr<apache::thrift::transport::TTransport> TPipeServer::acceptImpl() {
  return acceptPipe();
}

int TPipeServer::getNativeWaitHandle() const {
  auto impl = currentImpl();
  return impl ? impl->getNativeWaitHandle() : -1;
}

std::shared_ptr<TPipeServerImpl> TPipeServer::getImpl() const {
  return currentImpl();
}

std::shared_ptr<TNamedPipeServer> TPipeServer::currentImpl() const {
  std::lock_guard lock(mutex_);
  return impl_;
}

}  // namespace hsdig::transport
