#include "server/ConcurrentProcessorEventHandler.h"

namespace hsdig {

void ConcurrentProcessorEventHandler::requestRead() {
  if (keep_) return;
  released_ = true;
  if (!guard_.owns_lock()) return;
  if (handOff_ != nullptr) {
    handOff_->handOff(guard_);
  } else {
    guard_.unlock();
  }
}

}  // namespace hsdig
