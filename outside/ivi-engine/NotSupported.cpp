// The engine functions that nothing in the system or the simulated driver
// calls: generated from the table's NSUP rows, each answers
// IVI_ERROR_FUNCTION_NOT_SUPPORTED (value-returning ones answer 0).
#include "IviEngine.h"

#pragma GCC diagnostic ignored "-Wunused-parameter"

#define CVIVI_RESULT_STATUS IVI_ERROR_FUNCTION_NOT_SUPPORTED
#define CVIVI_RESULT_CLASS IVI_ERROR_FUNCTION_NOT_SUPPORTED
#define CVIVI_RESULT_VALUE 0
#define CVIVI_STUB_IMPL(cname, kind, ret, params)
#define CVIVI_STUB_NSUP(cname, kind, ret, params)    \
  ret cname params {                                 \
    return (ret)IVI_ENGINE_CAT(CVIVI_RESULT_, kind); \
  }
#define CVIVI_STUB(cname, method, avail, kind, support, ret, sess, params, args) \
  IVI_ENGINE_CAT(CVIVI_STUB_, support)(cname, kind, ret, params)

IVI_ENGINE_FUNCTIONS(CVIVI_STUB)
