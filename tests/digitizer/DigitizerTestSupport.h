// Shared helpers of the simulated digitizer's tests: a session per test
// and readers of the session's error information.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "IviEngine.h"
#include "hsdig.h"

namespace hsdig::test {

struct ErrorInfo {
  ViStatus primary = 0;
  ViStatus secondary = 0;
  std::string elaboration;
};

// Reads (and so clears) the pending error information of `vi`.
inline ErrorInfo takeError(ViSession vi) {
  ErrorInfo e;
  std::vector<char> text(1024, '\0');
  Ivi_GetErrorInfo(vi, &e.primary, &e.secondary, static_cast<ViInt32>(text.size()), text.data());
  e.elaboration = text.data();
  return e;
}

inline ViSession openSession(const std::string& options = "",
                             const char* resource = "SIM::DIGITIZER0") {
  ViSession vi = 0;
  ViStatus st =
      hsdig_InitWithOptions(const_cast<ViRsrc>(resource), VI_TRUE, VI_FALSE, options.c_str(), &vi);
  EXPECT_EQ(st, VI_SUCCESS) << takeError(0).elaboration;
  return vi;
}

class DigitizerTest : public ::testing::Test {
 protected:
  void SetUp() override { vi = openSession(); }
  void TearDown() override {
    if (vi) {
      EXPECT_EQ(hsdig_close(vi), VI_SUCCESS);
    }
  }
  std::string text(ViAttr id, const char* channel = "") {
    ViStatus size = hsdig_GetAttributeViString(vi, channel, id, 0, nullptr);
    std::string s(static_cast<size_t>(size > 0 ? size : 1), '\0');
    EXPECT_EQ(hsdig_GetAttributeViString(vi, channel, id, static_cast<ViInt32>(s.size()), s.data()),
              VI_SUCCESS);
    return s.c_str();
  }
  double real(ViAttr id, const char* channel = "") {
    ViReal64 v = 0;
    EXPECT_EQ(hsdig_GetAttributeViReal64(vi, channel, id, &v), VI_SUCCESS);
    return v;
  }
  ViInt32 integer(ViAttr id, const char* channel = "") {
    ViInt32 v = 0;
    EXPECT_EQ(hsdig_GetAttributeViInt32(vi, channel, id, &v), VI_SUCCESS);
    return v;
  }
  // One record of `length` samples at `rate` on every channel, immediate
  // trigger.
  void horizontal(double rate, ViInt32 length, ViInt32 records = 1, double refPosition = 0.0) {
    ASSERT_EQ(hsdig_ConfigureHorizontalTiming(vi, rate, length, refPosition, records, VI_TRUE),
              VI_SUCCESS);
  }
  ViSession vi = 0;
};

}  // namespace hsdig::test
