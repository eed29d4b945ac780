// Attribute definition, access (set, check, get with callbacks, caching,
// range checking, coercion and user-set tracking) and attribute information.
#include "Attributes.h"

#include <cstdio>
#include <cstdlib>
#include <functional>
#include <type_traits>

using namespace cvivi;

namespace cvivi {

ViStatus lookupAttribute(Session& s, ViAttr id, ViInt32 type, ViConstString channelName,
                         Attribute*& attribute, std::string& key) {
  auto it = s.attributes.find(id);
  if (it == s.attributes.end()) return IVI_ERROR_INVALID_ATTRIBUTE;
  Attribute& a = it->second;
  if (type != 0 && a.type != type) return IVI_ERROR_TYPES_DO_NOT_MATCH;
  const std::string name = trim(channelName ? channelName : "");
  if (a.repCap.empty()) {
    if (!name.empty()) return IVI_ERROR_CHANNEL_NAME_NOT_ALLOWED;
    key.clear();
  } else if (name.empty()) {
    auto table = s.repCaps.find(upper(a.repCap));
    if (table == s.repCaps.end() || table->second.size() != 1) {
      return IVI_ERROR_CHANNEL_NAME_REQUIRED;
    }
    key = table->second.front();
  } else if (ViStatus st = resolveRepCapName(s, a.repCap, name, key); st < 0) {
    return st;
  }
  if (!a.allowedInstances.empty() && !a.allowedInstances.count(key)) {
    return IVI_ERROR_ATTRIBUTE_NOT_SUPPORTED;
  }
  attribute = &a;
  return VI_SUCCESS;
}

Instance& instanceOf(Attribute& a, const std::string& key) {
  return a.instances.try_emplace(key, Instance{a.defaultValue}).first->second;
}

ViStatus rangeTableOf(Session& s, Attribute& a, const std::string& key, IviRangeTablePtr& table) {
  table = a.rangeTable;
  if (a.rangeTableCallback) return a.rangeTableCallback(s.handle(), key.c_str(), a.id, &table);
  return VI_SUCCESS;
}

}  // namespace cvivi

