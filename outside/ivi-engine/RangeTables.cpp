// Range tables: validation, lookups, default checking and coercion, and the
// tables the engine makes with Ivi_RangeTableNew. A table ends with the entry
// whose cmdString is IVI_RANGE_TABLE_END_STRING; a table without one within
// kMaxEntries entries is refused rather than read past its end.
#include <algorithm>
#include <cmath>
#include <cstring>

#include "Attributes.h"

using namespace cvivi;

namespace {

constexpr ViInt32 kMaxEntries = 65536;

std::mutex g_ownedMutex;
// Tables made by Ivi_RangeTableNew, so that the session-less entry setters
// can check an index against the capacity.
std::map<IviRangeTablePtr, OwnedRangeTable*>& ownedTables() {
  static auto* map = new std::map<IviRangeTablePtr, OwnedRangeTable*>();
  return *map;
}

bool isEnd(const IviRangeTableEntry& e) {
  return e.cmdString == IVI_RANGE_TABLE_END_STRING;
}

ViStatus countEntries(IviRangeTablePtr table, ViInt32& count) {
  if (!table) return IVI_ERROR_NULL_POINTER;
  if (!table->rangeValues) return IVI_ERROR_INVALID_RANGE_TABLE;
  if (table->type != IVI_VAL_DISCRETE && table->type != IVI_VAL_RANGED &&
      table->type != IVI_VAL_COERCED) {
    return IVI_ERROR_INVALID_RANGE_TABLE;
  }
  for (ViInt32 i = 0; i < kMaxEntries; ++i) {
    if (isEnd(table->rangeValues[i])) {
      count = i;
      return VI_SUCCESS;
    }
  }
  return IVI_ERROR_INVALID_RANGE_TABLE;
}

template <class T>
T minOf(const IviRangeTableEntry& e) {
  if constexpr (std::is_same_v<T, ViInt64>)
    return e.discreteOrMinValueViInt64;
  else
    return static_cast<T>(e.discreteOrMinValue);
}
template <class T>
T maxOf(const IviRangeTableEntry& e) {
  if constexpr (std::is_same_v<T, ViInt64>)
    return e.maxValueViInt64;
  else
    return static_cast<T>(e.maxValue);
}
template <class T>
T coercedOf(const IviRangeTableEntry& e) {
  if constexpr (std::is_same_v<T, ViInt64>)
    return e.coercedValueViInt64;
  else
    return static_cast<T>(e.coercedValue);
}

template <class T>
bool matches(const IviRangeTable& t, const IviRangeTableEntry& e, T value, ViInt32 precision) {
  if (t.type == IVI_VAL_DISCRETE) {
    if constexpr (std::is_same_v<T, ViReal64>)
      return equalWithPrecision(precision, value, minOf<T>(e));
    else
      return value == minOf<T>(e);
  }
  return value >= minOf<T>(e) && value <= maxOf<T>(e);
}

template <class T, class Pred>
ViStatus findEntry(IviRangeTablePtr table, Pred pred, ViInt32& index) {
  ViInt32 n = 0;
  if (ViStatus st = countEntries(table, n); st < 0) return st;
  for (ViInt32 i = 0; i < n; ++i) {
    if (pred(table->rangeValues[i])) {
      index = i;
      return VI_SUCCESS;
    }
  }
  return IVI_ERROR_INVALID_VALUE;
}

template <class T>
ViStatus fill(IviRangeTablePtr table, ViInt32 index, T* minValue, T* maxValue, T* coerced,
              ViInt32* tableIndex, ViString* cmdString, ViInt32* cmdValue) {
  const IviRangeTableEntry& e = table->rangeValues[index];
  if (minValue) *minValue = minOf<T>(e);
  if (maxValue) *maxValue = maxOf<T>(e);
  if (coerced) *coerced = coercedOf<T>(e);
  if (tableIndex) *tableIndex = index;
  if (cmdString) *cmdString = e.cmdString;
  if (cmdValue) *cmdValue = e.cmdValue;
  return VI_SUCCESS;
}

OwnedRangeTable* owned(IviRangeTablePtr table) {
  auto it = ownedTables().find(table);
  return it == ownedTables().end() ? nullptr : it->second;
}

}  // namespace

