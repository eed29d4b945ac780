// Rendering a status into text: the json1 form, attribute and enum names,
// languages, nested errors, the retry chain, code pages and sessions used
// from several threads.
#include <gtest/gtest.h>

#include <lua.hpp>

#include <barrier>
#include <string>
#include <thread>
#include <vector>

#include "TempFolder.h"
#include "errors/ErrorDescription.h"
#include "errors/Status.h"
#include "errors/translator/Json1Formatter.h"
#include "errors/translator/Translator.h"
#include "errors/translator/TranslatorSession.h"

namespace hsdig::translator {
namespace {

constexpr int32_t ivi(uint32_t code) {
  return static_cast<int32_t>(code);
}
constexpr int32_t kInvalidOption = ivi(0xBFFA004C);

// A description with the given ordered_data items (JSON text of the array).
std::string describe(const std::string& items, const std::string& extra = "") {
  return R"({"translator":"mxlator_hsdig","translator_info":{"version":1,"is_debug":false,"ordered_data":)" +
         items + "}" + extra + "}";
}

class Translate : public testing::Test {
 protected:
  std::string staticText(int32_t code, int language = 0) {
    return session.staticDescription(code, language);
  }
  std::string full(int32_t code, const std::string& json, int language = 0,
                   uint32_t flags = kFlagPlain) {
    return session.render(code, json, language, flags).text;
  }
  TranslatorSession session;
};

TEST_F(Translate, UsageItemsShowAttributeNamesEnumNamesAndValues) {
  struct ItemCase {
    const char* name;
    const char* item;
    const char* line;
  };
  const ItemCase cases[] = {
      {"attribute id in the table",
       R"({"type":"usage","usage":"kUsageTypeAttributeId","value":1050005,"value_type":"int32_t"})",
       "Attribute: SIMULATE"},
      {"attribute id not in the table",
       R"({"type":"usage","usage":"kUsageTypeAttributeId","value":1234567,"value_type":"int32_t"})",
       "Attribute: 0x0012D687"},
      {"negative attribute id",
       R"({"type":"usage","usage":"kUsageTypeAffectedAttribute","value":-1})",
       "Affected attribute: 0xFFFFFFFF"},
      {"array of attribute ids",
       R"({"type":"usage","usage":"kUsageTypeConflictingAttr","value":[1050005,1199999,11]})",
       "Conflicting attribute: SIMULATE, SECM_ATTR_LANGUAGE, 0x0000000B"},
      {"enum value with a name",
       R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":3,"value_type":{"type":"enum","id":1199999}})",
       "Requested value: jp"},
      {"enum value without a name",
       R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":42,"value_type":{"type":"enum","id":1199999}})",
       "Requested value: 42"},
      {"enum of an unknown attribute",
       R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":3,"value_type":{"type":"enum","id":77}})",
       "Requested value: 3"},
      {"text value",
       R"({"type":"usage","usage":"kUsageTypeFilePath","value":"/tmp/a b","value_type":"string"})",
       "File path: /tmp/a b"},
      {"array of texts", R"({"type":"usage","usage":"kUsageTypeDevice","value":["Dev1","Dev2"]})",
       "Device: Dev1, Dev2"},
      {"64-bit value beyond a double",
       R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":9007199254740993,"value_type":"uint64_t"})",
       "Requested value: 9007199254740993"},
      {"largest unsigned 64-bit value",
       R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":18446744073709551615})",
       "Requested value: 18446744073709551615"},
      {"fraction", R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":0.25})",
       "Requested value: 0.25"},
      {"boolean", R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":true})",
       "Requested value: true"},
      {"unknown usage key shows the key", R"({"type":"usage","usage":"kNoSuchKey","value":1})",
       "kNoSuchKey: 1"},
      {"elaboration", R"({"type":"elaboration","usage":"kSidlRepeatedTag"})",
       "Repeated DriverSetup tag."},
      {"elaboration that is its own text",
       R"({"type":"elaboration","usage":"Oversized session information table data section"})",
       "Oversized session information table data section"},
      {"header", R"({"type":"header","usage":"kSidlInvalidTag"})", "Invalid DriverSetup tag"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    EXPECT_EQ(full(kInvalidOption, describe(std::string("[") + c.item + "]")),
              staticText(kInvalidOption) + "\n\n" + c.line);
  }
}

TEST_F(Translate, ItemsFollowInOrderWithBlankLines) {
  std::string items = R"([{"type":"elaboration","usage":"kSidlInvalidTag"},{"type":"empty"},)"
                      R"({"type":"usage","usage":"kUsageTypeRequestedValue","value":"x"}])";
  EXPECT_EQ(full(kInvalidOption, describe(items)),
            staticText(kInvalidOption) + "\n\nInvalid DriverSetup tag\n\nRequested value: x");
}

TEST_F(Translate, LanguagesOutsideTheSixReadEnglish) {
  std::string json =
      describe(R"([{"type":"usage","usage":"kUsageTypeParameterName","value":"wfm"}])");
  std::string english = full(ivi(0xBFFA0058), json, 0);
  EXPECT_EQ(english, staticText(ivi(0xBFFA0058)) + "\n\nParameter name: wfm");
  for (int language : {6, 7, -1, 1000}) {
    SCOPED_TRACE(language);
    EXPECT_EQ(full(ivi(0xBFFA0058), json, language), english);
  }
  for (int language = 1; language <= 5; ++language) {
    SCOPED_TRACE(language);
    std::string text = full(ivi(0xBFFA0058), json, language);
    EXPECT_FALSE(text.empty());
    EXPECT_EQ(text.find("Error description not found"), std::string::npos);
  }
}

TEST_F(Translate, MappedCodesReadTheirOriginalDescription) {
  EXPECT_EQ(staticText(ivi(0xBFFA9400)), staticText(-52000));
  EXPECT_EQ(staticText(ivi(0xBFFA9403)), "An internal error occurred.");
  EXPECT_EQ(staticText(ivi(0xBFFA94FF)), "Error description not found");
}

TEST_F(Translate, ZeroCodeGivesNoText) {
  EXPECT_EQ(full(0, describe("[]")), "");
  EXPECT_EQ(full(0, ""), "");
}

TEST_F(Translate, NestedErrorsFollowIndentedByThreeSpacesPerLevel) {
  Status outer(kInvalidOption);
  description::addElaboration(outer, "kSidlInvalidTag");
  description::addUsage(outer, "kUsageTypeRequestedValue", "Bogus");
  Status inner(-52006);
  description::addUsage(inner, "kUsageTypeFilePath", "/x");
  Status innermost(ivi(0xBFFA9157));
  description::addNestedError(inner, innermost);
  description::addNestedError(outer, inner);

  std::string text, unused;
  Status result;
  session.translate(outer, 0, kFlagPlain, text, result);
  EXPECT_EQ(result.code(), 0);
  EXPECT_EQ(text, staticText(kInvalidOption) +
                      "\n\nInvalid DriverSetup tag\nRequested value: Bogus"
                      "\n\n   " +
                      staticText(-52006) +
                      "\n\n   File path: /x"
                      "\n\n      " +
                      staticText(ivi(0xBFFA9157)));
}

TEST_F(Translate, DebugItemsShowWhenTheDescriptionOrTheCallerAsks) {
  Status status(kInvalidOption);
  description::addUsage(status, "kUsageTypeRequestedValue", 5);
  status.description().AddMember("extra", 1, status.description().GetAllocator());
  std::string base = staticText(kInvalidOption) + "\n\nRequested value: 5";

  EXPECT_EQ(full(status.code(), status.descriptionJson()), base);
  std::string debug = full(status.code(), status.descriptionJson(), 0, kFlagPlain | kFlagDebug);
  EXPECT_EQ(debug.rfind(base + "\nComponent: hsdigRemote\nFile: ", 0), 0u) << debug;
  EXPECT_NE(debug.find("\nLine: "), std::string::npos);
  EXPECT_NE(debug.find("\nrest_of_input_json: {\"extra\":1}"), std::string::npos) << debug;

  description::prepare(status, true);
  status.description()["translator_info"]["is_debug"] = true;
  EXPECT_EQ(full(status.code(), status.descriptionJson()), debug);
}

TEST_F(Translate, FormatOtherThanJson1AnswersMinus52029AndAStaticText) {
  std::string json = describe(R"([{"type":"usage","usage":"kUsageTypeRequestedValue","value":1}])");
  try {
    session.translator(kBuiltInTranslatorName).getDynamicDesc(json, 0, 0, "json2");
    FAIL() << "json2 was accepted";
  } catch (const TranslationFailure& failure) {
    EXPECT_EQ(failure.code(), kCodeUnsupportedFormat);
  }
  Translation t = session.render(kInvalidOption, json, 0, kFlagPlain, "json2");
  EXPECT_TRUE(t.complete);
  EXPECT_EQ(t.attempts, 2);
  EXPECT_EQ(t.text, staticText(kInvalidOption));
}

// The dynamic step cannot read a description nested beyond its limit.
std::string unreadableDescription() {
  std::string deep(300, '[');
  deep += std::string(300, ']');
  return describe("[]", R"(,"deep":)" + deep);
}

TEST_F(Translate, RetryChain) {
  struct RetryCase {
    const char* name;
    std::string json;
    uint32_t flags;
    int attempts;
    bool complete;
    bool staticOnly;  // the text is exactly the static description
  };
  const std::string noTranslator = R"({"translator_info":{"version":1,"ordered_data":[]}})";
  const std::string otherTranslator = R"({"translator":"someone_else","translator_info":{}})";
  const RetryCase cases[] = {
      {"unreadable, plain: the static form", unreadableDescription(), kFlagPlain, 2, true, true},
      {"unreadable, plain and debug: debug dropped, then static", unreadableDescription(),
       kFlagPlain | kFlagDebug, 3, true, true},
      {"unreadable, no fallbacks allowed", unreadableDescription(), 0, 1, false, false},
      {"no translator key: only the code-only form works", noTranslator, kFlagPlain, 3, true, true},
      {"unknown translator: only the code-only form works", otherTranslator, kFlagPlain, 3, true,
       true},
      {"not JSON: only the code-only form works", "{broken", kFlagPlain, 3, true, true},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    Translation t = session.render(kInvalidOption, c.json, 0, c.flags);
    EXPECT_EQ(t.attempts, c.attempts);
    EXPECT_EQ(t.complete, c.complete);
    if (c.staticOnly) {
      EXPECT_EQ(t.text, staticText(kInvalidOption));
    }
    if (!c.complete) {
      // The static description, then what went wrong.
      std::string head = staticText(kInvalidOption) + "\n\n";
      EXPECT_EQ(t.text.rfind(head, 0), 0u) << t.text;
      EXPECT_NE(t.text.find("nested"), std::string::npos) << t.text;
      EXPECT_NE(t.failure.code(), 0);
    }
  }
}

TEST_F(Translate, MissingTranslatorKeyWithoutFallbacksIsReported) {
  Translation t = session.render(kInvalidOption, R"({"translator_info":{}})", 0, 0);
  EXPECT_FALSE(t.complete);
  EXPECT_EQ(t.text, "Error description not found\n\ncould not find translator key in json");
}

TEST_F(Translate, CodePageConversionOfBit30) {
  std::string json =
      describe(R"([{"type":"usage","usage":"kUsageTypeFilePath","value":"/tmp/caf\u00e9"}])");
  std::string utf8 = full(kInvalidOption, json, 1, kFlagPlain);
  ASSERT_NE(utf8.find("caf\xC3\xA9"), std::string::npos);
  struct PageCase {
    int language;
    const char* expected;
  };
  const PageCase cases[] = {
      {1, "caf\xE9"},      // code page 1252
      {2, "caf\xE9"},      // code page 1252
      {3, "caf?"},         // code page 932 has no such letter
      {7, "caf\xC3\xA9"},  // no particular language: UTF-8 stays
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.language);
    std::string converted = full(kInvalidOption, json, c.language, kConversionFlags);
    EXPECT_NE(converted.find(std::string("/tmp/") + c.expected), std::string::npos) << converted;
  }
}

TEST_F(Translate, StatusEntryPointLeavesResultAlone) {
  Status status(ivi(0xBFFA0058));
  description::addUsage(status, "kUsageTypeParameterName", "wfmInfo");
  std::string text = "old";
  Status result;
  session.translate(status, 0, kConversionFlags, text, result);
  EXPECT_EQ(result.code(), 0);
  EXPECT_EQ(text, staticText(ivi(0xBFFA0058)) + "\n\nParameter name: wfmInfo");
}

TEST(Json1Items, MalformedDynamicResultsAreRefused) {
  struct BadCase {
    const char* json;
    const char* message;
  };
  const BadCase cases[] = {
      {R"({"dynamic":[1]})", "json1 dynamic object invalid. each array item must be an object"},
      {R"({"dynamic":"x"})", "json1 dynamic object invalid. each array item must be an object"},
      {R"([])", "json1 dynamic object invalid. each array item must be an object"},
      {R"({"dynamic":[{"type":"usage","key":"k"}]})",
       "json1 dynamic object invalid. something's wrong with value item"},
      {R"({"dynamic":[{"type":"usage","key":"k","value":3}]})",
       "json1 dynamic object invalid. value can only be string"},
      {R"({"dynamic":[{"type":"usage","key":"k","value":["a",2]}]})",
       "json1 dynamic object invalid. value can only be string"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.json);
    try {
      formatDynamicItems(c.json, false);
      ADD_FAILURE() << "accepted";
    } catch (const TranslationFailure& failure) {
      EXPECT_STREQ(failure.what(), c.message);
    }
  }
  EXPECT_EQ(formatDynamicItems(R"({"dynamic":{},"debug":[{"type":"usage","key":"k","value":"v"}]})",
                               true),
            "k: v");
}

TEST(Json1Nested, MalformedNestedErrorsKeepTheOuterText) {
  TranslatorSession session;
  struct NestedCase {
    const char* nested;
    const char* message;
  };
  const NestedCase cases[] = {
      {R"(,"nested_error":5)", "nested_error contains invalid json type"},
      {R"(,"nested_error":[5])", "nested_error contains invalid json type on one of the element"},
      {R"(,"nested_error":[{"no_code":1}])",
       "nested_error contains invalid json type on one of the element"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.nested);
    Translation t = session.render(kInvalidOption, describe("[]", c.nested), 0, 0);
    EXPECT_FALSE(t.complete);
    EXPECT_EQ(t.text, session.staticDescription(kInvalidOption, 0) + "\n\n" + c.message);
  }
}

TEST(AttributeTables, WhenNoneLoadsIdsShowInHexAndTheFailureIsNoted) {
  test::TempFolder own;  // its own pool key: the changed interpreter is never shared
  TranslatorSession session(TranslatorOptions{own.path().string()});
  lua_State* L = session.translator(kBuiltInTranslatorName).state();
  ASSERT_EQ(luaL_dostring(L, R"(
      package.loaded["hsdig_attributes_eng"] = { encoding = "latin-1" }
      package.loaded["cvmxl_defaultAttrTable"] = { encoding = "latin-1" })"),
            0);
  std::string json =
      describe(R"([{"type":"usage","usage":"kUsageTypeAttributeId","value":1050005}])");
  std::string text = session.render(kInvalidOption, json, 0, kFlagPlain | kFlagDebug).text;
  EXPECT_NE(text.find("\nAttribute: 0x00100595\n"), std::string::npos) << text;
  EXPECT_NE(text.find("Internal error: Cannot load cvmxl_defaultAttrTable"), std::string::npos)
      << text;
}

TEST(Sessions, TranslatorsArePooledAndSessionsRunSideBySide) {
  constexpr int kThreads = 4;
  constexpr int kRounds = 25;
  const int32_t codes[kThreads] = {ivi(0xBFFA9157), ivi(0xBFFA1190), -52000, ivi(0xBFFA9181)};
  std::vector<std::string> expected;
  {
    TranslatorSession session;
    for (int32_t code : codes) {
      Status status(code);
      description::addUsage(status, "kUsageTypeRequestedValue", code);
      std::string text;
      Status result;
      session.translate(status, 0, kConversionFlags, text, result);
      expected.push_back(text);
    }
  }
  std::barrier start(kThreads);
  std::vector<std::vector<std::string>> seen(kThreads);
  std::vector<std::thread> threads;
  for (int i = 0; i < kThreads; ++i) {
    threads.emplace_back([&, i] {
      start.arrive_and_wait();
      for (int round = 0; round < kRounds; ++round) {
        TranslatorSession session;
        Status status(codes[i]);
        description::addUsage(status, "kUsageTypeRequestedValue", codes[i]);
        std::string text;
        Status result;
        session.translate(status, 0, kConversionFlags, text, result);
        seen[i].push_back(text);
      }
    });
  }
  for (auto& t : threads) t.join();
  for (int i = 0; i < kThreads; ++i) {
    SCOPED_TRACE(i);
    ASSERT_EQ(seen[i].size(), static_cast<std::size_t>(kRounds));
    for (const auto& text : seen[i]) EXPECT_EQ(text, expected[i]);
  }
}

}  // namespace
}  // namespace hsdig::translator
