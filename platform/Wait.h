// Waiting for one descriptor to become ready, with an optional time-out.
#pragma once

namespace hsdig::platform {

enum class WaitResult { kReady, kTimedOut, kFailed };

// Waits until `fd` reports one of `events` (POLLIN, POLLOUT), an error or a
// hang-up. A `timeoutMs` below 1 waits without limit. Interrupted waits are
// resumed with the time that is left, so the whole wait never exceeds
// `timeoutMs`. On kFailed errno holds the reason.
WaitResult waitForDescriptor(int fd, short events, int timeoutMs);

}  // namespace hsdig::platform
