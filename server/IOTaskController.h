// Task 0 of every worker: a queue of jobs that change the worker's task list
// from outside the leading thread (adding an accepted connection, removing a
// failed one, shutting down). Posting a job sets the controller's event; the
// next leader runs the jobs with the wait lock held.
//
// The task count (the controller, in the first worker also the accept task,
// plus every connection placed or queued) keeps each worker at no more than
// 64 handles: the first worker takes 62 connections, later ones 63.
//
// Lock order: a worker's wait lock before the controller's mutex.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <vector>

#include "platform/EventFd.h"
#include "server/IOMultiTask.h"

namespace hsdig {

template <class THandleWaitPolicy>
class IOTaskController : public IOTask {
 public:
  using MultiTask = IOMultiTask<THandleWaitPolicy>;
  using Job = std::function<void(UniqueGuard&)>;
  static constexpr int64_t kMaxTasks = 64;

  // Throws std::system_error when the event cannot be created.
  IOTaskController(MultiTask& multiTask, int64_t initialCount)
      : multiTask_(multiTask), taskCount_(initialCount) {
    if (int error = event_.create()) {
      throw std::system_error(error, std::generic_category(), "eventfd");
    }
  }

  int getWaitHandle() override { return event_.fd(); }

  void process(UniqueGuard& guard) override {
    std::vector<Job> jobs;
    {
      std::lock_guard lock(mutex_);
      event_.reset();
      jobs.swap(pending_);
    }
    for (auto& job : jobs) job(guard);
    if (guard.owns_lock()) guard.unlock();
  }

  // Queues the addition of `task` when the worker has room. Returns false
  // when it is full.
  bool tryAddTask(std::shared_ptr<IOTask> task) {
    MultiTask* multi = &multiTask_;
    Job job = [multi, task](UniqueGuard& guard) { multi->addIOTask(task, guard); };
    std::lock_guard lock(mutex_);
    if (taskCount_ >= kMaxTasks) return false;
    pending_.push_back(std::move(job));
    ++taskCount_;
    event_.set();
    return true;
  }

  // Queues the removal of `task`; its room is free at once.
  void scheduleRemoval(const IOTask* task) {
    MultiTask* multi = &multiTask_;
    std::lock_guard lock(mutex_);
    pending_.push_back([multi, task](UniqueGuard& guard) { multi->removeIOTask(task, guard); });
    --taskCount_;
    event_.set();
  }

  // Queues the shutdown of the worker (the count stays).
  void postStop() {
    MultiTask* multi = &multiTask_;
    std::lock_guard lock(mutex_);
    pending_.push_back([multi](UniqueGuard& guard) { multi->shutdown(guard); });
    event_.set();
  }

  // Frees the room of a connection that the worker already dropped.
  void releaseRoom() {
    std::lock_guard lock(mutex_);
    --taskCount_;
  }

  int64_t taskCount() const {
    std::lock_guard lock(mutex_);
    return taskCount_;
  }

 private:
  platform::EventFd event_;
  MultiTask& multiTask_;
  mutable std::mutex mutex_;
  std::vector<Job> pending_;  // guarded by mutex_
  int64_t taskCount_;         // guarded by mutex_
};

}  // namespace hsdig
