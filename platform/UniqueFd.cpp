#include "platform/UniqueFd.h"

#include <unistd.h>

namespace hsdig::platform {

void UniqueFd::reset(int fd) noexcept {
  const int old = std::exchange(fd_, fd);
  if (old >= 0) ::close(old);
}

}  // namespace hsdig::platform
