// A manual-reset event made of an eventfd: readable (POLLIN) from set() until
// reset(). Used where a waiter polls a descriptor for a condition that lives
// in user space.
//
// set() and reset() may be called from different threads; each is one
// system call and never blocks.
#pragma once

#include "platform/UniqueFd.h"

namespace hsdig::platform {

class EventFd {
 public:
  // Creates the event, initially reset. Returns 0 or the errno of eventfd().
  int create() noexcept;

  void set() noexcept;
  void reset() noexcept;
  int fd() const noexcept { return fd_.get(); }

 private:
  UniqueFd fd_;
};

}  // namespace hsdig::platform
