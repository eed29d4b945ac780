// The engine's status texts (Ivi_GetErrorMessage) and parameter-position
// errors. The README lists the same codes for the error translator.
#include <cstdio>
#include <cstring>

#include "EngineSession.h"

namespace {

// clang-format off
#define CVIVI_MESSAGES(X) \
  X(VI_SUCCESS, "Success.") \
  X(IVI_ERROR_CANNOT_RECOVER, "Unrecoverable failure in the IVI engine.") \
  X(IVI_ERROR_CANNOT_OPEN_FILE, "Unable to open file.") \
  X(IVI_ERROR_READING_FILE, "Error reading file.") \
  X(IVI_ERROR_FUNCTION_NOT_FOUND, "A function of the IVI engine or driver library was not found.") \
  X(IVI_ERROR_INVALID_ATTRIBUTE, "Attribute ID not recognized.") \
  X(IVI_ERROR_ATTRIBUTE_NOT_WRITABLE, "Attribute is read-only.") \
  X(IVI_ERROR_ATTRIBUTE_NOT_READABLE, "Attribute is write-only.") \
  X(IVI_ERROR_INVALID_PARAMETER, "Invalid parameter.") \
  X(IVI_ERROR_INVALID_VALUE, "Invalid value for parameter or attribute.") \
  X(IVI_ERROR_FUNCTION_NOT_SUPPORTED, "Function not supported by the IVI engine.") \
  X(IVI_ERROR_ATTRIBUTE_NOT_SUPPORTED, "Attribute not supported.") \
  X(IVI_ERROR_VALUE_NOT_SUPPORTED, "Value not supported.") \
  X(IVI_ERROR_INVALID_TYPE, "The type is not a valid attribute type.") \
  X(IVI_ERROR_TYPES_DO_NOT_MATCH, "The attribute and the function do not have the same type.") \
  X(IVI_ERROR_ITEM_ALREADY_EXISTS, "The item already exists.") \
  X(IVI_ERROR_INVALID_CONFIGURATION, "The logical-name configuration file is not valid.") \
  X(IVI_ERROR_NO_RANGE_TABLE, "The attribute has no range table.") \
  X(IVI_ERROR_INVALID_RANGE_TABLE, "The range table is not valid.") \
  X(IVI_ERROR_NO_CHANNEL_TABLE, "The session has no channel table.") \
  X(IVI_ERROR_UNKNOWN_CHANNEL_NAME, "Unknown channel or repeated capability name.") \
  X(IVI_ERROR_SYS_RSRC_ALLOC, "Unable to allocate system resource.") \
  X(IVI_ERROR_SESSION_NOT_LOCKED, "The calling thread does not hold the session lock.") \
  X(IVI_ERROR_CHANNEL_NAME_REQUIRED, "A channel or repeated capability name is required.") \
  X(IVI_ERROR_CHANNEL_NAME_NOT_ALLOWED, "The attribute does not take a channel or repeated capability name.") \
  X(IVI_ERROR_BAD_OPTION_NAME, "The option string contains an unknown option name.") \
  X(IVI_ERROR_BAD_OPTION_VALUE, "The option string contains an invalid value.") \
  X(IVI_ERROR_NULL_POINTER, "Null pointer passed for a parameter that requires a value.") \
  X(IVI_ERROR_INVALID_SESSION_HANDLE, "The session handle is not valid.")
// clang-format on

struct Message {
  ViStatus code;
  const char* text;
};
#define CVIVI_MESSAGE_ROW(code, text) {code, text},
constexpr Message kMessages[] = {CVIVI_MESSAGES(CVIVI_MESSAGE_ROW)};
#undef CVIVI_MESSAGE_ROW

}  // namespace

ViStatus Ivi_GetErrorMessage(ViStatus statusCode, ViChar message[IVI_MAX_MESSAGE_BUF_SIZE]) {
  if (!message) return IVI_ERROR_NULL_POINTER;
  char text[IVI_MAX_MESSAGE_BUF_SIZE];
  ViStatus result = VI_SUCCESS;
  const Message* found = nullptr;
  for (const auto& m : kMessages) {
    if (m.code == statusCode) found = &m;
  }
  if (found) {
    std::snprintf(text, sizeof text, "%s", found->text);
  } else if (statusCode >= IVI_ERROR_PARAMETER1 && statusCode <= IVI_ERROR_PARAMETER8) {
    std::snprintf(text, sizeof text, "Parameter %d has an invalid value.",
                  static_cast<int>(statusCode - IVI_ERROR_PARAMETER1 + 1));
  } else {
    std::snprintf(text, sizeof text, "Unknown status code 0x%08X.",
                  static_cast<unsigned>(statusCode));
    result = IVI_ERROR_INVALID_VALUE;
  }
  std::memcpy(message, text, std::strlen(text) + 1);
  return result;
}

ViStatus Ivi_ParamPositionError(ViInt32 parameterPosition) {
  if (parameterPosition >= 1 && parameterPosition <= 8) {
    return IVI_ERROR_PARAMETER1 + (parameterPosition - 1);
  }
  return IVI_ERROR_INVALID_PARAMETER;
}
