// Attributes of the stand-in engine: typed access, flags, user-set
// tracking, channels, callbacks, caching, range checking and coercion.
#include <gtest/gtest.h>

#include <string>

#include "EngineTestSupport.h"

using engine_test::int32Attribute;
using engine_test::ScopedSession;
using engine_test::stringAttribute;

namespace {

constexpr ViAttr kRange = 1200001;
constexpr ViAttr kGain = 1200002;
constexpr ViAttr kName = 1200003;
constexpr ViAttr kHidden = 1200004;
constexpr ViAttr kReadCount = 1200005;
constexpr ViAttr kPointer = 1200006;

IviRangeTableEntry kCoercedEntries[] = {
    {0, 10, 10, const_cast<ViString>("LOW"), 1, 0, 10, 10},
    {10.000001, 100, 100, const_cast<ViString>("HIGH"), 2, 10, 100, 100},
    {0, 0, 0, IVI_RANGE_TABLE_END_STRING, 0, 0, 0, 0},
};
IviRangeTable kCoercedTable = {IVI_VAL_COERCED, VI_TRUE, VI_TRUE, nullptr, kCoercedEntries};

int g_reads = 0;
ViStatus countingRead(ViSession, ViSession, ViConstString, ViAttr, ViInt32* value) {
  *value = ++g_reads;
  return VI_SUCCESS;
}

ViStatus nameRead(ViSession vi, ViSession, ViConstString channel, ViAttr id, ViConstString) {
  return Ivi_SetValInStringCallback(vi, id, (std::string("name of ") + channel).c_str());
}

int g_writes = 0;
ViStatus countingWrite(ViSession, ViSession, ViConstString, ViAttr, ViReal64) {
  ++g_writes;
  return VI_SUCCESS;
}

ViStatus rejectOdd(ViSession, ViConstString, ViAttr, ViInt32 value) {
  return (value % 2) ? IVI_ERROR_INVALID_VALUE : VI_SUCCESS;
}

class EngineAttributes : public ::testing::Test {
 protected:
  void SetUp() override {
    ASSERT_EQ(session_.status(), VI_SUCCESS);
    ASSERT_EQ(Ivi_BuildChannelTable(vi(), "CH1, ch2"), VI_SUCCESS);
    ASSERT_EQ(Ivi_AddAttributeViReal64(vi(), kRange, "RANGE", 1.0, IVI_VAL_MULTI_CHANNEL, nullptr,
                                       countingWrite, &kCoercedTable, 0),
              VI_SUCCESS);
    ASSERT_EQ(Ivi_AddAttributeViInt32(vi(), kGain, "GAIN", 4, 0, nullptr, nullptr, nullptr),
              VI_SUCCESS);
    ASSERT_EQ(
        Ivi_AddAttributeViString(vi(), kName, "NAME", "", IVI_VAL_MULTI_CHANNEL, nameRead, nullptr),
        VI_SUCCESS);
    ASSERT_EQ(Ivi_AddAttributeViInt32(vi(), kHidden, "HIDDEN", 0, IVI_VAL_HIDDEN, nullptr, nullptr,
                                      nullptr),
              VI_SUCCESS);
    ASSERT_EQ(
        Ivi_AddAttributeViInt32(vi(), kReadCount, "READS", 0, 0, countingRead, nullptr, nullptr),
        VI_SUCCESS);
    g_reads = g_writes = 0;
  }
  ViSession vi() const { return session_.vi(); }

