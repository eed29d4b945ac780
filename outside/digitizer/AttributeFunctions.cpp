// The attribute functions: Set, Check, Get and GetWithOptions of every type,
// ResetAttribute, AttributeWasSetByUser, GetAttributeFlags and the
// configuration export and import.
//
// Attributes of the driver's table are range-checked here and reach the
// engine as the user's settings; any other id (the engine's own attributes,
// for example IVI_ATTR_CACHE) goes to the engine unchanged.
#include <cstring>
#include <fstream>
#include <iterator>
#include <sstream>

#include "Boundary.h"
#include "Values.h"

using namespace hsdig::sim;

namespace {

std::string channelArgument(ViConstString list) {
  return list ? list : "";
}

bool blank(const std::string& s) {
  return s.find_first_not_of(" \t") == std::string::npos;
}

// The channels an attribute call names: none for a session attribute, one
// or more for a per-channel one.
std::vector<int> channelsFor(const Digitizer& d, const AttributeInfo& a, ViConstString list,
                             bool single) {
  std::string text = channelArgument(list);
  if (!a.perChannel) {
    if (!blank(text)) {
      fail(HSDIG_ERROR_INVALID_CHANNEL, std::string("HSDIG_ATTR_") + a.name +
                                            " belongs to the session and takes no channel, not \"" +
                                            text + "\".");
    }
    return {};
  }
  if (blank(text)) {
    if (d.model.channels == 1) return {0};
    fail(HSDIG_ERROR_INVALID_CHANNEL,
         std::string("HSDIG_ATTR_") + a.name + " is set per channel; name the channel.");
  }
  std::vector<int> channels = parseChannelList(d, list);
  if (single && channels.size() != 1) {
    fail(HSDIG_ERROR_INVALID_CHANNEL,
         "Reading HSDIG_ATTR_" + std::string(a.name) + " takes one channel, not \"" + text + "\".");
  }
  return channels;
}

void checkWritable(const AttributeInfo& a) {
  if (a.readOnly) {
    fail(HSDIG_ERROR_ATTRIBUTE_ACCESS, std::string("HSDIG_ATTR_") + a.name + " is read-only.");
  }
}

template <class T>
ViStatus engineCheck(ViSession vi, const char* ch, ViAttr id, T value);
template <class T>
ViStatus engineGet(ViSession vi, const char* ch, ViAttr id, T* value);
#define HSDIG_ENGINE_ACCESS(T)                                                 \
  template <>                                                                  \
  ViStatus engineCheck<T>(ViSession vi, const char* ch, ViAttr id, T value) {  \
    return Ivi_CheckAttribute##T(vi, ch, id, IVI_VAL_DIRECT_USER_CALL, value); \
  }                                                                            \
  template <>                                                                  \
  ViStatus engineGet<T>(ViSession vi, const char* ch, ViAttr id, T* value) {   \
    return Ivi_GetAttribute##T(vi, ch, id, IVI_VAL_DIRECT_USER_CALL, value);   \
  }
HSDIG_ENGINE_ACCESS(ViInt32)
HSDIG_ENGINE_ACCESS(ViInt64)
HSDIG_ENGINE_ACCESS(ViReal64)
HSDIG_ENGINE_ACCESS(ViBoolean)
HSDIG_ENGINE_ACCESS(ViSession)
#undef HSDIG_ENGINE_ACCESS

template <class T>
ViStatus setOrCheck(Digitizer& d, ViConstString list, ViAttr id, T value, bool checkOnly) {
  const AttributeInfo* a = findAttribute(id);
  if (!a) {
    // An engine attribute: the engine decides.
    Value v{value};
    if (checkOnly) {
      if constexpr (std::is_same_v<T, std::string>) {
        return checkEngine(
            Ivi_CheckAttributeViString(d.vi, list, id, IVI_VAL_DIRECT_USER_CALL, value.c_str()),
            "Checking attribute " + std::to_string(id) + ".");
      } else {
        return checkEngine(engineCheck<T>(d.vi, list, id, value),
                           "Checking attribute " + std::to_string(id) + ".");
      }
    }
    writeValue(d.vi, list, id, v, IVI_VAL_DIRECT_USER_CALL);
    return VI_SUCCESS;
  }
  Value v{value};
  if (iviTypeOf(v) != a->type) {
    fail(HSDIG_ERROR_ATTRIBUTE_TYPE,
         std::string("HSDIG_ATTR_") + a->name + " is not of the type this function writes.");
  }
  std::vector<int> channels = channelsFor(d, *a, list, false);
  checkWritable(*a);
  validateValue(d, *a, v);
  if (checkOnly) return VI_SUCCESS;
  if (a->perChannel) {
    for (int c : channels)
      writeValue(d.vi, channelName(c).c_str(), id, v, IVI_VAL_DIRECT_USER_CALL);
  } else {
    writeValue(d.vi, "", id, v, IVI_VAL_DIRECT_USER_CALL);
  }
  return VI_SUCCESS;
}

// The value a retrieval mode asks for, for table attributes.
template <class T>
ViStatus getNumeric(Digitizer& d, ViConstString list, ViAttr id, ViInt32 mode, T* value) {
  requirePointer(value, "value");
  const AttributeInfo* a = findAttribute(id);
  if (!a) {
    if (mode != HSDIG_VAL_RETRIEVE_CURRENT) {
      fail(HSDIG_ERROR_NOT_SUPPORTED,
           "Only the current value of engine attribute " + std::to_string(id) + " can be read.");
    }
    return checkEngine(engineGet<T>(d.vi, list, id, value),
                       "Reading attribute " + std::to_string(id) + ".");
  }
  if (iviTypeOf(Value{T{}}) != a->type) {
    fail(HSDIG_ERROR_ATTRIBUTE_TYPE,
         std::string("HSDIG_ATTR_") + a->name + " is not of the type this function reads.");
  }
  std::vector<int> channels = channelsFor(d, *a, list, true);
  std::string ch = channels.empty() ? "" : channelName(channels[0]);
  switch (mode) {
    case HSDIG_VAL_RETRIEVE_CURRENT:
      return checkEngine(engineGet<T>(d.vi, ch.c_str(), id, value),
                         std::string("Reading HSDIG_ATTR_") + a->name + ".");
    case HSDIG_VAL_RETRIEVE_DEFAULT:
      *value = static_cast<T>(a->numericDefault);
      if (id == HSDIG_ATTR_SIGNAL_FREQUENCY && !channels.empty())
        *value = static_cast<T>((channels[0] + 1) * 1.0e6);
      return VI_SUCCESS;
    case HSDIG_VAL_RETRIEVE_MIN:
      *value = static_cast<T>(a->min);
      return VI_SUCCESS;
    case HSDIG_VAL_RETRIEVE_MAX:
      *value = static_cast<T>(a->max);
      return VI_SUCCESS;
    default:
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "The retrieval mode " + std::to_string(mode) +
               " is not HSDIG_VAL_RETRIEVE_CURRENT, _DEFAULT, _MIN or _MAX.");
  }
}

