// SessionLock: holds an engine session's lock for a scope.
//
// lock(wrapper) takes the session lock through the wrapper in throwing mode
// (an error throws, a warning is recorded and returned); at scope end the
// lock is given back if this object took it. Giving it back never throws:
// when it fails (the session was disposed meanwhile) there is nothing left
// to unlock, and a destructor must not end the host process.
#pragma once

#include "session/IviWrapperInterface.h"

namespace hsdig {

class SessionLock {
 public:
  SessionLock() = default;
  ~SessionLock();
  SessionLock(const SessionLock&) = delete;
  SessionLock& operator=(const SessionLock&) = delete;

  // The wrapper must outlive this object.
  ViStatus lock(IviWrapperInterface& wrapper);
  // Gives the lock back now, in throwing mode; a no-op unless held.
  ViStatus unlock();
  bool callerHasLock() const { return callerHasLock_ != VI_FALSE; }

 private:
  IviWrapperInterface* wrapper_ = nullptr;
  ViBoolean callerHasLock_ = VI_FALSE;
};

}  // namespace hsdig
