#include "errors/translator/LuaStdio.h"

#include <stdio.h>

#include <mutex>
#include <new>

extern "C" {
FILE* hsdig_lua_stdin = nullptr;
FILE* hsdig_lua_stdout = nullptr;
FILE* hsdig_lua_stderr = nullptr;

[[noreturn]] void hsdig_lua_exit(int) {
  throw std::bad_alloc();
}
}

namespace hsdig::translator {

namespace {

ssize_t discardWrite(void*, const char*, size_t size) {
  return static_cast<ssize_t>(size);
}
ssize_t emptyRead(void*, char*, size_t) {
  return 0;
}

// A stream that reads as empty and swallows writes. Never closed: the
// interpreter may hold it until the process ends.
FILE* nullStream(const char* mode) {
  cookie_io_functions_t functions{};
  functions.read = emptyRead;
  functions.write = discardWrite;
  return fopencookie(nullptr, mode, functions);
}

}  // namespace

void prepareLuaStdio() noexcept {
  static std::once_flag once;
  std::call_once(once, [] {
    hsdig_lua_stdin = nullStream("r");
    hsdig_lua_stdout = nullStream("w");
    hsdig_lua_stderr = nullStream("w");
  });
}

}  // namespace hsdig::translator
