#include "errors/translator/NativeFunctions.h"

#include <lua.hpp>

#include <cmath>
#include <string>

#include "errors/translator/CodeMapping.h"
#include "errors/translator/CodePage.h"
#include "errors/translator/ErrorFiles.h"
#include "errors/translator/LuaState.h"
#include "errors/translator/SharedFolder.h"

namespace hsdig::translator {

namespace {

constexpr const char* kLongNames[] = {"English",  "French", "German",
                                      "Japanese", "Korean", "ChineseS"};

// A status code from a script number: signed 32-bit values as they are,
// unsigned 32-bit values (0xBFFA... literals) wrapped.
int32_t codeArg(lua_State* L, int index) {
  double d = luaL_checknumber(L, index);
  if (!(d >= -2147483648.0 && d <= 4294967295.0) || d != std::floor(d)) {
    luaL_error(L, "status code out of range");
  }
  return static_cast<int32_t>(static_cast<uint32_t>(static_cast<int64_t>(d)));
}

int languageArg(lua_State* L, int index) {
  double d = luaL_optnumber(L, index, 0);
  return (d >= 0 && d <= 5 && d == std::floor(d)) ? static_cast<int>(d) : 6;
}

std::string stringArg(lua_State* L, int index) {
  std::size_t size = 0;
  const char* text = luaL_checklstring(L, index, &size);
  return std::string(text, size);
}

int pushLookup(lua_State* L, const ErrorFileLookup& found) {
  if (found.text) {
    lua_pushlstring(L, found.text->data(), found.text->size());
    return 1;
  }
  lua_pushnil(L);
  if (found.failure.empty()) {
    lua_pushnil(L);
  } else {
    lua_pushstring(L, found.failure.c_str());
  }
  return 2;
}

// Searches `folder`/<language>, then `folder`/English; the first failure
// met is kept when nothing is found.
ErrorFileLookup searchByLanguage(const std::string& folder, int language, int32_t code,
                                 bool convert) {
  ErrorFileLookup first = searchErrorFolder(folder + "/" + longLanguageName(language), code);
  if (first.text) {
    if (convert) first.text = mbsToUtf8(language, *first.text);
    return first;
  }
  if (language >= 1 && language <= 5) {
    ErrorFileLookup english = searchErrorFolder(folder + "/English", code);
    if (english.text) {
      if (convert) english.text = mbsToUtf8(0, *english.text);
      return english;
    }
    if (first.failure.empty()) first.failure = std::move(english.failure);
  }
  return first;
}

int nativeMbsToUtf8(lua_State* L) {
  int language = languageArg(L, 1);
  std::string out = mbsToUtf8(language, stringArg(L, 2));
  lua_pushlstring(L, out.data(), out.size());
  return 1;
}

int nativeExpandPath(lua_State* L) {
  std::string path = stringArg(L, 1);
  lua_getfield(L, LUA_REGISTRYINDEX, kSharedFolderKey);
  std::string shared =
      lua_isstring(L, -1) ? std::string(lua_tostring(L, -1)) : installSharedFolder();
  lua_pop(L, 1);
  std::string out = expandPath(path, shared);
  lua_pushlstring(L, out.data(), out.size());
  return 1;
}

int nativeSearchQMErrors(lua_State* L) {
  std::string folder = stringArg(L, 1) + "/" + stringArg(L, 2);
  return pushLookup(L, searchByLanguage(folder, languageArg(L, 3), codeArg(L, 4), true));
}

int nativeSearchSharedErrors(lua_State* L) {
  return pushLookup(L, searchByLanguage(stringArg(L, 1), languageArg(L, 2), codeArg(L, 3), false));
}

int nativeMapErrorCode(lua_State* L) {
  lua_pushnumber(L, cvmxl_mapErrorCode(codeArg(L, 1)));
  return 1;
}

int nativeUnmapErrorCode(lua_State* L) {
  lua_pushnumber(L, cvmxl_unmapErrorCode(codeArg(L, 1)));
  return 1;
}

// The message handler of every protected call: the error text alone; a
// non-text error object is described rather than lost.
int errHandler(lua_State* L) {
  std::string text = errorText(L, 1);
  lua_pushlstring(L, text.data(), text.size());
  return 1;
}

const luaL_Reg kUtils[] = {{"mbsToUtf8", nativeMbsToUtf8},
                           {"expandPath", nativeExpandPath},
                           {"searchQMErrors", nativeSearchQMErrors},
                           {"searchSharedErrors", nativeSearchSharedErrors},
                           {"mapErrorCode", nativeMapErrorCode},
                           {"unmapErrorCode", nativeUnmapErrorCode},
                           {nullptr, nullptr}};

// setupEnv(name, settingsJson): returns the glue module, ready to translate.
int setupEnv(lua_State* L) {
  luaL_checkstring(L, 1);
  luaL_checkstring(L, 2);
  lua_pushcfunction(L, errHandler);
  lua_setglobal(L, "cvxlatorlua_errHandler");

  lua_getglobal(L, "require");
  lua_pushstring(L, "cvxlatorluautils");
  lua_call(L, 1, 1);
  if (!lua_istable(L, -1)) return luaL_error(L, "cvxlatorluautils is not a module table");
  luaL_register(L, nullptr, kUtils);
  lua_pop(L, 1);

  lua_getglobal(L, "require");
  lua_pushstring(L, "cvxlatorlua");
  lua_call(L, 1, 1);
  if (!lua_istable(L, -1)) return luaL_error(L, "cvxlatorlua is not a module table");
  lua_getfield(L, -1, "setup");
  lua_pushvalue(L, 1);
  lua_pushvalue(L, 2);
  lua_call(L, 2, 0);
  return 1;
}

}  // namespace

int luaopen_setupEnv(lua_State* L) {
  lua_pushcfunction(L, setupEnv);
  return 1;
}

const char* longLanguageName(int language) noexcept {
  return (language >= 0 && language <= 5) ? kLongNames[language] : kLongNames[0];
}

}  // namespace hsdig::translator
