// IviWrapper's status rule, the factory and SessionLock, on the real engine.
#include <gtest/gtest.h>

#include <latch>
#include <string>
#include <thread>

#include "errors/Exception.h"
#include "session/IviWrapper.h"
#include "session/SessionLock.h"

namespace hsdig {
namespace {

constexpr ViStatus kWarning = 0x3FFA1234;
constexpr ViAttr kWarned = 1200100;
constexpr ViAttr kFailing = 1200101;

ViStatus warningRead(ViSession, ViSession, ViConstString, ViAttr, ViInt32* value) {
  *value = 42;
  return kWarning;
}
ViStatus failingRead(ViSession, ViSession, ViConstString, ViAttr, ViInt32*) {
  return IVI_ERROR_INVALID_VALUE;
}

class Wrapper : public ::testing::Test {
 protected:
  void SetUp() override {
    IviWrapper none(0);
    ASSERT_EQ(none.specificDriverNew("hsdig", "Simulate=1, DriverSetup=Model:A1", &vi_),
              VI_SUCCESS);
    IviWrapper w(vi_);
    w.addAttributeViInt32(kWarned, "WARNED", 0, IVI_VAL_NEVER_CACHE, warningRead, nullptr, nullptr);
    w.addAttributeViInt32(kFailing, "FAILING", 0, IVI_VAL_NEVER_CACHE, failingRead, nullptr,
                          nullptr);
  }
  void TearDown() override { IviWrapper(vi_).dispose(1); }

  struct ErrorInfo {
    ViInt32 primary = 0, secondary = 0;
    std::string elaboration;
  };
  ErrorInfo errorInfo(ViSession vi) {
    IviWrapper w(vi);
    ErrorInfo info;
    w.getAttributeViInt32(nullptr, IVI_ATTR_PRIMARY_ERROR, 0, &info.primary);
    w.getAttributeViInt32(nullptr, IVI_ATTR_SECONDARY_ERROR, 0, &info.secondary);
    char text[256] = {};
    w.getAttributeViString("", IVI_ATTR_ERROR_ELABORATION, 0, sizeof text, text);
    info.elaboration = text;
    return info;
  }

  ViSession vi_ = 0;
};

TEST_F(Wrapper, AnErrorThrowsWithTheOperationsLocation) {
  IviWrapper w(vi_);
  ViInt32 value = 0;
  try {
    w.getAttributeViInt32("", kFailing, 0, &value);
    FAIL() << "no exception";
  } catch (const Exception& e) {
    EXPECT_EQ(e.status().code(), IVI_ERROR_INVALID_VALUE);
    EXPECT_NE(std::string(e.where().function_name()).find("getAttributeViInt32"),
              std::string::npos);
    EXPECT_NE(std::string(e.where().file_name()).find("IviWrapper.cpp"), std::string::npos);
  }
  // An error is not recorded by the wrapper.
  EXPECT_EQ(errorInfo(vi_).primary, 0);
}

TEST_F(Wrapper, AWarningIsRecordedAndReturned) {
  IviWrapper w(vi_);
  ViInt32 value = 0;
  EXPECT_EQ(w.getAttributeViInt32("", kWarned, 0, &value), kWarning);
  EXPECT_EQ(value, 42);
  ErrorInfo info = errorInfo(vi_);
  EXPECT_EQ(info.primary, kWarning);
  EXPECT_EQ(info.secondary, 0);
  EXPECT_EQ(info.elaboration, "");

  // A recorded error is not overwritten by a later warning.
  w.setErrorInfo(VI_TRUE, -77, -78, "kept");
  EXPECT_EQ(w.getAttributeViInt32("", kWarned, 0, &value), kWarning);
  EXPECT_EQ(errorInfo(vi_).primary, -77);
  EXPECT_EQ(errorInfo(vi_).elaboration, "kept");
}

TEST_F(Wrapper, NoThrowReturnsTheStatusAndRecordsNothing) {
  IviWrapper w(vi_);
  ViInt32 value = 0;
  struct Case {
    ViAttr attribute;
    ViStatus expected;
  };
  for (const Case& c : {Case{kFailing, IVI_ERROR_INVALID_VALUE}, Case{kWarned, kWarning}}) {
    SCOPED_TRACE(c.attribute);
    EXPECT_EQ(w.getAttributeViInt32("", c.attribute, 0, &value, 1), c.expected);
    EXPECT_EQ(errorInfo(vi_).primary, 0);
  }
}

TEST_F(Wrapper, ANeededSizeIsNotAWarning) {
  IviWrapper w(vi_);
  EXPECT_EQ(w.getAttributeViString("", IVI_ATTR_DRIVER_SETUP, 0, 0, nullptr), 9);
  char small[4];
  EXPECT_EQ(w.getAttributeViString("", IVI_ATTR_DRIVER_SETUP, 0, sizeof small, small), 9);
  EXPECT_STREQ(small, "Mod");
  EXPECT_EQ(errorInfo(vi_).primary, 0);
}

TEST_F(Wrapper, ValueOperationsAndTheFactory) {
  IviWrapperFactory factory;
  auto w = factory.create(vi_);
  EXPECT_EQ(w->getSessionHandle(), vi_);
  EXPECT_EQ(w->simulating(), VI_TRUE);
  EXPECT_EQ(w->validateAttribute(IVI_ATTR_DRIVER_SETUP, IVI_VAL_STRING), VI_SUCCESS);
  EXPECT_THROW(w->validateAttribute(IVI_ATTR_DRIVER_SETUP, IVI_VAL_ADDR), Exception);
  EXPECT_EQ(factory.create(0)->getSessionHandle(), 0u);
  // The session 0 wrapper reaches the engine's session-less functions.
  EXPECT_EQ(factory.create(0)->paramPositionError(2, 1), static_cast<ViStatus>(0xBFFC0002));
}

TEST_F(Wrapper, SessionLockHoldsForItsScope) {
  IviWrapper w(vi_);
  {
    SessionLock lock;
    EXPECT_EQ(lock.lock(w), VI_SUCCESS);
    EXPECT_TRUE(lock.callerHasLock());
    // Another thread's lock waits until the scope ends; the log shows it.
    std::latch started(1);
    std::string order;
    std::thread other([&] {
      started.count_down();
      SessionLock otherLock;
      otherLock.lock(w);
      order += "other";
    });
    started.wait();
    order += "holder,";
    lock.unlock();
    other.join();
    EXPECT_EQ(order, "holder,other");
    EXPECT_FALSE(lock.callerHasLock());
    EXPECT_EQ(lock.lock(w), VI_SUCCESS);
  }
  // Released at scope end: this thread no longer holds it.
  EXPECT_EQ(w.unlockSession(nullptr, 1), IVI_ERROR_SESSION_NOT_LOCKED);
}

TEST_F(Wrapper, SessionLockOfADisposedSessionEndsQuietly) {
  ViSession vi = 0;
  ASSERT_EQ(IviWrapper(0).specificDriverNew("hsdig", "", &vi), VI_SUCCESS);
  IviWrapper w(vi);
  {
    SessionLock lock;
    lock.lock(w);
    w.dispose();
  }
  EXPECT_THROW(SessionLock().lock(w), Exception);
}

}  // namespace
}  // namespace hsdig
