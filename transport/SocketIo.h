// Reading and writing a non-blocking connected socket with the failure
// reports of the pipe transport. Shared by both pipe implementations.
#pragma once

#include <cstdint>

namespace hsdig::transport::socketio {

// How a failed read is reported: the exception text of a failed receive,
// and the diagnostic and exception text of a failed wait without time-out.
struct ReadTexts {
  const char* readFailed;
  const char* blockingWaitDiagnostic;
  const char* blockingWaitFailed;
};

// Receives up to `length` (> 0) bytes, waiting for data at most `timeoutMs`
// when that is at least 1, else without limit. Returns 0 at the end of the
// stream. A time-out throws TTransportException TIMED_OUT
// "getOverlappedResultWithTimeout timed out" and loses no data: the next read
// gets what arrives later.
// With `waitFirst` the wait comes before the first attempt: for a read that
// follows a request just sent, whose answer cannot be there yet.
uint32_t receive(int fd, uint8_t* buffer, uint32_t length, int32_t timeoutMs,
                 const ReadTexts& texts, bool waitFirst = false);

// Sends all `length` bytes, waiting for room at most `timeoutMs` each time
// the socket is full (no limit below 1). Never raises SIGPIPE: a peer that
// has gone throws TTransportException UNKNOWN "TPipe: write failed".
void sendAll(int fd, const uint8_t* buffer, uint32_t length, int32_t timeoutMs);

}  // namespace hsdig::transport::socketio