ViStatus getText(Digitizer& d, ViConstString list, ViAttr id, ViInt32 mode, ViInt32 bufSize,
                 ViChar* value) {
  const AttributeInfo* a = findAttribute(id);
  std::string text;
  if (!a) {
    if (mode != HSDIG_VAL_RETRIEVE_CURRENT) {
      fail(HSDIG_ERROR_NOT_SUPPORTED,
           "Only the current value of engine attribute " + std::to_string(id) + " can be read.");
    }
    ViStatus size =
        checkEngine(Ivi_GetAttributeViString(d.vi, list, id, IVI_VAL_DIRECT_USER_CALL, 0, nullptr),
                    "Reading attribute " + std::to_string(id) + ".");
    text.assign(static_cast<size_t>(std::max<ViStatus>(size, 1)), '\0');
    checkEngine(Ivi_GetAttributeViString(d.vi, list, id, IVI_VAL_DIRECT_USER_CALL,
                                         static_cast<ViInt32>(text.size()), text.data()),
                "Reading attribute " + std::to_string(id) + ".");
    text.resize(std::strlen(text.c_str()));
  } else {
    if (a->type != IVI_VAL_STRING) {
      fail(HSDIG_ERROR_ATTRIBUTE_TYPE,
           std::string("HSDIG_ATTR_") + a->name + " is not a string attribute.");
    }
    std::vector<int> channels = channelsFor(d, *a, list, true);
    std::string ch = channels.empty() ? "" : channelName(channels[0]);
    if (mode == HSDIG_VAL_RETRIEVE_CURRENT) {
      text = getString(d.vi, ch.c_str(), id);
    } else if (mode == HSDIG_VAL_RETRIEVE_DEFAULT) {
      text = a->stringDefault;
    } else {
      fail(mode == HSDIG_VAL_RETRIEVE_MIN || mode == HSDIG_VAL_RETRIEVE_MAX
               ? HSDIG_ERROR_NOT_SUPPORTED
               : HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "String attributes have a current and a default value only.");
    }
  }
  return copyString(text, bufSize, value, "value");
}

}  // namespace

