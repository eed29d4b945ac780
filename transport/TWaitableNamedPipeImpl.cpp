#include "transport/TWaitableNamedPipeImpl.h"

#include <sys/epoll.h>
#include <thrift/concurrency/Exception.h>

#include <algorithm>
#include <cerrno>
#include <cstring>

#include "platform/Diagnostic.h"
#include "platform/Syscalls.h"
#include "transport/SocketIo.h"
#include "transport/WaitSet.h"

namespace hsdig::transport {

namespace {

constexpr socketio::ReadTexts kServerReadTexts{
    "TPipe: ReadFile failed",
    "TPipe ::GetOverlappedResult errored GLE=",
    "TPipe: GetOverlappedResult failed",
};

}  // namespace

TWaitableNamedPipeImpl::TWaitableNamedPipeImpl(platform::UniqueFd socket)
    : socket_(std::move(socket)) {
  if (const int error = ready_.create(); error != 0) eventCreationFailed(error);
  waitSet_.reset(platform::sys::epoll_create1(EPOLL_CLOEXEC));
  if (!waitSet_) eventCreationFailed(errno);
  addToWaitSet(waitSet_.get(), socket_.get());
  addToWaitSet(waitSet_.get(), ready_.fd());
}

uint32_t TWaitableNamedPipeImpl::read(uint8_t* buffer, uint32_t length) {
  if (length == 0) return 0;
  if (begin_ == end_) {
    if (length >= kReadAheadSize)
      return socketio::receive(socket_.get(), buffer, length, readTimeoutMs_, kServerReadTexts);
    const uint32_t got = socketio::receive(socket_.get(), readAhead_.data(), kReadAheadSize,
                                           readTimeoutMs_, kServerReadTexts);
    if (got == 0) return 0;
    begin_ = 0;
    end_ = got;
  }
  const uint32_t count = std::min(end_ - begin_, length);
  std::memcpy(buffer, readAhead_.data() + begin_, count);
  begin_ += count;
  if (begin_ == end_) {
    beginAsyncRead();
  } else if (!readySet_) {
    ready_.set();
    readySet_ = true;
  }
  return count;
}

void TWaitableNamedPipeImpl::beginAsyncRead() {
  begin_ = end_ = 0;
  if (readySet_) {
    ready_.reset();
    readySet_ = false;
  }
}

void TWaitableNamedPipeImpl::write(const uint8_t* buffer, uint32_t length) {
  socketio::sendAll(socket_.get(), buffer, length, writeTimeoutMs_);
}

void TWaitableNamedPipeImpl::setTimeouts(int32_t readTimeoutMs, int32_t writeTimeoutMs) {
  readTimeoutMs_ = readTimeoutMs;
  writeTimeoutMs_ = writeTimeoutMs;
}

}  // namespace hsdig::transport
