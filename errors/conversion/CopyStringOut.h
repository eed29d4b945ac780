// The IVI string output rule, shared by every export that returns text.
#pragma once

#include <string_view>

#include "hsdigRemote/vitypes.h"

namespace hsdig {

// needed = text length + 1.
// - bufferSize 0: returns needed; writes nothing.
// - buffer null: returns 0xBFFA0058.
// - bufferSize >= needed, or negative: copies the text and its terminator;
//   returns 0. A negative size is the caller's promise that the buffer is
//   big enough.
// - otherwise: copies bufferSize - 1 bytes and a terminator; returns needed.
// Never writes more than bufferSize bytes when bufferSize is positive.
ViStatus copyStringOut(std::string_view text, ViInt32 bufferSize, ViChar* buffer);

}  // namespace hsdig
