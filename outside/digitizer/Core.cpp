// Models, status codes, the session registry, channel lists and the
// attribute table as the driver uses it.
#include <algorithm>
#include <cctype>
#include <charconv>
#include <cstring>
#include <mutex>
#include <set>

#include "Digitizer.h"

namespace hsdig::sim {

// ---- Models ----------------------------------------------------------------
const std::vector<Model>& allModels() {
  // name, channels, bits, max sample rate, bandwidth, samples per channel
  static const std::vector<Model> models = {
      {"HSD-1", 1, 12, 1.0e9, 350.0e6, std::int64_t(128) << 20},
      {"HSD-2", 2, 14, 500.0e6, 200.0e6, std::int64_t(64) << 20},
      {"HSD-4", 4, 14, 250.0e6, 100.0e6, std::int64_t(64) << 20},
      {"HSD-8", 8, 16, 125.0e6, 50.0e6, std::int64_t(32) << 20},
  };
  return models;
}

const Model* findModel(std::string_view name) {
  for (const Model& m : allModels()) {
    std::string_view n = m.name;
    if (n.size() == name.size() && std::equal(n.begin(), n.end(), name.begin(), [](char a, char b) {
          return std::tolower(static_cast<unsigned char>(a)) ==
                 std::tolower(static_cast<unsigned char>(b));
        })) {
      return &m;
    }
  }
  return nullptr;
}

const Model& defaultModel() {
  return allModels()[2];
}

// ---- Errors ----------------------------------------------------------------
void fail(ViStatus code, std::string elaboration, ViStatus secondary) {
  throw DriverError{code, std::move(elaboration), secondary};
}

ViStatus checkEngine(ViStatus st, std::string_view what) {
  if (st >= 0) return st;
  ViStatus code = st;
  switch (st) {
    case IVI_ERROR_INVALID_SESSION_HANDLE:
      code = HSDIG_ERROR_INVALID_SESSION;
      break;
    case IVI_ERROR_UNKNOWN_CHANNEL_NAME:
    case IVI_ERROR_CHANNEL_NAME_REQUIRED:
    case IVI_ERROR_CHANNEL_NAME_NOT_ALLOWED:
    case IVI_ERROR_NO_CHANNEL_TABLE:
      code = HSDIG_ERROR_INVALID_CHANNEL;
      break;
    case IVI_ERROR_INVALID_ATTRIBUTE:
    case IVI_ERROR_ATTRIBUTE_NOT_SUPPORTED:
      code = HSDIG_ERROR_INVALID_ATTRIBUTE;
      break;
    case IVI_ERROR_TYPES_DO_NOT_MATCH:
    case IVI_ERROR_INVALID_TYPE:
      code = HSDIG_ERROR_ATTRIBUTE_TYPE;
      break;
    case IVI_ERROR_ATTRIBUTE_NOT_READABLE:
    case IVI_ERROR_ATTRIBUTE_NOT_WRITABLE:
      code = HSDIG_ERROR_ATTRIBUTE_ACCESS;
      break;
    case IVI_ERROR_INVALID_VALUE:
      code = HSDIG_ERROR_VALUE_OUT_OF_RANGE;
      break;
    case IVI_ERROR_NULL_POINTER:
      code = HSDIG_ERROR_NULL_POINTER;
      break;
    case IVI_ERROR_BAD_OPTION_NAME:
    case IVI_ERROR_BAD_OPTION_VALUE:
      code = HSDIG_ERROR_OPTION_STRING;
      break;
    case IVI_ERROR_SYS_RSRC_ALLOC:
      code = HSDIG_ERROR_INTERNAL;
      break;
    default:
      break;
  }
  fail(code, std::string(what), code == st ? 0 : st);
}

const char* statusText(ViStatus code) {
#define HSDIG_TEXT(NAME, value, text) \
  if (code == static_cast<ViStatus>(value)) return text;
  HSDIG_DRIVER_STATUS(HSDIG_TEXT)
#undef HSDIG_TEXT
  return nullptr;
}

// ---- Registry ----------------------------------------------------------------
namespace {
std::mutex registryMutex;
std::map<ViSession, std::shared_ptr<Digitizer>>& registry() {
  static auto* sessions = new std::map<ViSession, std::shared_ptr<Digitizer>>();
  return *sessions;
}
}  // namespace

Digitizer& digitizerOf(ViSession vi) {
  std::lock_guard lock(registryMutex);
  auto it = registry().find(vi);
  if (it == registry().end()) {
    fail(HSDIG_ERROR_INVALID_SESSION, "Session " + std::to_string(vi) + " is not open.");
  }
  // The session lock that the caller holds keeps the session alive: close
  // removes it only under that lock.
  return *it->second;
}

void addDigitizer(ViSession vi, std::unique_ptr<Digitizer> d) {
  std::lock_guard lock(registryMutex);
  registry()[vi] = std::move(d);
}

void removeDigitizer(ViSession vi) {
  std::lock_guard lock(registryMutex);
  registry().erase(vi);
}

Digitizer::Digitizer(ViSession v, const Model& m, std::string r)
    : vi(v), model(m), resource(std::move(r)) {
  processing.resize(static_cast<size_t>(m.channels));
  equalization.resize(static_cast<size_t>(m.channels));
  auto put32 = [&](int offset, std::uint32_t value) {
    for (int i = 0; i < 4; ++i)
      registers[static_cast<size_t>(offset + i)] = (value >> (8 * i)) & 0xFF;
  };
  put32(HSDIG_REG_ID, 0x48534447u);
  put32(HSDIG_REG_REVISION, 0x00030201u);
  put32(HSDIG_REG_CHANNELS, static_cast<std::uint32_t>(m.channels));
}

// ---- Channels ----------------------------------------------------------------
std::string channelName(int index) {
  return std::to_string(index);
}

namespace {
std::string_view trimmed(std::string_view s) {
  while (!s.empty() && std::isspace(static_cast<unsigned char>(s.front()))) s.remove_prefix(1);
  while (!s.empty() && std::isspace(static_cast<unsigned char>(s.back()))) s.remove_suffix(1);
  return s;
}

int channelIndex(const Digitizer& d, std::string_view name, std::string_view whole) {
  name = trimmed(name);
  int value = -1;
  auto [end, ec] = std::from_chars(name.data(), name.data() + name.size(), value);
  if (name.empty() || ec != std::errc() || end != name.data() + name.size() || value < 0 ||
      value >= d.model.channels) {
    fail(HSDIG_ERROR_INVALID_CHANNEL, "Channel \"" + std::string(name) + "\" in \"" +
                                          std::string(whole) + "\" is not a channel of the " +
                                          d.model.name + " (channels 0 to " +
                                          std::to_string(d.model.channels - 1) + ").");
  }
  return value;
}
}  // namespace

std::vector<int> parseChannelList(const Digitizer& d, ViConstString list) {
  if (!list) fail(HSDIG_ERROR_NULL_POINTER, "The channel list is a null pointer.");
  std::string_view whole = list;
  if (trimmed(whole).empty()) fail(HSDIG_ERROR_INVALID_CHANNEL, "The channel list is empty.");
  std::vector<int> result;
  std::set<int> seen;
  std::string_view rest = whole;
  while (true) {
    size_t comma = rest.find(',');
    std::string_view item = trimmed(rest.substr(0, comma));
    size_t dash = item.find_first_of("-:");
    int first, last;
    if (dash == std::string_view::npos) {
      first = last = channelIndex(d, item, whole);
    } else {
      first = channelIndex(d, item.substr(0, dash), whole);
      last = channelIndex(d, item.substr(dash + 1), whole);
    }
    for (int c = first;; c += first <= last ? 1 : -1) {
      if (!seen.insert(c).second) {
        fail(HSDIG_ERROR_INVALID_CHANNEL,
             "Channel " + channelName(c) + " is named twice in \"" + std::string(whole) + "\".");
      }
      result.push_back(c);
      if (c == last) break;
    }
    if (comma == std::string_view::npos) break;
    rest = rest.substr(comma + 1);
  }
  return result;
}

// ---- Attribute table -----------------------------------------------------------
namespace {
struct Default {
  double number = 0;
  const char* text = nullptr;
  constexpr Default(double d) : number(d) {}
  constexpr Default(int i) : number(i) {}
  constexpr Default(long long i) : number(static_cast<double>(i)) {}
  constexpr Default(const char* s) : text(s) {}
};
constexpr ViInt32 kType_ViInt32 = IVI_VAL_INT32;
constexpr ViInt32 kType_ViInt64 = IVI_VAL_INT64;
constexpr ViInt32 kType_ViReal64 = IVI_VAL_REAL64;
constexpr ViInt32 kType_ViBoolean = IVI_VAL_BOOLEAN;
constexpr ViInt32 kType_ViSession = IVI_VAL_SESSION;
constexpr ViInt32 kType_ViString = IVI_VAL_STRING;
constexpr bool kScope_CHANNEL = true;
constexpr bool kScope_SESSION = false;
}  // namespace

const std::vector<AttributeInfo>& allAttributes() {
  static const std::vector<AttributeInfo> table = [] {
    std::vector<AttributeInfo> t;
#define HSDIG_ROW(NAME, id, type, scope, def, mn, mx, flags)                                       \
  {                                                                                                \
    Default d(def);                                                                                \
    t.push_back({id, #NAME, kType_##type, kScope_##scope, d.number, d.text ? d.text : "",          \
                 static_cast<double>(mn), static_cast<double>(mx), (flags)&HSDIG_ATTR_READ_ONLY}); \
  }
    HSDIG_ATTRIBUTES(HSDIG_ROW)
#undef HSDIG_ROW
    return t;
  }();
  return table;
}

const AttributeInfo* findAttribute(ViAttr id) {
  for (const AttributeInfo& a : allAttributes()) {
    if (a.id == id) return &a;
  }
  return nullptr;
}

// ---- Typed access ------------------------------------------------------------------
namespace {
std::string describe(ViAttr id) {
  const AttributeInfo* a = findAttribute(id);
  return a ? std::string("HSDIG_ATTR_") + a->name : "attribute " + std::to_string(id);
}
}  // namespace

ViInt32 getInt32(ViSession vi, const char* ch, ViAttr id) {
  ViInt32 v = 0;
  checkEngine(Ivi_GetAttributeViInt32(vi, ch, id, 0, &v), "Reading " + describe(id) + ".");
  return v;
}
ViInt64 getInt64(ViSession vi, const char* ch, ViAttr id) {
  ViInt64 v = 0;
  checkEngine(Ivi_GetAttributeViInt64(vi, ch, id, 0, &v), "Reading " + describe(id) + ".");
  return v;
}
ViReal64 getReal64(ViSession vi, const char* ch, ViAttr id) {
  ViReal64 v = 0;
  checkEngine(Ivi_GetAttributeViReal64(vi, ch, id, 0, &v), "Reading " + describe(id) + ".");
  return v;
}
bool getBoolean(ViSession vi, const char* ch, ViAttr id) {
  ViBoolean v = 0;
  checkEngine(Ivi_GetAttributeViBoolean(vi, ch, id, 0, &v), "Reading " + describe(id) + ".");
  return v != VI_FALSE;
}
std::string getString(ViSession vi, const char* ch, ViAttr id) {
  ViStatus size = Ivi_GetAttributeViString(vi, ch, id, 0, 0, nullptr);
  checkEngine(size, "Reading " + describe(id) + ".");
  std::string text(static_cast<size_t>(std::max<ViStatus>(size, 1)), '\0');
  checkEngine(
      Ivi_GetAttributeViString(vi, ch, id, 0, static_cast<ViInt32>(text.size()), text.data()),
      "Reading " + describe(id) + ".");
  text.resize(std::strlen(text.c_str()));
  return text;
}
void setInternal(ViSession vi, const char* ch, ViAttr id, ViInt32 value) {
  checkEngine(Ivi_SetAttributeViInt32(vi, ch, id, 0, value), "Writing " + describe(id) + ".");
}
void setInternal(ViSession vi, const char* ch, ViAttr id, ViInt64 value) {
  checkEngine(Ivi_SetAttributeViInt64(vi, ch, id, 0, value), "Writing " + describe(id) + ".");
}
void setInternal(ViSession vi, const char* ch, ViAttr id, ViReal64 value) {
  checkEngine(Ivi_SetAttributeViReal64(vi, ch, id, 0, value), "Writing " + describe(id) + ".");
}
void setInternalBoolean(ViSession vi, const char* ch, ViAttr id, bool value) {
  checkEngine(Ivi_SetAttributeViBoolean(vi, ch, id, 0, value ? VI_TRUE : VI_FALSE),
              "Writing " + describe(id) + ".");
}
void setInternal(ViSession vi, const char* ch, ViAttr id, const std::string& value) {
  checkEngine(Ivi_SetAttributeViString(vi, ch, id, 0, value.c_str()),
              "Writing " + describe(id) + ".");
}

void defineAttributes(ViSession vi, const Model& model, const std::string& serial) {
  std::string channels;
  for (int c = 0; c < model.channels; ++c) channels += (c ? "," : "") + channelName(c);
  checkEngine(Ivi_BuildChannelTable(vi, channels.c_str()), "Building the channel table.");
  for (const AttributeInfo& a : allAttributes()) {
    ViInt32 flags = a.perChannel ? IVI_VAL_MULTI_CHANNEL : 0;
    if (a.readOnly) flags |= IVI_VAL_NOT_USER_WRITABLE;
    std::string name = std::string("HSDIG_ATTR_") + a.name;
    ViStatus st = VI_SUCCESS;
    switch (a.type) {
      case IVI_VAL_INT32:
        st = Ivi_AddAttributeViInt32(vi, a.id, name.c_str(), static_cast<ViInt32>(a.numericDefault),
                                     flags, nullptr, nullptr, nullptr);
        break;
      case IVI_VAL_INT64:
        st = Ivi_AddAttributeViInt64(vi, a.id, name.c_str(), static_cast<ViInt64>(a.numericDefault),
                                     flags, nullptr, nullptr, nullptr);
        break;
      case IVI_VAL_REAL64:
        st = Ivi_AddAttributeViReal64(vi, a.id, name.c_str(), a.numericDefault, flags, nullptr,
                                      nullptr, nullptr, 0);
        break;
      case IVI_VAL_BOOLEAN:
        st = Ivi_AddAttributeViBoolean(vi, a.id, name.c_str(),
                                       a.numericDefault != 0 ? VI_TRUE : VI_FALSE, flags, nullptr,
                                       nullptr);
        break;
      case IVI_VAL_SESSION:
        st = Ivi_AddAttributeViSession(vi, a.id, name.c_str(),
                                       static_cast<ViSession>(a.numericDefault), flags, nullptr,
                                       nullptr);
        break;
      case IVI_VAL_STRING:
        st = Ivi_AddAttributeViString(vi, a.id, name.c_str(), a.stringDefault, flags, nullptr,
                                      nullptr);
        break;
    }
    checkEngine(st, "Defining " + name + ".");
  }
  // The model's own values replace the table's defaults.
  setInternal(vi, "", HSDIG_ATTR_MODEL, std::string(model.name));
  setInternal(vi, "", HSDIG_ATTR_SERIAL_NUMBER, serial);
  setInternal(vi, "", HSDIG_ATTR_RESOLUTION, ViInt32{model.resolution});
  setInternal(vi, "", HSDIG_ATTR_MAX_SAMPLE_RATE, model.maxSampleRate);
  setInternal(vi, "", HSDIG_ATTR_BANDWIDTH, model.bandwidth);
  // Each channel carries its own signal by default, so the channels of a
  // fresh session are told apart: channel c runs at (c + 1) MHz.
  for (int c = 1; c < model.channels; ++c) applyChannelDefaults(vi, c);
}

void resetAttributes(Digitizer& d) {
  for (const AttributeInfo& a : allAttributes()) {
    if (a.readOnly) continue;
    int count = a.perChannel ? d.model.channels : 1;
    for (int c = 0; c < count; ++c) {
      std::string ch = a.perChannel ? channelName(c) : "";
      checkEngine(Ivi_ResetAttribute(d.vi, ch.c_str(), a.id), "Resetting attributes.");
    }
  }
  for (int c = 1; c < d.model.channels; ++c) applyChannelDefaults(d.vi, c);
}

void resetOne(ViSession vi, int channel, ViAttr id) {
  std::string ch = channel < 0 ? "" : channelName(channel);
  checkEngine(Ivi_ResetAttribute(vi, ch.c_str(), id), "Resetting " + describe(id) + ".");
  if (id == HSDIG_ATTR_SIGNAL_FREQUENCY && channel > 0) applyChannelDefaults(vi, channel);
}

void applyChannelDefaults(ViSession vi, int channel) {
  setInternal(vi, channelName(channel).c_str(), HSDIG_ATTR_SIGNAL_FREQUENCY, (channel + 1) * 1.0e6);
}

double effectiveSampleRate(const Digitizer& d) {
  return std::min(getReal64(d.vi, "", HSDIG_ATTR_SAMPLE_RATE), d.model.maxSampleRate);
}

}  // namespace hsdig::sim
