// The native "stdint" module: exact 64-bit integer values for scripts, whose
// numbers are doubles.
//
//   stdint.int64(v), stdint.uint64(v)  from a number, a decimal or "0x" text,
//                                       or another stdint value
//   stdint.tonumber(v)                  the nearest double
//   stdint.tohex(v [, digits])          upper-case hexadecimal, zero-padded
//   stdint.isinteger(v)                 true for a stdint value
// Values support + - * / % unary -, ==, <, <=, tostring and "..". Mixed with a
// plain number, the number is truncated to an integer first; a result is
// unsigned when either operand is. Addition, subtraction and multiplication
// wrap around; division by zero and the one overflowing signed division raise
// a script error. Note that Lua compares a number and a stdint value with ==
// as never equal (that comparison does not reach the metamethod).
#pragma once

struct lua_State;

namespace hsdig::translator {

int luaopen_stdint(lua_State* L);

}  // namespace hsdig::translator
