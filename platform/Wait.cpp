#include "platform/Wait.h"

#include <poll.h>

#include <cerrno>
#include <chrono>

#include "platform/Syscalls.h"

namespace hsdig::platform {

WaitResult waitForDescriptor(int fd, short events, int timeoutMs) {
  using Clock = std::chrono::steady_clock;
  const bool limited = timeoutMs >= 1;
  const auto deadline = Clock::now() + std::chrono::milliseconds(limited ? timeoutMs : 0);
  int remaining = limited ? timeoutMs : -1;
  for (;;) {
    pollfd entry{fd, events, 0};
    const int rc = sys::poll(&entry, 1, remaining);
    if (rc > 0) return WaitResult::kReady;
    if (rc == 0) return WaitResult::kTimedOut;
    if (errno != EINTR) return WaitResult::kFailed;
    if (limited) {
      const auto left =
          std::chrono::ceil<std::chrono::milliseconds>(deadline - Clock::now()).count();
      if (left <= 0) return WaitResult::kTimedOut;
      remaining = static_cast<int>(left);
    }
  }
}

}  // namespace hsdig::platform
