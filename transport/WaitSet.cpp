#include "transport/WaitSet.h"

#include <sys/epoll.h>

#include <cerrno>

#include <thrift/concurrency/Exception.h>

#include "platform/Diagnostic.h"
#include "platform/Syscalls.h"

namespace hsdig::transport {

void eventCreationFailed(int error) {
  platform::reportErrno("TManualResetEvent unable to create event, GLE=", error);
  throw apache::thrift::concurrency::SystemResourceException("CreateEvent failed");
}

void addToWaitSet(int waitSet, int fd) {
  epoll_event event{};
  event.events = EPOLLIN;
  event.data.fd = fd;
  if (platform::sys::epoll_ctl(waitSet, EPOLL_CTL_ADD, fd, &event) != 0) {
    eventCreationFailed(errno);
  }
}

}  // namespace hsdig::transport
