// The translator's Lua scripts and term tables, embedded into the library at
// build time (EmbedModules.cmake generates the definitions). Each entry is
// the module name (the file name without ".lua") and the file's bytes.
// The data is immutable and may be read from any thread.
#pragma once

#include <cstddef>

namespace hsdig::translator {

struct EmbeddedModule {
  const char* name;
  const unsigned char* data;
  std::size_t size;  // without the terminating zero that follows the data
};

extern const EmbeddedModule kEmbeddedModules[];
extern const std::size_t kEmbeddedModuleCount;

}  // namespace hsdig::translator