namespace {

template <class T>
typename Traits<T>::Stored toStored(typename Traits<T>::In v) {
  if constexpr (std::is_same_v<T, ViString>) {
    return std::string(v ? v : "");
  } else {
    return v;
  }
}

template <class T>
typename Traits<T>::In toIn(const typename Traits<T>::Stored& v) {
  if constexpr (std::is_same_v<T, ViString>) {
    return v.c_str();
  } else {
    return v;
  }
}

template <class T>
std::string describe(const typename Traits<T>::Stored& v) {
  char text[64];
  if constexpr (std::is_same_v<T, ViReal64>) {
    std::snprintf(text, sizeof text, "%.15g", v);
  } else {
    std::snprintf(text, sizeof text, "%lld", static_cast<long long>(v));
  }
  return text;
}

bool cachingOn(Session& s, const Attribute& a) {
  if (a.flags & IVI_VAL_NEVER_CACHE) return false;
  return (a.flags & IVI_VAL_ALWAYS_CACHE) || directBoolean(s, IVI_ATTR_CACHE);
}

template <class T>
ViStatus runCheck(Session& s, Attribute& a, const std::string& key,
                  const typename Traits<T>::Stored& v) {
  if (auto cb = reinterpret_cast<typename Traits<T>::Check>(a.callbacks[IVI_CALLBACK_CHECK])) {
    return cb(s.handle(), key.c_str(), a.id, toIn<T>(v));
  }
  if constexpr (Traits<T>::numeric) {
    IviRangeTablePtr table = nullptr;
    if (ViStatus st = rangeTableOf(s, a, key, table); st < 0) return st;
    if (table) return checkWithTable<T>(table, v, a.comparePrecision);
  }
  return VI_SUCCESS;
}

template <class T>
ViStatus runCoerce(Session& s, Attribute& a, const std::string& key,
                   const typename Traits<T>::Stored& v, typename Traits<T>::Stored& out) {
  out = v;
  if (auto cb = reinterpret_cast<typename Traits<T>::Coerce>(a.callbacks[IVI_CALLBACK_COERCE])) {
    if constexpr (std::is_same_v<T, ViString>) {
      s.pendingString.reset();
      ViStatus st = cb(s.handle(), key.c_str(), a.id, v.c_str(), v.c_str());
      if (st >= 0 && s.pendingString) out = *s.pendingString;
      s.pendingString.reset();
      return st;
    } else {
      return cb(s.handle(), key.c_str(), a.id, v, &out);
    }
  }
  if constexpr (Traits<T>::numeric) {
    IviRangeTablePtr table = nullptr;
    if (ViStatus st = rangeTableOf(s, a, key, table); st < 0) return st;
    if (table && table->type == IVI_VAL_COERCED) return coerceWithTable<T>(table, v, out);
  }
  if constexpr (std::is_same_v<T, ViBoolean>) out = v ? VI_TRUE : VI_FALSE;
  return VI_SUCCESS;
}

template <class T>
ViStatus compareEqual(Session& s, Attribute& a, const std::string& key,
                      const typename Traits<T>::Stored& x, const typename Traits<T>::Stored& y,
                      bool& equal) {
  if (auto cb = reinterpret_cast<typename Traits<T>::Compare>(a.callbacks[IVI_CALLBACK_COMPARE])) {
    ViInt32 result = 1;
    ViStatus st = cb(s.handle(), key.c_str(), a.id, toIn<T>(x), toIn<T>(y), &result);
    equal = st >= 0 && result == 0;
    return st;
  }
  if constexpr (std::is_same_v<T, ViReal64>) {
    equal = equalWithPrecision(a.comparePrecision, x, y);
  } else {
    equal = x == y;
  }
  return VI_SUCCESS;
}

void invalidateDependents(Session& s, const Attribute& a, const std::string& key) {
  for (const auto& [targetId, sameChannel] : a.invalidations) {
    auto it = s.attributes.find(targetId);
    if (it == s.attributes.end()) continue;
    Attribute& t = it->second;
    if (sameChannel && !key.empty() && t.repCap == a.repCap) {
      if (auto inst = t.instances.find(key); inst != t.instances.end()) {
        inst->second.cacheValid = false;
      }
    } else {
      for (auto& [name, inst] : t.instances) inst.cacheValid = false;
    }
  }
}

template <class T>
ViStatus setOrCheck(ViSession vi, ViConstString channelName, ViAttr id, ViInt32 optionFlags,
                    typename Traits<T>::In value, bool checkOnly) {
  return withInstance(
      vi, channelName, id, Traits<T>::type,
      [&]([[maybe_unused]] Session& s, Attribute* a,
          [[maybe_unused]] const std::string& key) -> ViStatus {
        if (a->flags & IVI_VAL_NOT_SUPPORTED) return IVI_ERROR_ATTRIBUTE_NOT_SUPPORTED;
        const bool user = optionFlags & IVI_VAL_DIRECT_USER_CALL;
        if ((a->flags & IVI_VAL_NOT_WRITABLE) || (user && (a->flags & IVI_VAL_NOT_USER_WRITABLE))) {
          return IVI_ERROR_ATTRIBUTE_NOT_WRITABLE;
        }
        const auto v = toStored<T>(value);
        ViStatus warning = VI_SUCCESS;
        auto keep = [&](ViStatus st) {
          if (st > 0 && warning == VI_SUCCESS) warning = st;
          return st;
        };
        if (checkOnly || directBoolean(s, IVI_ATTR_RANGE_CHECK)) {
          if (ViStatus st = runCheck<T>(s, *a, key, v); keep(st) < 0) return st;
        }
        if (checkOnly) return warning;
        typename Traits<T>::Stored coerced;
        if (ViStatus st = runCoerce<T>(s, *a, key, v, coerced); keep(st) < 0) return st;
        if constexpr (Traits<T>::numeric) {
          if (coerced != v && directBoolean(s, IVI_ATTR_RECORD_COERCIONS)) {
            std::string where = key.empty() ? "" : " on \"" + key + "\"";
            s.coercionRecords.push_back("Attribute " + a->name + where + ": " + describe<T>(v) +
                                        " was coerced to " + describe<T>(coerced) + ".");
          }
        }
        Instance& inst = instanceOf(*a, key);
        bool same = false;
        if (cachingOn(s, *a) && inst.cacheValid) {
          if (ViStatus st = compareEqual<T>(s, *a, key, coerced,
                                            std::get<typename Traits<T>::Stored>(inst.value), same);
              keep(st) < 0) {
            return st;
          }
        }
        if (!same && !(optionFlags & IVI_VAL_SET_CACHE_ONLY)) {
          if (auto cb =
                  reinterpret_cast<typename Traits<T>::Write>(a->callbacks[IVI_CALLBACK_WRITE])) {
            ViSession io = 0;
            if (Value* iov = directValue(s, IVI_ATTR_IO_SESSION)) io = std::get<ViSession>(*iov);
            if (ViStatus st = cb(vi, io, key.c_str(), id, toIn<T>(coerced)); keep(st) < 0)
              return st;
          }
        }
        inst.value = coerced;
        inst.cacheValid = !(a->flags & IVI_VAL_NEVER_CACHE);
        if (user && !(optionFlags & IVI_VAL_DONT_MARK_AS_SET_BY_USER)) {
          inst.setByUser = inst.everSetByUser = true;
        }
        if (!same) invalidateDependents(s, *a, key);
        return warning;
      });
}

template <class T>
ViStatus readValue(Session& s, ViConstString channelName, ViAttr id, ViInt32 optionFlags,
                   typename Traits<T>::Stored& out) {
  Attribute* a = nullptr;
  std::string key;
  if (ViStatus st = lookupAttribute(s, id, Traits<T>::type, channelName, a, key); st < 0) return st;
  if (a->flags & IVI_VAL_NOT_SUPPORTED) return IVI_ERROR_ATTRIBUTE_NOT_SUPPORTED;
  if ((a->flags & IVI_VAL_NOT_READABLE) ||
      ((optionFlags & IVI_VAL_DIRECT_USER_CALL) && (a->flags & IVI_VAL_NOT_USER_READABLE))) {
    return IVI_ERROR_ATTRIBUTE_NOT_READABLE;
  }
  Instance& inst = instanceOf(*a, key);
  ViStatus status = VI_SUCCESS;
  auto cb = reinterpret_cast<typename Traits<T>::Read>(a->callbacks[IVI_CALLBACK_READ]);
  if (cb && !(cachingOn(s, *a) && inst.cacheValid)) {
    ViSession io = 0;
    if (Value* iov = directValue(s, IVI_ATTR_IO_SESSION)) io = std::get<ViSession>(*iov);
    auto current = std::get<typename Traits<T>::Stored>(inst.value);
    if constexpr (std::is_same_v<T, ViString>) {
      s.pendingString.reset();
      status = cb(s.handle(), io, key.c_str(), id, current.c_str());
      if (status >= 0 && s.pendingString) current = *s.pendingString;
      s.pendingString.reset();
    } else {
      status = cb(s.handle(), io, key.c_str(), id, &current);
    }
    if (status < 0) return status;
    inst.value = current;
    inst.cacheValid = !(a->flags & IVI_VAL_NEVER_CACHE);
  }
  out = std::get<typename Traits<T>::Stored>(inst.value);
  return status;
}

template <class T>
ViStatus getValue(ViSession vi, ViConstString channelName, ViAttr id, ViInt32 optionFlags,
                  typename Traits<T>::Stored* value) {
  if (!value) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    typename Traits<T>::Stored v{};
    ViStatus st = readValue<T>(s, channelName, id, optionFlags, v);
    if (st >= 0) *value = v;
    return st;
  });
}

