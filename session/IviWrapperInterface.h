// IviWrapperInterface: the one door to the IVI engine for a session handle.
//
// After the destructor and getSessionHandle, one operation per engine
// function in the order of the engine function table, named after the
// function in lower camel case without its prefix. An operation takes the
// engine function's parameters after its session parameter (the wrapper
// supplies the session); functions without a session parameter take theirs
// unchanged. Status-returning operations take a trailing `noThrow` flag:
// - noThrow set: the engine's status is returned as it is;
// - otherwise an error throws Exception with the status and the operation's
//   source location, a warning is recorded in the session's error
//   information (not overwriting an error already there) and returned, and
//   success returns 0.
// Operations that write text under the IVI string rule return the size they
// need as a positive value; that size is not a warning and is not recorded.
// Value-returning operations have no flag and return the engine's value.
//
// A wrapper holds only its session handle; it does not own the engine
// session (dispose() ends it). Any thread may use any wrapper.
#pragma once

#include "session/IviEngineTable.h"

namespace hsdig {

class IviWrapperInterface {
 public:
  virtual ~IviWrapperInterface() = default;
  virtual ViSession getSessionHandle() const = 0;

#define HSDIG_IVI_OP_STATUS(method, ret, sess, params) \
  virtual ViStatus method(HSDIG_IVI_WITH_NOTHROW_DEFAULT(HSDIG_IVI_OP_PARAMS(sess, params))) = 0;
#define HSDIG_IVI_OP_VALUE(method, ret, sess, params) \
  virtual ret method(HSDIG_IVI_OP_PARAMS(sess, params)) = 0;
#define HSDIG_IVI_OP_CLASS HSDIG_IVI_OP_VALUE
#define HSDIG_IVI_OP_DECLARE(cname, method, avail, kind, support, ret, sess, params, args) \
  IVI_ENGINE_CAT(HSDIG_IVI_OP_, kind)(method, ret, sess, params)
  IVI_ENGINE_FUNCTIONS(HSDIG_IVI_OP_DECLARE)
#undef HSDIG_IVI_OP_DECLARE
#undef HSDIG_IVI_OP_CLASS
#undef HSDIG_IVI_OP_VALUE
#undef HSDIG_IVI_OP_STATUS
};

}  // namespace hsdig
