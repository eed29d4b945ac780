#include "session/ReadersWriterGate.h"

namespace hsdig {

void ReadersWriterGate::enterReader() {
  std::lock_guard lock(countMutex_);
  if (++readers_ == 1) gate_.acquire();
}

void ReadersWriterGate::leaveReader() {
  std::lock_guard lock(countMutex_);
  if (--readers_ == 0) gate_.release();
}

}  // namespace hsdig
