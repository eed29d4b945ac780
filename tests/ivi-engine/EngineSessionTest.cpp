// Sessions of the stand-in engine: option strings, error information,
// session 0, locking across threads, disposal and status texts.
#include <gtest/gtest.h>

#include <atomic>
#include <barrier>
#include <cstring>
#include <latch>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "EngineTestSupport.h"

using engine_test::booleanAttribute;
using engine_test::int32Attribute;
using engine_test::ScopedSession;
using engine_test::stringAttribute;

namespace {

TEST(EngineOptions, EachStandardItemSetsItsAttribute) {
  struct Case {
    const char* options;
    ViAttr attribute;
    bool expected;
  };
  const Case cases[] = {
      {"", IVI_ATTR_RANGE_CHECK, true},
      {"RangeCheck=0", IVI_ATTR_RANGE_CHECK, false},
      {"", IVI_ATTR_QUERY_INSTRUMENT_STATUS, false},
      {"QueryInstrStatus=VI_TRUE", IVI_ATTR_QUERY_INSTRUMENT_STATUS, true},
      {"", IVI_ATTR_CACHE, true},
      {"cache=false", IVI_ATTR_CACHE, false},
      {"", IVI_ATTR_SIMULATE, false},
      {"Simulate=1", IVI_ATTR_SIMULATE, true},
      {"", IVI_ATTR_RECORD_COERCIONS, false},
      {"RecordCoercions=True", IVI_ATTR_RECORD_COERCIONS, true},
      {"", IVI_ATTR_INTERCHANGE_CHECK, false},
      {" InterchangeCheck = 1 ,Simulate=0", IVI_ATTR_INTERCHANGE_CHECK, true},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(std::string(c.options) + " attribute " + std::to_string(c.attribute));
    ScopedSession s(c.options);
    ASSERT_EQ(s.status(), VI_SUCCESS);
    EXPECT_EQ(booleanAttribute(s.vi(), c.attribute), c.expected);
  }
  ScopedSession simulated("Simulate=1");
  EXPECT_EQ(Ivi_Simulating(simulated.vi()), VI_TRUE);
  EXPECT_EQ(Ivi_RangeChecking(simulated.vi()), VI_TRUE);
  EXPECT_EQ(Ivi_QueryInstrStatus(simulated.vi()), VI_FALSE);
}

TEST(EngineOptions, DriverSetupTakesTheRestOfTheString) {
  ScopedSession s("Simulate=1, DriverSetup=Model:A1; BoardType:B2, more");
  ASSERT_EQ(s.status(), VI_SUCCESS);
  EXPECT_EQ(stringAttribute(s.vi(), IVI_ATTR_DRIVER_SETUP), "Model:A1; BoardType:B2, more");
  EXPECT_EQ(stringAttribute(s.vi(), IVI_ATTR_SPECIFIC_DRIVER_PREFIX), "hsdig");
  // The driver setup is the engine's to set, not the user's.
  EXPECT_EQ(
      Ivi_SetAttributeViString(s.vi(), "", IVI_ATTR_DRIVER_SETUP, IVI_VAL_DIRECT_USER_CALL, "x"),
      IVI_ERROR_ATTRIBUTE_NOT_WRITABLE);
}

TEST(EngineOptions, BadOptionStringsFailAndExplainOnSessionZero) {
  struct Case {
    const char* options;
    ViStatus expected;
    const char* elaborationPart;
  };
  const Case cases[] = {
      {"Simulate=1, Turbo=1", IVI_ERROR_BAD_OPTION_NAME, "Turbo"},
      {"Simulate=maybe", IVI_ERROR_BAD_OPTION_VALUE, "maybe"},
      {"Simulate", IVI_ERROR_BAD_OPTION_VALUE, "Simulate"},
      {"=1", IVI_ERROR_BAD_OPTION_VALUE, "=1"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.options);
    ViSession vi = 123;
    EXPECT_EQ(Ivi_SpecificDriverNew("hsdig", c.options, &vi), c.expected);
    EXPECT_EQ(vi, 0u);
    EXPECT_EQ(int32Attribute(0, IVI_ATTR_PRIMARY_ERROR), c.expected);
    EXPECT_NE(stringAttribute(0, IVI_ATTR_ERROR_ELABORATION).find(c.elaborationPart),
              std::string::npos);
  }
  ViSession vi = 0;
  EXPECT_EQ(Ivi_SpecificDriverNew("", "", &vi), IVI_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(Ivi_SpecificDriverNew("hsdig", "", nullptr), IVI_ERROR_NULL_POINTER);
}

TEST(EngineErrorInfo, OverwriteRule) {
  struct Case {
    ViStatus held;
    ViStatus incoming;
    ViBoolean overwrite;
    ViStatus result;
  };
  const ViStatus error1 = IVI_ERROR_INVALID_VALUE, error2 = IVI_ERROR_INVALID_PARAMETER;
  const ViStatus warning = 0x3FFA4000;
  const Case cases[] = {
      {0, error1, VI_FALSE, error1},       {0, warning, VI_FALSE, warning},
      {warning, error1, VI_FALSE, error1}, {error1, error2, VI_FALSE, error1},
      {error1, warning, VI_FALSE, error1}, {warning, 0x3FFA4001, VI_FALSE, warning},
      {error1, error2, VI_TRUE, error2},   {error1, 0, VI_TRUE, 0},
  };
  ScopedSession s;
  for (const auto& c : cases) {
    SCOPED_TRACE(std::to_string(c.held) + " then " + std::to_string(c.incoming));
    ASSERT_EQ(Ivi_SetErrorInfo(s.vi(), VI_TRUE, c.held, 1, "held"), VI_SUCCESS);
    ASSERT_EQ(Ivi_SetErrorInfo(s.vi(), c.overwrite, c.incoming, 2, "incoming"), VI_SUCCESS);
    EXPECT_EQ(int32Attribute(s.vi(), IVI_ATTR_PRIMARY_ERROR), c.result);
    const bool replaced = c.result == c.incoming && c.held != c.incoming;
    EXPECT_EQ(int32Attribute(s.vi(), IVI_ATTR_SECONDARY_ERROR), replaced ? 2 : 1);
    EXPECT_EQ(stringAttribute(s.vi(), IVI_ATTR_ERROR_ELABORATION), replaced ? "incoming" : "held");
  }
}

TEST(EngineErrorInfo, RoundTripsThroughAttributesAndGetErrorInfo) {
  ScopedSession s;
  ASSERT_EQ(Ivi_SetErrorInfo(s.vi(), VI_FALSE, -5, -6, "seven"), VI_SUCCESS);
  // The elaboration's size, then the text.
  EXPECT_EQ(Ivi_GetAttributeViString(s.vi(), nullptr, IVI_ATTR_ERROR_ELABORATION, 0, 0, nullptr),
            6);
  char small[4];
  EXPECT_EQ(Ivi_GetAttributeViString(s.vi(), "", IVI_ATTR_ERROR_ELABORATION, 0, 4, small), 6);
  EXPECT_STREQ(small, "sev");
  ViStatus primary = 0, secondary = 0;
  char text[32];
  EXPECT_EQ(Ivi_GetErrorInfo(s.vi(), &primary, &secondary, sizeof text, text), VI_SUCCESS);
  EXPECT_EQ(primary, -5);
  EXPECT_EQ(secondary, -6);
  EXPECT_STREQ(text, "seven");
  // Reading handed it over.
  EXPECT_EQ(int32Attribute(s.vi(), IVI_ATTR_PRIMARY_ERROR), 0);

  ASSERT_EQ(Ivi_SetErrorInfo(s.vi(), VI_FALSE, -5, 0, nullptr), VI_SUCCESS);
  EXPECT_EQ(Ivi_ClearErrorInfo(s.vi()), VI_SUCCESS);
  EXPECT_EQ(int32Attribute(s.vi(), IVI_ATTR_PRIMARY_ERROR), 0);
  EXPECT_EQ(stringAttribute(s.vi(), IVI_ATTR_ERROR_ELABORATION), "");
}

TEST(EngineErrorInfo, SessionZeroBelongsToEachThread) {
  ASSERT_EQ(Ivi_SetErrorInfo(0, VI_TRUE, -11, 0, "main"), VI_SUCCESS);
  ViInt32 seenByOther = 1;
  std::thread other([&] {
    seenByOther = int32Attribute(0, IVI_ATTR_PRIMARY_ERROR);
    Ivi_SetErrorInfo(0, VI_TRUE, -12, 0, "other");
  });
  other.join();
  EXPECT_EQ(seenByOther, 0);
  EXPECT_EQ(int32Attribute(0, IVI_ATTR_PRIMARY_ERROR), -11);
  EXPECT_EQ(stringAttribute(0, IVI_ATTR_ERROR_ELABORATION), "main");
  // Session 0 has only its error information.
  ViInt32 flags = 0;
  EXPECT_EQ(Ivi_GetAttributeFlags(0, IVI_ATTR_SIMULATE, &flags), IVI_ERROR_INVALID_ATTRIBUTE);
  EXPECT_EQ(Ivi_ValidateSession(0), IVI_ERROR_INVALID_SESSION_HANDLE);
  EXPECT_EQ(Ivi_Dispose(0), IVI_ERROR_INVALID_SESSION_HANDLE);
  Ivi_ClearErrorInfo(0);
}

TEST(EngineSessions, DisposedHandlesAreInvalidAndNotReused) {
  ViSession first = 0, second = 0;
  ASSERT_EQ(Ivi_SpecificDriverNew("hsdig", "", &first), VI_SUCCESS);
  EXPECT_EQ(Ivi_ValidateSession(first), VI_SUCCESS);
  EXPECT_EQ(Ivi_SessionIsAvailable(first), VI_TRUE);
  EXPECT_EQ(Ivi_SpecificDriverSession(first), first);
  ASSERT_EQ(Ivi_Dispose(first), VI_SUCCESS);
  EXPECT_EQ(Ivi_ValidateSession(first), IVI_ERROR_INVALID_SESSION_HANDLE);
  EXPECT_EQ(Ivi_SessionIsAvailable(first), VI_FALSE);
  EXPECT_EQ(Ivi_Simulating(first), VI_FALSE);
  EXPECT_EQ(Ivi_Dispose(first), IVI_ERROR_INVALID_SESSION_HANDLE);
  ViInt32 value = 0;
  EXPECT_EQ(Ivi_GetAttributeViInt32(first, "", IVI_ATTR_PRIMARY_ERROR, 0, &value),
            IVI_ERROR_INVALID_SESSION_HANDLE);
  ASSERT_EQ(Ivi_SpecificDriverNew("hsdig", "", &second), VI_SUCCESS);
  EXPECT_NE(second, first);
  EXPECT_EQ(Ivi_Dispose(second), VI_SUCCESS);
}

TEST(EngineLocking, RecursiveForTheHolderWithTheCallerFlag) {
  ScopedSession s;
  ViBoolean has = VI_FALSE;
  ASSERT_EQ(Ivi_LockSession(s.vi(), &has), VI_SUCCESS);
  EXPECT_EQ(has, VI_TRUE);
  // With the flag already set the call takes nothing more.
  ASSERT_EQ(Ivi_LockSession(s.vi(), &has), VI_SUCCESS);
  ASSERT_EQ(Ivi_LockSession(s.vi(), nullptr), VI_SUCCESS);
  ASSERT_EQ(Ivi_UnlockSession(s.vi(), nullptr), VI_SUCCESS);
  ASSERT_EQ(Ivi_UnlockSession(s.vi(), &has), VI_SUCCESS);
  EXPECT_EQ(has, VI_FALSE);
  // Not held any more: a flagged unlock is a no-op, a plain one an error.
  EXPECT_EQ(Ivi_UnlockSession(s.vi(), &has), VI_SUCCESS);
  EXPECT_EQ(Ivi_UnlockSession(s.vi(), nullptr), IVI_ERROR_SESSION_NOT_LOCKED);
  EXPECT_EQ(Ivi_LockSession(9999999, &has), IVI_ERROR_INVALID_SESSION_HANDLE);
}

TEST(EngineLocking, ALockedSessionBlocksOtherThreads) {
  ScopedSession s;
  ASSERT_EQ(Ivi_AddAttributeViInt32(s.vi(), 1200000, "COUNTER", 0, 0, nullptr, nullptr, nullptr),
            VI_SUCCESS);
  ViBoolean has = VI_FALSE;
  ASSERT_EQ(Ivi_LockSession(s.vi(), &has), VI_SUCCESS);

  std::mutex logMutex;
  std::vector<std::string> log;
  auto note = [&](const char* what) {
    std::lock_guard lock(logMutex);
    log.push_back(what);
  };
  std::latch started(2);
  std::vector<std::thread> others;
  for (int i = 0; i < 2; ++i) {
    others.emplace_back([&] {
      started.count_down();
      ViBoolean otherHas = VI_FALSE;
      EXPECT_EQ(Ivi_LockSession(s.vi(), &otherHas), VI_SUCCESS);
      note("other locked");
      ViInt32 v = 0;
      Ivi_GetAttributeViInt32(s.vi(), "", 1200000, 0, &v);
      Ivi_SetAttributeViInt32(s.vi(), "", 1200000, 0, v + 1);
      EXPECT_EQ(Ivi_UnlockSession(s.vi(), &otherHas), VI_SUCCESS);
    });
  }
  started.wait();
  // The others wait for the lock; this thread still works on the session.
  EXPECT_EQ(int32Attribute(s.vi(), 1200000), 0);
  note("holder unlocks");
  ASSERT_EQ(Ivi_UnlockSession(s.vi(), &has), VI_SUCCESS);
  for (auto& t : others) t.join();
  ASSERT_EQ(log.size(), 3u);
  EXPECT_EQ(log[0], "holder unlocks");
  EXPECT_EQ(int32Attribute(s.vi(), 1200000), 2);
}

TEST(EngineLocking, DisposeWakesWaitersWithInvalidSession) {
  ViSession vi = 0;
  ASSERT_EQ(Ivi_SpecificDriverNew("hsdig", "", &vi), VI_SUCCESS);
  ViBoolean has = VI_FALSE;
  ASSERT_EQ(Ivi_LockSession(vi, &has), VI_SUCCESS);
  std::latch started(1);
  ViStatus waiterStatus = 0;
  std::thread waiter([&] {
    started.count_down();
    ViBoolean otherHas = VI_FALSE;
    waiterStatus = Ivi_LockSession(vi, &otherHas);
    EXPECT_EQ(otherHas, waiterStatus == VI_SUCCESS ? VI_TRUE : VI_FALSE);
  });
  started.wait();
  // The holder may dispose the session it holds.
  ASSERT_EQ(Ivi_Dispose(vi), VI_SUCCESS);
  waiter.join();
  EXPECT_EQ(waiterStatus, IVI_ERROR_INVALID_SESSION_HANDLE);
  EXPECT_EQ(Ivi_UnlockSession(vi, &has), IVI_ERROR_INVALID_SESSION_HANDLE);
}

TEST(EngineMessages, OwnCodesHaveTextsAndParameterPositions) {
  struct Case {
    ViStatus code;
    const char* text;
  };
  const Case cases[] = {
      {VI_SUCCESS, "Success."},
      {IVI_ERROR_INVALID_SESSION_HANDLE, "The session handle is not valid."},
      {IVI_ERROR_FUNCTION_NOT_SUPPORTED, "Function not supported by the IVI engine."},
      {IVI_ERROR_BAD_OPTION_NAME, "The option string contains an unknown option name."},
      {IVI_ERROR_PARAMETER1 + 2, "Parameter 3 has an invalid value."},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.code);
    char message[IVI_MAX_MESSAGE_BUF_SIZE];
    EXPECT_EQ(Ivi_GetErrorMessage(c.code, message), VI_SUCCESS);
    EXPECT_STREQ(message, c.text);
  }
  char message[IVI_MAX_MESSAGE_BUF_SIZE];
  EXPECT_EQ(Ivi_GetErrorMessage(0x12345, message), IVI_ERROR_INVALID_VALUE);
  EXPECT_STREQ(message, "Unknown status code 0x00012345.");
  EXPECT_EQ(Ivi_GetErrorMessage(0, nullptr), IVI_ERROR_NULL_POINTER);

  for (ViInt32 position = 1; position <= 8; ++position) {
    EXPECT_EQ(Ivi_ParamPositionError(position), static_cast<ViStatus>(0xBFFC0000 + position));
  }
  EXPECT_EQ(Ivi_ParamPositionError(9), IVI_ERROR_INVALID_PARAMETER);
  EXPECT_EQ(Ivi_ParamPositionError(0), IVI_ERROR_INVALID_PARAMETER);
}

}  // namespace