namespace cvivi {

bool equalWithPrecision(ViInt32 digits, ViReal64 a, ViReal64 b) {
  if (a == b) return true;
  if (std::isnan(a) || std::isnan(b)) return false;
  const ViReal64 scale = std::max(std::fabs(a), std::fabs(b));
  return std::fabs(a - b) <= scale * std::pow(10.0, -digits);
}

template <class T>
ViStatus checkWithTable(IviRangeTablePtr table, T value, ViInt32 precision) {
  ViInt32 index = 0;
  return findEntry<T>(
      table, [&](const IviRangeTableEntry& e) { return matches<T>(*table, e, value, precision); },
      index);
}

template <class T>
ViStatus coerceWithTable(IviRangeTablePtr table, T value, T& coerced) {
  ViInt32 index = 0;
  if (ViStatus st = findEntry<T>(
          table, [&](const IviRangeTableEntry& e) { return matches<T>(*table, e, value, 14); },
          index);
      st < 0) {
    return st;
  }
  coerced = coercedOf<T>(table->rangeValues[index]);
  return VI_SUCCESS;
}

template <class T>
ViStatus minMaxOfTable(IviRangeTablePtr table, T& minValue, T& maxValue, bool& hasMin,
                       bool& hasMax) {
  ViInt32 n = 0;
  if (ViStatus st = countEntries(table, n); st < 0) return st;
  hasMin = hasMax = n > 0;
  for (ViInt32 i = 0; i < n; ++i) {
    const auto& e = table->rangeValues[i];
    const T lo = minOf<T>(e);
    const T hi = table->type == IVI_VAL_DISCRETE ? lo : maxOf<T>(e);
    if (i == 0 || lo < minValue) minValue = lo;
    if (i == 0 || hi > maxValue) maxValue = hi;
  }
  return VI_SUCCESS;
}

#define CVIVI_INSTANTIATE(T)                                         \
  template ViStatus checkWithTable<T>(IviRangeTablePtr, T, ViInt32); \
  template ViStatus coerceWithTable<T>(IviRangeTablePtr, T, T&);     \
  template ViStatus minMaxOfTable<T>(IviRangeTablePtr, T&, T&, bool&, bool&);
CVIVI_INSTANTIATE(ViInt32)
CVIVI_INSTANTIATE(ViInt64)
CVIVI_INSTANTIATE(ViReal64)
#undef CVIVI_INSTANTIATE

}  // namespace cvivi

ViStatus Ivi_ValidateRangeTable(IviRangeTablePtr rangeTable) {
  ViInt32 n = 0;
  if (ViStatus st = countEntries(rangeTable, n); st < 0) return st;
  if (rangeTable->type != IVI_VAL_DISCRETE) {
    for (ViInt32 i = 0; i < n; ++i) {
      const auto& e = rangeTable->rangeValues[i];
      if (e.discreteOrMinValue > e.maxValue) return IVI_ERROR_INVALID_RANGE_TABLE;
    }
  }
  return VI_SUCCESS;
}

ViStatus Ivi_GetRangeTableNumEntries(IviRangeTablePtr rangeTable, ViInt32* numEntries) {
  if (!numEntries) return IVI_ERROR_NULL_POINTER;
  return countEntries(rangeTable, *numEntries);
}

