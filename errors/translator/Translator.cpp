#include "errors/translator/Translator.h"

#include <rapidjson/document.h>
#include <rapidjson/stringbuffer.h>
#include <rapidjson/writer.h>
#include <lua.hpp>

#include "errors/ErrorDescription.h"
#include "errors/translator/LuaState.h"
#include "errors/translator/NativeFunctions.h"

namespace hsdig::translator {

namespace {

// Keeps the stack height of a scope: whatever a call leaves is dropped.
class StackGuard {
 public:
  explicit StackGuard(lua_State* L) : L_(L), top_(lua_gettop(L)) {}
  ~StackGuard() { lua_settop(L_, top_); }
  StackGuard(const StackGuard&) = delete;
  StackGuard& operator=(const StackGuard&) = delete;

 private:
  lua_State* L_;
  int top_;
};

std::string toText(lua_State* L, int index) {
  std::size_t size = 0;
  const char* text = lua_tolstring(L, index, &size);
  return text ? std::string(text, size) : std::string();
}

[[noreturn]] void throwLua(int luaStatus, const std::string& message,
                           const char* summary = nullptr) {
  TranslationFailure failure(luaStatus == LUA_ERRMEM ? kCodeOutOfMemory : kCodeInternal,
                             summary ? std::string(summary) : message);
  description::addInternalError(failure.status(), "lua", luaStatus, message);
  throw failure;
}

}  // namespace

TranslationFailure::TranslationFailure(int32_t code, const std::string& message,
                                       std::string partialText)
    : std::runtime_error(message), status_(code), partialText_(std::move(partialText)) {}

Translator::Translator(std::string_view settingsJson, std::string sharedFolder) {
  rapidjson::Document settings;
  settings.Parse(settingsJson.data(), settingsJson.size());
  if (settings.HasParseError() || !settings.IsObject() ||
      !settings.HasMember("cvxlatorlua_xlator") || !settings["cvxlatorlua_xlator"].IsString()) {
    throw TranslationFailure(kCodeInternal, "could not find translator key in json");
  }
  std::string name = settings["cvxlatorlua_xlator"].GetString();
  std::string inner = "{}";
  if (auto found = settings.FindMember("cvxlatorlua_settings");
      found != settings.MemberEnd() && found->value.IsObject()) {
    rapidjson::StringBuffer buffer;
    rapidjson::Writer<rapidjson::StringBuffer> writer(buffer);
    found->value.Accept(writer);
    inner.assign(buffer.GetString(), buffer.GetSize());
  }

  lua_ = std::make_unique<LuaState>();
  lua_State* L = lua_->get();
  if (!addEmbeddedModules(L)) {
    throw TranslationFailure(kCodeInternal, "failed to add embedded modules to preload table");
  }
  lua_pushlstring(L, sharedFolder.data(), sharedFolder.size());
  lua_setfield(L, LUA_REGISTRYINDEX, kSharedFolderKey);

  StackGuard guard(L);
  lua_getglobal(L, "require");
  lua_pushstring(L, "cvxlatorlua_setupEnv");
  int status = lua_pcall(L, 1, 1, 0);
  if (status == 0) {
    lua_pushlstring(L, name.data(), name.size());
    lua_pushlstring(L, inner.data(), inner.size());
    status = lua_pcall(L, 2, 1, 0);
  }
  if (status != 0) throwLua(status, errorText(L, -1), "lua setupEnv failed");
  glueRef_ = luaL_ref(L, LUA_REGISTRYINDEX);
}

Translator::~Translator() = default;

lua_State* Translator::state() noexcept {
  return lua_->get();
}

void Translator::call(const char* name, int nargs, int nresults) {
  lua_State* L = lua_->get();
  lua_getglobal(L, "cvxlatorlua_errHandler");
  lua_rawgeti(L, LUA_REGISTRYINDEX, glueRef_);
  lua_getfield(L, -1, name);
  lua_remove(L, -2);
  // Stack: args..., handler, function. Move handler and function below the args.
  lua_insert(L, -(nargs + 2));
  lua_insert(L, -(nargs + 2));
  int handler = lua_gettop(L) - nargs - 1;
  int status = lua_pcall(L, nargs, nresults, handler);
  lua_remove(L, handler);
  if (status != 0) {
    std::string message = errorText(L, -1);
    lua_pop(L, 1);
    throwLua(status, message);
  }
}

std::string Translator::getStaticDesc(int32_t code, int language, int ade) {
  lua_State* L = lua_->get();
  StackGuard guard(L);
  lua_pushnumber(L, code);
  lua_pushinteger(L, language);
  lua_pushinteger(L, ade);
  call("getStaticDesc", 3, 2);
  std::string text = lua_isstring(L, -2) ? toText(L, -2) : std::string(kDescriptionNotFound);
  if (lua_isstring(L, -1)) throw TranslationFailure(kCodeInternal, toText(L, -1), text);
  return text;
}

std::string Translator::getDynamicDesc(std::string_view errjson, int language, int ade,
                                       std::string_view format) {
  lua_State* L = lua_->get();
  StackGuard guard(L);
  lua_pushlstring(L, errjson.data(), errjson.size());
  lua_pushinteger(L, language);
  lua_pushinteger(L, ade);
  lua_pushlstring(L, format.data(), format.size());
  call("getDynamicDesc", 4, 3);
  if (lua_isstring(L, -3)) return toText(L, -3);
  auto code = static_cast<int32_t>(lua_isnumber(L, -2) ? lua_tonumber(L, -2) : kCodeInternal);
  throw TranslationFailure(
      code, lua_isstring(L, -1) ? toText(L, -1) : std::string("getDynamicDesc failed"));
}

std::vector<std::pair<int32_t, std::string>> Translator::listStaticDescs(int language) {
  lua_State* L = lua_->get();
  StackGuard guard(L);
  lua_pushinteger(L, language);
  call("listStaticDescs", 1, 1);
  std::vector<std::pair<int32_t, std::string>> out;
  if (!lua_istable(L, -1)) return out;
  int count = static_cast<int>(lua_objlen(L, -1));
  for (int i = 1; i <= count; ++i) {
    lua_rawgeti(L, -1, i);
    lua_rawgeti(L, -1, 1);
    lua_rawgeti(L, -2, 2);
    if (lua_isnumber(L, -2) && lua_isstring(L, -1)) {
      out.emplace_back(static_cast<int32_t>(lua_tonumber(L, -2)), toText(L, -1));
    }
    lua_pop(L, 3);
  }
  return out;
}

}  // namespace hsdig::translator
