// The working part of a TPipeServer: one listening socket and the
// connection that is ready to be handed out next.
//
// The listen event (the native wait handle) is an epoll descriptor over the
// listening socket and an event; it polls readable when accept() would not
// wait: a client is pending in the backlog, a client was already taken in
// ahead ("cached"), or the server was interrupted (accept then fails).
// After handing out a client the server at once takes in the next pending
// one, if any, so the wait handle stays ready while clients queue.
//
// Each accepted peer is checked against the permission manager by its
// credentials; a refused peer is disconnected and never handed out.
//
// Threads: one thread accepts at a time; interrupt() and close() may be
// called from any thread, also while accept() waits.
#pragma once

#include <memory>
#include <mutex>

#include "platform/EventFd.h"
#include "platform/UniqueFd.h"
#include "transport/AccessControl.h"
#include "transport/ListeningSocket.h"
#include "transport/PipeName.h"

namespace hsdig::transport {

class TPipe;

class TPipeServerImpl {
 public:
  virtual ~TPipeServerImpl() = default;
  virtual void interrupt() = 0;
  virtual std::shared_ptr<TPipe> acceptImpl() = 0;
  virtual int getPipeHandle() const = 0;
  virtual int getNativeWaitHandle() const = 0;
};

class TNamedPipeServer : public TPipeServerImpl {
 public:
  // Creates the listening socket (see ListeningSocket for its failures) and
  // takes in a client that is already waiting. `manager` is borrowed and
  // must outlive the server.
  TNamedPipeServer(const PipePath& path, int backlog, const TPurePermissionManager& manager);
  ~TNamedPipeServer() override;

  // Makes a waiting accept and every later one fail, and drops the client
  // taken in ahead. The socket file stays until close or destruction.
  void interrupt() override;
  // interrupt(), and the socket file is removed.
  void close();

  // Returns the next admitted client, waiting for one if none is ready.
  // Failures report "TPipeServer ConnectNamedPipe GLE=" and throw
  // TTransportException NOT_OPEN "TPipeServer: client connection failed"
  // (ECANCELED after interrupt); after close(): NOT_OPEN "TNamedPipeServer:
  // someone called accept on a closed pipe server".
  std::shared_ptr<TPipe> acceptImpl() override;

  int getPipeHandle() const override { return listener_.fd(); }
  int getNativeWaitHandle() const override { return waitSet_.get(); }

 private:
  // Takes in a client already pending, if any. Called with mutex_ held.
  void initiateNextConnection();
  // Whether the peer of `client` may stay; a refused one is reported.
  bool admits(int client) const;
  [[noreturn]] void acceptFailed(int error);
  // The cached client or the interruption keep the listen event set.
  void updateListenEvent();

  const TPurePermissionManager& manager_;
  ListeningSocket listener_;       // immutable; the descriptor lives as long as this
  platform::EventFd listenEvent_;  // set while cachedClient_ or cancelled_
  platform::UniqueFd waitSet_;     // epoll over listener_ and listenEvent_

  std::mutex mutex_;  // guards the members below
  platform::UniqueFd cachedClient_;
  bool stopping_ = false;   // no client is taken in ahead any more
  bool cancelled_ = false;  // accept fails
  bool closed_ = false;     // the socket file is gone
};

}  // namespace hsdig::transport