#define CVIVI_ENTRY_GETTERS(T)                                                                    \
  ViStatus Ivi_Get##T##EntryFromValue(T value, IviRangeTablePtr table, T* minValue, T* maxValue,  \
                                      T* coerced, ViInt32* tableIndex, ViString* cmdString,       \
                                      ViInt32* cmdValue) {                                        \
    ViInt32 i = 0;                                                                                \
    if (ViStatus st = findEntry<T>(                                                               \
            table, [&](const IviRangeTableEntry& e) { return matches<T>(*table, e, value, 14); }, \
            i);                                                                                   \
        st < 0)                                                                                   \
      return st;                                                                                  \
    return fill<T>(table, i, minValue, maxValue, coerced, tableIndex, cmdString, cmdValue);       \
  }                                                                                               \
  ViStatus Ivi_Get##T##EntryFromString(ViConstString string, IviRangeTablePtr table, T* minValue, \
                                       T* maxValue, T* coerced, ViInt32* tableIndex,              \
                                       ViInt32* cmdValue) {                                       \
    if (!string) return IVI_ERROR_NULL_POINTER;                                                   \
    ViInt32 i = 0;                                                                                \
    if (ViStatus st = findEntry<T>(                                                               \
            table,                                                                                \
            [&](const IviRangeTableEntry& e) {                                                    \
              return e.cmdString && std::strcmp(e.cmdString, string) == 0;                        \
            },                                                                                    \
            i);                                                                                   \
        st < 0)                                                                                   \
      return st;                                                                                  \
    return fill<T>(table, i, minValue, maxValue, coerced, tableIndex, nullptr, cmdValue);         \
  }                                                                                               \
  ViStatus Ivi_Get##T##EntryFromIndex(ViInt32 index, IviRangeTablePtr table, T* minValue,         \
                                      T* maxValue, T* coerced, ViString* cmdString,               \
                                      ViInt32* cmdValue) {                                        \
    ViInt32 n = 0;                                                                                \
    if (ViStatus st = countEntries(table, n); st < 0) return st;                                  \
    if (index < 0 || index >= n) return IVI_ERROR_INVALID_VALUE;                                  \
    return fill<T>(table, index, minValue, maxValue, coerced, nullptr, cmdString, cmdValue);      \
  }                                                                                               \
  ViStatus Ivi_Get##T##EntryFromCmdValue(ViInt32 cmdValue, IviRangeTablePtr table, T* minValue,   \
                                         T* maxValue, T* coerced, ViInt32* tableIndex,            \
                                         ViString* cmdString) {                                   \
    ViInt32 i = 0;                                                                                \
    if (ViStatus st = findEntry<T>(                                                               \
            table, [&](const IviRangeTableEntry& e) { return e.cmdValue == cmdValue; }, i);       \
        st < 0)                                                                                   \
      return st;                                                                                  \
    return fill<T>(table, i, minValue, maxValue, coerced, tableIndex, cmdString, nullptr);        \
  }                                                                                               \
  ViStatus Ivi_Get##T##EntryFromCoercedVal(T coercedValue, IviRangeTablePtr table, T* minValue,   \
                                           T* maxValue, ViInt32* tableIndex, ViString* cmdString, \
                                           ViInt32* cmdValue) {                                   \
    ViInt32 i = 0;                                                                                \
    if (ViStatus st = findEntry<T>(                                                               \
            table,                                                                                \
            [&](const IviRangeTableEntry& e) {                                                    \
              return (table->type == IVI_VAL_COERCED ? coercedOf<T>(e) : minOf<T>(e)) ==          \
                     coercedValue;                                                                \
            },                                                                                    \
            i);                                                                                   \
        st < 0)                                                                                   \
      return st;                                                                                  \
    return fill<T>(table, i, minValue, maxValue, nullptr, tableIndex, cmdString, cmdValue);       \
  }
CVIVI_ENTRY_GETTERS(ViInt32)
CVIVI_ENTRY_GETTERS(ViInt64)
CVIVI_ENTRY_GETTERS(ViReal64)

