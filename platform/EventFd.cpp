#include "platform/EventFd.h"

#include <sys/eventfd.h>
#include <unistd.h>

#include <cerrno>
#include <cstdint>

#include "platform/Retry.h"
#include "platform/Syscalls.h"

namespace hsdig::platform {

int EventFd::create() noexcept {
  const int fd = sys::eventfd(0, EFD_NONBLOCK | EFD_CLOEXEC);
  if (fd < 0) return errno;
  fd_.reset(fd);
  return 0;
}

// A write can only fail when the counter would overflow (EAGAIN after 2^64-2
// sets without a reset), which leaves the event set: the state wanted.
void EventFd::set() noexcept {
  const uint64_t one = 1;
  retryOnEintr([&] { return ::write(fd_.get(), &one, sizeof one); });
}

// A read of a reset event fails with EAGAIN, which is the state wanted.
void EventFd::reset() noexcept {
  uint64_t value = 0;
  retryOnEintr([&] { return ::read(fd_.get(), &value, sizeof value); });
}

}  // namespace hsdig::platform
