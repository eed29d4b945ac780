#include "errors/translator/LuaState.h"

#include <lua.hpp>

#include <stdexcept>

#include "errors/translator/EmbeddedModules.h"
#include "errors/translator/LuaStdio.h"
#include "errors/translator/NativeFunctions.h"
#include "errors/translator/StdintModule.h"
#include "errors/translator/Translator.h"

// The statically linked lua-cjson and LuaFileSystem modules (C linkage).
extern "C" int luaopen_cjson(lua_State* L);
extern "C" int luaopen_lfs(lua_State* L);

namespace hsdig::translator {

namespace {

int panic(lua_State* L) {
  throw std::runtime_error("lua panic: " + errorText(L, -1));
}

// Loader of an embedded module; upvalue 1 is its index in kEmbeddedModules.
int loadEmbedded(lua_State* L) {
  auto index = static_cast<std::size_t>(lua_tointeger(L, lua_upvalueindex(1)));
  const EmbeddedModule& module = kEmbeddedModules[index];
  std::string chunkName = std::string("=") + module.name;
  if (luaL_loadbuffer(L, reinterpret_cast<const char*>(module.data), module.size,
                      chunkName.c_str()) != 0) {
    return lua_error(L);
  }
  lua_pushvalue(L, 1);  // the module name, as require passes it
  lua_call(L, 1, 1);
  return 1;
}

struct NativeModule {
  const char* name;
  lua_CFunction open;
};

const NativeModule kNativeModules[] = {
    {"cjson", luaopen_cjson},
    {"lfs", luaopen_lfs},
    {"stdint", luaopen_stdint},
    {"cvxlatorlua_setupEnv", luaopen_setupEnv},
};

int fillPreload(lua_State* L) {
  lua_getglobal(L, "package");
  if (!lua_istable(L, -1)) return luaL_error(L, "no package table");
  lua_getfield(L, -1, "preload");
  if (!lua_istable(L, -1)) return luaL_error(L, "no preload table");
  for (std::size_t i = 0; i < kEmbeddedModuleCount; ++i) {
    lua_pushinteger(L, static_cast<lua_Integer>(i));
    lua_pushcclosure(L, loadEmbedded, 1);
    lua_setfield(L, -2, kEmbeddedModules[i].name);
  }
  for (const auto& native : kNativeModules) {
    lua_pushcfunction(L, native.open);
    lua_setfield(L, -2, native.name);
  }
  return 0;
}

}  // namespace

namespace {

lua_State* newState() {
  prepareLuaStdio();
  return luaL_newstate();
}

// Functions of the standard libraries that could end or spawn processes;
// the translator's scripts never need them.
constexpr const char* kRemoved = "os.exit = nil os.execute = nil io.popen = nil debug.debug = nil";

}  // namespace

LuaState::LuaState() : L_(newState()) {
  if (L_ == nullptr) throw TranslationFailure(kCodeInternal, "failed to create lua state");
  lua_atpanic(L_, panic);
  try {
    luaL_openlibs(L_);
    if (luaL_dostring(L_, kRemoved) != 0) throw std::runtime_error("cannot restrict the libraries");
  } catch (...) {
    lua_close(L_);
    throw TranslationFailure(kCodeInternal, "failed to create lua state");
  }
}

LuaState::~LuaState() {
  lua_close(L_);
}

bool addEmbeddedModules(lua_State* L) noexcept {
  try {
    lua_pushcfunction(L, fillPreload);
    return lua_pcall(L, 0, 0, 0) == 0 || (lua_pop(L, 1), false);
  } catch (...) {
    return false;
  }
}

std::string errorText(lua_State* L, int index) {
  if (lua_type(L, index) == LUA_TSTRING || lua_type(L, index) == LUA_TNUMBER) {
    std::size_t size = 0;
    const char* text = lua_tolstring(L, index, &size);
    return std::string(text, size);
  }
  return "(error object is not a string)";
}

}  // namespace hsdig::translator
