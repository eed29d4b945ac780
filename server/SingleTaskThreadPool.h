// The threads of one worker: every thread runs the same runnable (the
// worker's IOMultiTask loop).
//
// Threads are added by the server (3 for a new worker) and by a leader that
// finds nobody waiting behind it (1); a thread retires after a long idle wait
// while enough others wait. A thread cannot join itself, so a retiring
// thread parks in the retired list and is joined later (by the next
// addThreads or by join).
//
// Thread promises: every operation may be called from any thread, including
// the pool's own threads; all state is guarded by the pool's monitor.
#pragma once

#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>
#include <vector>

namespace hsdig {

class SingleTaskThreadPool {
 public:
  SingleTaskThreadPool() = default;
  SingleTaskThreadPool(const SingleTaskThreadPool&) = delete;
  SingleTaskThreadPool& operator=(const SingleTaskThreadPool&) = delete;
  // Joins whatever is left; the owner calls stop and join first.
  ~SingleTaskThreadPool();

  // The body of every thread. Set before the first addThreads.
  void setRunnable(std::function<void()> runnable);

  // Starts `n` threads (nothing when stopped). Retired threads other than the
  // caller are joined first. Throws std::system_error when a thread cannot
  // be started; the threads started before stay.
  void addThreads(int n);
  // Takes the thread `id` out of the active list: joined at once when it is
  // another thread, parked for a later join when it is the caller.
  void retireThread(std::thread::id id);
  // Marks the pool stopped and wakes join.
  void stop();
  // Waits until the pool is stopped, then joins every thread.
  void join();

  std::size_t activeCount() const;
  bool stopped() const;

 private:
  mutable std::mutex monitor_;
  std::condition_variable stoppedChanged_;
  std::vector<std::thread> active_;
  std::vector<std::thread> retired_;
  std::function<void()> runnable_;
  bool stopped_ = false;
};

}  // namespace hsdig