extern "C" {

#define HSDIG_NUMERIC_ATTRIBUTE_FUNCTIONS(T)                                                       \
  ViStatus hsdig_SetAttribute##T(ViSession vi, ViConstString channelList, ViAttr attributeId,      \
                                 T value) {                                                        \
    return callDriver(vi, "hsdig_SetAttribute" #T, [&](Digitizer& d) {                             \
      return setOrCheck<T>(d, channelList, attributeId, value, false);                             \
    });                                                                                            \
  }                                                                                                \
  ViStatus hsdig_CheckAttribute##T(ViSession vi, ViConstString channelList, ViAttr attributeId,    \
                                   T value) {                                                      \
    return callDriver(vi, "hsdig_CheckAttribute" #T, [&](Digitizer& d) {                           \
      return setOrCheck<T>(d, channelList, attributeId, value, true);                              \
    });                                                                                            \
  }                                                                                                \
  ViStatus hsdig_GetAttribute##T(ViSession vi, ViConstString channelList, ViAttr attributeId,      \
                                 T* value) {                                                       \
    return callDriver(vi, "hsdig_GetAttribute" #T, [&](Digitizer& d) {                             \
      return getNumeric<T>(d, channelList, attributeId, HSDIG_VAL_RETRIEVE_CURRENT, value);        \
    });                                                                                            \
  }                                                                                                \
  ViStatus hsdig_GetAttributeWithOptions##T(ViSession vi, ViConstString channelList,               \
                                            ViAttr attributeId, ViInt32 retrievalMode, T* value) { \
    return callDriver(vi, "hsdig_GetAttributeWithOptions" #T, [&](Digitizer& d) {                  \
      return getNumeric<T>(d, channelList, attributeId, retrievalMode, value);                     \
    });                                                                                            \
  }
HSDIG_NUMERIC_ATTRIBUTE_FUNCTIONS(ViInt32)
HSDIG_NUMERIC_ATTRIBUTE_FUNCTIONS(ViInt64)
HSDIG_NUMERIC_ATTRIBUTE_FUNCTIONS(ViReal64)
HSDIG_NUMERIC_ATTRIBUTE_FUNCTIONS(ViBoolean)
HSDIG_NUMERIC_ATTRIBUTE_FUNCTIONS(ViSession)
#undef HSDIG_NUMERIC_ATTRIBUTE_FUNCTIONS

ViStatus hsdig_SetAttributeViString(ViSession vi, ViConstString channelList, ViAttr attributeId,
                                    ViConstString value) {
  return callDriver(vi, "hsdig_SetAttributeViString", [&](Digitizer& d) {
    requirePointer(value, "value");
    return setOrCheck<std::string>(d, channelList, attributeId, value, false);
  });
}

ViStatus hsdig_CheckAttributeViString(ViSession vi, ViConstString channelList, ViAttr attributeId,
                                      ViConstString value) {
  return callDriver(vi, "hsdig_CheckAttributeViString", [&](Digitizer& d) {
    requirePointer(value, "value");
    return setOrCheck<std::string>(d, channelList, attributeId, value, true);
  });
}

ViStatus hsdig_GetAttributeViString(ViSession vi, ViConstString channelList, ViAttr attributeId,
                                    ViInt32 bufSize, ViChar value[]) {
  return callDriver(vi, "hsdig_GetAttributeViString", [&](Digitizer& d) {
    return getText(d, channelList, attributeId, HSDIG_VAL_RETRIEVE_CURRENT, bufSize, value);
  });
}

ViStatus hsdig_GetAttributeWithOptionsViString(ViSession vi, ViConstString channelList,
                                               ViAttr attributeId, ViInt32 retrievalMode,
                                               ViInt32 bufSize, ViChar value[]) {
  return callDriver(vi, "hsdig_GetAttributeWithOptionsViString", [&](Digitizer& d) {
    return getText(d, channelList, attributeId, retrievalMode, bufSize, value);
  });
}

ViStatus hsdig_ResetAttribute(ViSession vi, ViConstString channelList, ViAttr attributeId) {
  return callDriver(vi, "hsdig_ResetAttribute", [&](Digitizer& d) {
    const AttributeInfo* a = findAttribute(attributeId);
    if (!a) {
      return checkEngine(Ivi_ResetAttribute(d.vi, channelList, attributeId),
                         "Resetting attribute " + std::to_string(attributeId) + ".");
    }
    checkWritable(*a);
    if (!a->perChannel) {
      channelsFor(d, *a, channelList, false);
      resetOne(d.vi, -1, attributeId);
      return VI_SUCCESS;
    }
    // No channel resets the attribute on every channel.
    std::vector<int> channels;
    if (blank(channelArgument(channelList))) {
      for (int c = 0; c < d.model.channels; ++c) channels.push_back(c);
    } else {
      channels = parseChannelList(d, channelList);
    }
    for (int c : channels) resetOne(d.vi, c, attributeId);
    return VI_SUCCESS;
  });
}

