#include "server/Server.h"

#include "contract/TransportConfiguration.h"
#include "server/ServerStartObserver.h"
#include "server/hsdigEPConcurrentProcessor.h"
#include "transport/TPipeServer.h"

namespace hsdig {

void ServerBase::stop() {
  if (!server_) return;
  server_->stop();
  server_->join();
  server_.reset();
}

Server::Server(const std::string& pipeName, std::shared_ptr<hsdigEPIf> handler)
    : ServerBase(pipeName) {
  auto handlerFactory = std::make_shared<hsdigEPIfSingletonFactory>(std::move(handler));
  auto processorFactory = std::make_shared<hsdigEPConcurrentProcessorFactory>(handlerFactory);
  auto pipeServer = std::make_shared<transport::TPipeServer>(pipeName);
  pipeServer->setPermissionManager(&permissionManager_);
  auto server = std::make_shared<TConcurrentServer>(pipeServer, processorFactory,
                                                    contract::makeProtocolFactory());
  auto observer = std::make_shared<ServerStartObserver>();
  server->setServerEventHandler(observer);
  server->serve();
  observer->startInterface().waitForStart();
  server_ = std::move(server);
}

Server::~Server() {
  stop();
}

}  // namespace hsdig
