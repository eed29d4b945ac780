// A connection accepted by a server, built for a server that waits on many
// connections at once with poll().
//
// Reads go through a 1024-byte read-ahead. While the read-ahead is empty the
// socket's kernel buffer plays the part of an outstanding read: nothing is
// lost and nothing is copied early. The native wait handle is an epoll
// descriptor over the socket and a "ready" event; it polls readable when
// bytes wait in the read-ahead, when the kernel holds data, and at the end of
// the stream or an error. Bytes already pulled into user space never wake a
// poll on the bare socket, which is why the handle is not the socket itself.
//
// A read that finds the read-ahead empty and is asked for at least 1024 bytes
// receives straight into the caller's buffer; the bytes and their order are
// the same, only the copy is saved.
//
// Threads: one thread reads at a time; another thread may write meanwhile.
#pragma once

#include <array>

#include "platform/EventFd.h"
#include "platform/UniqueFd.h"
#include "transport/TPipeImpl.h"

namespace hsdig::transport {

class TWaitableNamedPipeImpl : public TPipeImpl {
 public:
  static constexpr uint32_t kReadAheadSize = 1024;

  // Takes the accepted, non-blocking socket. Failing to make the wait handle
  // reports "TManualResetEvent unable to create event, GLE=" and throws
  // apache::thrift::concurrency::SystemResourceException "CreateEvent failed";
  // the socket is closed.
  explicit TWaitableNamedPipeImpl(platform::UniqueFd socket);

  // Returns buffered bytes first; when none are buffered, waits for the next
  // bytes (up to the read time-out, which accepted connections leave unset).
  // Returns 0 once the peer has ended the stream.
  uint32_t read(uint8_t* buffer, uint32_t length) override;
  void write(const uint8_t* buffer, uint32_t length) override;
  int getPipeHandle() const override { return socket_.get(); }
  void setTimeouts(int32_t readTimeoutMs, int32_t writeTimeoutMs) override;
  bool isBufferedDataAvailable() const override { return begin_ < end_; }
  int getNativeWaitHandle() const override { return waitSet_.get(); }

 private:
  // Called when the read-ahead has been handed out completely: from now on
  // the wait handle follows the socket alone.
  void beginAsyncRead();

  platform::UniqueFd socket_;
  platform::EventFd ready_;     // set while begin_ < end_
  platform::UniqueFd waitSet_;  // epoll over socket_ and ready_
  bool readySet_ = false;
  std::array<uint8_t, kReadAheadSize> readAhead_{};
  uint32_t begin_ = 0;
  uint32_t end_ = 0;
  int32_t writeTimeoutMs_ = -1;
  int32_t readTimeoutMs_ = -1;
};

}  // namespace hsdig::transport
