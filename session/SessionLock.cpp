#include "session/SessionLock.h"

namespace hsdig {

SessionLock::~SessionLock() {
  if (wrapper_ && callerHasLock_) wrapper_->unlockSession(&callerHasLock_, 1);
}

ViStatus SessionLock::lock(IviWrapperInterface& wrapper) {
  wrapper_ = &wrapper;
  return wrapper.lockSession(&callerHasLock_);
}

ViStatus SessionLock::unlock() {
  if (!wrapper_ || !callerHasLock_) return VI_SUCCESS;
  return wrapper_->unlockSession(&callerHasLock_);
}

}  // namespace hsdig
