// Moving infrastructure status codes into the driver's IVI status range and
// back.
//
// Infrastructure failures use small codes (-52000 out of memory, -52003
// internal, ...) and the codes of a few neighbouring components; before any
// of them reaches a caller it is moved into the 0xBFFAxxxx range (warnings
// into 0x3FFAxxxx, or the negated mapping for the mirrored positive ranges).
// `cvmxl_unmapErrorCode` is the exact inverse on every mapped code; both
// leave every other code unchanged. Pure functions, callable from any thread.
#pragma once

#include <cstdint>

namespace hsdig::translator {

int32_t cvmxl_mapErrorCode(int32_t code) noexcept;
int32_t cvmxl_unmapErrorCode(int32_t code) noexcept;

}  // namespace hsdig::translator
