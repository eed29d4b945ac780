// Attribute configuration as text, for export and import.
//
//   HSDIG-CONFIGURATION 1
//   model HSD-4
//   <ATTRIBUTE_NAME> <channel or -> <value>
//   ...
//   checksum <16 hex digits>
//
// Every writable attribute appears once per channel (per-channel ones) or
// once. Numbers are written exactly (%.17g), strings as hex bytes so any
// byte survives. The checksum (FNV-1a 64 over everything before its line)
// catches damage; import checks the whole text, every name, channel and
// value before it changes anything.
#include <cinttypes>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <sstream>

#include "Digitizer.h"

namespace hsdig::sim {

namespace {

constexpr const char* kHeader = "HSDIG-CONFIGURATION 1";

std::uint64_t fnv1a(std::string_view s) {
  std::uint64_t h = 0xcbf29ce484222325ull;
  for (unsigned char c : s) {
    h ^= c;
    h *= 0x100000001b3ull;
  }
  return h;
}

std::string hex(std::string_view s) {
  static const char* digits = "0123456789abcdef";
  std::string out = "x";
  for (unsigned char c : s) {
    out += digits[c >> 4];
    out += digits[c & 15];
  }
  return out;
}

bool unhex(std::string_view s, std::string& out) {
  if (s.empty() || s[0] != 'x' || (s.size() - 1) % 2) return false;
  auto val = [](char c) -> int {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    return -1;
  };
  out.clear();
  for (size_t i = 1; i < s.size(); i += 2) {
    int a = val(s[i]), b = val(s[i + 1]);
    if (a < 0 || b < 0) return false;
    out += static_cast<char>(a * 16 + b);
  }
  return true;
}

std::string valueText(ViSession vi, const AttributeInfo& a, const char* ch) {
  char buf[64];
  switch (a.type) {
    case IVI_VAL_INT32:
      return std::to_string(getInt32(vi, ch, a.id));
    case IVI_VAL_INT64:
      return std::to_string(getInt64(vi, ch, a.id));
    case IVI_VAL_BOOLEAN:
      return getBoolean(vi, ch, a.id) ? "1" : "0";
    case IVI_VAL_SESSION: {
      ViSession v = 0;
      checkEngine(Ivi_GetAttributeViSession(vi, ch, a.id, 0, &v), "Reading a session attribute.");
      return std::to_string(v);
    }
    case IVI_VAL_REAL64:
      std::snprintf(buf, sizeof buf, "%.17g", getReal64(vi, ch, a.id));
      return buf;
    default:
      return hex(getString(vi, ch, a.id));
  }
}

struct Item {
  const AttributeInfo* attribute;
  std::string channel;
  double number = 0;
  std::int64_t integer = 0;
  std::string text;
};

[[noreturn]] void damaged(int line, const std::string& why) {
  fail(HSDIG_ERROR_CONFIGURATION_DATA,
       "Line " + std::to_string(line) + " of the configuration: " + why);
}

}  // namespace

std::string exportConfiguration(Digitizer& d) {
  std::string out = std::string(kHeader) + "\nmodel " + d.model.name + "\n";
  for (const AttributeInfo& a : allAttributes()) {
    if (a.readOnly) continue;
    const int count = a.perChannel ? d.model.channels : 1;
    for (int c = 0; c < count; ++c) {
      std::string ch = a.perChannel ? channelName(c) : "";
      out += std::string(a.name) + " " + (a.perChannel ? ch : "-") + " " +
             valueText(d.vi, a, ch.c_str()) + "\n";
    }
  }
  char sum[40];
  std::snprintf(sum, sizeof sum, "checksum %016" PRIx64 "\n", fnv1a(out));
  return out + sum;
}

void importConfiguration(Digitizer& d, std::string_view text) {
  // The checksum line is the last one; everything before it is covered.
  size_t end = text.size();
  if (end && text[end - 1] == '\n') --end;
  size_t lastStart = text.rfind('\n', end ? end - 1 : 0);
  if (lastStart == std::string_view::npos || end == 0)
    damaged(1, "the text is empty or has no checksum line.");
  std::string_view body = text.substr(0, lastStart + 1);
  std::string_view last = text.substr(lastStart + 1, end - lastStart - 1);
  char expected[40];
  std::snprintf(expected, sizeof expected, "checksum %016" PRIx64, fnv1a(body));
  if (last != expected) damaged(0, "the checksum does not match; the configuration is damaged.");

  std::vector<Item> items;
  std::istringstream in{std::string(body)};
  std::string line;
  int number = 0;
  while (std::getline(in, line)) {
    ++number;
    if (number == 1) {
      if (line != kHeader) damaged(number, "the header is not \"" + std::string(kHeader) + "\".");
      continue;
    }
    std::istringstream words(line);
    std::string name, channel, value, extra;
    words >> name >> channel;
    if (number == 2) {
      if (name != "model" || channel != d.model.name) {
        damaged(number, "the configuration was made for model \"" + channel + "\", this is a " +
                            d.model.name + ".");
      }
      continue;
    }
    words >> value;
    if (name.empty() || value.empty() || (words >> extra))
      damaged(number, "it is not \"NAME CHANNEL VALUE\".");
    const AttributeInfo* a = nullptr;
    for (const AttributeInfo& candidate : allAttributes()) {
      if (name == candidate.name) a = &candidate;
    }
    if (!a || a->readOnly) damaged(number, "\"" + name + "\" is not a writable attribute.");
    Item item;
    item.attribute = a;
    item.channel = a->perChannel ? channel : "";
    if (a->perChannel) {
      char* stop = nullptr;
      long c = std::strtol(channel.c_str(), &stop, 10);
      if (channel.empty() || *stop || c < 0 || c >= d.model.channels)
        damaged(number, "bad channel \"" + channel + "\".");
    } else if (channel != "-") {
      damaged(number, "a session attribute takes \"-\" as its channel.");
    }
    char* stop = nullptr;
    errno = 0;
    switch (a->type) {
      case IVI_VAL_STRING:
        if (!unhex(value, item.text)) damaged(number, "the string value is not hex text.");
        break;
      case IVI_VAL_REAL64:
        item.number = std::strtod(value.c_str(), &stop);
        if (*stop || errno || !std::isfinite(item.number))
          damaged(number, "\"" + value + "\" is not a number.");
        if (item.number < a->min || item.number > a->max)
          damaged(number, "the value is out of range.");
        break;
      default:
        item.integer = std::strtoll(value.c_str(), &stop, 10);
        if (*stop || errno) damaged(number, "\"" + value + "\" is not an integer.");
        if (static_cast<double>(item.integer) < a->min ||
            static_cast<double>(item.integer) > a->max) {
          damaged(number, "the value is out of range.");
        }
        break;
    }
    items.push_back(std::move(item));
  }
  if (items.empty()) damaged(number, "it holds no attribute.");
  for (const Item& it : items) {
    const char* ch = it.channel.c_str();
    const ViInt32 flags = IVI_VAL_DIRECT_USER_CALL;
    ViStatus st = VI_SUCCESS;
    switch (it.attribute->type) {
      case IVI_VAL_INT32:
        st = Ivi_SetAttributeViInt32(d.vi, ch, it.attribute->id, flags,
                                     static_cast<ViInt32>(it.integer));
        break;
      case IVI_VAL_INT64:
        st = Ivi_SetAttributeViInt64(d.vi, ch, it.attribute->id, flags, it.integer);
        break;
      case IVI_VAL_BOOLEAN:
        st = Ivi_SetAttributeViBoolean(d.vi, ch, it.attribute->id, flags,
                                       it.integer ? VI_TRUE : VI_FALSE);
        break;
      case IVI_VAL_SESSION:
        st = Ivi_SetAttributeViSession(d.vi, ch, it.attribute->id, flags,
                                       static_cast<ViSession>(it.integer));
        break;
      case IVI_VAL_REAL64:
        st = Ivi_SetAttributeViReal64(d.vi, ch, it.attribute->id, flags, it.number);
        break;
      default:
        st = Ivi_SetAttributeViString(d.vi, ch, it.attribute->id, flags, it.text.c_str());
        break;
    }
    checkEngine(st, std::string("Applying ") + it.attribute->name + ".");
  }
}

}  // namespace hsdig::sim
