// Range tables, value tables, numbers, memory and logical names.
#include <gtest/gtest.h>
#include <unistd.h>

#include <cmath>
#include <cstdlib>
#include <fstream>
#include <string>

#include "EngineTestSupport.h"

using engine_test::ScopedSession;

namespace {

TEST(EngineRangeTables, MadeByTheEngineAndLookedUp) {
  ScopedSession s;
  IviRangeTablePtr table = nullptr;
  ASSERT_EQ(Ivi_RangeTableNew(s.vi(), 3, IVI_VAL_DISCRETE, VI_TRUE, VI_TRUE, &table), VI_SUCCESS);
  ASSERT_EQ(Ivi_SetRangeTableEntry(table, 0, 1, 0, 0, "ONE", 10), VI_SUCCESS);
  ASSERT_EQ(Ivi_SetRangeTableEntry(table, 1, 2, 0, 0, "TWO", 20), VI_SUCCESS);
  ASSERT_EQ(Ivi_SetRangeTableEntryViInt64(table, 2, 5000000000LL, 0, 0, "BIG", 30), VI_SUCCESS);
  EXPECT_EQ(Ivi_SetRangeTableEntry(table, 3, 0, 0, 0, "X", 0), IVI_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(Ivi_ValidateRangeTable(table), VI_SUCCESS);
  ViInt32 n = 0;
  ASSERT_EQ(Ivi_GetRangeTableNumEntries(table, &n), VI_SUCCESS);
  EXPECT_EQ(n, 3);

  ViInt32 index = -1, cmdValue = 0, value = 0;
  ViString cmd = nullptr;
  ASSERT_EQ(
      Ivi_GetViInt32EntryFromValue(2, table, nullptr, nullptr, nullptr, &index, &cmd, &cmdValue),
      VI_SUCCESS);
  EXPECT_EQ(index, 1);
  EXPECT_STREQ(cmd, "TWO");
  EXPECT_EQ(cmdValue, 20);
  ASSERT_EQ(Ivi_GetViInt32EntryFromString("ONE", table, &value, nullptr, nullptr, nullptr, nullptr),
            VI_SUCCESS);
  EXPECT_EQ(value, 1);
  ViInt64 big = 0;
  ASSERT_EQ(Ivi_GetViInt64EntryFromCmdValue(30, table, &big, nullptr, nullptr, nullptr, nullptr),
            VI_SUCCESS);
  EXPECT_EQ(big, 5000000000LL);
  EXPECT_EQ(Ivi_GetViReal64EntryFromIndex(3, table, nullptr, nullptr, nullptr, nullptr, nullptr),
            IVI_ERROR_INVALID_VALUE);
  EXPECT_EQ(
      Ivi_GetViInt32EntryFromValue(3, table, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr),
      IVI_ERROR_INVALID_VALUE);

  // Shortening the table with an earlier end.
  ASSERT_EQ(Ivi_SetRangeTableEnd(table, 1), VI_SUCCESS);
  ASSERT_EQ(Ivi_GetRangeTableNumEntries(table, &n), VI_SUCCESS);
  EXPECT_EQ(n, 1);
  ASSERT_EQ(Ivi_RangeTableFree(s.vi(), table, VI_TRUE), VI_SUCCESS);
  EXPECT_EQ(Ivi_SetRangeTableEntry(table, 0, 1, 0, 0, "ONE", 10), IVI_ERROR_INVALID_PARAMETER);
}

TEST(EngineRangeTables, MalformedTablesAreRefused) {
  IviRangeTableEntry entries[] = {{5, 1, 0, nullptr, 0, 0, 0, 0},
                                  {0, 0, 0, IVI_RANGE_TABLE_END_STRING, 0, 0, 0, 0}};
  IviRangeTable ranged = {IVI_VAL_RANGED, VI_TRUE, VI_TRUE, nullptr, entries};
  EXPECT_EQ(Ivi_ValidateRangeTable(&ranged), IVI_ERROR_INVALID_RANGE_TABLE);
  IviRangeTable badType = {7, VI_TRUE, VI_TRUE, nullptr, entries};
  EXPECT_EQ(Ivi_ValidateRangeTable(&badType), IVI_ERROR_INVALID_RANGE_TABLE);
  IviRangeTable noEntries = {IVI_VAL_RANGED, VI_TRUE, VI_TRUE, nullptr, nullptr};
  EXPECT_EQ(Ivi_ValidateRangeTable(&noEntries), IVI_ERROR_INVALID_RANGE_TABLE);
  EXPECT_EQ(Ivi_ValidateRangeTable(nullptr), IVI_ERROR_NULL_POINTER);
}

TEST(EngineHelpers, ValueTablesAndNumbers) {
  IviStringValueTableEntry entries[] = {{1, "ONE"}, {2, "TWO"}, {0, nullptr}};
  ViConstString text = nullptr;
  ASSERT_EQ(Ivi_GetStringFromTable(entries, 2, &text), VI_SUCCESS);
  EXPECT_STREQ(text, "TWO");
  ViInt32 value = 0;
  ASSERT_EQ(Ivi_GetValueFromTable(entries, "ONE", &value), VI_SUCCESS);
  EXPECT_EQ(value, 1);
  EXPECT_EQ(Ivi_GetValueFromTable(entries, "THREE", &value), IVI_ERROR_INVALID_VALUE);

  EXPECT_EQ(Ivi_CheckNumericRange(5, 0, 10, -7), VI_SUCCESS);
  EXPECT_EQ(Ivi_CheckNumericRange(11, 0, 10, -7), -7);
  EXPECT_EQ(Ivi_CheckNumericRange(NAN, 0, 10, -7), -7);
  EXPECT_EQ(Ivi_CheckBooleanRange(2, -8), -8);
  ViBoolean b = 5;
  ASSERT_EQ(Ivi_CoerceBoolean(&b), VI_SUCCESS);
  EXPECT_EQ(b, VI_TRUE);
  ViInt32 result = 9;
  ASSERT_EQ(Ivi_CompareWithPrecision(6, 1.0000001, 1.0, &result), VI_SUCCESS);
  EXPECT_EQ(result, 0);
  ASSERT_EQ(Ivi_CompareWithPrecision(14, 1.0000001, 1.0, &result), VI_SUCCESS);
  EXPECT_EQ(result, 1);
  ViInt32 type = -1;
  ASSERT_EQ(Ivi_GetViReal64Type(-INFINITY, &type), VI_SUCCESS);
  EXPECT_EQ(type, IVI_VAL_TYPE_NINF);
  EXPECT_TRUE(
      std::isnan(*static_cast<ViReal64*>(Ivi_GetPtrToSpecialViReal64Value(IVI_VAL_TYPE_NAN))));
}

TEST(EngineHelpers, MemoryBelongsToTheSession) {
  ScopedSession s;
  ViAddr block = nullptr;
  ASSERT_EQ(Ivi_Alloc(s.vi(), 64, &block), VI_SUCCESS);
  EXPECT_EQ(static_cast<unsigned char*>(block)[63], 0);
  EXPECT_EQ(Ivi_Free(s.vi(), block), VI_SUCCESS);
  EXPECT_EQ(Ivi_Free(s.vi(), block), IVI_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(Ivi_Alloc(s.vi(), 0, &block), IVI_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(Ivi_Alloc(s.vi(), -1, &block), IVI_ERROR_INVALID_PARAMETER);
  ASSERT_EQ(Ivi_Alloc(s.vi(), 8, &block), VI_SUCCESS);
  EXPECT_EQ(Ivi_FreeAll(s.vi()), VI_SUCCESS);
  EXPECT_EQ(Ivi_Free(s.vi(), block), IVI_ERROR_INVALID_PARAMETER);
  // Blocks left over go with the session (the leak checker would say so).
  ASSERT_EQ(Ivi_Alloc(s.vi(), 8, &block), VI_SUCCESS);
}

// Each case gets its own configuration file.
class EngineLogicalNames : public ::testing::Test {
 protected:
  void SetUp() override {
    path_ = ::testing::TempDir() + "ivi-names-" + std::to_string(getpid()) + ".conf";
    setenv("CVIVI_LOGICAL_NAMES", path_.c_str(), 1);
  }
  void TearDown() override {
    unsetenv("CVIVI_LOGICAL_NAMES");
    std::remove(path_.c_str());
  }
  void write(const std::string& text) { std::ofstream(path_) << text; }

  ViStatus resolve(const char* name, const char* options) {
    return Ivi_GetInfoFromResourceName(name, options, resource_, options_, &logical_);
  }

  std::string path_;
  char resource_[IVI_MAX_RESOURCE_BUF_SIZE] = {};
  char options_[IVI_MAX_RESOURCE_BUF_SIZE] = {};
  ViBoolean logical_ = 9;
};

TEST_F(EngineLogicalNames, LogicalNamesResolveAndOtherNamesPassThrough) {
  write(
      "# digitizers\n"
      "[MyScope]\n"
      "Resource = PXI1Slot4\n"
      "Driver = hsdig\n"
      "Options = Simulate=1, RangeCheck=0, DriverSetup=Model:A1\n"
      "\n"
      "[Other]\n"
      "Resource=PXI1Slot5\n");
  ASSERT_EQ(resolve("myscope", "RangeCheck=1"), VI_SUCCESS);
  EXPECT_STREQ(resource_, "PXI1Slot4");
  EXPECT_STREQ(options_, "Simulate=1, RangeCheck=1, DriverSetup=Model:A1");
  EXPECT_EQ(logical_, VI_TRUE);

  ASSERT_EQ(resolve("PXI1Slot9", "Simulate=1"), VI_SUCCESS);
  EXPECT_STREQ(resource_, "PXI1Slot9");
  EXPECT_STREQ(options_, "Simulate=1");
  EXPECT_EQ(logical_, VI_FALSE);

  ViInt32 count = 0;
  ViAddr list = nullptr;
  ASSERT_EQ(Ivi_GetLogicalNamesList("hsdig", &count, &list), VI_SUCCESS);
  ASSERT_EQ(count, 1);
  char name[32];
  ASSERT_EQ(Ivi_GetNthLogicalName(list, 1, sizeof name, name), VI_SUCCESS);
  EXPECT_STREQ(name, "MyScope");
  EXPECT_EQ(Ivi_DisposeLogicalNamesList(list), VI_SUCCESS);
  EXPECT_EQ(Ivi_DisposeLogicalNamesList(list), IVI_ERROR_INVALID_PARAMETER);
}

TEST_F(EngineLogicalNames, BrokenFilesAreReported) {
  const char* broken[] = {"Resource = x\n", "[A]\nColour = red\n", "[A]\nDriver = hsdig\n", "[A\n",
                          "[A]\nResource=1\n[a]\nResource=2\n"};
  for (const char* text : broken) {
    SCOPED_TRACE(text);
    write(text);
    EXPECT_EQ(resolve("A", ""), IVI_ERROR_INVALID_CONFIGURATION);
  }
  // Resolved texts must fit the engine's fixed buffers.
  write("");
  const std::string longName(300, 'r');
  EXPECT_EQ(resolve(longName.c_str(), ""), IVI_ERROR_INVALID_VALUE);
  // No file at all is an empty configuration.
  std::remove(path_.c_str());
  EXPECT_EQ(resolve("A", ""), VI_SUCCESS);
}

}  // namespace
