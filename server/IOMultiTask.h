// One worker's leader/follower loop over up to 64 tasks.
//
// Every thread of the worker's pool runs run(). The wait lock makes one of
// them the leader: it waits on the task handles, and serves the task that
// became ready with the lock held. A task that starts a request hands the
// lock back (through the dispatcher's server context), so the next thread
// leads while the request runs. The pool grows by one thread whenever a new
// leader finds nobody waiting behind it, and a leader whose wait times out
// retires while two or more other threads wait.
//
// The task list and handle array change only under the wait lock: directly
// in the accept and read-failure paths, otherwise through jobs that the
// worker's IOTaskController runs (task 0). `waiting_` is atomic and read
// without the lock for the grow and retire decisions.
#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <mutex>
#include <thread>
#include <typeinfo>
#include <vector>

#include <thrift/Thrift.h>

#include "platform/Diagnostic.h"
#include "server/IOTask.h"
#include "server/SingleTaskThreadPool.h"
#include "server/UniqueGuard.h"

namespace hsdig {

template <class THandleWaitPolicy>
class IOMultiTask : public std::enable_shared_from_this<IOMultiTask<THandleWaitPolicy>> {
 public:
  static constexpr int kDefaultWaitTimeoutMs = 600000;
  // The pool grows only up to this many threads. Calls on one served session
  // are serialized by the driver's session lock anyway, so more threads
  // would only wait there; without a ceiling a busy worker would grow a
  // thread for nearly every connection it holds.
  static constexpr std::size_t kMaxThreads = 4;

  explicit IOMultiTask(SingleTaskThreadPool& pool) : pool_(pool) {}
  IOMultiTask(const IOMultiTask&) = delete;
  IOMultiTask& operator=(const IOMultiTask&) = delete;

  // The body of every pool thread. An exception out of the wait (the wait
  // itself failed) ends this thread only; the process and the other workers
  // go on.
  void run() {
    try {
      loop();
    } catch (const std::exception& e) {
      platform::reportLine((std::string("IOMultiTask::run thread ends: ") + e.what()).c_str());
    }
  }

  // Appends `task` with a placeholder handle, then refreshes the handles.
  void addIOTask(std::shared_ptr<IOTask> task, UniqueGuard&) {
    try {
      tasks_.push_back(std::move(task));
      handles_.push_back(-1);
    } catch (const std::exception&) {
      if (handles_.size() < tasks_.size()) tasks_.pop_back();
      platform::reportLine(
          "IOMultiTask::addIOTask initializeIOTaskHelper_ failed, dropping connection");
    }
    refreshHandles();
  }

  // Removes `task` by identity (swap with the last, drop the last).
  void removeIOTask(const IOTask* task, UniqueGuard&) {
    for (std::size_t i = 0; i < tasks_.size(); ++i) {
      if (tasks_[i].get() == task) {
        removeAt(i);
        return;
      }
    }
    platform::reportLine("IOMultiTask::removeIOTask connection is double dead");
  }

  // Removes the task served last (the caller is that task).
  void removeAtLastIndex(UniqueGuard&) {
    if (lastIndex_ < 0 || static_cast<std::size_t>(lastIndex_) >= tasks_.size()) {
      platform::reportLine("IOMultiTask::removeIOTask connection is double dead");
      return;
    }
    removeAt(static_cast<std::size_t>(lastIndex_));
  }

  // Also forgets the readiness found by the last wait: its indices may no
  // longer name the same tasks. A ready handle is found again by the next wait.
  void refreshHandles() {
    for (std::size_t k = 0; k < tasks_.size(); ++k) handles_[k] = tasks_[k]->getWaitHandle();
    foundReady_.clear();
  }