  ScopedSession session_{"Simulate=1, RecordCoercions=1"};
};

TEST_F(EngineAttributes, ChannelQualifiersAreResolved) {
  struct Case {
    const char* channel;
    ViAttr attribute;
    ViStatus expected;
  };
  const Case cases[] = {
      {"ch1", kRange, VI_SUCCESS},
      {" CH2 ", kRange, VI_SUCCESS},
      {"CH3", kRange, IVI_ERROR_UNKNOWN_CHANNEL_NAME},
      {"", kRange, IVI_ERROR_CHANNEL_NAME_REQUIRED},
      {nullptr, kRange, IVI_ERROR_CHANNEL_NAME_REQUIRED},
      {"CH1", kGain, IVI_ERROR_CHANNEL_NAME_NOT_ALLOWED},
      {"", 1299999, IVI_ERROR_INVALID_ATTRIBUTE},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.channel ? c.channel : "(null)");
    EXPECT_EQ(Ivi_ValidateAttrForChannel(vi(), c.channel, c.attribute), c.expected);
  }
  EXPECT_EQ(int32Attribute(vi(), IVI_ATTR_CHANNEL_COUNT), 2);
  ViConstString name = nullptr;
  ASSERT_EQ(Ivi_CoerceChannelName(vi(), "cH2", &name), VI_SUCCESS);
  EXPECT_STREQ(name, "ch2");
  ViInt32 index = 0;
  ASSERT_EQ(Ivi_GetChannelIndex(vi(), "ch2", &index), VI_SUCCESS);
  EXPECT_EQ(index, 2);
  ASSERT_EQ(Ivi_GetNthChannelString(vi(), 1, &name), VI_SUCCESS);
  EXPECT_STREQ(name, "CH1");
  EXPECT_EQ(Ivi_AddToChannelTable(vi(), "CH1"), IVI_ERROR_ITEM_ALREADY_EXISTS);
  ASSERT_EQ(Ivi_RestrictAttrToChannels(vi(), kRange, "CH1"), VI_SUCCESS);
  EXPECT_EQ(Ivi_ValidateAttrForChannel(vi(), "CH2", kRange), IVI_ERROR_ATTRIBUTE_NOT_SUPPORTED);
}

TEST_F(EngineAttributes, ValuesArePerChannelCheckedAndCoerced) {
  ASSERT_EQ(Ivi_SetAttributeViReal64(vi(), "CH1", kRange, 0, 7.5), VI_SUCCESS);
  ASSERT_EQ(Ivi_SetAttributeViReal64(vi(), "CH2", kRange, 0, 50), VI_SUCCESS);
  ViReal64 value = 0;
  ASSERT_EQ(Ivi_GetAttributeViReal64(vi(), "ch1", kRange, 0, &value), VI_SUCCESS);
  EXPECT_EQ(value, 10);
  ASSERT_EQ(Ivi_GetAttributeViReal64(vi(), "CH2", kRange, 0, &value), VI_SUCCESS);
  EXPECT_EQ(value, 100);
  EXPECT_EQ(Ivi_SetAttributeViReal64(vi(), "CH1", kRange, 0, 1000), IVI_ERROR_INVALID_VALUE);
  EXPECT_EQ(Ivi_CheckAttributeViReal64(vi(), "CH1", kRange, 0, -1), IVI_ERROR_INVALID_VALUE);
  EXPECT_EQ(Ivi_CheckAttributeViReal64(vi(), "CH1", kRange, 0, 99), VI_SUCCESS);
  // Each coercion was recorded, oldest first; then the queue is empty.
  char record[256];
  ASSERT_EQ(Ivi_GetNextCoercionInfo(vi(), sizeof record, record), VI_SUCCESS);
  EXPECT_EQ(std::string(record), "Attribute RANGE on \"CH1\": 7.5 was coerced to 10.");
  ASSERT_EQ(Ivi_GetNextCoercionInfo(vi(), sizeof record, record), VI_SUCCESS);
  EXPECT_EQ(std::string(record), "Attribute RANGE on \"ch2\": 50 was coerced to 100.");
  ASSERT_EQ(Ivi_GetNextCoercionInfo(vi(), sizeof record, record), VI_SUCCESS);
  EXPECT_STREQ(record, "");
  // Setting the cached value again does not reach the instrument.
  EXPECT_EQ(g_writes, 2);
  ASSERT_EQ(Ivi_SetAttributeViReal64(vi(), "CH1", kRange, 0, 9), VI_SUCCESS);
  EXPECT_EQ(g_writes, 2);
  ASSERT_EQ(Ivi_InvalidateAttribute(vi(), "CH1", kRange), VI_SUCCESS);
  ASSERT_EQ(Ivi_SetAttributeViReal64(vi(), "CH1", kRange, 0, 9), VI_SUCCESS);
  EXPECT_EQ(g_writes, 3);
  ViReal64 lo = 0, hi = 0;
  ViBoolean hasLo = VI_FALSE, hasHi = VI_FALSE;
  ASSERT_EQ(Ivi_GetAttrMinMaxViReal64(vi(), "CH1", kRange, &lo, &hi, &hasLo, &hasHi), VI_SUCCESS);
  EXPECT_EQ(lo, 0);
  EXPECT_EQ(hi, 100);
  EXPECT_TRUE(hasLo && hasHi);
}

