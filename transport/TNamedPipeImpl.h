// A client's connection: reads and writes with optional time-outs.
//
// Used by one reading thread and one writing thread at a time.
#pragma once

#include <atomic>

#include "platform/UniqueFd.h"
#include "transport/TPipeImpl.h"

namespace hsdig::transport {

class TNamedPipeImpl : public TPipeImpl {
 public:
  // Takes the connected, non-blocking socket.
  explicit TNamedPipeImpl(platform::UniqueFd socket);

  // Returns what is there, at most `length` bytes, waiting up to the read
  // time-out. An expired time-out throws TIMED_OUT "getOverlappedResultWith
  // Timeout timed out" and leaves the connection usable.
  uint32_t read(uint8_t* buffer, uint32_t length) override;
  void write(const uint8_t* buffer, uint32_t length) override;
  int getPipeHandle() const override { return socket_.get(); }
  void setTimeouts(int32_t readTimeoutMs, int32_t writeTimeoutMs) override;

  int32_t readTimeoutMs() const { return readTimeoutMs_; }
  int32_t writeTimeoutMs() const { return writeTimeoutMs_; }

 private:
  platform::UniqueFd socket_;
  // Set by a write, cleared by a read that got bytes: the next read waits
  // before it tries, since an answer takes at least a round trip.
  std::atomic<bool> answerPending_{false};
  int32_t writeTimeoutMs_ = -1;
  int32_t readTimeoutMs_ = -1;
};

}  // namespace hsdig::transport
