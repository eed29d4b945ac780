// The server's side of one call: built on the serving thread's stack for each
// request frame, over the worker's UniqueGuard and the connection's reply lock.
//
// - requestRead releases the worker lock (and sets `released`) unless the call
//   already failed (`keep`): a failed read keeps the lock with the worker, so
//   the server's clean-up knows which path to take by `released`.
// - replyStarting/replyFinished hold the connection lock around a reply, so
//   replies on one connection never interleave.
#pragma once

#include <mutex>

#include "server/LeaderHandOff.h"
#include "server/TConcurrentServerContext.h"
#include "server/UniqueGuard.h"

namespace hsdig {

class ConcurrentProcessorEventHandler : public TConcurrentServerContext {
 public:
  // `handOff` (optional) releases the worker lock for requestRead; without
  // it the lock is simply unlocked.
  ConcurrentProcessorEventHandler(UniqueGuard& guard, std::mutex& connectionLock,
                                  LeaderHandOffInterface* handOff = nullptr)
      : guard_(guard), connectionLock_(connectionLock), handOff_(handOff) {}

  void requestStarting() override {}
  void requestRead() override;
  void replyStarting() override { connectionLock_.lock(); }
  void replyFinished() override { connectionLock_.unlock(); }
  void callFailed() override { keep_ = true; }

  // True once the worker lock was handed back during this call.
  bool released() const noexcept { return released_; }
  bool keep() const noexcept { return keep_; }

 private:
  UniqueGuard& guard_;
  std::mutex& connectionLock_;
  LeaderHandOffInterface* handOff_;
  bool released_ = false;
  bool keep_ = false;
};

}  // namespace hsdig