TEST_F(EngineAttributes, TypesFlagsAndUserSetTracking) {
  EXPECT_EQ(Ivi_SetAttributeViReal64(vi(), "", kGain, 0, 1.0), IVI_ERROR_TYPES_DO_NOT_MATCH);
  EXPECT_EQ(Ivi_ValidateAttribute(vi(), kGain, IVI_VAL_INT32), VI_SUCCESS);
  EXPECT_EQ(Ivi_ValidateAttribute(vi(), kGain, IVI_VAL_ADDR), IVI_ERROR_TYPES_DO_NOT_MATCH);
  EXPECT_EQ(Ivi_ValidateAttribute(vi(), kGain, 99), IVI_ERROR_INVALID_TYPE);
  EXPECT_EQ(Ivi_AddAttributeViInt32(vi(), kGain, "AGAIN", 0, 0, nullptr, nullptr, nullptr),
            IVI_ERROR_ITEM_ALREADY_EXISTS);

  EXPECT_EQ(Ivi_AttributeWasSetByUser(vi(), "", kGain), VI_FALSE);
  ASSERT_EQ(Ivi_SetAttributeViInt32(vi(), "", kGain, 0, 8), VI_SUCCESS);
  EXPECT_EQ(Ivi_AttributeWasSetByUser(vi(), "", kGain), VI_FALSE);
  ASSERT_EQ(Ivi_SetAttributeViInt32(vi(), "", kGain, IVI_VAL_DIRECT_USER_CALL, 16), VI_SUCCESS);
  EXPECT_EQ(Ivi_AttributeWasSetByUser(vi(), "", kGain), VI_TRUE);
  ASSERT_EQ(Ivi_ResetAttribute(vi(), "", kGain), VI_SUCCESS);
  EXPECT_EQ(int32Attribute(vi(), kGain), 4);
  EXPECT_EQ(Ivi_AttributeWasSetByUser(vi(), "", kGain), VI_FALSE);
  EXPECT_EQ(Ivi_AttributeEverSetByUser(vi(), "", kGain), VI_TRUE);

  // Hidden attributes: the driver may use them, its user may not.
  ViInt32 value = 0;
  EXPECT_EQ(Ivi_SetAttributeViInt32(vi(), "", kHidden, IVI_VAL_DIRECT_USER_CALL, 1),
            IVI_ERROR_ATTRIBUTE_NOT_WRITABLE);
  EXPECT_EQ(Ivi_GetAttributeViInt32(vi(), "", kHidden, IVI_VAL_DIRECT_USER_CALL, &value),
            IVI_ERROR_ATTRIBUTE_NOT_READABLE);
  EXPECT_EQ(Ivi_SetAttributeViInt32(vi(), "", kHidden, IVI_VAL_DONT_MARK_AS_SET_BY_USER, 1),
            VI_SUCCESS);
  EXPECT_EQ(int32Attribute(vi(), kHidden), 1);

  // An address attribute, as session open stores a pointer.
  int target = 0;
  ASSERT_EQ(Ivi_AddAttributeViAddr(vi(), kPointer, "PTR", nullptr, 0x18, nullptr, nullptr),
            VI_SUCCESS);
  ASSERT_EQ(Ivi_SetAttributeViAddr(vi(), "", kPointer, 4, &target), VI_SUCCESS);
  ViAddr stored = nullptr;
  ASSERT_EQ(Ivi_GetAttributeViAddr(vi(), "", kPointer, 0, &stored), VI_SUCCESS);
  EXPECT_EQ(stored, &target);

  ViInt32 count = 0;
  ASSERT_EQ(Ivi_GetNumAttributes(vi(), &count), VI_SUCCESS);
  ViAttr last = 0;
  ASSERT_EQ(Ivi_GetNthAttribute(vi(), count, &last), VI_SUCCESS);
  EXPECT_EQ(last, kPointer);
  ASSERT_EQ(Ivi_DeleteAttribute(vi(), kPointer), VI_SUCCESS);
  EXPECT_EQ(Ivi_AttributeIsAvailable(vi(), kPointer), VI_FALSE);
}