template <class T>
ViStatus addAttribute(ViSession vi, ViConstString repCap, ViAttr id, ViConstString name,
                      typename Traits<T>::In defaultValue, ViInt32 flags, AnyCallback read,
                      AnyCallback write, IviRangeTablePtr rangeTable, ViInt32 comparePrecision) {
  return withSession(vi, [&](Session& s) {
    if (s.attributes.count(id)) return IVI_ERROR_ITEM_ALREADY_EXISTS;
    Attribute a;
    a.id = id;
    a.name = name ? name : "";
    a.type = Traits<T>::type;
    a.flags = flags;
    a.defaultValue = toStored<T>(defaultValue);
    if (repCap && *repCap) {
      a.repCap = trim(repCap);
    } else if (flags & IVI_VAL_MULTI_CHANNEL) {
      a.repCap = IVI_REPCAP_CHANNEL;
    }
    if (equalsIgnoreCase(a.repCap, IVI_REPCAP_CHANNEL)) a.flags |= IVI_VAL_MULTI_CHANNEL;
    a.callbacks[IVI_CALLBACK_READ] = read;
    a.callbacks[IVI_CALLBACK_WRITE] = write;
    a.rangeTable = rangeTable;
    if (comparePrecision > 0) a.comparePrecision = comparePrecision;
    s.attributes.emplace(id, std::move(a));
    return VI_SUCCESS;
  });
}

ViStatus withAttribute(ViSession vi, ViAttr id, ViInt32 type,
                       const std::function<ViStatus(Session&, Attribute&)>& body) {
  return withSession(vi, [&](Session& s) {
    auto it = s.attributes.find(id);
    if (it == s.attributes.end()) return IVI_ERROR_INVALID_ATTRIBUTE;
    if (type != 0 && it->second.type != type) return IVI_ERROR_TYPES_DO_NOT_MATCH;
    return body(s, it->second);
  });
}

template <class T>
ViStatus setCallback(ViSession vi, ViAttr id, int kind, AnyCallback callback) {
  return withAttribute(vi, id, Traits<T>::type, [&](Session&, Attribute& a) {
    a.callbacks[kind] = callback;
    return VI_SUCCESS;
  });
}

}  // namespace

// ---- Definition ----
#define CVIVI_CB(p) reinterpret_cast<AnyCallback>(p)
#define CVIVI_ADD_WITH_TABLE(T)                                                                  \
  ViStatus Ivi_AddAttribute##T(ViSession vi, ViAttr attributeId, ViConstString name,             \
                               T defaultValue, ViInt32 flags, IviReadCallback##T readCallback,   \
                               IviWriteCallback##T writeCallback, IviRangeTablePtr rangeTable) { \
    return addAttribute<T>(vi, nullptr, attributeId, name, defaultValue, flags,                  \
                           CVIVI_CB(readCallback), CVIVI_CB(writeCallback), rangeTable, 0);      \
  }                                                                                              \
  ViStatus Ivi_AddRepeatedAttribute##T(                                                          \
      ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name,      \
      T defaultValue, ViInt32 flags, IviReadCallback##T readCallback,                            \
      IviWriteCallback##T writeCallback, IviRangeTablePtr rangeTable) {                          \
    if (!repCapIdentifier || !*repCapIdentifier) return IVI_ERROR_INVALID_PARAMETER;             \
    return addAttribute<T>(vi, repCapIdentifier, attributeId, name, defaultValue, flags,         \
                           CVIVI_CB(readCallback), CVIVI_CB(writeCallback), rangeTable, 0);      \
  }
