// One thing a worker waits for: the controller's job queue, the listening
// pipe, or one connection.
//
// A worker keeps up to 64 tasks and waits on their handles at once (a handle
// is a descriptor that polls readable when the task has work). process is
// called by the leading thread with the worker's wait lock held; the task may
// hand the lock back early (a request being served does, so the worker's
// other connections go on).
#pragma once

#include "server/UniqueGuard.h"

namespace hsdig {

class IOTask {
 public:
  IOTask() = default;
  IOTask(const IOTask&) = delete;
  IOTask& operator=(const IOTask&) = delete;
  virtual ~IOTask() = default;

  // The descriptor to wait on; -1 while the task has none.
  virtual int getWaitHandle() = 0;
  virtual void process(UniqueGuard& guard) = 0;
  // True when the task has work without waiting (a whole frame is buffered).
  virtual bool isReady() { return false; }
};

}  // namespace hsdig
