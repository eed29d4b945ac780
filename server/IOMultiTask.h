// One worker's leader/follower loop over up to 64 tasks.
//
// Every thread of the worker's pool runs run(). The thread that holds the
// wait lock leads: it waits on the task handles and serves the task that
// became ready with the lock held. A task that starts a request hands the
// lead off (handOff, through the dispatcher's server context) before the
// handler runs, so the worker's other connections are served meanwhile.
//
// The other threads follow: they wait on the worker's standby timer, not on
// the lock. A hand-off releases the lock and then makes sure the timer will
// expire within kStandbyDelayUs; the serving thread takes the lead back when
// its request is done, and a follower leads only when the timer expires and
// finds the lock free. A short request thus costs no thread wake-up at all, a
// long one delays the worker's other connections by at most the standby
// delay, and a busy worker arms the timer at most once per delay. Whatever
// leaves the lock without coming back for it (a retiring or failing thread)
// wakes a follower at once.
//
// The pool grows by one thread whenever a new leader finds no follower, and a
// leader whose wait times out retires while two or more followers wait.
//
// The task list and handle array change only under the wait lock: directly
// in the accept and read-failure paths, otherwise through jobs that the
// worker's IOTaskController runs (task 0). `waiting_` (the followers) is
// atomic and read without the lock for the grow and retire decisions.
#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <mutex>
#include <system_error>
#include <thread>
#include <typeinfo>
#include <vector>

#include <thrift/Thrift.h>

#include "platform/Diagnostic.h"
#include "platform/EventFd.h"
#include "platform/TimerFd.h"
#include "server/IOTask.h"
#include "server/LeaderHandOff.h"
#include "server/SingleTaskThreadPool.h"
#include "server/UniqueGuard.h"

namespace hsdig {

template <class THandleWaitPolicy>
class IOMultiTask : public std::enable_shared_from_this<IOMultiTask<THandleWaitPolicy>>,
                    public LeaderHandOffInterface {
 public:
  static constexpr int kDefaultWaitTimeoutMs = 600000;
  // How long a request may run before a follower takes the lead.
  static constexpr int64_t kStandbyDelayUs = 1000;
  // The pool grows only up to this many threads. Calls on one served session
  // are serialized by the driver's session lock anyway, so more threads
  // would only wait there; without a ceiling a busy worker would grow a
  // thread for nearly every connection it holds.
  static constexpr std::size_t kMaxThreads = 4;

  // Throws std::system_error when the standby timer or the stop event
  // cannot be created.
  explicit IOMultiTask(SingleTaskThreadPool& pool) : pool_(pool) {
    if (int error = standby_.create()) {
      throw std::system_error(error, std::generic_category(), "timerfd");
    }
    if (int error = stopEvent_.create()) {
      throw std::system_error(error, std::generic_category(), "eventfd");
    }
  }
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
      wakeAFollower();
    }
  }

  // Called with the wait lock held. The lock is released first, and the
  // standby timer armed afterwards unless it already is (a timer armed by an
  // earlier hand-off expires no later than this one would, and arming a
  // timer costs more than a small request). A follower clears the armed flag
  // after it takes an expiry and only then tries the lock, so whenever a
  // hand-off skips the arming, that follower's try comes after the release:
  // it finds the lock free, or held by a thread that leads or hands off in
  // turn.
  void handOff(UniqueGuard& guard) override {
    if (guard.owns_lock()) guard.unlock();
    if (!standbyArmed_.exchange(true)) standby_.arm(kStandbyDelayUs);
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
    stopEvent_.set();
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
      UniqueGuard guard(waitLock_, std::try_to_lock);
      if (!guard.owns_lock()) {
        if (!follow()) return;
        continue;
      }
      if (stopped_.load()) return;
      if (waiting_.load() < 1 && pool_.activeCount() < kMaxThreads) launchAnotherThread();

      const int i = nextReadyTask();
      if (i < 0) {
        if (waiting_.load() > 1) {
          guard.unlock();
          wakeAFollower();
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

  // Waits as a follower until the standby timer expires (a request outlasted
  // the standby delay, or the leader left). False once the worker stops.
  bool follow() {
    waiting_.fetch_add(1);
    const int handles[2] = {standby_.fd(), stopEvent_.fd()};
    int ready = -1;
    try {
      while (ready < 0) ready = THandleWaitPolicy::wait_for_multiple(handles, 2, -1);
    } catch (...) {
      waiting_.fetch_sub(1);
      throw;
    }
    waiting_.fetch_sub(1);
    if (ready == 1 || stopped_.load()) return false;
    standby_.consume();
    standbyArmed_.store(false);
    return true;
  }

  // Lets a follower take the lead now; called after the lock is released.
  void wakeAFollower() {
    standbyArmed_.store(true);
    standby_.arm(1);
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
  platform::TimerFd standby_;  // expires when a follower must lead
  std::atomic<bool> standbyArmed_{false};
  platform::EventFd stopEvent_;  // set once the worker stops
  int32_t lastIndex_ = 0;        // guarded by waitLock_
};

}  // namespace hsdig
