// The lock a worker thread holds while it serves its set of connections.
//
// The dispatcher releases it (unlock, no longer owning) once a request has
// been read, so a slow handler does not hold up the worker's other
// connections; the worker takes it again before it waits for the next event.
#pragma once

#include <mutex>

namespace hsdig {

using UniqueGuard = std::unique_lock<std::mutex>;

}  // namespace hsdig
