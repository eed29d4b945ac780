// Who this process is, and who is at the other end of a local socket.
#pragma once

#include <sys/types.h>

namespace hsdig::platform {

// The effective user id: the user whose rights this process acts with.
uid_t effectiveUserId() noexcept;

struct PeerCredentials {
  pid_t pid = 0;
  uid_t uid = 0;
  gid_t gid = 0;
};

// Reads the credentials the kernel recorded for the peer of a connected
// Unix-domain socket (for a client: the server at listen time; for a server:
// the client at connect time). Returns 0, or the errno of the failure.
int peerCredentials(int socketFd, PeerCredentials& out) noexcept;

}  // namespace hsdig::platform
