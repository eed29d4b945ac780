#include "platform/Syscalls.h"

namespace hsdig::platform::sys::detail {

#define HSDIG_SYSCALL_DEFINITION(name, ret, params, args) \
  std::atomic<name##_fn> name##_entry{&::name};
HSDIG_PLATFORM_SYSCALLS(HSDIG_SYSCALL_DEFINITION)
#undef HSDIG_SYSCALL_DEFINITION

}  // namespace hsdig::platform::sys::detail
