#include "OptionString.h"

#include "EngineSession.h"

namespace cvivi {
namespace {

constexpr std::string_view kDriverSetup = "DriverSetup";

bool parseBoolean(std::string_view text, bool& out) {
  const std::string v = upper(trim(text));
  if (v == "1" || v == "TRUE" || v == "VI_TRUE") return out = true, true;
  if (v == "0" || v == "FALSE" || v == "VI_FALSE") return out = false, true;
  return false;
}

}  // namespace

ViStatus splitOptions(std::string_view text, std::vector<OptionItem>& items, std::string& problem) {
  items.clear();
  size_t pos = 0;
  while (pos < text.size()) {
    size_t comma = text.find(',', pos);
    if (comma == std::string_view::npos) comma = text.size();
    std::string_view raw = text.substr(pos, comma - pos);
    const size_t eq = raw.find('=');
    const std::string name = trim(raw.substr(0, eq == std::string_view::npos ? raw.size() : eq));
    if (name.empty() && trim(raw).empty()) {
      pos = comma + 1;
      continue;
    }
    if (eq == std::string_view::npos || name.empty()) {
      problem = "Option string item \"" + trim(raw) + "\" is not of the form Name=Value.";
      return IVI_ERROR_BAD_OPTION_VALUE;
    }
    if (equalsIgnoreCase(name, kDriverSetup)) {
      // The driver setup takes the rest of the string.
      items.push_back({std::string(kDriverSetup), trim(text.substr(pos + eq + 1))});
      break;
    }
    items.push_back({name, trim(raw.substr(eq + 1))});
    pos = comma + 1;
  }
  return VI_SUCCESS;
}

std::string joinOptions(const std::vector<OptionItem>& items) {
  std::string out;
  const OptionItem* setup = nullptr;
  for (const auto& item : items) {
    if (equalsIgnoreCase(item.name, kDriverSetup)) {
      setup = &item;
      continue;
    }
    if (!out.empty()) out += ", ";
    out += item.name + "=" + item.value;
  }
  if (setup) {
    if (!out.empty()) out += ", ";
    out += setup->name + "=" + setup->value;
  }
  return out;
}

std::vector<OptionItem> mergeOptions(std::vector<OptionItem> base,
                                     const std::vector<OptionItem>& overrides) {
  for (const auto& o : overrides) {
    bool replaced = false;
    for (auto& b : base) {
      if (equalsIgnoreCase(b.name, o.name)) {
        b.value = o.value;
        replaced = true;
      }
    }
    if (!replaced) base.push_back(o);
  }
  return base;
}

ViStatus parseSessionOptions(std::string_view text, SessionOptions& out, std::string& problem) {
  std::vector<OptionItem> items;
  if (ViStatus st = splitOptions(text, items, problem); st < 0) return st;
  for (const auto& item : items) {
    if (equalsIgnoreCase(item.name, kDriverSetup)) {
      out.driverSetup = item.value;
      continue;
    }
    bool* target = nullptr;
    if (equalsIgnoreCase(item.name, "RangeCheck"))
      target = &out.rangeCheck;
    else if (equalsIgnoreCase(item.name, "QueryInstrStatus"))
      target = &out.queryInstrStatus;
    else if (equalsIgnoreCase(item.name, "Cache"))
      target = &out.cache;
    else if (equalsIgnoreCase(item.name, "Simulate"))
      target = &out.simulate;
    else if (equalsIgnoreCase(item.name, "RecordCoercions"))
      target = &out.recordCoercions;
    else if (equalsIgnoreCase(item.name, "InterchangeCheck"))
      target = &out.interchangeCheck;
    if (!target) {
      problem = "Unknown option \"" + item.name + "\".";
      return IVI_ERROR_BAD_OPTION_NAME;
    }
    if (!parseBoolean(item.value, *target)) {
      problem = "Option \"" + item.name + "\" has the value \"" + item.value +
                "\"; expected 1, 0, true, false, VI_TRUE or VI_FALSE.";
      return IVI_ERROR_BAD_OPTION_VALUE;
    }
  }
  return VI_SUCCESS;
}

}  // namespace cvivi
