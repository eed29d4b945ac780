// An engine session for the length of a test, made through the process's
// engine binding (libcvivi.so beside the library), and disposed at the end.
#pragma once

#include <gtest/gtest.h>

#include "session/IviWrapper.h"

namespace hsdig::test {

class EngineSession {
 public:
  explicit EngineSession(const char* options = "Simulate=1") {
    ViSession vi = 0;
    EXPECT_EQ(IviWrapper(0).specificDriverNew("hsdig", options, &vi, 1), VI_SUCCESS);
    wrapper_ = std::make_unique<IviWrapper>(vi);
  }
  ~EngineSession() { wrapper_->dispose(1); }
  EngineSession(const EngineSession&) = delete;
  EngineSession& operator=(const EngineSession&) = delete;

  IviWrapper& wrapper() { return *wrapper_; }
  ViSession handle() const { return wrapper_->getSessionHandle(); }

 private:
  std::unique_ptr<IviWrapper> wrapper_;
};

}  // namespace hsdig::test
