#include "server/TConcurrentServer.h"

#include <thrift/transport/TBufferTransports.h>
#include <thrift/transport/TTransportException.h>

#include "contract/TransportConfiguration.h"
#include "platform/Diagnostic.h"
#include "server/ServerAcceptWatch.h"
#include "server/ServerReadWatch.h"
#include "transport/TStreamingFramedTransport.h"

namespace hsdig {

using apache::thrift::transport::TTransportException;

TConcurrentServer::TConcurrentServer(
    std::shared_ptr<transport::TPipeServer> pipeServer,
    std::shared_ptr<TConcurrentProcessorFactory> processorFactory,
    std::shared_ptr<apache::thrift::protocol::TProtocolFactory> protocolFactory,
    int64_t initialThreads, uint32_t maxFrameSize)
    : pipeServer_(std::move(pipeServer)),
      initialThreads_(initialThreads),
      maxFrameSize_(maxFrameSize),
      processorFactory_(std::move(processorFactory)),
      protocolFactory_(std::move(protocolFactory)) {}

TConcurrentServer::~TConcurrentServer() {
  stop();
  join();
}

IOWorker& TConcurrentServer::addWorker(int64_t taskCount) {
  IOWorker worker;
  worker.pool = std::make_shared<SingleTaskThreadPool>();
  worker.multiTask = std::make_shared<IOWorker::MultiTask>(*worker.pool);
  worker.multiTask->setWaitTimeoutMs(idleWaitMs_);
  worker.controller = std::make_shared<IOWorker::Controller>(*worker.multiTask, taskCount);
  {
    // The worker is not running yet; the lock only satisfies the contract
    // that the task list changes under it.
    UniqueGuard guard(worker.multiTask->waitLock());
    worker.multiTask->addIOTask(worker.controller, guard);
  }
  std::weak_ptr<IOWorker::MultiTask> runnable = worker.multiTask;
  worker.pool->setRunnable([runnable] {
    if (auto multi = runnable.lock()) multi->run();
  });
  workers_.push_back(std::move(worker));
  return workers_.back();
}

void TConcurrentServer::startThreads(IOWorker& worker) {
  worker.pool->addThreads(static_cast<int>(initialThreads_));
}

void TConcurrentServer::serve() {
  IOWorker* first = nullptr;
  {
    std::lock_guard lock(mutex_);
    if (stopped_) {
      throw TTransportException(TTransportException::NOT_OPEN, "Server closed very early");
    }
    first = &addWorker(2);
    auto accept = std::make_shared<ServerAcceptWatch>(*this, *first->multiTask, pipeServer_);
    pipeServer_->listen();
    UniqueGuard guard(first->multiTask->waitLock());
    first->multiTask->addIOTask(accept, guard);
    first->multiTask->refreshHandles();
  }
  if (eventHandler_) eventHandler_->preServe();
  startThreads(*first);
}

void TConcurrentServer::add(std::shared_ptr<transport::TPipe> connection) {
  try {
    auto config = contract::makeTransportConfiguration();
    auto inputBuffer = std::make_shared<apache::thrift::transport::TMemoryBuffer>(config);
    auto input = protocolFactory_->getProtocol(inputBuffer);
    // Large reply fields are sent from the handler's own memory; a reply
    // buffer grown beyond the reclaim threshold is given back once sent.
    auto framed = std::make_shared<transport::TStreamingFramedTransport>(
        connection, config, transport::TStreamingFramedTransport::DirectWrites::kOn,
        kReplyBufferReclaimThreshold);
    auto output = protocolFactory_->getProtocol(framed);
    apache::thrift::TConnectionInfo info{input, output, connection};
    auto processor = processorFactory_->getProcessor(info);
    auto task = std::make_shared<ServerReadWatch>(*this, eventHandler_, input, output, inputBuffer,
                                                  connection, processor, maxFrameSize_);

    std::lock_guard lock(mutex_);
    if (stopped_) return;
    for (auto& worker : workers_) {
      task->setWorker(worker.multiTask.get(), worker.controller.get());
      if (worker.controller->tryAddTask(task)) return;
    }
    IOWorker& worker = addWorker(1);
    task->setWorker(worker.multiTask.get(), worker.controller.get());
    worker.controller->tryAddTask(task);
    worker.multiTask->refreshHandles();
    startThreads(worker);
  } catch (...) {
    platform::reportLine("TConcurrentServer::add failed, dropping connection");
  }
}

void TConcurrentServer::stop() {
  std::vector<IOWorker> workers;
  {
    std::lock_guard lock(mutex_);
    stopped_ = true;
    workers = workers_;
  }
  for (auto& worker : workers) {
    worker.pool->stop();
    worker.controller->postStop();
  }
}

void TConcurrentServer::join() {
  std::vector<IOWorker> workers;
  {
    std::lock_guard lock(mutex_);
    workers = workers_;
  }
  for (auto& worker : workers) worker.pool->join();
}

std::size_t TConcurrentServer::workerCount() const {
  std::lock_guard lock(mutex_);
  return workers_.size();
}

int64_t TConcurrentServer::workerTaskCount(std::size_t worker) const {
  std::lock_guard lock(mutex_);
  return worker < workers_.size() ? workers_[worker].controller->taskCount() : -1;
}

std::size_t TConcurrentServer::workerThreadCount(std::size_t worker) const {
  std::lock_guard lock(mutex_);
  return worker < workers_.size() ? workers_[worker].pool->activeCount() : 0;
}

void TConcurrentServer::setIdleWaitMsForTest(int ms) {
  std::lock_guard lock(mutex_);
  idleWaitMs_ = ms;
  for (auto& worker : workers_) worker.multiTask->setWaitTimeoutMs(ms);
}

}  // namespace hsdig
