#include "server/ConcurrentProcessorEventHandler.h"

namespace hsdig {

void ConcurrentProcessorEventHandler::requestRead() {
  if (keep_) return;
  released_ = true;
  if (guard_.owns_lock()) guard_.unlock();
}

}  // namespace hsdig
