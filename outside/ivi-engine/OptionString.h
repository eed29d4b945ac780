// The IVI option string: "Name=Value" items separated by ",". Names are
// compared without regard to case. The "DriverSetup" item's value runs to the
// end of the string, so it may itself hold commas; it is therefore the last
// item.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "IviEngine.h"

namespace cvivi {

struct OptionItem {
  std::string name;
  std::string value;
};

// Splits `text` into items. An item without "=" or with an empty name gives
// IVI_ERROR_BAD_OPTION_VALUE with `problem` naming it. Empty items are skipped.
ViStatus splitOptions(std::string_view text, std::vector<OptionItem>& items, std::string& problem);

// Joins items back into an option string, "DriverSetup" last.
std::string joinOptions(const std::vector<OptionItem>& items);

// `base` with every item of `overrides` replacing the item of the same name
// or added.
std::vector<OptionItem> mergeOptions(std::vector<OptionItem> base,
                                     const std::vector<OptionItem>& overrides);

// The engine settings that an option string selects for a new session.
struct SessionOptions {
  bool rangeCheck = true;
  bool queryInstrStatus = false;
  bool cache = true;
  bool simulate = false;
  bool recordCoercions = false;
  bool interchangeCheck = false;
  std::string driverSetup;
};

// Reads the standard items "RangeCheck", "QueryInstrStatus", "Cache",
// "Simulate", "RecordCoercions", "InterchangeCheck" (booleans: 1/0,
// true/false, VI_TRUE/VI_FALSE) and "DriverSetup". Unknown names give
// IVI_ERROR_BAD_OPTION_NAME, bad values IVI_ERROR_BAD_OPTION_VALUE.
ViStatus parseSessionOptions(std::string_view text, SessionOptions& out, std::string& problem);

}  // namespace cvivi
