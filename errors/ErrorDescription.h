// Builders of the structured error description that travels with a Status
// and that the error translator ("mxlator") turns into localized text.
//
// Shape of the document (every builder creates what it needs on first use):
//   {
//     "translator": "mxlator_hsdig",
//     "translator_info": {
//       "version": 1, "is_debug": false,
//       "ordered_data": [ items in display order ]
//     },
//     "component": ..., "file": ..., "line": ...,     (set by Status::set)
//     "nested_error": [ further descriptions ],
//     "internal_error": [ {"api": ..., "code": ..., "string": ...} ]
//   }
// Items of "ordered_data":
//   {"type": "usage", "usage": KEY, "value": scalar or array, "value_type": TYPE}
//     where TYPE is a type name ("int32_t", "uint32_t", "string", ...) or
//     {"type": "enum", "id": attribute id};
//   {"type": "elaboration", "usage": KEY}   a message key;
//   {"type": "header", "usage": KEY}        a key shown as a heading;
//   {"type": "empty"}                       a blank line.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "errors/Status.h"

namespace hsdig::description {

inline constexpr const char* kTranslatorName = "mxlator_hsdig";
inline constexpr int kTranslatorInfoVersion = 1;

// Makes sure the description names the translator and has "translator_info"
// with "version", "is_debug" and "ordered_data". Existing members are kept.
void prepare(Status& status, bool isDebug = false);

// True when the description has "translator_info" with an "ordered_data" array.
bool hasOrderedData(const Status& status);

// "usage" items. The value type is recorded as the C type name of the value.
void addUsage(Status& status, std::string_view usage, int32_t value);
void addUsage(Status& status, std::string_view usage, uint32_t value);
void addUsage(Status& status, std::string_view usage, int64_t value);
void addUsage(Status& status, std::string_view usage, uint64_t value);
void addUsage(Status& status, std::string_view usage, double value);
void addUsage(Status& status, std::string_view usage, bool value);
void addUsage(Status& status, std::string_view usage, std::string_view value);
void addUsage(Status& status, std::string_view usage, const char* value);
void addUsage(Status& status, std::string_view usage, const std::vector<int32_t>& values);
void addUsage(Status& status, std::string_view usage, const std::vector<std::string>& values);
// A value of an enumerated attribute, shown by the translator as the enum
// value name of attribute `attributeId`.
void addEnumUsage(Status& status, std::string_view usage, int32_t value, uint32_t attributeId);

void addElaboration(Status& status, std::string_view key);
void addHeader(Status& status, std::string_view key);
void addEmpty(Status& status);

// Appends the description of `nested` (with its code as "code") to
// "nested_error"; the translator formats it one level deeper.
void addNestedError(Status& status, const Status& nested);

// Appends a record of a failed system or library call to "internal_error".
void addInternalError(Status& status, std::string_view api, int64_t code, std::string_view text);

}  // namespace hsdig::description
