#include "session/IviWrapper.h"

#include "errors/Exception.h"

namespace hsdig {

ViStatus IviWrapper::settle(ViStatus status, int noThrow, bool returnsSize,
                            const std::source_location& where) {
  if (noThrow) return status;
  if (status < 0) throw Exception(status, where);
  if (status > 0 && !returnsSize) {
    // A warning stays readable as the session's error information; an error
    // already recorded there is kept.
    binding_.Ivi_SetErrorInfo(session_, VI_FALSE, status, 0, nullptr);
    return status;
  }
  return status;
}

// For S rows the row's argument list names `vi`: it is this wrapper's
// session.
#define HSDIG_IVI_DEFINE_STATUS(cname, method, ret, sess, params, args)                    \
  ViStatus IviWrapper::method(HSDIG_IVI_WITH_NOTHROW(HSDIG_IVI_OP_PARAMS(sess, params))) { \
    [[maybe_unused]] const ViSession vi = session_;                                        \
    return settle(binding_.cname args, noThrow, ivi::returnsNeededSize(#params),           \
                  std::source_location::current());                                        \
  }
#define HSDIG_IVI_DEFINE_VALUE(cname, method, ret, sess, params, args) \
  ret IviWrapper::method(HSDIG_IVI_OP_PARAMS(sess, params)) {          \
    [[maybe_unused]] const ViSession vi = session_;                    \
    return binding_.cname args;                                        \
  }
#define HSDIG_IVI_DEFINE_CLASS HSDIG_IVI_DEFINE_VALUE
#define HSDIG_IVI_DEFINE(cname, method, avail, kind, support, ret, sess, params, args) \
  IVI_ENGINE_CAT(HSDIG_IVI_DEFINE_, kind)(cname, method, ret, sess, params, args)
IVI_ENGINE_FUNCTIONS(HSDIG_IVI_DEFINE)
#undef HSDIG_IVI_DEFINE

}  // namespace hsdig
