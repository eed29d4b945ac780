#include "errors/translator/StdintModule.h"

#include <lua.hpp>

#include <cerrno>
#include <cinttypes>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace hsdig::translator {

namespace {

constexpr const char* kMetatable = "hsdig.stdint";

struct Int {
  uint64_t bits;
  bool isUnsigned;
};

int push(lua_State* L, uint64_t bits, bool isUnsigned) {
  auto* v = static_cast<Int*>(lua_newuserdata(L, sizeof(Int)));
  v->bits = bits;
  v->isUnsigned = isUnsigned;
  luaL_getmetatable(L, kMetatable);
  lua_setmetatable(L, -2);
  return 1;
}

Int* test(lua_State* L, int index) {
  void* p = lua_touserdata(L, index);
  if (p == nullptr || !lua_getmetatable(L, index)) return nullptr;
  luaL_getmetatable(L, kMetatable);
  bool same = lua_rawequal(L, -1, -2) != 0;
  lua_pop(L, 2);
  return same ? static_cast<Int*>(p) : nullptr;
}

uint64_t fromDouble(lua_State* L, double d) {
  if (std::isnan(d) || d >= 18446744073709551616.0 || d < -9223372036854775808.0) {
    luaL_error(L, "stdint: number out of the 64-bit range");
  }
  if (d >= 9223372036854775808.0) return static_cast<uint64_t>(d);
  return static_cast<uint64_t>(static_cast<int64_t>(d));
}

uint64_t fromText(lua_State* L, const char* text) {
  bool negative = text[0] == '-';
  const char* digits = negative ? text + 1 : text;
  char* end = nullptr;
  errno = 0;
  unsigned long long value = std::strtoull(digits, &end, 0);
  if (end == digits || *end != '\0' || errno == ERANGE || digits[0] == '-' || digits[0] == '+') {
    luaL_error(L, "stdint: not an integer: %s", text);
  }
  if (negative && value > 9223372036854775808ULL) luaL_error(L, "stdint: not an integer: %s", text);
  return negative ? 0 - static_cast<uint64_t>(value) : static_cast<uint64_t>(value);
}

// Reads operand `index`: a stdint value, a number or an integer text.
Int operand(lua_State* L, int index) {
  if (Int* v = test(L, index)) return *v;
  if (lua_type(L, index) == LUA_TNUMBER) return {fromDouble(L, lua_tonumber(L, index)), false};
  if (lua_type(L, index) == LUA_TSTRING) return {fromText(L, lua_tostring(L, index)), false};
  luaL_error(L, "stdint: operand %d is not an integer", index);
  return {};
}

int construct(lua_State* L, bool isUnsigned) {
  Int v = operand(L, 1);
  return push(L, v.bits, isUnsigned);
}

int int64(lua_State* L) {
  return construct(L, false);
}
int uint64(lua_State* L) {
  return construct(L, true);
}

double toDouble(const Int& v) {
  return v.isUnsigned ? static_cast<double>(v.bits)
                      : static_cast<double>(static_cast<int64_t>(v.bits));
}

int tonumber(lua_State* L) {
  lua_pushnumber(L, toDouble(operand(L, 1)));
  return 1;
}

int tohex(lua_State* L) {
  Int v = operand(L, 1);
  int digits = static_cast<int>(luaL_optinteger(L, 2, 1));
  if (digits < 1 || digits > 16) digits = 1;
  char buffer[32];
  std::snprintf(buffer, sizeof buffer, "%0*" PRIX64, digits, v.bits);
  lua_pushstring(L, buffer);
  return 1;
}

int isinteger(lua_State* L) {
  lua_pushboolean(L, test(L, 1) != nullptr);
  return 1;
}

int toString(lua_State* L) {
  Int v = operand(L, 1);
  char buffer[32];
  if (v.isUnsigned) {
    std::snprintf(buffer, sizeof buffer, "%" PRIu64, v.bits);
  } else {
    std::snprintf(buffer, sizeof buffer, "%" PRId64, static_cast<int64_t>(v.bits));
  }
  lua_pushstring(L, buffer);
  return 1;
}

int concat(lua_State* L) {
  for (int i = 1; i <= 2; ++i) {
    if (test(L, i)) {
      lua_pushcfunction(L, toString);
      lua_pushvalue(L, i);
      lua_call(L, 1, 1);
      lua_replace(L, i);
    }
  }
  luaL_checkstring(L, 1);
  luaL_checkstring(L, 2);
  lua_concat(L, 2);
  return 1;
}

enum class Op { Add, Sub, Mul, Div, Mod };

int arith(lua_State* L, Op op) {
  Int a = operand(L, 1);
  Int b = operand(L, 2);
  bool isUnsigned = a.isUnsigned || b.isUnsigned;
  uint64_t r = 0;
  switch (op) {
    case Op::Add:
      r = a.bits + b.bits;
      break;
    case Op::Sub:
      r = a.bits - b.bits;
      break;
    case Op::Mul:
      r = a.bits * b.bits;
      break;
    case Op::Div:
    case Op::Mod: {
      if (b.bits == 0) luaL_error(L, "stdint: division by zero");
      if (isUnsigned) {
        r = op == Op::Div ? a.bits / b.bits : a.bits % b.bits;
      } else {
        auto x = static_cast<int64_t>(a.bits);
        auto y = static_cast<int64_t>(b.bits);
        if (x == INT64_MIN && y == -1) luaL_error(L, "stdint: overflow in division");
        r = static_cast<uint64_t>(op == Op::Div ? x / y : x % y);
      }
      break;
    }
  }
  return push(L, r, isUnsigned);
}

int add(lua_State* L) {
  return arith(L, Op::Add);
}
int sub(lua_State* L) {
  return arith(L, Op::Sub);
}
int mul(lua_State* L) {
  return arith(L, Op::Mul);
}
int div(lua_State* L) {
  return arith(L, Op::Div);
}
int mod(lua_State* L) {
  return arith(L, Op::Mod);
}
int unm(lua_State* L) {
  Int a = operand(L, 1);
  return push(L, 0 - a.bits, a.isUnsigned);
}

// -1, 0 or 1. Mixed signedness compares mathematically.
int compare(const Int& a, const Int& b) {
  bool aNegative = !a.isUnsigned && static_cast<int64_t>(a.bits) < 0;
  bool bNegative = !b.isUnsigned && static_cast<int64_t>(b.bits) < 0;
  if (aNegative != bNegative) return aNegative ? -1 : 1;
  if (aNegative) {
    auto x = static_cast<int64_t>(a.bits), y = static_cast<int64_t>(b.bits);
    return x < y ? -1 : (x > y ? 1 : 0);
  }
  return a.bits < b.bits ? -1 : (a.bits > b.bits ? 1 : 0);
}

int eq(lua_State* L) {
  lua_pushboolean(L, compare(operand(L, 1), operand(L, 2)) == 0);
  return 1;
}
int lt(lua_State* L) {
  lua_pushboolean(L, compare(operand(L, 1), operand(L, 2)) < 0);
  return 1;
}
int le(lua_State* L) {
  lua_pushboolean(L, compare(operand(L, 1), operand(L, 2)) <= 0);
  return 1;
}

const luaL_Reg kMeta[] = {
    {"__add", add}, {"__sub", sub},           {"__mul", mul},       {"__div", div},
    {"__mod", mod}, {"__unm", unm},           {"__eq", eq},         {"__lt", lt},
    {"__le", le},   {"__tostring", toString}, {"__concat", concat}, {nullptr, nullptr}};

const luaL_Reg kFunctions[] = {{"int64", int64}, {"uint64", uint64},       {"tonumber", tonumber},
                               {"tohex", tohex}, {"isinteger", isinteger}, {nullptr, nullptr}};

}  // namespace

int luaopen_stdint(lua_State* L) {
  luaL_newmetatable(L, kMetatable);
  luaL_register(L, nullptr, kMeta);
  lua_pop(L, 1);
  lua_newtable(L);
  luaL_register(L, nullptr, kFunctions);
  return 1;
}

}  // namespace hsdig::translator
