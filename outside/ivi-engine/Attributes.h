// Typed attribute machinery shared by the engine's attribute, callback and
// range-table functions. Everything here runs under the session lock.
#pragma once

#include <string>

#include "EngineSession.h"

namespace cvivi {

template <class T>
struct Traits;
#define CVIVI_TRAITS(T, Code, InT, StoredT, Numeric) \
  template <>                                        \
  struct Traits<T> {                                 \
    static constexpr ViInt32 type = Code;            \
    static constexpr bool numeric = Numeric;         \
    using In = InT;                                  \
    using Stored = StoredT;                          \
    using Read = IviReadCallback##T;                 \
    using Write = IviWriteCallback##T;               \
    using Check = IviCheckCallback##T;               \
    using Coerce = IviCoerceCallback##T;             \
    using Compare = IviCompareCallback##T;           \
  };
CVIVI_TRAITS(ViInt32, IVI_VAL_INT32, ViInt32, ViInt32, true)
CVIVI_TRAITS(ViInt64, IVI_VAL_INT64, ViInt64, ViInt64, true)
CVIVI_TRAITS(ViReal64, IVI_VAL_REAL64, ViReal64, ViReal64, true)
CVIVI_TRAITS(ViString, IVI_VAL_STRING, ViConstString, std::string, false)
CVIVI_TRAITS(ViBoolean, IVI_VAL_BOOLEAN, ViBoolean, ViBoolean, false)
CVIVI_TRAITS(ViSession, IVI_VAL_SESSION, ViSession, ViSession, false)
CVIVI_TRAITS(ViAddr, IVI_VAL_ADDR, ViAddr, ViAddr, false)
#undef CVIVI_TRAITS

// Finds attribute `id` (of `type`, unless type is 0) and the instance that
// `channelName` names. `key` receives the canonical instance name.
ViStatus lookupAttribute(Session& s, ViAttr id, ViInt32 type, ViConstString channelName,
                         Attribute*& attribute, std::string& key);

// Runs body(session, attribute, key) on session `vi` for the instance of
// attribute `id` that `channelName` names, after the lookup above; a failed
// lookup is returned without running `body`.
template <class Body>
ViStatus withInstance(ViSession vi, ViConstString channelName, ViAttr id, ViInt32 type,
                      Body&& body) noexcept {
  return withSession(vi, [&](Session& s) -> ViStatus {
    Attribute* a = nullptr;
    std::string key;
    if (ViStatus st = lookupAttribute(s, id, type, channelName, a, key); st < 0) return st;
    return body(s, a, key);
  });
}

// The canonical name of `name` in the repeated capability `repCap`.
ViStatus resolveRepCapName(Session& s, const std::string& repCap, std::string_view name,
                           std::string& canonical);

// The instance `key` of `a`, created with the default value on first use.
Instance& instanceOf(Attribute& a, const std::string& key);

// The attribute's range table for `key`: its range-table callback's answer,
// else the table given when it was added (may be null).
ViStatus rangeTableOf(Session& s, Attribute& a, const std::string& key, IviRangeTablePtr& table);

// Range-table checks and coercion (RangeTables.cpp).
template <class T>
ViStatus checkWithTable(IviRangeTablePtr table, T value, ViInt32 precision);
template <class T>
ViStatus coerceWithTable(IviRangeTablePtr table, T value, T& coerced);
template <class T>
ViStatus minMaxOfTable(IviRangeTablePtr table, T& minValue, T& maxValue, bool& hasMin,
                       bool& hasMax);
bool equalWithPrecision(ViInt32 digits, ViReal64 a, ViReal64 b);

}  // namespace cvivi
