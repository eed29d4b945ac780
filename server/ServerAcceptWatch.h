// The task that accepts connections: it waits on the pipe server's listen
// handle and passes each accepted connection to the server for placement.
#pragma once

#include <memory>

#include "server/HandleWaitPolicy.h"
#include "server/IOMultiTask.h"
#include "server/IOTask.h"
#include "transport/TPipeServer.h"

namespace hsdig {

class TConcurrentServer;

class ServerAcceptWatch : public IOTask {
 public:
  ServerAcceptWatch(TConcurrentServer& server, IOMultiTask<PollWaitPolicy>& multiTask,
                    std::shared_ptr<transport::TPipeServer> pipeServer)
      : server_(server), multiTask_(multiTask), pipeServer_(std::move(pipeServer)) {}
  // Interrupts the pipe server, so no accept outlives the task.
  ~ServerAcceptWatch() override;

  int getWaitHandle() override { return pipeServer_->getNativeWaitHandle(); }
  // Accepts one connection; a failed accept tears the whole server down.
  void process(UniqueGuard& guard) override;

 private:
  TConcurrentServer& server_;
  IOMultiTask<PollWaitPolicy>& multiTask_;
  std::shared_ptr<transport::TPipeServer> pipeServer_;
};

}  // namespace hsdig
