#include "server/HandleWaitPolicy.h"

#include <poll.h>
#include <time.h>

#include <cerrno>
#include <string>

#include <thrift/transport/TTransportException.h>

#include "platform/Diagnostic.h"
#include "platform/Syscalls.h"

namespace hsdig {

namespace {

int64_t nowMs() {
  timespec ts{};
  clock_gettime(CLOCK_MONOTONIC, &ts);
  return int64_t{ts.tv_sec} * 1000 + ts.tv_nsec / 1000000;
}

[[noreturn]] void fail(int error) {
  const char* what = "SelectPolicy<TPipeServer>::wait_for_multiple() ";
  platform::reportErrno(what, error);
  throw apache::thrift::transport::TTransportException(
      apache::thrift::transport::TTransportException::UNKNOWN,
      "Unknown: " + platform::errnoText("", error));
}

}  // namespace

int PollWaitPolicy::wait_for_multiple(const int* handles, std::size_t count, int timeoutMs,
                                      std::vector<int>* alsoReady) {
  if (count > kMaxHandles) fail(EINVAL);
  pollfd fds[kMaxHandles];
  for (std::size_t i = 0; i < count; ++i) fds[i] = pollfd{handles[i], POLLIN, 0};

  const int64_t deadline = nowMs() + timeoutMs;
  int left = timeoutMs;
  for (;;) {
    const int ready = platform::sys::poll(fds, static_cast<nfds_t>(count), left);
    if (ready > 0) break;
    if (ready == 0) return -1;
    if (errno != EINTR) fail(errno);
    const int64_t remaining = deadline - nowMs();
    if (remaining <= 0) return -1;
    left = static_cast<int>(remaining);
  }
  // POLLNVAL (a handle closed under the wait) counts as ready: the task's
  // own read then fails and takes its failure path.
  int first = -1;
  for (std::size_t i = 0; i < count; ++i) {
    if (fds[i].revents != 0) {
      first = static_cast<int>(i);
      break;
    }
  }
  if (alsoReady != nullptr && first >= 0) {
    for (std::size_t i = count; i-- > static_cast<std::size_t>(first) + 1;) {
      if (fds[i].revents != 0) alsoReady->push_back(static_cast<int>(i));
    }
  }
  return first;
}

}  // namespace hsdig
