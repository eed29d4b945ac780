// Serves many pipe connections with few threads.
//
// Connections are spread over workers (IOWorker): each waits on at most 64
// handles and runs a leader/follower pool over them. The first worker also
// holds the accept task, so it takes 62 connections; every later worker 63.
// A worker is created when all existing ones are full and is kept until
// stop, even when it has no connections left.
//
// Lock order, outermost first: the server mutex (workers, stopped), a
// worker's wait lock, that worker's controller mutex, a connection's reply
// lock, a pool's monitor. add() runs on the accepting thread after it has
// handed back its own worker's wait lock.
#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <vector>

#include <thrift/protocol/TBinaryProtocol.h>
#include <thrift/server/TServer.h>

#include "server/HandleWaitPolicy.h"
#include "server/IOMultiTask.h"
#include "server/IOTaskController.h"
#include "server/SingleTaskThreadPool.h"
#include "server/TConcurrentProcessor.h"
#include "transport/TPipe.h"
#include "transport/TPipeServer.h"

namespace hsdig {

class TPureConcurrentServer {
 public:
  virtual ~TPureConcurrentServer() = default;
  virtual void serve() = 0;
  virtual void stop() = 0;
  virtual void join() = 0;
};

struct IOWorker {
  using MultiTask = IOMultiTask<PollWaitPolicy>;
  using Controller = IOTaskController<PollWaitPolicy>;
  // Declared first, destroyed last: the threads are joined before the
  // multi-task they run goes.
  std::shared_ptr<SingleTaskThreadPool> pool;
  std::shared_ptr<MultiTask> multiTask;
  std::shared_ptr<Controller> controller;
};

class TConcurrentServer : public TPureConcurrentServer {
 public:
  static constexpr int64_t kInitialThreads = 3;
  static constexpr uint32_t kMaxFrameSize = 0x10000000;
  static constexpr uint32_t kReplyBufferReclaimThreshold = 1 << 20;

  TConcurrentServer(std::shared_ptr<transport::TPipeServer> pipeServer,
                    std::shared_ptr<TConcurrentProcessorFactory> processorFactory,
                    std::shared_ptr<apache::thrift::protocol::TProtocolFactory> protocolFactory,
                    int64_t initialThreads = kInitialThreads,
                    uint32_t maxFrameSize = kMaxFrameSize);
  ~TConcurrentServer() override;

  // Listens and starts the first worker. Throws TTransportException NOT_OPEN
  // "Server closed very early" after stop, and what listen throws.
  void serve() override;
  // Stops accepting and tells every worker to shut down; running requests
  // finish first. Safe from any thread, also from a worker thread.
  void stop() override;
  // Returns when every thread of every worker has ended. Not from a worker thread.
  void join() override;

  // Places an accepted connection on a worker with room, or on a new one.
  void add(std::shared_ptr<transport::TPipe> connection);

  void setServerEventHandler(std::shared_ptr<apache::thrift::server::TServerEventHandler> h) {
    eventHandler_ = std::move(h);
  }

  // Test views.
  std::size_t workerCount() const;
  int64_t workerTaskCount(std::size_t worker) const;
  std::size_t workerThreadCount(std::size_t worker) const;
  // Test hook: the idle wait of the workers, set before serve (a leader
  // already waiting keeps its wait).
  void setIdleWaitMsForTest(int ms);

 private:
  IOWorker& addWorker(int64_t taskCount);  // with mutex_ held
  void startThreads(IOWorker& worker);

  std::vector<IOWorker> workers_;  // guarded by mutex_
  mutable std::mutex mutex_;
  bool stopped_ = false;  // guarded by mutex_
  std::shared_ptr<transport::TPipeServer> pipeServer_;
  const int64_t initialThreads_;
  const uint32_t maxFrameSize_;
  std::shared_ptr<TConcurrentProcessorFactory> processorFactory_;
  std::shared_ptr<apache::thrift::protocol::TProtocolFactory> protocolFactory_;
  std::shared_ptr<apache::thrift::server::TServerEventHandler> eventHandler_;
  int idleWaitMs_ = IOMultiTask<PollWaitPolicy>::kDefaultWaitTimeoutMs;  // guarded by mutex_
};

}  // namespace hsdig