#define CVIVI_ADD_PLAIN(T, In)                                                                  \
  ViStatus Ivi_AddAttribute##T(ViSession vi, ViAttr attributeId, ViConstString name,            \
                               In defaultValue, ViInt32 flags, IviReadCallback##T readCallback, \
                               IviWriteCallback##T writeCallback) {                             \
    return addAttribute<T>(vi, nullptr, attributeId, name, defaultValue, flags,                 \
                           CVIVI_CB(readCallback), CVIVI_CB(writeCallback), nullptr, 0);        \
  }                                                                                             \
  ViStatus Ivi_AddRepeatedAttribute##T(ViSession vi, ViConstString repCapIdentifier,            \
                                       ViAttr attributeId, ViConstString name, In defaultValue, \
                                       ViInt32 flags, IviReadCallback##T readCallback,          \
                                       IviWriteCallback##T writeCallback) {                     \
    if (!repCapIdentifier || !*repCapIdentifier) return IVI_ERROR_INVALID_PARAMETER;            \
    return addAttribute<T>(vi, repCapIdentifier, attributeId, name, defaultValue, flags,        \
                           CVIVI_CB(readCallback), CVIVI_CB(writeCallback), nullptr, 0);        \
  }
CVIVI_ADD_WITH_TABLE(ViInt32)
CVIVI_ADD_WITH_TABLE(ViInt64)
CVIVI_ADD_PLAIN(ViString, ViConstString)
CVIVI_ADD_PLAIN(ViBoolean, ViBoolean)
CVIVI_ADD_PLAIN(ViSession, ViSession)
CVIVI_ADD_PLAIN(ViAddr, ViAddr)

ViStatus Ivi_AddAttributeViReal64(ViSession vi, ViAttr attributeId, ViConstString name,
                                  ViReal64 defaultValue, ViInt32 flags,
                                  IviReadCallbackViReal64 readCallback,
                                  IviWriteCallbackViReal64 writeCallback,
                                  IviRangeTablePtr rangeTable, ViInt32 comparePrecision) {
  return addAttribute<ViReal64>(vi, nullptr, attributeId, name, defaultValue, flags,
                                CVIVI_CB(readCallback), CVIVI_CB(writeCallback), rangeTable,
                                comparePrecision);
}
ViStatus Ivi_AddRepeatedAttributeViReal64(ViSession vi, ViConstString repCapIdentifier,
                                          ViAttr attributeId, ViConstString name,
                                          ViReal64 defaultValue, ViInt32 flags,
                                          IviReadCallbackViReal64 readCallback,
                                          IviWriteCallbackViReal64 writeCallback,
                                          IviRangeTablePtr rangeTable, ViInt32 comparePrecision) {
  if (!repCapIdentifier || !*repCapIdentifier) return IVI_ERROR_INVALID_PARAMETER;
  return addAttribute<ViReal64>(vi, repCapIdentifier, attributeId, name, defaultValue, flags,
                                CVIVI_CB(readCallback), CVIVI_CB(writeCallback), rangeTable,
                                comparePrecision);
}

// ---- Access ----
#define CVIVI_ACCESS(T, In)                                                                   \
  ViStatus Ivi_SetAttribute##T(ViSession vi, ViConstString channelName, ViAttr attributeId,   \
                               ViInt32 optionFlags, In value) {                               \
    return setOrCheck<T>(vi, channelName, attributeId, optionFlags, value, false);            \
  }                                                                                           \
  ViStatus Ivi_CheckAttribute##T(ViSession vi, ViConstString channelName, ViAttr attributeId, \
                                 ViInt32 optionFlags, In value) {                             \
    return setOrCheck<T>(vi, channelName, attributeId, optionFlags, value, true);             \
  }
#define CVIVI_GET(T)                                                                        \
  ViStatus Ivi_GetAttribute##T(ViSession vi, ViConstString channelName, ViAttr attributeId, \
                               ViInt32 optionFlags, T* value) {                             \
    return getValue<T>(vi, channelName, attributeId, optionFlags, value);                   \
  }
CVIVI_ACCESS(ViInt32, ViInt32)
CVIVI_ACCESS(ViInt64, ViInt64)
CVIVI_ACCESS(ViReal64, ViReal64)
CVIVI_ACCESS(ViString, ViConstString)
CVIVI_ACCESS(ViBoolean, ViBoolean)
CVIVI_ACCESS(ViSession, ViSession)
CVIVI_ACCESS(ViAddr, ViAddr)
CVIVI_GET(ViInt32)
CVIVI_GET(ViInt64)
CVIVI_GET(ViReal64)
CVIVI_GET(ViBoolean)
CVIVI_GET(ViSession)
CVIVI_GET(ViAddr)

ViStatus Ivi_GetAttributeViString(ViSession vi, ViConstString channelName, ViAttr attributeId,
                                  ViInt32 optionFlags, ViInt32 bufferSize, ViChar value[]) {
  return withSession(vi, [&](Session& s) {
    std::string text;
    ViStatus st = readValue<ViString>(s, channelName, attributeId, optionFlags, text);
    if (st < 0) return st;
    ViStatus out = copyOut(text, bufferSize, value);
    return out != VI_SUCCESS ? out : st;
  });
}

// ---- Callback setters ----
#define CVIVI_SETTER(Kind, Index, T)                                         \
  ViStatus Ivi_SetAttr##Kind##Callback##T(ViSession vi, ViAttr attributeId,  \
                                          Ivi##Kind##Callback##T callback) { \
    return setCallback<T>(vi, attributeId, Index, CVIVI_CB(callback));       \
  }
