#include "Values.h"

#include <cmath>
#include <cstdio>
#include <cstring>

namespace hsdig::sim {

ViInt32 iviTypeOf(const Value& v) {
  static constexpr ViInt32 types[] = {IVI_VAL_INT32,   IVI_VAL_INT64,   IVI_VAL_REAL64,
                                      IVI_VAL_BOOLEAN, IVI_VAL_SESSION, IVI_VAL_STRING};
  return types[v.index()];
}

std::string describeValue(const Value& v) {
  return std::visit(
      [](const auto& x) -> std::string {
        using T = std::decay_t<decltype(x)>;
        if constexpr (std::is_same_v<T, std::string>) {
          return "\"" + x + "\"";
        } else if constexpr (std::is_same_v<T, ViReal64>) {
          char buf[40];
          std::snprintf(buf, sizeof buf, "%.10g", x);
          return buf;
        } else {
          return std::to_string(x);
        }
      },
      v);
}

bool isChannelName(const Digitizer& d, const std::string& s) {
  if (s.empty() || s.size() > 3) return false;
  for (char c : s) {
    if (c < '0' || c > '9') return false;
  }
  return std::atoi(s.c_str()) < d.model.channels;
}

bool validTriggerSource(const Digitizer& d, const std::string& s, ViInt32 type) {
  static const char* digital[] = {"PFI0",  "PFI1",  "Trig0", "Trig1", "Trig2",
                                  "Trig3", "Trig4", "Trig5", "Trig6", "Trig7"};
  for (const char* n : digital) {
    if (s == n) return true;
  }
  if (type == HSDIG_VAL_DIGITAL_TRIGGER) return false;
  return isChannelName(d, s) || s == "External";
}

bool validTerminal(const std::string& s) {
  static const char* terminals[] = {"None",  "PFI0",  "PFI1",  "ClkOut", "Trig0", "Trig1",
                                    "Trig2", "Trig3", "Trig4", "Trig5",  "Trig6", "Trig7"};
  for (const char* n : terminals) {
    if (s == n) return true;
  }
  return false;
}

void validateValue(const Digitizer& d, const AttributeInfo& a, const Value& v) {
  const std::string name = std::string("HSDIG_ATTR_") + a.name;
  if (iviTypeOf(v) != a.type) {
    fail(HSDIG_ERROR_ATTRIBUTE_TYPE, name + " is not of the type this function writes.");
  }
  if (const auto* text = std::get_if<std::string>(&v)) {
    auto oneOf = [&](std::initializer_list<const char*> allowed) {
      std::string list;
      for (const char* n : allowed) {
        if (*text == n) return;
        list += std::string(list.empty() ? "" : ", ") + "\"" + n + "\"";
      }
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           name + " cannot be \"" + *text + "\"; it takes " + list + ".");
    };
    switch (a.id) {
      case HSDIG_ATTR_TRIGGER_SOURCE:
        if (!validTriggerSource(d, *text, 0)) {
          fail(HSDIG_ERROR_INVALID_TRIGGER_SOURCE,
               "\"" + *text + "\" is not a trigger source of the " + d.model.name + ".");
        }
        break;
      case HSDIG_ATTR_INPUT_CLOCK_SOURCE:
        oneOf({"Internal", "ClkIn", "RefIn"});
        break;
      case HSDIG_ATTR_OUTPUT_CLOCK_SOURCE:
        oneOf({"None", "ClkOut", "RefOut"});
        break;
      case HSDIG_ATTR_CLOCK_SYNC_PULSE_SOURCE:
        oneOf({"None", "SyncIn", "PFI0", "PFI1"});
        break;
      case HSDIG_ATTR_EXPORTED_REF_CLOCK_TERMINAL:
      case HSDIG_ATTR_EXPORTED_START_TRIGGER_TERMINAL:
      case HSDIG_ATTR_EXPORTED_REF_TRIGGER_TERMINAL:
      case HSDIG_ATTR_EXPORTED_END_OF_RECORD_TERMINAL:
      case HSDIG_ATTR_EXPORTED_READY_FOR_START_TERMINAL:
        if (!validTerminal(*text)) {
          fail(HSDIG_ERROR_INVALID_TRIGGER_SOURCE, "\"" + *text + "\" is not an output terminal.");
        }
        break;
      default:
        if (text->size() > 255)
          fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, name + " holds at most 255 characters.");
        break;
    }
    return;
  }
  const double x = std::visit(
      [](const auto& y) -> double {
        if constexpr (std::is_same_v<std::decay_t<decltype(y)>, std::string>) {
          return 0;
        } else {
          return static_cast<double>(y);
        }
      },
      v);
  if (!(x >= a.min && x <= a.max)) {
    char range[96];
    std::snprintf(range, sizeof range, "[%.10g, %.10g]", a.min, a.max);
    fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
         name + " = " + describeValue(v) + " is outside " + range + ".");
  }
  if (a.id == HSDIG_ATTR_INPUT_IMPEDANCE && x != 50.0 && x != 1.0e6) {
    fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
         name + " = " + describeValue(v) + "; the inputs offer 50 or 1e6 ohms.");
  }
}

