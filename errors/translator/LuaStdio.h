// The standard streams and the exit function of the statically linked
// interpreter and its native modules (their references are renamed at build
// time, see CMakeLists.txt). A library inside someone else's process never
// writes to its console nor ends it: the streams discard what is written and
// read as empty, and exit throws std::bad_alloc, the JSON module's string
// buffer being its one caller in practice (when memory runs out).
#pragma once

namespace hsdig::translator {

// Makes the streams ready; called before any interpreter state is created.
// Thread-safe and idempotent.
void prepareLuaStdio() noexcept;

}  // namespace hsdig::translator
