// The term tables: module form, key parity of every language with English,
// no English left in a translation except names, and coverage of the codes
// and keys this system raises.
#include <gtest/gtest.h>

#include <lua.hpp>

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <fstream>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "driver/hsdigAttributes.h"
#include "driver/hsdigErrors.h"
#include "errors/translator/EmbeddedModules.h"
#include "errors/translator/Translator.h"
#include "errors/translator/TranslatorSession.h"
#include "outside/ivi-engine/IviEngine.h"

namespace hsdig::translator {
namespace {

constexpr int32_t ivi(uint32_t code) {
  return static_cast<int32_t>(code);
}

// Table families with a language suffix, and whether their texts are names
// (names need not differ from English).
struct Family {
  const char* prefix;
  bool names;
};
const Family kFamilies[] = {
    {"errors_", false}, {"commonTerms_", false}, {"hsdig_attributes_", true}};

// Keys whose English text is itself a name or identifier, the same in every
// language.
const std::set<std::string> kUntranslatedKeys = {"rest_of_input_json"};

// Loads module `name` into `L` and returns its entries as key text -> text
// (for attribute tables: the short name and every value name).
std::map<std::string, std::string> entriesOf(lua_State* L, const std::string& name) {
  std::map<std::string, std::string> out;
  int top = lua_gettop(L);
  lua_getglobal(L, "require");
  lua_pushstring(L, name.c_str());
  if (lua_pcall(L, 1, 1, 0) != 0) {
    ADD_FAILURE() << name << ": " << lua_tostring(L, -1);
    lua_settop(L, top);
    return out;
  }
  lua_getfield(L, -1, "encoding");
  EXPECT_STREQ(lua_tostring(L, -1), "utf-8") << name;
  lua_pop(L, 1);
  lua_getfield(L, -1, "entries");
  if (!lua_istable(L, -1)) {
    ADD_FAILURE() << name << " has no entries";
    lua_settop(L, top);
    return out;
  }
  lua_pushnil(L);
  while (lua_next(L, -2) != 0) {
    lua_pushvalue(L, -2);
    std::string key = lua_tostring(L, -1);
    lua_pop(L, 1);
    if (lua_isstring(L, -1)) {
      out[key] = lua_tostring(L, -1);
    } else if (lua_istable(L, -1)) {
      lua_getfield(L, -1, "name");
      out[key] = lua_isstring(L, -1) ? lua_tostring(L, -1) : "";
      lua_pop(L, 1);
      lua_getfield(L, -1, "values");
      if (lua_istable(L, -1)) {
        lua_pushnil(L);
        while (lua_next(L, -2) != 0) {
          lua_pushvalue(L, -2);
          out[key + " value " + lua_tostring(L, -1)] =
              lua_isstring(L, -2) ? lua_tostring(L, -2) : "";
          lua_pop(L, 2);
        }
      }
      lua_pop(L, 1);
    }
    lua_pop(L, 1);
  }
  lua_settop(L, top);
  return out;
}

// The key-parity check of one language table against English; answers one
// message per missing or extra key.
std::vector<std::string> parityProblems(lua_State* L, const std::string& english,
                                        const std::string& other) {
  auto reference = entriesOf(L, english);
  auto translated = entriesOf(L, other);
  std::vector<std::string> problems;
  for (const auto& [key, text] : reference) {
    if (!translated.count(key)) problems.push_back(other + " lacks the key " + key);
  }
  for (const auto& [key, text] : translated) {
    if (!reference.count(key))
      problems.push_back(other + " has the key " + key + ", which " + english + " lacks");
  }
  return problems;
}

std::vector<std::string> languageModules(const char* prefix) {
  std::vector<std::string> out;
  const std::string start(prefix);
  for (std::size_t i = 0; i < kEmbeddedModuleCount; ++i) {
    std::string name = kEmbeddedModules[i].name;
    if (name.size() != start.size() + 3 || name.compare(0, start.size(), start) != 0) continue;
    std::string language = name.substr(start.size());
    bool lowerCase =
        std::all_of(language.begin(), language.end(), [](char c) { return c >= 'a' && c <= 'z'; });
    if (lowerCase && language != "eng") out.push_back(name);
  }
  return out;
}

class TermTables : public testing::Test {
 protected:
  Translator translator{kTranslatorSettings, "/nonexistent"};
  lua_State* L = translator.state();
};

TEST_F(TermTables, EveryLanguageTableHasExactlyTheEnglishKeys) {
  for (const auto& family : kFamilies) {
    std::string english = std::string(family.prefix) + "eng";
    SCOPED_TRACE(english);
    EXPECT_FALSE(entriesOf(L, english).empty() &&
                 std::string(family.prefix) != "hsdig_attributes_");
    for (const auto& other : languageModules(family.prefix)) {
      SCOPED_TRACE(other);
      for (const auto& problem : parityProblems(L, english, other)) ADD_FAILURE() << problem;
    }
  }
}

TEST_F(TermTables, TheParityCheckNamesAMissingKey) {
  // A stand-in translation that lacks one key and adds another.
  ASSERT_EQ(luaL_dostring(L, R"(
      local english = require("commonTerms_eng").entries
      local copy = {}
      for k, v in pairs(english) do copy[k] = "x" .. v end
      copy.kSidlNoTag = nil
      copy.kSurplus = "y"
      package.preload["commonTerms_tst"] = function()
        return require("cvmxl_utilities").stringTable(copy)
      end)"),
            0);
  auto problems = parityProblems(L, "commonTerms_eng", "commonTerms_tst");
  ASSERT_EQ(problems.size(), 2u);
  EXPECT_EQ(problems[0], "commonTerms_tst lacks the key kSidlNoTag");
  EXPECT_EQ(problems[1], "commonTerms_tst has the key kSurplus, which commonTerms_eng lacks");
}

TEST_F(TermTables, NoTextIsLeftInEnglishInAnotherLanguageExceptNames) {
  int checked = 0;
  for (const auto& family : kFamilies) {
    if (family.names) continue;
    std::string english = std::string(family.prefix) + "eng";
    auto reference = entriesOf(L, english);
    for (const auto& other : languageModules(family.prefix)) {
      SCOPED_TRACE(other);
      for (const auto& [key, text] : entriesOf(L, other)) {
        if (kUntranslatedKeys.count(key) || !reference.count(key)) continue;
        EXPECT_NE(text, reference[key]) << other << " keeps the English text of " << key;
        ++checked;
      }
    }
  }
  if (checked == 0) GTEST_SKIP() << "no translated tables are embedded yet";
}

TEST_F(TermTables, EnglishCoversEveryCodeAndKeyThisSystemRaises) {
  const int32_t codes[] = {
      ivi(0xBFFA0000), ivi(0xBFFA0009), ivi(0xBFFA000F), ivi(0xBFFA0010), ivi(0xBFFA0013),
      ivi(0xBFFA004A), ivi(0xBFFA004C), ivi(0xBFFA0056), ivi(0xBFFA0058), ivi(0xBFFA0060),
      ivi(0xBFFA1190), ivi(0xBFFA402B), ivi(0xBFFA402E), ivi(0xBFFA40BA), ivi(0xBFFA8BF0),
      ivi(0xBFFA8CF0), ivi(0xBFFA9175), ivi(0xBFFA9178), ivi(0xBFFA9181), ivi(0xBFFA9182),
      ivi(0xBFFF0011), ivi(0xBFFF003C), ivi(0xBFFF0078), ivi(0xBFFF0000), ivi(0xBFFA9400),
      ivi(0xBFFA9403), ivi(0xBFFA9405), ivi(0xBFFA9406), ivi(0xBFFA9408), ivi(0xBFFA941B),
      ivi(0xBFFA941D), -52000,          -52003,          -52005,          -52006,
      -52008,          -52027,          -52029,
  };
  TranslatorSession session;
  for (int32_t code : codes) {
    SCOPED_TRACE(testing::Message() << std::hex << static_cast<uint32_t>(code));
    bool known = false;
    session.staticDescription(code, 0, &known);
    EXPECT_TRUE(known);
  }
  for (uint32_t code = 0xBFFA914E; code <= 0xBFFA915C; ++code) {
    SCOPED_TRACE(testing::Message() << std::hex << code);
    bool known = false;
    session.staticDescription(ivi(code), 0, &known);
    EXPECT_TRUE(known);
  }

  auto terms = entriesOf(L, "commonTerms_eng");
  const char* keys[] = {
      "kUsageTypeAffectedAttribute",
      "kUsageTypeAttributeId",
      "kUsageTypeAttributeIdentifier",
      "kUsageTypeConflictingAttr",
      "kUsageTypeConflictingProperty",
      "kUsageTypeDevice",
      "kUsageTypeFilePath",
      "kUsageTypeInvalidIdentifier",
      "kUsageTypeParameterName",
      "kUsageTypeRequestedDeviceName",
      "kUsageTypeRequestedValue",
      "kUsageTypeUnspecifiedProperty",
      "kSidlUsageTypeErrno",
      "kSidlSetupContainsEqual",
      "kSidlSetupNotParsed",
      "kSidlInvalidTag",
      "kSidlRepeatedTag",
      "kSidlNotInteger",
      "kSidlNotBoolean",
      "kSidlNoTag",
      "kSidlNoValue",
      "kSidlInvalidLanguage",
      "kSidlInvalidResourceName",
      "kSidlRepeatedResourceName",
      "kSidlNoResourceName",
      "kSidlInvalidFileHandle",
      "kSidlInitialization",
      "kSidlMaxNumSessionsExceeded",
      "kSidlSharedMemMutex",
      "Oversized session information table data section",
      "You must set the CloseFunctionPtr prior to calling any functions.",
      "Windows generated an error",
      "Windows Error Code:",
      "Windows Error Message:",
      "Component",
      "File",
      "Line",
      "Internal Error",
  };
  for (const char* key : keys) {
    SCOPED_TRACE(key);
    EXPECT_TRUE(terms.count(key));
  }
  // The DriverSetup messages are fixed texts.
  EXPECT_EQ(terms["kSidlSetupContainsEqual"], "DriverSetup string cannot contain a '='");
  EXPECT_EQ(terms["kSidlInvalidFileHandle"], "Invalid file handle.");
}

// The engine's status codes, as its public header defines them: every
// "#define IVI_ERROR_... ((ViStatus)0x...)" but the base, plus the parameter
// position range. Read from the header so that a code added there without a
// text fails here.
std::vector<int32_t> engineStatusCodes() {
  std::ifstream in(HSDIG_SOURCE_DIR "/outside/ivi-engine/IviEngine.h");
  std::stringstream text;
  text << in.rdbuf();
  std::string header = text.str();
  std::vector<int32_t> codes;
  const std::string prefix = "#define IVI_ERROR_", cast = "((ViStatus)0x";
  for (size_t at = header.find(prefix); at != std::string::npos; at = header.find(prefix, at + 1)) {
    size_t nameEnd = header.find_first_of(" \t", at + prefix.size());
    size_t value = header.find_first_not_of(" \t", nameEnd);
    if (nameEnd == std::string::npos || value == std::string::npos ||
        header.compare(value, cast.size(), cast) != 0)
      continue;
    if (header.compare(at + 8, nameEnd - at - 8, "IVI_ERROR_BASE") == 0) continue;
    codes.push_back(
        ivi(static_cast<uint32_t>(std::stoul(header.substr(value + cast.size(), 8), nullptr, 16))));
  }
  for (int32_t code = IVI_ERROR_PARAMETER1; code <= IVI_ERROR_PARAMETER8; ++code) {
    codes.push_back(code);
  }
  return codes;
}

TEST_F(TermTables, EnglishDescribesEveryCodeOfTheEngine) {
  auto codes = engineStatusCodes();
  // The scan found the header's codes, among them the first and the last.
  ASSERT_GE(codes.size(), 36u);
  EXPECT_NE(std::find(codes.begin(), codes.end(), IVI_ERROR_CANNOT_OPEN_FILE), codes.end());
  EXPECT_NE(std::find(codes.begin(), codes.end(), IVI_ERROR_INVALID_SESSION_HANDLE), codes.end());
  TranslatorSession session;
  for (int32_t code : codes) {
    SCOPED_TRACE(testing::Message() << std::hex << static_cast<uint32_t>(code));
    bool known = false;
    session.staticDescription(code, 0, &known);
    EXPECT_TRUE(known);
  }
  // Each parameter position names its own parameter.
  EXPECT_EQ(session.staticDescription(IVI_ERROR_PARAMETER1 + 2, 0),
            "Parameter 3 of the function has an invalid value.");
}

TEST_F(TermTables, EnglishDescribesExactlyTheDriverStatusCodes) {
  struct DriverCode {
    const char* name;
    int32_t code;
  };
#define HSDIG_TEST_CODE(NAME, code, text) {#NAME, ivi(code)},
  const DriverCode driverCodes[] = {HSDIG_DRIVER_STATUS(HSDIG_TEST_CODE)};
#undef HSDIG_TEST_CODE
  TranslatorSession session;
  std::set<int32_t> driverSet;
  for (const auto& [name, code] : driverCodes) {
    SCOPED_TRACE(name);
    driverSet.insert(code);
    bool known = false;
    session.staticDescription(code, 0, &known);
    EXPECT_TRUE(known);
  }
  // No text is left for a code the driver no longer has: the driver's blocks
  // hold only its own codes.
  for (const auto& [key, text] : entriesOf(L, "errors_eng")) {
    uint32_t code = static_cast<uint32_t>(std::stoll(key));
    bool inDriverBlock = (code & 0x7FFFFF00u) == 0x3FFA5000u;
    if (inDriverBlock) {
      EXPECT_TRUE(driverSet.count(ivi(code))) << std::hex << code << " is not a driver code";
    }
  }
}

TEST_F(TermTables, DigitizerAttributesHaveTheirShortNamesAndValueNames) {
  auto entries = entriesOf(L, "hsdig_attributes_eng");
  auto keyOf = [](uint32_t id) {
    char key[9];
    std::snprintf(key, sizeof key, "%08X", id);
    return std::string(key);
  };
  auto textOf = [&entries](const std::string& key) {
    auto found = entries.find(key);
    return found == entries.end() ? std::string("(missing)") : found->second;
  };

  struct Attribute {
    const char* name;
    uint32_t id;
  };
#define HSDIG_TEST_ATTRIBUTE(NAME, id, type, scope, def, min, max, flags) {#NAME, id},
  const Attribute attributes[] = {HSDIG_ATTRIBUTES(HSDIG_TEST_ATTRIBUTE)};
#undef HSDIG_TEST_ATTRIBUTE
  std::set<std::string> driverKeys;
  for (const auto& [name, id] : attributes) {
    SCOPED_TRACE(name);
    driverKeys.insert(keyOf(id));
    EXPECT_EQ(textOf(keyOf(id)), name);
  }

  // The enumerated attributes and the constants of their values.
  struct Value {
    uint32_t attribute;
    int value;
    const char* name;
  };
#define HSDIG_TEST_VALUE(ATTR, NAME) \
  { HSDIG_ATTR_##ATTR, HSDIG_VAL_##NAME, #NAME }
  const Value values[] = {
      HSDIG_TEST_VALUE(VERTICAL_COUPLING, AC),
      HSDIG_TEST_VALUE(VERTICAL_COUPLING, DC),
      HSDIG_TEST_VALUE(VERTICAL_COUPLING, GND),
      HSDIG_TEST_VALUE(SIGNAL_SHAPE, SHAPE_DC),
      HSDIG_TEST_VALUE(SIGNAL_SHAPE, SHAPE_SINE),
      HSDIG_TEST_VALUE(SIGNAL_SHAPE, SHAPE_SQUARE),
      HSDIG_TEST_VALUE(SIGNAL_SHAPE, SHAPE_TRIANGLE),
      HSDIG_TEST_VALUE(SIGNAL_SHAPE, SHAPE_SAWTOOTH),
      HSDIG_TEST_VALUE(ACQUISITION_TYPE, NORMAL),
      HSDIG_TEST_VALUE(ACQUISITION_TYPE, FLEXRES),
      HSDIG_TEST_VALUE(ACQUISITION_TYPE, DDC),
      HSDIG_TEST_VALUE(SAMPLE_MODE, REAL_TIME),
      HSDIG_TEST_VALUE(SAMPLE_MODE, EQUIVALENT_TIME),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, EDGE_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, HYSTERESIS_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, DIGITAL_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, WINDOW_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, SOFTWARE_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, IMMEDIATE_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, WIDTH_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, RUNT_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, GLITCH_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_TYPE, VIDEO_TRIGGER),
      HSDIG_TEST_VALUE(TRIGGER_SLOPE, NEGATIVE),
      HSDIG_TEST_VALUE(TRIGGER_SLOPE, POSITIVE),
      HSDIG_TEST_VALUE(TRIGGER_COUPLING, TRIGGER_COUPLING_AC),
      HSDIG_TEST_VALUE(TRIGGER_COUPLING, TRIGGER_COUPLING_DC),
      HSDIG_TEST_VALUE(TRIGGER_COUPLING, TRIGGER_COUPLING_HF_REJECT),
      HSDIG_TEST_VALUE(TRIGGER_COUPLING, TRIGGER_COUPLING_LF_REJECT),
      HSDIG_TEST_VALUE(TRIGGER_COUPLING, TRIGGER_COUPLING_AC_PLUS_HF_REJECT),
      HSDIG_TEST_VALUE(TRIGGER_WINDOW_MODE, ENTERING_WINDOW),
      HSDIG_TEST_VALUE(TRIGGER_WINDOW_MODE, LEAVING_WINDOW),
      HSDIG_TEST_VALUE(TRIGGER_POLARITY, POLARITY_POSITIVE),
      HSDIG_TEST_VALUE(TRIGGER_POLARITY, POLARITY_NEGATIVE),
      HSDIG_TEST_VALUE(TRIGGER_POLARITY, POLARITY_EITHER),
      HSDIG_TEST_VALUE(TRIGGER_WIDTH_CONDITION, WITHIN),
      HSDIG_TEST_VALUE(TRIGGER_WIDTH_CONDITION, OUTSIDE),
      HSDIG_TEST_VALUE(TRIGGER_GLITCH_CONDITION, LESS_THAN),
      HSDIG_TEST_VALUE(TRIGGER_GLITCH_CONDITION, GREATER_THAN),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_FORMAT, NTSC),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_FORMAT, PAL),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_FORMAT, SECAM),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_FORMAT, M_PAL),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_EVENT, VIDEO_ANY_FIELD),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_EVENT, VIDEO_FIELD1),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_EVENT, VIDEO_FIELD2),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_EVENT, VIDEO_ANY_LINE),
      HSDIG_TEST_VALUE(TRIGGER_VIDEO_EVENT, VIDEO_LINE_NUMBER),
      HSDIG_TEST_VALUE(PRIVILEGE_LEVEL, PRIVILEGE_NONE),
      HSDIG_TEST_VALUE(PRIVILEGE_LEVEL, PRIVILEGE_OBSERVE),
      HSDIG_TEST_VALUE(PRIVILEGE_LEVEL, PRIVILEGE_CONFIGURE),
      HSDIG_TEST_VALUE(PRIVILEGE_LEVEL, PRIVILEGE_CONTROL),
      HSDIG_TEST_VALUE(FETCH_RELATIVE_TO, START_RELATIVE),
      HSDIG_TEST_VALUE(FETCH_RELATIVE_TO, TRIGGER_RELATIVE),
  };