#define CVIVI_SETTERS(T)                       \
  CVIVI_SETTER(Read, IVI_CALLBACK_READ, T)     \
  CVIVI_SETTER(Write, IVI_CALLBACK_WRITE, T)   \
  CVIVI_SETTER(Check, IVI_CALLBACK_CHECK, T)   \
  CVIVI_SETTER(Coerce, IVI_CALLBACK_COERCE, T) \
  CVIVI_SETTER(Compare, IVI_CALLBACK_COMPARE, T)
CVIVI_SETTERS(ViInt32)
CVIVI_SETTERS(ViInt64)
CVIVI_SETTERS(ViReal64)
CVIVI_SETTERS(ViString)
CVIVI_SETTERS(ViBoolean)
CVIVI_SETTERS(ViSession)
CVIVI_SETTERS(ViAddr)

ViStatus Ivi_SetAttrCallback(ViSession vi, ViAttr attributeId, ViInt32 callbackType,
                             ViAddr callback) {
  if (callbackType < IVI_CALLBACK_READ || callbackType > IVI_CALLBACK_COMPARE) {
    return IVI_ERROR_INVALID_PARAMETER;
  }
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    a.callbacks[callbackType] = reinterpret_cast<AnyCallback>(callback);
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetAttrCallback(ViSession vi, ViAttr attributeId, ViInt32 callbackType,
                             ViAddr* callback) {
  if (callbackType < IVI_CALLBACK_READ || callbackType > IVI_CALLBACK_COMPARE) {
    return IVI_ERROR_INVALID_PARAMETER;
  }
  if (!callback) return IVI_ERROR_NULL_POINTER;
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    *callback = reinterpret_cast<ViAddr>(a.callbacks[callbackType]);
    return VI_SUCCESS;
  });
}

ViStatus Ivi_SetValInStringCallback(ViSession vi, ViAttr attributeId, ViConstString value) {
  return withAttribute(vi, attributeId, IVI_VAL_STRING, [&](Session& s, Attribute&) {
    s.pendingString = value ? value : "";
    return VI_SUCCESS;
  });
}

// ---- Definition and information ----
ViStatus Ivi_ValidateAttribute(ViSession vi, ViAttr attributeId, ViInt32 valueType) {
  switch (valueType) {
    case IVI_VAL_INT32:
    case IVI_VAL_INT64:
    case IVI_VAL_REAL64:
    case IVI_VAL_STRING:
    case IVI_VAL_BOOLEAN:
    case IVI_VAL_SESSION:
    case IVI_VAL_ADDR:
      break;
    default:
      return IVI_ERROR_INVALID_TYPE;
  }
  return withAttribute(vi, attributeId, valueType, [](Session&, Attribute&) { return VI_SUCCESS; });
}

ViBoolean Ivi_AttributeIsAvailable(ViSession vi, ViAttr attributeId) {
  ViBoolean result = VI_FALSE;
  withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    result = (a.flags & IVI_VAL_NOT_SUPPORTED) ? VI_FALSE : VI_TRUE;
    return VI_SUCCESS;
  });
  return result;
}

ViStatus Ivi_ResetAttribute(ViSession vi, ViConstString channelName, ViAttr attributeId) {
  return withInstance(vi, channelName, attributeId, 0,
                      [&](Session&, Attribute* a, const std::string& key) {
                        Instance& inst = instanceOf(*a, key);
                        inst.value = a->defaultValue;
                        inst.cacheValid = false;
                        inst.setByUser = false;
                        return VI_SUCCESS;
                      });
}

ViStatus Ivi_DeleteAttribute(ViSession vi, ViAttr attributeId) {
  return withSession(vi, [&](Session& s) {
    return s.attributes.erase(attributeId) ? VI_SUCCESS : IVI_ERROR_INVALID_ATTRIBUTE;
  });
}