void writeValue(ViSession vi, const char* ch, ViAttr id, const Value& v, ViInt32 flags) {
  ViStatus st = std::visit(
      [&](const auto& x) -> ViStatus {
        using T = std::decay_t<decltype(x)>;
        if constexpr (std::is_same_v<T, ViInt32>)
          return Ivi_SetAttributeViInt32(vi, ch, id, flags, x);
        if constexpr (std::is_same_v<T, ViInt64>)
          return Ivi_SetAttributeViInt64(vi, ch, id, flags, x);
        if constexpr (std::is_same_v<T, ViReal64>)
          return Ivi_SetAttributeViReal64(vi, ch, id, flags, x);
        if constexpr (std::is_same_v<T, ViBoolean>)
          return Ivi_SetAttributeViBoolean(vi, ch, id, flags, x);
        if constexpr (std::is_same_v<T, ViSession>)
          return Ivi_SetAttributeViSession(vi, ch, id, flags, x);
        if constexpr (std::is_same_v<T, std::string>)
          return Ivi_SetAttributeViString(vi, ch, id, flags, x.c_str());
      },
      v);
  checkEngine(st, "Writing attribute " + std::to_string(id) + ".");
}

void applyChanges(Digitizer& d, const std::vector<int>& channels,
                  const std::vector<Change>& changes) {
  for (const Change& c : changes) {
    const AttributeInfo* a = findAttribute(c.id);
    if (!a) fail(HSDIG_ERROR_INTERNAL, "Attribute " + std::to_string(c.id) + " is not defined.");
    validateValue(d, *a, c.value);
  }
  for (const Change& c : changes) {
    const AttributeInfo* a = findAttribute(c.id);
    if (a->perChannel) {
      for (int ch : channels)
        writeValue(d.vi, channelName(ch).c_str(), c.id, c.value, IVI_VAL_DIRECT_USER_CALL);
    } else {
      writeValue(d.vi, "", c.id, c.value, IVI_VAL_DIRECT_USER_CALL);
    }
  }
}

void requirePointer(const void* p, const char* name) {
  if (!p)
    fail(HSDIG_ERROR_NULL_POINTER, std::string("The argument ") + name + " is a null pointer.");
}

ViStatus copyString(const std::string& text, ViInt32 bufferSize, ViChar* buffer, const char* name) {
  const ViInt32 needed = static_cast<ViInt32>(text.size() + 1);
  if (bufferSize < 0) {
    fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
         std::string("The buffer size for ") + name + " is negative.");
  }
  if (bufferSize == 0) return needed;
  requirePointer(buffer, name);
  const size_t n = std::min<size_t>(text.size(), static_cast<size_t>(bufferSize - 1));
  std::memcpy(buffer, text.data(), n);
  buffer[n] = '\0';
  return needed > bufferSize ? needed : VI_SUCCESS;
}

}  // namespace hsdig::sim
