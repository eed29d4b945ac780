#include "server/ServerAcceptWatch.h"

#include "platform/Diagnostic.h"
#include "server/TConcurrentServer.h"

namespace hsdig {

ServerAcceptWatch::~ServerAcceptWatch() {
  try {
    pipeServer_->interrupt();
  } catch (...) {
    // The server is going away; an interrupt that fails has nothing to stop.
  }
}

void ServerAcceptWatch::process(UniqueGuard& guard) {
  std::shared_ptr<transport::TPipe> connection;
  try {
    connection = pipeServer_->acceptPipe();
  } catch (...) {
    platform::reportLine("ServerAcceptWatch accept failed, tearing down server");
    TConcurrentServer& server = server_;  // shutdown below destroys this task
    multiTask_.shutdown(guard);
    if (guard.owns_lock()) guard.unlock();
    server.stop();
    return;
  }
  if (guard.owns_lock()) guard.unlock();
  server_.add(std::move(connection));
}

}  // namespace hsdig