ViStatus hsdig_AttributeWasSetByUser(ViSession vi, ViConstString repCapName, ViAttr attributeId,
                                     ViBoolean* wasSetByUser) {
  return callDriver(vi, "hsdig_AttributeWasSetByUser", [&](Digitizer& d) {
    requirePointer(wasSetByUser, "wasSetByUser");
    std::string ch = channelArgument(repCapName);
    if (const AttributeInfo* a = findAttribute(attributeId)) {
      std::vector<int> channels = channelsFor(d, *a, repCapName, true);
      ch = channels.empty() ? "" : channelName(channels[0]);
    }
    checkEngine(Ivi_ValidateAttrForChannel(d.vi, ch.c_str(), attributeId),
                "Attribute " + std::to_string(attributeId) + " on \"" + ch + "\".");
    *wasSetByUser = Ivi_AttributeWasSetByUser(d.vi, ch.c_str(), attributeId) ? VI_TRUE : VI_FALSE;
    return VI_SUCCESS;
  });
}

ViStatus hsdig_GetAttributeFlags(ViSession vi, ViAttr attributeId, ViInt32* flags,
                                 ViBoolean* supported) {
  return callDriver(vi, "hsdig_GetAttributeFlags", [&](Digitizer& d) {
    ViInt32 f = 0;
    ViStatus st = Ivi_GetAttributeFlags(d.vi, attributeId, &f);
    const bool known = st >= 0 && !(f & IVI_VAL_NOT_SUPPORTED);
    if (flags) *flags = known ? f : 0;
    if (supported) *supported = known ? VI_TRUE : VI_FALSE;
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ExportAttributeConfigurationBuffer(ViSession vi, ViInt32 sizeInBytes,
                                                  ViInt8 configuration[]) {
  return callDriver(vi, "hsdig_ExportAttributeConfigurationBuffer", [&](Digitizer& d) -> ViStatus {
    std::string text = exportConfiguration(d);
    const ViInt32 needed = static_cast<ViInt32>(text.size());
    if (sizeInBytes < 0) fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "sizeInBytes is negative.");
    if (sizeInBytes == 0) return needed;
    requirePointer(configuration, "configuration");
    if (sizeInBytes < needed) {
      fail(HSDIG_ERROR_BUFFER_TOO_SMALL, "The configuration needs " + std::to_string(needed) +
                                             " bytes; the buffer holds " +
                                             std::to_string(sizeInBytes) + ".");
    }
    std::memcpy(configuration, text.data(), text.size());
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ImportAttributeConfigurationBuffer(ViSession vi, ViInt32 sizeInBytes,
                                                  const ViInt8 configuration[]) {
  return callDriver(vi, "hsdig_ImportAttributeConfigurationBuffer", [&](Digitizer& d) {
    if (sizeInBytes < 0) fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "sizeInBytes is negative.");
    if (sizeInBytes > 0) requirePointer(configuration, "configuration");
    importConfiguration(d, std::string_view(reinterpret_cast<const char*>(configuration),
                                            static_cast<size_t>(sizeInBytes)));
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ExportAttributeConfigurationFile(ViSession vi, ViConstString filePath) {
  return callDriver(vi, "hsdig_ExportAttributeConfigurationFile", [&](Digitizer& d) {
    requirePointer(filePath, "filePath");
    std::string text = exportConfiguration(d);
    std::ofstream out(filePath, std::ios::binary | std::ios::trunc);
    if (!out || !out.write(text.data(), static_cast<std::streamsize>(text.size())) ||
        !out.flush()) {
      fail(HSDIG_ERROR_FILE_ACCESS,
           "Cannot write \"" + std::string(filePath) + "\": " + std::strerror(errno) + ".");
    }
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ImportAttributeConfigurationFile(ViSession vi, ViConstString filePath) {
  return callDriver(vi, "hsdig_ImportAttributeConfigurationFile", [&](Digitizer& d) {
    requirePointer(filePath, "filePath");
    std::ifstream in(filePath, std::ios::binary);
    if (!in)
      fail(HSDIG_ERROR_FILE_ACCESS,
           "Cannot open \"" + std::string(filePath) + "\": " + std::strerror(errno) + ".");
    // A configuration is a few kilobytes; anything far larger is not one.
    constexpr std::streamsize kLimit = 1 << 20;
    std::string text(static_cast<size_t>(kLimit) + 1, '\0');
    in.read(text.data(), kLimit + 1);
    if (in.bad()) fail(HSDIG_ERROR_FILE_ACCESS, "Cannot read \"" + std::string(filePath) + "\".");
    if (in.gcount() > kLimit)
      fail(HSDIG_ERROR_CONFIGURATION_DATA,
           "\"" + std::string(filePath) + "\" is too large to be a configuration.");
    text.resize(static_cast<size_t>(in.gcount()));
    importConfiguration(d, text);
    return VI_SUCCESS;
  });
}

}  // extern "C"
