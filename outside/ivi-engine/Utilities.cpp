// Memory helpers, value/name tables and number helpers.
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <limits>

#include "Attributes.h"

using namespace cvivi;

namespace {
constexpr int kMaxTableEntries = 65536;
}

ViStatus Ivi_Alloc(ViSession vi, ViInt32 memBlockSize, ViAddr* memBlock) {
  if (!memBlock) return IVI_ERROR_NULL_POINTER;
  *memBlock = nullptr;
  if (memBlockSize <= 0) return IVI_ERROR_INVALID_PARAMETER;
  return withSession(vi, [&](Session& s) {
    void* p = std::calloc(1, static_cast<size_t>(memBlockSize));
    if (!p) return IVI_ERROR_SYS_RSRC_ALLOC;
    s.allocations.insert(p);
    *memBlock = p;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_Free(ViSession vi, ViAddr memBlock) {
  return withSession(vi, [&](Session& s) {
    if (!s.allocations.erase(memBlock)) return IVI_ERROR_INVALID_PARAMETER;
    std::free(memBlock);
    return VI_SUCCESS;
  });
}

ViStatus Ivi_FreeAll(ViSession vi) {
  return withSession(vi, [&](Session& s) {
    for (void* p : s.allocations) std::free(p);
    s.allocations.clear();
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetStringFromTable(IviStringValueTable table, ViInt32 value, ViConstString* string) {
  if (!table || !string) return IVI_ERROR_NULL_POINTER;
  for (int i = 0; i < kMaxTableEntries && table[i].string; ++i) {
    if (table[i].value == value) {
      *string = table[i].string;
      return VI_SUCCESS;
    }
  }
  return IVI_ERROR_INVALID_VALUE;
}

ViStatus Ivi_GetValueFromTable(IviStringValueTable table, ViConstString string, ViInt32* value) {
  if (!table || !string || !value) return IVI_ERROR_NULL_POINTER;
  for (int i = 0; i < kMaxTableEntries && table[i].string; ++i) {
    if (std::strcmp(table[i].string, string) == 0) {
      *value = table[i].value;
      return VI_SUCCESS;
    }
  }
  return IVI_ERROR_INVALID_VALUE;
}

ViStatus Ivi_CheckNumericRange(ViReal64 value, ViReal64 minValue, ViReal64 maxValue,
                               ViStatus errorCode) {
  return (value < minValue || value > maxValue || std::isnan(value)) ? errorCode : VI_SUCCESS;
}

ViStatus Ivi_CheckBooleanRange(ViBoolean value, ViStatus errorCode) {
  return (value != VI_TRUE && value != VI_FALSE) ? errorCode : VI_SUCCESS;
}

ViStatus Ivi_CoerceBoolean(ViBoolean* value) {
  if (!value) return IVI_ERROR_NULL_POINTER;
  *value = *value ? VI_TRUE : VI_FALSE;
  return VI_SUCCESS;
}

ViStatus Ivi_CompareWithPrecision(ViInt32 digitsOfPrecision, ViReal64 a, ViReal64 b,
                                  ViInt32* result) {
  if (!result) return IVI_ERROR_NULL_POINTER;
  if (digitsOfPrecision < 1 || digitsOfPrecision > 14) return IVI_ERROR_INVALID_PARAMETER;
  *result = equalWithPrecision(digitsOfPrecision, a, b) ? 0 : (a < b ? -1 : 1);
  return VI_SUCCESS;
}

ViStatus Ivi_GetViReal64Type(ViReal64 value, ViInt32* type) {
  if (!type) return IVI_ERROR_NULL_POINTER;
  if (std::isnan(value))
    *type = IVI_VAL_TYPE_NAN;
  else if (std::isinf(value))
    *type = value > 0 ? IVI_VAL_TYPE_PINF : IVI_VAL_TYPE_NINF;
  else
    *type = IVI_VAL_TYPE_NORMAL;
  return VI_SUCCESS;
}

ViAddr Ivi_GetPtrToSpecialViReal64Value(ViInt32 type) {
  static ViReal64 nan = std::numeric_limits<ViReal64>::quiet_NaN();
  static ViReal64 pinf = std::numeric_limits<ViReal64>::infinity();
  static ViReal64 ninf = -std::numeric_limits<ViReal64>::infinity();
  switch (type) {
    case IVI_VAL_TYPE_NAN:
      return &nan;
    case IVI_VAL_TYPE_PINF:
      return &pinf;
    case IVI_VAL_TYPE_NINF:
      return &ninf;
    default:
      return nullptr;
  }
}
