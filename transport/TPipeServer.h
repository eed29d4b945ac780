// The server side of a pipe name, as a Thrift server transport.
//
// listen() creates the listening socket file (see ListeningSocket); accept()
// hands out one connected TPipe per client. The permission manager decides
// the file's access mode, the owner check and which peers are admitted: by
// default every local user (TEveryoneIncludingNetworkPermissionManager); the
// pipe servers of this system install a TSameUserPermissionManager.
//
// Threads: one thread accepts at a time; interrupt() and close() may be
// called from any thread.
#pragma once

#include <thrift/transport/TServerTransport.h>

#include <cstdint>
#include <memory>
#include <mutex>
#include <string>

#include "transport/AccessControl.h"
#include "transport/PipeName.h"
#include "transport/TNamedPipeServer.h"

namespace hsdig::transport {

class TPipe;

class TPipeServer : public apache::thrift::transport::TServerTransport {
 public:
  // `pipeName` as for TPipe. Nothing is created before listen().
  explicit TPipeServer(const std::string& pipeName);
  ~TPipeServer() override;

  bool isOpen() const override;
  // Creates the listening socket unless it exists; fails as ListeningSocket.
  void listen() override;
  // Makes a waiting accept and every later one fail.
  void interrupt() override;
  void interruptChildren() override {}
  // Removes the socket file and drops the listening socket.
  void close() override;

  // The permission manager for the next listen (borrowed; it must outlive
  // the server). nullptr restores the default.
  void setPermissionManager(const TPurePermissionManager* manager);

  // accept() for callers that want the pipe itself.
  std::shared_ptr<TPipe> acceptPipe();

  // The socket path.
  const std::string& getPipename() const { return path_.path; }
  // The listen event (see TNamedPipeServer), or -1 before listen and after close.
  int getNativeWaitHandle() const;
  std::shared_ptr<TPipeServerImpl> getImpl() const;

 protected:
  std::shared_ptr<apache::thrift::transport::TTransport> acceptImpl() override;

 private:
  std::shared_ptr<TNamedPipeServer> currentImpl() const;

  const PipePath path_;
  TEveryoneIncludingNetworkPermissionManager defaultManager_;
  const TPurePermissionManager* manager_ = &defaultManager_;
  mutable std::mutex mutex_;  // guards impl_
  std::shared_ptr<TNamedPipeServer> impl_;
};

}  // namespace hsdig::transport