ViStatus Ivi_RangeTableNew(ViSession vi, ViInt32 numEntries, ViInt32 typeOfTable, ViBoolean hasMin,
                           ViBoolean hasMax, IviRangeTablePtr* rangeTable) {
  if (!rangeTable) return IVI_ERROR_NULL_POINTER;
  if (numEntries < 0 || numEntries >= kMaxEntries) return IVI_ERROR_INVALID_PARAMETER;
  if (typeOfTable != IVI_VAL_DISCRETE && typeOfTable != IVI_VAL_RANGED &&
      typeOfTable != IVI_VAL_COERCED) {
    return IVI_ERROR_INVALID_PARAMETER;
  }
  return withSession(vi, [&](Session& s) {
    auto t = std::make_unique<OwnedRangeTable>();
    t->capacity = numEntries;
    t->entries.assign(static_cast<size_t>(numEntries) + 1, IviRangeTableEntry{});
    t->cmdStrings.assign(static_cast<size_t>(numEntries) + 1, std::string());
    t->entries.back().cmdString = IVI_RANGE_TABLE_END_STRING;
    t->table.type = typeOfTable;
    t->table.hasMin = hasMin;
    t->table.hasMax = hasMax;
    t->table.rangeValues = t->entries.data();
    IviRangeTablePtr ptr = &t->table;
    {
      std::lock_guard lock(g_ownedMutex);
      ownedTables()[ptr] = t.get();
    }
    s.rangeTables.emplace(ptr, std::move(t));
    *rangeTable = ptr;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_RangeTableFree(ViSession vi, IviRangeTablePtr rangeTable, ViBoolean freeCmdStrings) {
  // The engine owns copies of the command strings, so freeCmdStrings has
  // nothing left to free.
  (void)freeCmdStrings;
  return withSession(vi, [&](Session& s) {
    auto it = s.rangeTables.find(rangeTable);
    if (it == s.rangeTables.end()) return IVI_ERROR_INVALID_PARAMETER;
    {
      std::lock_guard lock(g_ownedMutex);
      ownedTables().erase(rangeTable);
    }
    s.rangeTables.erase(it);
    return VI_SUCCESS;
  });
}

namespace cvivi {
// Called when a session goes: its tables leave the index of owned tables.
void forgetRangeTables(Session& s) {
  std::lock_guard lock(g_ownedMutex);
  for (auto& [ptr, table] : s.rangeTables) ownedTables().erase(ptr);
  s.rangeTables.clear();
}
}  // namespace cvivi

ViStatus Ivi_SetRangeTableEntry(IviRangeTablePtr rangeTable, ViInt32 index,
                                ViReal64 discreteOrMinValue, ViReal64 maxValue,
                                ViReal64 coercedValue, ViConstString cmdString, ViInt32 cmdValue) {
  std::lock_guard lock(g_ownedMutex);
  OwnedRangeTable* t = owned(rangeTable);
  if (!t) return IVI_ERROR_INVALID_PARAMETER;
  if (index < 0 || index >= t->capacity) return IVI_ERROR_INVALID_PARAMETER;
  auto& e = t->entries[static_cast<size_t>(index)];
  auto& text = t->cmdStrings[static_cast<size_t>(index)];
  text = cmdString ? cmdString : "";
  e.discreteOrMinValue = discreteOrMinValue;
  e.maxValue = maxValue;
  e.coercedValue = coercedValue;
  e.discreteOrMinValueViInt64 = static_cast<ViInt64>(discreteOrMinValue);
  e.maxValueViInt64 = static_cast<ViInt64>(maxValue);
  e.coercedValueViInt64 = static_cast<ViInt64>(coercedValue);
  e.cmdString = cmdString ? text.data() : nullptr;
  e.cmdValue = cmdValue;
  return VI_SUCCESS;
}

ViStatus Ivi_SetRangeTableEntryViInt64(IviRangeTablePtr rangeTable, ViInt32 index,
                                       ViInt64 discreteOrMinValue, ViInt64 maxValue,
                                       ViInt64 coercedValue, ViConstString cmdString,
                                       ViInt32 cmdValue) {
  ViStatus st = Ivi_SetRangeTableEntry(rangeTable, index, static_cast<ViReal64>(discreteOrMinValue),
                                       static_cast<ViReal64>(maxValue),
                                       static_cast<ViReal64>(coercedValue), cmdString, cmdValue);
  if (st < 0) return st;
  std::lock_guard lock(g_ownedMutex);
  auto& e = owned(rangeTable)->entries[static_cast<size_t>(index)];
  e.discreteOrMinValueViInt64 = discreteOrMinValue;
  e.maxValueViInt64 = maxValue;
  e.coercedValueViInt64 = coercedValue;
  return VI_SUCCESS;
}

ViStatus Ivi_SetRangeTableEnd(IviRangeTablePtr rangeTable, ViInt32 index) {
  std::lock_guard lock(g_ownedMutex);
  OwnedRangeTable* t = owned(rangeTable);
  if (!t) return IVI_ERROR_INVALID_PARAMETER;
  if (index < 0 || index > t->capacity) return IVI_ERROR_INVALID_PARAMETER;
  t->entries[static_cast<size_t>(index)].cmdString = IVI_RANGE_TABLE_END_STRING;
  return VI_SUCCESS;
}
