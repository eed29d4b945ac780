// Helpers shared by the engine tests.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "IviEngine.h"

namespace engine_test {

// An engine session that is disposed at scope end.
class ScopedSession {
 public:
  explicit ScopedSession(const char* options = "Simulate=1") {
    status_ = Ivi_SpecificDriverNew("hsdig", options, &vi_);
  }
  ~ScopedSession() {
    if (vi_) Ivi_Dispose(vi_);
  }
  ScopedSession(const ScopedSession&) = delete;
  ScopedSession& operator=(const ScopedSession&) = delete;
  ViSession vi() const { return vi_; }
  ViStatus status() const { return status_; }

 private:
  ViSession vi_ = 0;
  ViStatus status_ = 0;
};

inline std::string stringAttribute(ViSession vi, ViAttr id, const char* channel = "") {
  char buffer[512] = {};
  EXPECT_EQ(Ivi_GetAttributeViString(vi, channel, id, 0, sizeof buffer, buffer), VI_SUCCESS);
  return buffer;
}

inline ViInt32 int32Attribute(ViSession vi, ViAttr id, const char* channel = "") {
  ViInt32 value = -1;
  EXPECT_EQ(Ivi_GetAttributeViInt32(vi, channel, id, 0, &value), VI_SUCCESS);
  return value;
}

inline bool booleanAttribute(ViSession vi, ViAttr id) {
  ViBoolean value = 7;
  EXPECT_EQ(Ivi_GetAttributeViBoolean(vi, "", id, 0, &value), VI_SUCCESS);
  return value == VI_TRUE;
}

}  // namespace engine_test
