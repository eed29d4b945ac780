// One served pipe name: the pipe server with the same-user permission
// manager, the concurrent server over it, and the handler that answers.
//
// Constructing a Server returns only once it serves; stop() ends serving and
// joins every thread. The handler is the one object that all connections
// call; it must be safe for concurrent calls.
#pragma once

#include <memory>
#include <string>

#include "hsdigEP.h"
#include "server/TConcurrentServer.h"
#include "transport/AccessControl.h"

namespace hsdig {

class ServerInterface {
 public:
  virtual ~ServerInterface() = default;
  virtual const std::string& name() const = 0;
  virtual void stop() = 0;
};

class ServerBase : public ServerInterface {
 public:
  explicit ServerBase(std::string name) : name_(std::move(name)) {}
  const std::string& name() const override { return name_; }
  // Stops and joins the concurrent server, then drops it. Idempotent.
  void stop() override;

 protected:
  std::string name_;
  std::shared_ptr<TConcurrentServer> server_;
};

class Server : public ServerBase {
 public:
  // Serves `pipeName` (a name made by pipeNameForResource) with `handler`.
  // Throws what listening throws (for example when another live server owns
  // the name); nothing is left behind then.
  Server(const std::string& pipeName, std::shared_ptr<hsdigEPIf> handler);
  ~Server() override;

  // Test view of the running concurrent server (null after stop).
  std::shared_ptr<TConcurrentServer> concurrentServer() const { return server_; }

 private:
  transport::TSameUserPermissionManager permissionManager_;
};

}  // namespace hsdig
