#include "transport/SocketIo.h"

#include <poll.h>
#include <sys/socket.h>
#include <thrift/transport/TTransportException.h>

#include <algorithm>
#include <cerrno>

#include "platform/Diagnostic.h"
#include "platform/Syscalls.h"
#include "platform/Wait.h"

namespace hsdig::transport::socketio {

namespace {

using apache::thrift::transport::TTransportException;

constexpr const char* kWaitDiagnostic = "getOverlappedResultWithTimeout errored GLE=";
constexpr const char* kWaitFailed = "getOverlappedResultWithTimeout failed";
constexpr const char* kTimedOut = "getOverlappedResultWithTimeout timed out";

// Waits for the socket; with a time-out the failures are those of a timed
// overlapped result, without one they are the caller's.
void await(int fd, short events, int32_t timeoutMs, const char* blockingDiagnostic,
           const char* blockingFailed) {
  switch (platform::waitForDescriptor(fd, events, timeoutMs)) {
    case platform::WaitResult::kReady:
      return;
    case platform::WaitResult::kTimedOut:
      platform::reportLine(kTimedOut);
      throw TTransportException(TTransportException::TIMED_OUT, kTimedOut);
    case platform::WaitResult::kFailed: {
      const int error = errno;
      const bool timed = timeoutMs >= 1;
      platform::reportErrno(timed ? kWaitDiagnostic : blockingDiagnostic, error);
      throw TTransportException(TTransportException::UNKNOWN, timed ? kWaitFailed : blockingFailed);
    }
  }
}

}  // namespace

uint32_t receive(int fd, uint8_t* buffer, uint32_t length, int32_t timeoutMs,
                 const ReadTexts& texts, bool waitFirst) {
  if (waitFirst)
    await(fd, POLLIN, timeoutMs, texts.blockingWaitDiagnostic, texts.blockingWaitFailed);
  for (;;) {
    const ssize_t got = platform::sys::recv(fd, buffer, length, 0);
    if (got >= 0) return static_cast<uint32_t>(got);
    const int error = errno;
    if (error == EINTR) continue;
    if (error == EAGAIN || error == EWOULDBLOCK) {
      await(fd, POLLIN, timeoutMs, texts.blockingWaitDiagnostic, texts.blockingWaitFailed);
      continue;
    }
    platform::reportErrno("TPipe ::ReadFile errored GLE=", error);
    throw TTransportException(TTransportException::UNKNOWN, texts.readFailed);
  }
}

void sendAll(int fd, const uint8_t* buffer, uint32_t length, int32_t timeoutMs) {
  uint32_t written = 0;
  while (written < length) {
    const ssize_t sent = platform::sys::send(fd, buffer + written, length - written, MSG_NOSIGNAL);
    if (sent >= 0) {
      written += static_cast<uint32_t>(sent);
      continue;
    }
    const int error = errno;
    if (error == EINTR) continue;
    if (error == EAGAIN || error == EWOULDBLOCK) {
      await(fd, POLLOUT, timeoutMs, kWaitDiagnostic, kWaitFailed);
      continue;
    }
    platform::reportErrno("TPipe ::WriteFile errored GLE=", error);
    throw TTransportException(TTransportException::UNKNOWN, "TPipe: write failed");
  }
}

}  // namespace hsdig::transport::socketio
