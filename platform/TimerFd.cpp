#include "platform/TimerFd.h"

#include <sys/timerfd.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>

#include "platform/Retry.h"

namespace hsdig::platform {

int TimerFd::create() noexcept {
  const int fd = ::timerfd_create(CLOCK_MONOTONIC, TFD_NONBLOCK | TFD_CLOEXEC);
  if (fd < 0) return errno;
  fd_.reset(fd);
  return 0;
}

// timerfd_settime fails only for a bad descriptor or value, neither of which
// a created timer can have.
void TimerFd::arm(int64_t microseconds) noexcept {
  microseconds = std::max<int64_t>(microseconds, 1);
  itimerspec when{};
  when.it_value.tv_sec = static_cast<time_t>(microseconds / 1000000);
  when.it_value.tv_nsec = static_cast<long>(microseconds % 1000000) * 1000;
  ::timerfd_settime(fd_.get(), 0, &when, nullptr);
}

void TimerFd::disarm() noexcept {
  const itimerspec never{};
  ::timerfd_settime(fd_.get(), 0, &never, nullptr);
}

// A read with no expiry pending fails with EAGAIN, which is the state wanted.
void TimerFd::consume() noexcept {
  uint64_t expiries = 0;
  retryOnEintr([&] { return ::read(fd_.get(), &expiries, sizeof expiries); });
}

}  // namespace hsdig::platform
