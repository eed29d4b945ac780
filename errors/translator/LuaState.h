// Owner of one Lua 5.1 interpreter state with the translator's modules in
// its preload table.
//
// The interpreter is built as C++: a script error unwinds C++ frames as an
// exception, so native functions may hold C++ objects. An error outside any
// protected call (a "panic") becomes a std::runtime_error instead of ending
// the process. A state is used by one thread at a time.
#pragma once

#include <string>

struct lua_State;

namespace hsdig::translator {

class LuaState {
 public:
  // Creates the state and opens the standard libraries. Throws
  // TranslationFailure("failed to create lua state") when that fails.
  LuaState();
  ~LuaState();
  LuaState(const LuaState&) = delete;
  LuaState& operator=(const LuaState&) = delete;

  lua_State* get() const noexcept { return L_; }

 private:
  lua_State* L_;
};

// Adds every embedded script and term table and the native modules
// ("cjson", "lfs", "stdint", "cvxlatorlua_setupEnv") to package.preload.
// Returns false when the preload table cannot be filled.
bool addEmbeddedModules(lua_State* L) noexcept;

// The message of the error object on top of the stack, as text.
std::string errorText(lua_State* L, int index);

}  // namespace hsdig::translator
