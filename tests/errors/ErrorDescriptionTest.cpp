// The structured error description as the translator reads it.
#include <gtest/gtest.h>

#include "errors/ErrorDescription.h"

namespace hsdig {
namespace {

using namespace description;

const rapidjson::Value& items(const Status& s) {
  return s.description()["translator_info"]["ordered_data"];
}

TEST(ErrorDescription, PrepareCreatesTheTranslatorHeaderOnceAndKeepsItems) {
  Status s;
  prepare(s, true);
  EXPECT_STREQ(s.description()["translator"].GetString(), "mxlator_hsdig");
  const auto& info = s.description()["translator_info"];
  EXPECT_EQ(info["version"].GetInt(), 1);
  EXPECT_TRUE(info["is_debug"].GetBool());
  EXPECT_TRUE(hasOrderedData(s));
  addEmpty(s);
  prepare(s, false);  // a second prepare keeps what is there
  EXPECT_TRUE(s.description()["translator_info"]["is_debug"].GetBool());
  EXPECT_EQ(items(s).Size(), 1u);
}

TEST(ErrorDescription, ItemsKeepTheirOrderAndShape) {
  Status s(-1074134952);
  addUsage(s, "kUsageTypeParameterName", "wfm");
  addUsage(s, "kUsageTypeRequestedValue", int32_t{-7});
  addUsage(s, "kUsageTypeSessionHandle", uint32_t{4000000000u});
  addUsage(s, "kUsageTypeRecordLength", int64_t{1} << 40);
  addUsage(s, "kUsageTypeRange", 2.5);
  addUsage(s, "kUsageTypeChannels", std::vector<std::string>{"0", "1"});
  addEnumUsage(s, "kUsageTypeRequestedValue", 3, 1250003);
  addElaboration(s, "kSidlInvalidTag");
  addHeader(s, "kUsageTypeDevice");
  addEmpty(s);

  struct Expect {
    const char* type;
    const char* usage;
    const char* valueType;  // nullptr: no value
  };
  const Expect expected[] = {
      {"usage", "kUsageTypeParameterName", "string"},
      {"usage", "kUsageTypeRequestedValue", "int32_t"},
      {"usage", "kUsageTypeSessionHandle", "uint32_t"},
      {"usage", "kUsageTypeRecordLength", "int64_t"},
      {"usage", "kUsageTypeRange", "double"},
      {"usage", "kUsageTypeChannels", "string"},
      {"usage", "kUsageTypeRequestedValue", nullptr},
      {"elaboration", "kSidlInvalidTag", nullptr},
      {"header", "kUsageTypeDevice", nullptr},
      {"empty", nullptr, nullptr},
  };
  const auto& list = items(s);
  ASSERT_EQ(list.Size(), std::size(expected));
  for (rapidjson::SizeType i = 0; i < list.Size(); ++i) {
    SCOPED_TRACE(i);
    EXPECT_STREQ(list[i]["type"].GetString(), expected[i].type);
    if (expected[i].usage) {
      EXPECT_STREQ(list[i]["usage"].GetString(), expected[i].usage);
    }
    if (expected[i].valueType) {
      EXPECT_STREQ(list[i]["value_type"].GetString(), expected[i].valueType);
    }
  }
  EXPECT_STREQ(list[0]["value"].GetString(), "wfm");
  EXPECT_EQ(list[1]["value"].GetInt(), -7);
  EXPECT_EQ(list[2]["value"].GetUint(), 4000000000u);
  EXPECT_EQ(list[3]["value"].GetInt64(), int64_t{1} << 40);
  EXPECT_EQ(list[5]["value"].Size(), 2u);
  EXPECT_STREQ(list[6]["value_type"]["type"].GetString(), "enum");
  EXPECT_EQ(list[6]["value_type"]["id"].GetUint(), 1250003u);
  EXPECT_FALSE(list[9].HasMember("usage"));
  EXPECT_EQ(s.code(), -1074134952) << "building the description leaves the code";
}

TEST(ErrorDescription, NestedAndInternalErrorsAccumulate) {
  Status inner(-52008);
  addInternalError(inner, "linux", 13, "Permission denied");
  addUsage(inner, "kUsageTypeFilePath", "/dev/shm/x");

  Status outer(-1074097803);
  addNestedError(outer, inner);
  addNestedError(outer, Status());
  const auto& nested = outer.description()["nested_error"];
  ASSERT_EQ(nested.Size(), 2u);
  EXPECT_EQ(nested[0]["code"].GetInt(), -52008);
  EXPECT_STREQ(nested[0]["internal_error"][0]["api"].GetString(), "linux");
  EXPECT_EQ(nested[0]["internal_error"][0]["code"].GetInt(), 13);
  EXPECT_STREQ(nested[0]["translator_info"]["ordered_data"][0]["value"].GetString(), "/dev/shm/x");
  EXPECT_EQ(nested[1]["code"].GetInt(), 0);

  // The nested copy is independent of its source.
  inner.reset();
  EXPECT_EQ(outer.description()["nested_error"][0]["code"].GetInt(), -52008);
}

TEST(ErrorDescription, RepairsMembersOfTheWrongJsonType) {
  Status s;
  ASSERT_TRUE(s.setDescriptionJson(
      "{\"translator_info\":{\"ordered_data\":\"not a list\"},\"nested_error\":5}"));
  addEmpty(s);
  addNestedError(s, Status(-1));
  EXPECT_TRUE(hasOrderedData(s));
  EXPECT_EQ(items(s).Size(), 1u);
  EXPECT_EQ(s.description()["nested_error"].Size(), 1u);
  EXPECT_EQ(s.description()["translator_info"]["version"].GetInt(), 1);
}

}  // namespace
}  // namespace hsdig
