// The listening socket of a pipe server and the socket file it owns.
//
// Socket files outlive their processes. Creating one therefore follows a
// protocol, run under an exclusive lock on the file "<path>.lock" (flock: the
// kernel drops it when its holder dies) so that two servers starting at once
// on one name cannot both decide the name is free:
// - no file at the path: bind;
// - a file of another user: the owner check refuses the name;
// - a socket of this user that refuses connections: its server has died;
//   the file is stale and is replaced;
// - a socket of this user that answers, or anything else: the name is in use.
// The file is created with the permission manager's mode (never wider, not
// even for an instant: the mode is set on the socket before bind), then
// owner-checked. The file is removed before the descriptor closes, so a live
// server's file is never seen stale, and only if it is still the very file
// this socket created (same device and inode).
#pragma once

#include <sys/types.h>

#include <atomic>
#include <string>

#include "platform/UniqueFd.h"
#include "transport/AccessControl.h"
#include "transport/PipeName.h"

namespace hsdig::transport {

class ListeningSocket {
 public:
  // Creates, binds and listens. A failure reports "TPipeServer::
  // TCreateNamedPipe() GLE=" and throws TTransportException NOT_OPEN
  // "TCreateNamedPipe() failed: errno = N" (EADDRINUSE when a live server
  // holds the name); the owner check throws its TLocalAuthException.
  ListeningSocket(const PipePath& path, const TPurePermissionManager& manager, int backlog);
  ~ListeningSocket();
  ListeningSocket(const ListeningSocket&) = delete;
  ListeningSocket& operator=(const ListeningSocket&) = delete;

  int fd() const { return fd_.get(); }
  const std::string& path() const { return path_; }

  // Removes the socket file if it is still ours; later calls do nothing. New
  // clients can no longer find the server; connections already queued stay.
  void removeFile() noexcept;

 private:
  std::string path_;
  platform::UniqueFd fd_;
  dev_t device_ = 0;
  ino_t inode_ = 0;
  std::atomic<bool> fileOwned_{false};
};

}  // namespace hsdig::transport
