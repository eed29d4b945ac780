// ErrorCacher: a session's pending error, saved before a driver call and put
// back afterwards, so that the call's own outcome can be read from the
// session's error information without losing what was pending before.
//
// Used by the server's driver-call handlers, one per call, on one thread.
#pragma once

#include <string>

#include "errors/Status.h"
#include "session/IviWrapperInterface.h"

namespace hsdig {

class ErrorCacherInterface {
 public:
  virtual ~ErrorCacherInterface() = default;
  // Saves the pending error (when there is one) and clears it in the session.
  // Throws HostErrorException when `status` already holds an error, or when
  // reading or clearing fails.
  virtual void cacheAndClear(IviWrapperInterface& wrapper, Status& status) = 0;
  // Puts a saved error back (overwriting).
  virtual void restore(IviWrapperInterface& wrapper) = 0;
  virtual bool isWarning() const = 0;
  virtual bool isError() const = 0;
  virtual bool isSuccess() const = 0;
  // As cacheAndClear, without clearing the session's error information.
  virtual void cache(IviWrapperInterface& wrapper, Status& status) = 0;
};

class ErrorCacher : public ErrorCacherInterface {
 public:
  void cacheAndClear(IviWrapperInterface& wrapper, Status& status) override {
    read(wrapper, status, true);
  }
  void restore(IviWrapperInterface& wrapper) override;
  bool isWarning() const override { return primaryError > 0; }
  bool isError() const override { return primaryError < 0; }
  bool isSuccess() const override { return primaryError == 0; }
  void cache(IviWrapperInterface& wrapper, Status& status) override {
    read(wrapper, status, false);
  }

  ViStatus primaryError = 0;
  ViStatus secondaryError = 0;
  std::string elaboration;

 private:
  void read(IviWrapperInterface& wrapper, Status& status, bool clear);
};

}  // namespace hsdig
