#include "transport/TNamedPipeImpl.h"

#include "transport/SocketIo.h"

namespace hsdig::transport {

namespace {
constexpr socketio::ReadTexts kClientReadTexts{
    "TPipe: read failed",
    "getOverlappedResultWithTimeout errored GLE=",
    "getOverlappedResultWithTimeout failed",
};
}  // namespace

TNamedPipeImpl::TNamedPipeImpl(platform::UniqueFd socket) : socket_(std::move(socket)) {}

uint32_t TNamedPipeImpl::read(uint8_t* buffer, uint32_t length) {
  if (length == 0) return 0;
  const uint32_t got =
      socketio::receive(socket_.get(), buffer, length, readTimeoutMs_, kClientReadTexts,
                        answerPending_.load(std::memory_order_relaxed));
  answerPending_.store(false, std::memory_order_relaxed);
  return got;
}

void TNamedPipeImpl::write(const uint8_t* buffer, uint32_t length) {
  socketio::sendAll(socket_.get(), buffer, length, writeTimeoutMs_);
  answerPending_.store(true, std::memory_order_relaxed);
}

void TNamedPipeImpl::setTimeouts(int32_t readTimeoutMs, int32_t writeTimeoutMs) {
  readTimeoutMs_ = readTimeoutMs;
  writeTimeoutMs_ = writeTimeoutMs;
}

}  // namespace hsdig::transport
