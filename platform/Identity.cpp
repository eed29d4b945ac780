#include "platform/Identity.h"

#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>

namespace hsdig::platform {

uid_t effectiveUserId() noexcept {
  return ::geteuid();
}

int peerCredentials(int socketFd, PeerCredentials& out) noexcept {
  ucred cred{};
  socklen_t length = sizeof cred;
  if (::getsockopt(socketFd, SOL_SOCKET, SO_PEERCRED, &cred, &length) != 0) return errno;
  if (length != sizeof cred) return EPROTO;
  out.pid = cred.pid;
  out.uid = cred.uid;
  out.gid = cred.gid;
  return 0;
}

}  // namespace hsdig::platform
