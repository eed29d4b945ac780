// How a serving thread gives up the lead of its worker while it runs a
// request, so that the worker's other connections are served meanwhile.
#pragma once

#include "server/UniqueGuard.h"

namespace hsdig {

class LeaderHandOffInterface {
 public:
  virtual ~LeaderHandOffInterface() = default;
  // Releases `guard` (the worker's wait lock). Another thread takes the lead
  // unless this one comes back for it first.
  virtual void handOff(UniqueGuard& guard) = 0;
};

}  // namespace hsdig
