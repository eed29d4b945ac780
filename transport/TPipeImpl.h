// What a TPipe delegates to: one connected socket and the way it is read.
//
// Client pipes use TNamedPipeImpl (plain reads with optional time-outs);
// connections a server accepted use TWaitableNamedPipeImpl (a read-ahead
// and a descriptor the server can wait on).
#pragma once

#include <cstdint>

namespace hsdig::transport {

class TPipeImpl {
 public:
  virtual ~TPipeImpl() = default;
  TPipeImpl() = default;
  TPipeImpl(const TPipeImpl&) = delete;
  TPipeImpl& operator=(const TPipeImpl&) = delete;

  // Reads up to `length` bytes; 0 means the peer ended the stream.
  virtual uint32_t read(uint8_t* buffer, uint32_t length) = 0;
  // Writes all `length` bytes.
  virtual void write(const uint8_t* buffer, uint32_t length) = 0;
  // The connected socket.
  virtual int getPipeHandle() const = 0;
  // Time-outs in milliseconds for one wait of a read or a write; below 1
  // means no limit.
  virtual void setTimeouts(int32_t readTimeoutMs, int32_t writeTimeoutMs) = 0;
  // Whether bytes already read from the socket wait in user space.
  virtual bool isBufferedDataAvailable() const { return false; }
  // A descriptor that polls readable while a read would not block, or -1.
  virtual int getNativeWaitHandle() const { return -1; }
};

}  // namespace hsdig::transport
