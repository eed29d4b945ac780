// The one place where interrupted system calls are retried.
#pragma once

#include <cerrno>

namespace hsdig::platform {

// Calls `call` until it does not fail with EINTR and returns its last result.
// `call` reports failure the libc way: -1 with errno set.
template <class Call>
auto retryOnEintr(Call&& call) {
  for (;;) {
    auto result = call();
    if (!(result == -1 && errno == EINTR)) return result;
  }
}

}  // namespace hsdig::platform
