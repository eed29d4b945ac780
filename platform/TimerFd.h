// A one-shot timer made of a timerfd: readable (POLLIN) from the moment it
// expires until consume(). Arming and disarming are one system call each and
// wake nobody; only the expiry wakes a thread that polls the descriptor.
//
// arm, disarm and consume may be called from different threads.
#pragma once

#include <cstdint>

#include "platform/UniqueFd.h"

namespace hsdig::platform {

class TimerFd {
 public:
  // Creates the timer, disarmed. Returns 0 or the errno of timerfd_create().
  int create() noexcept;

  // Expires once, `microseconds` from now (at least 1); re-arming replaces
  // the earlier expiry.
  void arm(int64_t microseconds) noexcept;
  void disarm() noexcept;
  // Clears an expiry; does nothing when none is pending.
  void consume() noexcept;
  int fd() const noexcept { return fd_.get(); }

 private:
  UniqueFd fd_;
};

}  // namespace hsdig::platform