ViStatus Ivi_GetNumAttributes(ViSession vi, ViInt32* numAttributes) {
  if (!numAttributes) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    *numAttributes = static_cast<ViInt32>(s.attributes.size());
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetNthAttribute(ViSession vi, ViInt32 index, ViAttr* attributeId) {
  if (!attributeId) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    if (index < 1 || static_cast<size_t>(index) > s.attributes.size()) {
      return IVI_ERROR_INVALID_PARAMETER;
    }
    *attributeId = std::next(s.attributes.begin(), index - 1)->first;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetAttributeFlags(ViSession vi, ViAttr attributeId, ViInt32* flags) {
  if (!flags) return IVI_ERROR_NULL_POINTER;
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    *flags = a.flags;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_SetAttributeFlags(ViSession vi, ViAttr attributeId, ViInt32 flags) {
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    // Whether an attribute is per channel is fixed when it is added.
    a.flags = (flags & ~IVI_VAL_MULTI_CHANNEL) | (a.flags & IVI_VAL_MULTI_CHANNEL);
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetAttributeType(ViSession vi, ViAttr attributeId, ViInt32* valueType) {
  if (!valueType) return IVI_ERROR_NULL_POINTER;
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    *valueType = a.type;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetAttributeName(ViSession vi, ViAttr attributeId, ViInt32 bufferSize, ViChar name[]) {
  return withAttribute(vi, attributeId, 0,
                       [&](Session&, Attribute& a) { return copyOut(a.name, bufferSize, name); });
}

ViStatus Ivi_GetAttributeRepCapName(ViSession vi, ViAttr attributeId, ViInt32 bufferSize,
                                    ViChar repCapIdentifier[]) {
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    return copyOut(a.repCap, bufferSize, repCapIdentifier);
  });
}

namespace {
ViBoolean userSetState(ViSession vi, ViConstString channelName, ViAttr attributeId, bool ever) {
  ViBoolean result = VI_FALSE;
  withInstance(
      vi, channelName, attributeId, 0, [&](Session&, Attribute* a, const std::string& key) {
        auto it = a->instances.find(key);
        if (it != a->instances.end()) {
          result = (ever ? it->second.everSetByUser : it->second.setByUser) ? VI_TRUE : VI_FALSE;
        }
        return VI_SUCCESS;
      });
  return result;
}
}  // namespace

ViBoolean Ivi_AttributeWasSetByUser(ViSession vi, ViConstString channelName, ViAttr attributeId) {
  return userSetState(vi, channelName, attributeId, false);
}
ViBoolean Ivi_AttributeEverSetByUser(ViSession vi, ViConstString channelName, ViAttr attributeId) {
  return userSetState(vi, channelName, attributeId, true);
}

ViStatus Ivi_SetAttrComparePrecision(ViSession vi, ViAttr attributeId, ViInt32 comparePrecision) {
  if (comparePrecision < 1 || comparePrecision > 14) return IVI_ERROR_INVALID_PARAMETER;
  return withAttribute(vi, attributeId, IVI_VAL_REAL64, [&](Session&, Attribute& a) {
    a.comparePrecision = comparePrecision;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetAttrComparePrecision(ViSession vi, ViAttr attributeId, ViInt32* comparePrecision) {
  if (!comparePrecision) return IVI_ERROR_NULL_POINTER;
  return withAttribute(vi, attributeId, IVI_VAL_REAL64, [&](Session&, Attribute& a) {
    *comparePrecision = a.comparePrecision;
    return VI_SUCCESS;
  });
}

// ---- Caching ----
ViStatus Ivi_InvalidateAttribute(ViSession vi, ViConstString channelName, ViAttr attributeId) {
  return withSession(vi, [&](Session& s) {
    auto it = s.attributes.find(attributeId);
    if (it == s.attributes.end()) return IVI_ERROR_INVALID_ATTRIBUTE;
    if (!it->second.repCap.empty() && trim(channelName ? channelName : "").empty()) {
      for (auto& [name, inst] : it->second.instances) inst.cacheValid = false;
      return VI_SUCCESS;
    }
    Attribute* a = nullptr;
    std::string key;
    if (ViStatus st = lookupAttribute(s, attributeId, 0, channelName, a, key); st < 0) return st;
    instanceOf(*a, key).cacheValid = false;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_InvalidateAllAttributes(ViSession vi) {
  return withSession(vi, [&](Session& s) {
    for (auto& [id, a] : s.attributes) {
      if (a.flags & IVI_VAL_ALWAYS_CACHE) continue;
      for (auto& [name, inst] : a.instances) inst.cacheValid = false;
    }
    return VI_SUCCESS;
  });
}

ViStatus Ivi_AttributeIsCached(ViSession vi, ViConstString channelName, ViAttr attributeId,
                               ViBoolean* isCached) {
  if (!isCached) return IVI_ERROR_NULL_POINTER;
  return withInstance(
      vi, channelName, attributeId, 0, [&](Session& s, Attribute* a, const std::string& key) {
        auto it = a->instances.find(key);
        *isCached = (it != a->instances.end() && it->second.cacheValid && cachingOn(s, *a))
                        ? VI_TRUE
                        : VI_FALSE;
        return VI_SUCCESS;
      });
}

ViStatus Ivi_AddAttributeInvalidation(ViSession vi, ViAttr attributeId,
                                      ViAttr attributeToInvalidate, ViBoolean sameChannel) {
  return withSession(vi, [&](Session& s) {
    auto it = s.attributes.find(attributeId);
    if (it == s.attributes.end() || !s.attributes.count(attributeToInvalidate)) {
      return IVI_ERROR_INVALID_ATTRIBUTE;
    }
    for (auto& entry : it->second.invalidations) {
      if (entry.first == attributeToInvalidate) return IVI_ERROR_ITEM_ALREADY_EXISTS;
    }
    it->second.invalidations.emplace_back(attributeToInvalidate, sameChannel != VI_FALSE);
    return VI_SUCCESS;
  });
}

ViStatus Ivi_DeleteAttributeInvalidation(ViSession vi, ViAttr attributeId,
                                         ViAttr attributeToInvalidate) {
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    for (auto it = a.invalidations.begin(); it != a.invalidations.end(); ++it) {
      if (it->first == attributeToInvalidate) {
        a.invalidations.erase(it);
        return VI_SUCCESS;
      }
    }
    return IVI_ERROR_INVALID_ATTRIBUTE;
  });
}

ViStatus Ivi_GetInvalidationList(ViSession vi, ViAttr attributeId, ViInt32* count,
                                 ViAttr** invalidationList) {
  if (!count || !invalidationList) return IVI_ERROR_NULL_POINTER;
  return withAttribute(vi, attributeId, 0, [&](Session& s, Attribute& a) {
    const size_t n = a.invalidations.size();
    auto* list = static_cast<ViAttr*>(std::calloc(n + 1, sizeof(ViAttr)));
    if (!list) return IVI_ERROR_SYS_RSRC_ALLOC;
    for (size_t i = 0; i < n; ++i) list[i] = a.invalidations[i].first;
    s.allocations.insert(list);
    *count = static_cast<ViInt32>(n);
    *invalidationList = list;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_DisposeInvalidationList(ViSession vi, ViAttr* invalidationList) {
  return withSession(vi, [&](Session& s) {
    if (!s.allocations.erase(invalidationList)) return IVI_ERROR_INVALID_PARAMETER;
    std::free(invalidationList);
    return VI_SUCCESS;
  });
}

// ---- Coercion ----
namespace {
template <class T>
ViStatus coercedValue(ViSession vi, ViConstString channelName, ViAttr attributeId, T value,
                      T* coerced) {
  if (!coerced) return IVI_ERROR_NULL_POINTER;
  return withInstance(vi, channelName, attributeId, Traits<T>::type,
                      [&](Session& s, Attribute* a, const std::string& key) {
                        return runCoerce<T>(s, *a, key, value, *coerced);
                      });
}

ViStatus nextCoercion(ViSession vi, ViInt32 bufferSize, ViChar record[]) {
  return withSession(vi, [&](Session& s) {
    if (s.coercionRecords.empty()) return copyOut("", bufferSize, record);
    ViStatus st = copyOut(s.coercionRecords.front(), bufferSize, record);
    if (st == VI_SUCCESS) s.coercionRecords.pop_front();
    return st;
  });
}
}  // namespace

ViStatus Ivi_GetCoercedValViInt32(ViSession vi, ViConstString channelName, ViAttr attributeId,
                                  ViInt32 value, ViInt32* coerced) {
  return coercedValue<ViInt32>(vi, channelName, attributeId, value, coerced);
}
ViStatus Ivi_GetCoercedValViReal64(ViSession vi, ViConstString channelName, ViAttr attributeId,
                                   ViReal64 value, ViReal64* coerced) {
  return coercedValue<ViReal64>(vi, channelName, attributeId, value, coerced);
}
ViStatus Ivi_GetNextCoercionInfo(ViSession vi, ViInt32 bufferSize, ViChar coercionRecord[]) {
  return nextCoercion(vi, bufferSize, coercionRecord);
}
ViStatus Ivi_GetNextCoercionString(ViSession vi, ViInt32 bufferSize, ViChar coercionRecord[]) {
  return nextCoercion(vi, bufferSize, coercionRecord);
}

// ---- Range tables of attributes and the default callbacks ----
ViStatus Ivi_SetAttrRangeTableCallback(ViSession vi, ViAttr attributeId,
                                       IviRangeTableCallback rangeTableCallback) {
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    a.rangeTableCallback = rangeTableCallback;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetAttrRangeTable(ViSession vi, ViConstString channelName, ViAttr attributeId,
                               IviRangeTablePtr* rangeTable) {
  if (!rangeTable) return IVI_ERROR_NULL_POINTER;
  return withInstance(vi, channelName, attributeId, 0,
                      [&](Session& s, Attribute* a, const std::string& key) {
                        return rangeTableOf(s, *a, key, *rangeTable);
                      });
}

ViStatus Ivi_GetStoredRangeTablePtr(ViSession vi, ViAttr attributeId,
                                    IviRangeTablePtr* rangeTable) {
  if (!rangeTable) return IVI_ERROR_NULL_POINTER;
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    *rangeTable = a.storedRangeTable;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_SetStoredRangeTablePtr(ViSession vi, ViAttr attributeId, IviRangeTablePtr rangeTable) {
  return withAttribute(vi, attributeId, 0, [&](Session&, Attribute& a) {
    a.storedRangeTable = rangeTable;
    return VI_SUCCESS;
  });
}

namespace {
template <class T>
ViStatus defaultCheck(ViSession vi, ViConstString channelName, ViAttr attributeId, T value) {
  return withInstance(vi, channelName, attributeId, Traits<T>::type,
                      [&](Session& s, Attribute* a, const std::string& key) {
                        IviRangeTablePtr table = nullptr;
                        if (ViStatus st = rangeTableOf(s, *a, key, table); st < 0) return st;
                        return table ? checkWithTable<T>(table, value, a->comparePrecision)
                                     : VI_SUCCESS;
                      });
}

template <class T>
ViStatus defaultCoerce(ViSession vi, ViConstString channelName, ViAttr attributeId, T value,
                       T* coerced) {
  if (!coerced) return IVI_ERROR_NULL_POINTER;
  return withInstance(vi, channelName, attributeId, Traits<T>::type,
                      [&](Session& s, Attribute* a, const std::string& key) {
                        *coerced = value;
                        IviRangeTablePtr table = nullptr;
                        if (ViStatus st = rangeTableOf(s, *a, key, table); st < 0) return st;
                        if (table && table->type == IVI_VAL_COERCED)
                          return coerceWithTable<T>(table, value, *coerced);
                        return VI_SUCCESS;
                      });
}

template <class T>
ViStatus minMax(ViSession vi, ViConstString channelName, ViAttr attributeId, T* minValue,
                T* maxValue, ViBoolean* hasMin, ViBoolean* hasMax) {
  return withInstance(vi, channelName, attributeId, Traits<T>::type,
                      [&](Session& s, Attribute* a, const std::string& key) {
                        IviRangeTablePtr table = nullptr;
                        if (ViStatus st = rangeTableOf(s, *a, key, table); st < 0) return st;
                        T lo{}, hi{};
                        bool hasLo = false, hasHi = false;
                        if (table) {
                          if (ViStatus st = minMaxOfTable<T>(table, lo, hi, hasLo, hasHi); st < 0)
                            return st;
                        }
                        if (minValue) *minValue = lo;
                        if (maxValue) *maxValue = hi;
                        if (hasMin) *hasMin = hasLo ? VI_TRUE : VI_FALSE;
                        if (hasMax) *hasMax = hasHi ? VI_TRUE : VI_FALSE;
                        return VI_SUCCESS;
                      });
}
}  // namespace

ViStatus Ivi_DefaultCheckCallbackViInt32(ViSession vi, ViConstString channelName,
                                         ViAttr attributeId, ViInt32 value) {
  return defaultCheck<ViInt32>(vi, channelName, attributeId, value);
}
ViStatus Ivi_DefaultCheckCallbackViInt64(ViSession vi, ViConstString channelName,
                                         ViAttr attributeId, ViInt64 value) {
  return defaultCheck<ViInt64>(vi, channelName, attributeId, value);
}
ViStatus Ivi_DefaultCheckCallbackViReal64(ViSession vi, ViConstString channelName,
                                          ViAttr attributeId, ViReal64 value) {
  return defaultCheck<ViReal64>(vi, channelName, attributeId, value);
}
ViStatus Ivi_DefaultCoerceCallbackViInt32(ViSession vi, ViConstString channelName,
                                          ViAttr attributeId, ViInt32 value, ViInt32* coerced) {
  return defaultCoerce<ViInt32>(vi, channelName, attributeId, value, coerced);
}
ViStatus Ivi_DefaultCoerceCallbackViInt64(ViSession vi, ViConstString channelName,
                                          ViAttr attributeId, ViInt64 value, ViInt64* coerced) {
  return defaultCoerce<ViInt64>(vi, channelName, attributeId, value, coerced);
}
ViStatus Ivi_DefaultCoerceCallbackViReal64(ViSession vi, ViConstString channelName,
                                           ViAttr attributeId, ViReal64 value, ViReal64* coerced) {
  return defaultCoerce<ViReal64>(vi, channelName, attributeId, value, coerced);
}
ViStatus Ivi_DefaultCompareCallbackViReal64(ViSession vi, ViConstString channelName,
                                            ViAttr attributeId, ViReal64 coercedNewValue,
                                            ViReal64 cacheValue, ViInt32* result) {
  if (!result) return IVI_ERROR_NULL_POINTER;
  return withAttribute(vi, attributeId, IVI_VAL_REAL64, [&](Session& s, Attribute& a) {
    Attribute* checked = nullptr;
    std::string key;
    if (ViStatus st = lookupAttribute(s, a.id, 0, channelName, checked, key); st < 0) return st;
    *result = equalWithPrecision(a.comparePrecision, coercedNewValue, cacheValue)
                  ? 0
                  : (coercedNewValue < cacheValue ? -1 : 1);
    return VI_SUCCESS;
  });
}
ViStatus Ivi_DefaultCoerceCallbackViBoolean(ViSession vi, ViConstString channelName,
                                            ViAttr attributeId, ViBoolean value,
                                            ViBoolean* coerced) {
  if (!coerced) return IVI_ERROR_NULL_POINTER;
  return withInstance(vi, channelName, attributeId, IVI_VAL_BOOLEAN,
                      [&](Session&, Attribute*, const std::string&) {
                        *coerced = value ? VI_TRUE : VI_FALSE;
                        return VI_SUCCESS;
                      });
}

ViStatus Ivi_GetAttrMinMaxViInt32(ViSession vi, ViConstString channelName, ViAttr attributeId,
                                  ViInt32* minValue, ViInt32* maxValue, ViBoolean* hasMin,
                                  ViBoolean* hasMax) {
  return minMax<ViInt32>(vi, channelName, attributeId, minValue, maxValue, hasMin, hasMax);
}
ViStatus Ivi_GetAttrMinMaxViInt64(ViSession vi, ViConstString channelName, ViAttr attributeId,
                                  ViInt64* minValue, ViInt64* maxValue, ViBoolean* hasMin,
                                  ViBoolean* hasMax) {
  return minMax<ViInt64>(vi, channelName, attributeId, minValue, maxValue, hasMin, hasMax);
}
ViStatus Ivi_GetAttrMinMaxViReal64(ViSession vi, ViConstString channelName, ViAttr attributeId,
                                   ViReal64* minValue, ViReal64* maxValue, ViBoolean* hasMin,
                                   ViBoolean* hasMax) {
  return minMax<ViReal64>(vi, channelName, attributeId, minValue, maxValue, hasMin, hasMax);
}
