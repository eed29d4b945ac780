#include "server/SingleTaskThreadPool.h"

#include <algorithm>

namespace hsdig {

SingleTaskThreadPool::~SingleTaskThreadPool() {
  stop();
  join();
}

void SingleTaskThreadPool::setRunnable(std::function<void()> runnable) {
  std::lock_guard lock(monitor_);
  runnable_ = std::move(runnable);
}

void SingleTaskThreadPool::addThreads(int n) {
  std::unique_lock lock(monitor_);
  if (stopped_) return;
  const auto self = std::this_thread::get_id();
  for (auto it = retired_.begin(); it != retired_.end();) {
    if (it->get_id() == self) {
      ++it;
      continue;
    }
    it->join();
    it = retired_.erase(it);
  }
  for (int i = 0; i < n; ++i) active_.emplace_back(runnable_);
}

void SingleTaskThreadPool::retireThread(std::thread::id id) {
  std::thread other;
  {
    std::lock_guard lock(monitor_);
    if (stopped_) return;
    auto it = std::find_if(active_.begin(), active_.end(),
                           [&](const std::thread& t) { return t.get_id() == id; });
    if (it == active_.end()) return;
    std::thread thread = std::move(*it);
    active_.erase(it);
    if (id == std::this_thread::get_id()) {
      retired_.push_back(std::move(thread));
      return;
    }
    other = std::move(thread);
  }
  // Another thread is joined outside the monitor, which it may still need.
  other.join();
}

void SingleTaskThreadPool::stop() {
  std::lock_guard lock(monitor_);
  stopped_ = true;
  stoppedChanged_.notify_all();
}

void SingleTaskThreadPool::join() {
  std::vector<std::thread> threads;
  {
    std::unique_lock lock(monitor_);
    stoppedChanged_.wait(lock, [&] { return stopped_; });
    threads.swap(active_);
    for (auto& t : retired_) threads.push_back(std::move(t));
    retired_.clear();
  }
  // Joined outside the monitor: a finishing thread may still call into the
  // pool (addThreads, retireThread), which does nothing once stopped.
  const auto self = std::this_thread::get_id();
  for (auto& t : threads) {
    if (t.get_id() == self) {
      t.detach();  // a pool thread that joins its own pool cannot wait for itself
    } else if (t.joinable()) {
      t.join();
    }
  }
}

std::size_t SingleTaskThreadPool::activeCount() const {
  std::lock_guard lock(monitor_);
  return active_.size();
}

bool SingleTaskThreadPool::stopped() const {
  std::lock_guard lock(monitor_);
  return stopped_;
}

}  // namespace hsdig
