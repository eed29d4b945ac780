// Lets the builder of a server wait until the server has started serving.
#pragma once

#include <condition_variable>
#include <mutex>

#include <thrift/server/TServer.h>

namespace hsdig {

class ServerStartObserverInterface {
 public:
  virtual ~ServerStartObserverInterface() = default;
  virtual void notifyStarted() = 0;
  virtual void waitForStart() = 0;
};

// The server's event handler: its pre-serve hook marks the server started.
// The per-connection context hooks keep the library's defaults (none).
class ServerStartObserver : public apache::thrift::server::TServerEventHandler,
                            private ServerStartObserverInterface {
 public:
  void preServe() override { notifyStarted(); }
  void notifyStarted() override {
    std::lock_guard lock(monitor_);
    started_ = true;
    startedChanged_.notify_all();
  }
  void waitForStart() override {
    std::unique_lock lock(monitor_);
    startedChanged_.wait(lock, [&] { return started_; });
  }
  ServerStartObserverInterface& startInterface() { return *this; }

 private:
  std::mutex monitor_;
  std::condition_variable startedChanged_;
  bool started_ = false;  // guarded by monitor_
};

}  // namespace hsdig