  // Stops the loop and drops every task (the accept task and every
  // connection of this worker). The tasks are destroyed after the lists are
  // cleared, so a task's destructor never sees a half-cleared worker.
  void shutdown(UniqueGuard&) {
    stopped_.store(true);
    std::vector<std::shared_ptr<IOTask>> dropped;
    dropped.swap(tasks_);
    handles_.clear();
    foundReady_.clear();
    dropped.clear();
  }

  bool stopped() const noexcept { return stopped_.load(); }

  // Test hook: the idle wait after which a surplus leader retires. A leader
  // already waiting keeps the wait it started with.
  void setWaitTimeoutMs(int ms) { waitTimeoutMs_.store(ms); }
  // Test view: the number of tasks (the caller holds the wait lock or knows
  // the worker is quiet).
  std::size_t taskCountUnlocked() const { return tasks_.size(); }
  std::mutex& waitLock() { return waitLock_; }

 private:
  void removeAt(std::size_t i) {
    std::shared_ptr<IOTask> gone = std::move(tasks_[i]);
    tasks_[i] = std::move(tasks_.back());
    tasks_.pop_back();
    handles_.pop_back();
    refreshHandles();
    lastIndex_ = 0;
    gone.reset();
  }

  void loop() {
    for (;;) {
      if (stopped_.load()) return;
      waiting_.fetch_add(1);
      UniqueGuard guard(waitLock_);
      if (stopped_.load()) {
        waiting_.fetch_sub(1);
        return;
      }
      if (waiting_.fetch_sub(1) - 1 < 1 && pool_.activeCount() < kMaxThreads) {
        launchAnotherThread();
      }

      const int i = nextReadyTask();
      if (i < 0) {
        if (waiting_.load() > 1) {
          pool_.retireThread(std::this_thread::get_id());
          return;
        }
        continue;
      }
      if (static_cast<std::size_t>(i) >= tasks_.size()) continue;
      lastIndex_ = i;
      std::shared_ptr<IOTask> task = tasks_[static_cast<std::size_t>(i)];
      task->process(guard);
    }
  }

  // The task to serve next, waiting only when none has work already: first
  // the task served last when it holds another whole frame, then the tasks
  // the last wait found ready as well (one wait serves every connection it
  // found ready, in turn), then any task with bytes already read, and only
  // then a wait. -1 when the wait timed out.
  int nextReadyTask() {
    const int last = lastIndex_;
    if (last >= 0 && static_cast<std::size_t>(last) < tasks_.size() &&
        tasks_[static_cast<std::size_t>(last)]->isReady()) {
      return last;
    }
    if (!foundReady_.empty()) {
      const int next = foundReady_.back();
      foundReady_.pop_back();
      return next;
    }
    for (std::size_t k = 0; k < tasks_.size(); ++k) {
      if (tasks_[k]->isReady()) return static_cast<int>(k);
    }
    return THandleWaitPolicy::wait_for_multiple(handles_.data(), handles_.size(),
                                                waitTimeoutMs_.load(), &foundReady_);
  }

  void launchAnotherThread() {
    try {
      pool_.addThreads(1);
    } catch (const std::exception& e) {
      std::string line =
          "IOMultiTask::run launchAnotherThread_ failed, forging ahead anyway.\n"
          "Under certain conditions, lack of threads may cause a deadlock.\n"
          "std::exception: ";
      line += typeid(e).name();
      line += ": ";
      line += e.what();
      line += "\n";
      platform::reportLine(line.c_str());
    }
  }

  std::vector<int> handles_;                    // guarded by waitLock_
  std::vector<int> foundReady_;                 // guarded by waitLock_
  std::vector<std::shared_ptr<IOTask>> tasks_;  // guarded by waitLock_
  std::mutex waitLock_;
  SingleTaskThreadPool& pool_;
  std::atomic<int> waitTimeoutMs_{kDefaultWaitTimeoutMs};
  std::atomic<int32_t> waiting_{0};
  std::atomic<bool> stopped_{false};
  int32_t lastIndex_ = 0;  // guarded by waitLock_
};

}  // namespace hsdig