#undef HSDIG_TEST_VALUE
  std::set<std::string> valueKeys;
  for (const auto& [attribute, value, name] : values) {
    std::string key = keyOf(attribute) + " value " + std::to_string(value);
    SCOPED_TRACE(key);
    valueKeys.insert(key);
    EXPECT_EQ(textOf(key), name);
  }

  // Nothing beyond: no stale attribute of the digitizer's id block, no value
  // name the driver does not define.
  for (const auto& [key, text] : entries) {
    std::string id = key.substr(0, 8);
    if (id < keyOf(1250000) || id > keyOf(1259999)) continue;
    if (key.size() == 8) {
      EXPECT_TRUE(driverKeys.count(key)) << key << " (" << text << ") is not a driver attribute";
    } else {
      EXPECT_TRUE(valueKeys.count(key)) << key << " (" << text << ") is not a driver value";
    }
  }
}

TEST_F(TermTables, EnglishTextsAreCompleteSentences) {
  for (const auto& [key, text] : entriesOf(L, "errors_eng")) {
    SCOPED_TRACE(key);
    ASSERT_FALSE(text.empty());
    EXPECT_TRUE(std::isupper(static_cast<unsigned char>(text.front())));
    EXPECT_EQ(text.back(), '.');
  }
}

}  // namespace
}  // namespace hsdig::translator
