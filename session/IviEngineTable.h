// Helpers that turn rows of the engine function table (IVI_ENGINE_FUNCTIONS
// in IviEngine.h) into the binding's members and IviWrapper's operations.
//
// A row's parameter list is the engine function's own; for rows marked S the
// first parameter is the session, which IviWrapper supplies itself, so an
// operation takes the parameters after it. Status-returning operations add
// the trailing `noThrow` flag.
#pragma once

#include <string_view>

#include "IviEngine.h"

#define HSDIG_IVI_EXPAND(x) x
#define HSDIG_IVI_UNPAREN(...) __VA_ARGS__
#define HSDIG_IVI_DROP_FIRST(first, ...) __VA_ARGS__

// The operation's parameters: without the session for S rows.
#define HSDIG_IVI_OP_PARAMS_S(params) HSDIG_IVI_EXPAND(HSDIG_IVI_DROP_FIRST params)
#define HSDIG_IVI_OP_PARAMS_N(params) HSDIG_IVI_UNPAREN params
#define HSDIG_IVI_OP_PARAMS(sess, params) IVI_ENGINE_CAT(HSDIG_IVI_OP_PARAMS_, sess)(params)

// Appends the noThrow flag (with or without its default) to a parameter list
// that may be empty.
#define HSDIG_IVI_WITH_NOTHROW_DEFAULT(...) __VA_ARGS__ __VA_OPT__(, ) int noThrow = 0
#define HSDIG_IVI_WITH_NOTHROW(...) __VA_ARGS__ __VA_OPT__(, ) int noThrow

#define HSDIG_IVI_IS_REQUIRED_REQ true
#define HSDIG_IVI_IS_REQUIRED_OPT false
#define HSDIG_IVI_IS_REQUIRED(avail) IVI_ENGINE_CAT(HSDIG_IVI_IS_REQUIRED_, avail)

namespace hsdig::ivi {

// True for rows whose function writes text under the IVI string rule: their
// positive result is the size needed, not a warning.
constexpr bool returnsNeededSize(std::string_view params) {
  return params.find("ViInt32 bufferSize") != std::string_view::npos;
}

}  // namespace hsdig::ivi
