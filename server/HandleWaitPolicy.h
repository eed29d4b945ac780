// How a worker waits for any one of its task handles.
#pragma once

#include <cstddef>
#include <vector>

namespace hsdig {

// Waits with poll over at most 64 descriptors. A handle of -1 is never ready.
struct PollWaitPolicy {
  static constexpr std::size_t kMaxHandles = 64;

  // Waits until one handle is ready (readable, hung up or in error) or
  // `timeoutMs` has passed. Returns the lowest index of a ready handle, or -1
  // on time-out. Interrupted waits resume with the time left. A failure of
  // the wait writes the diagnostic line "SelectPolicy<TPipeServer>::
  // wait_for_multiple() " with the error and throws TTransportException
  // kind unknown.
  //
  // With `alsoReady`, the indices of the other handles found ready in the
  // same wait are appended to it, highest first, so that the caller can serve
  // them without waiting again.
  static int wait_for_multiple(const int* handles, std::size_t count, int timeoutMs,
                               std::vector<int>* alsoReady = nullptr);
};

}  // namespace hsdig
