// The system calls whose failures the layers above must survive, routed
// through one process-wide table so that a test can make the Nth call fail
// (EINTR, EMFILE, EAGAIN ...) and prove the caller's error path.
//
// Production code calls sys::<name>(...) exactly as it would call the libc
// function. The table starts out pointing at libc; only tests replace entries
// (ScopedSyscall), and they do so while no other thread uses the entry. Each
// entry is an atomic pointer so that such a swap is never a data race.
#pragma once

#include <poll.h>
#include <sys/epoll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <sys/types.h>

#include <atomic>

// X(name, return type, parameter list, argument list)
#define HSDIG_PLATFORM_SYSCALLS(X)                                                          \
  X(socket, int, (int domain, int type, int protocol), (domain, type, protocol))            \
  X(connect, int, (int fd, const struct sockaddr* addr, socklen_t len), (fd, addr, len))    \
  X(bind, int, (int fd, const struct sockaddr* addr, socklen_t len), (fd, addr, len))       \
  X(listen, int, (int fd, int backlog), (fd, backlog))                                      \
  X(accept4, int, (int fd, struct sockaddr* addr, socklen_t* len, int flags),               \
    (fd, addr, len, flags))                                                                 \
  X(recv, ssize_t, (int fd, void* buf, size_t len, int flags), (fd, buf, len, flags))       \
  X(send, ssize_t, (int fd, const void* buf, size_t len, int flags), (fd, buf, len, flags)) \
  X(poll, int, (struct pollfd * fds, nfds_t count, int timeout), (fds, count, timeout))     \
  X(eventfd, int, (unsigned int initval, int flags), (initval, flags))                      \
  X(epoll_create1, int, (int flags), (flags))                                               \
  X(epoll_ctl, int, (int epfd, int op, int fd, struct epoll_event* event), (epfd, op, fd, event))

namespace hsdig::platform::sys {

namespace detail {
#define HSDIG_SYSCALL_POINTER(name, ret, params, args) \
  using name##_fn = ret(*) params;                     \
  extern std::atomic<name##_fn> name##_entry;
HSDIG_PLATFORM_SYSCALLS(HSDIG_SYSCALL_POINTER)
#undef HSDIG_SYSCALL_POINTER
}  // namespace detail

#define HSDIG_SYSCALL_WRAPPER(name, ret, params, args)                \
  inline ret name params {                                            \
    return detail::name##_entry.load(std::memory_order_relaxed) args; \
  }
HSDIG_PLATFORM_SYSCALLS(HSDIG_SYSCALL_WRAPPER)
#undef HSDIG_SYSCALL_WRAPPER

// Replaces one entry for the life of the object and restores it afterwards.
//   ScopedSyscall<&detail::recv_entry> hook(&myRecv);
template <auto* Entry>
class ScopedSyscall {
 public:
  using Fn = typename std::remove_reference_t<decltype(*Entry)>::value_type;
  explicit ScopedSyscall(Fn replacement) : saved_(Entry->exchange(replacement)) {}
  ~ScopedSyscall() { Entry->store(saved_); }
  ScopedSyscall(const ScopedSyscall&) = delete;
  ScopedSyscall& operator=(const ScopedSyscall&) = delete;

  // The function that was in the table before; replacements forward to it.
  Fn original() const { return saved_; }

 private:
  Fn saved_;
};

}  // namespace hsdig::platform::sys