TEST_F(EngineAttributes, ReadCallbacksCachingAndInvalidation) {
  EXPECT_EQ(int32Attribute(vi(), kReadCount), 1);
  EXPECT_EQ(int32Attribute(vi(), kReadCount), 1);  // cached
  ASSERT_EQ(Ivi_AddAttributeInvalidation(vi(), kGain, kReadCount, VI_FALSE), VI_SUCCESS);
  ASSERT_EQ(Ivi_SetAttributeViInt32(vi(), "", kGain, 0, 6), VI_SUCCESS);
  EXPECT_EQ(int32Attribute(vi(), kReadCount), 2);
  ViBoolean cached = VI_FALSE;
  ASSERT_EQ(Ivi_AttributeIsCached(vi(), "", kReadCount, &cached), VI_SUCCESS);
  EXPECT_EQ(cached, VI_TRUE);
  ASSERT_EQ(Ivi_InvalidateAllAttributes(vi()), VI_SUCCESS);
  EXPECT_EQ(int32Attribute(vi(), kReadCount), 3);

  // A string read callback hands its value over with Ivi_SetValInStringCallback.
  EXPECT_EQ(stringAttribute(vi(), kName, "ch2"), "name of ch2");
  EXPECT_EQ(Ivi_GetAttributeViString(vi(), "CH1", kName, 0, 0, nullptr), 12);

  ASSERT_EQ(Ivi_SetAttrCheckCallbackViInt32(vi(), kGain, rejectOdd), VI_SUCCESS);
  EXPECT_EQ(Ivi_SetAttributeViInt32(vi(), "", kGain, 0, 3), IVI_ERROR_INVALID_VALUE);
  EXPECT_EQ(Ivi_SetAttrCheckCallbackViReal64(vi(), kGain, nullptr), IVI_ERROR_TYPES_DO_NOT_MATCH);
  ViAddr callback = nullptr;
  ASSERT_EQ(Ivi_GetAttrCallback(vi(), kGain, IVI_CALLBACK_CHECK, &callback), VI_SUCCESS);
  EXPECT_EQ(callback, reinterpret_cast<ViAddr>(rejectOdd));
}

TEST(EngineRangeChecking, OffLetsValuesThroughUncheckedButCoerced) {
  ScopedSession s("RangeCheck=0");
  ASSERT_EQ(Ivi_AddAttributeViReal64(s.vi(), kRange, "RANGE", 1.0, 0, nullptr, nullptr,
                                     &kCoercedTable, 0),
            VI_SUCCESS);
  EXPECT_EQ(Ivi_SetAttributeViReal64(s.vi(), "", kRange, 0, 5), VI_SUCCESS);
  // Out of range with checking off: coercion finds no entry.
  EXPECT_EQ(Ivi_SetAttributeViReal64(s.vi(), "", kRange, 0, 500), IVI_ERROR_INVALID_VALUE);
  // Check always checks.
  EXPECT_EQ(Ivi_CheckAttributeViReal64(s.vi(), "", kRange, 0, 500), IVI_ERROR_INVALID_VALUE);
}

}  // namespace
