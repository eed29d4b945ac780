#include "transport/AccessControl.h"

#include <sys/stat.h>

#include <cerrno>

#include "platform/Diagnostic.h"
#include "transport/TLocalAuthException.h"

namespace hsdig::transport {

namespace {
constexpr mode_t kOwnerOnlyMode = S_IRUSR | S_IWUSR;
// Connecting to a Unix-domain socket needs write permission on its file.
constexpr mode_t kEveryoneMode = S_IRUSR | S_IWUSR | S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;
constexpr uid_t kRoot = 0;
}  // namespace

TMyUserAccountSid::TMyUserAccountSid() : uid_(platform::effectiveUserId()) {}

void checkOwnerEqual(const TMyUserAccountSid& user, const std::string& socketPath) {
  struct stat info {};
  if (::lstat(socketPath.c_str(), &info) != 0) {
    platform::reportErrno("checkOwnerEqual::GetSecurityInfo errored WinError=", errno);
    throw TLocalAuthException("checkOwnerEqual::GetSecurityInfo");
  }
  if (info.st_uid != user.uid())
    throw TLocalAuthException("checkOwnerEqual: Current user is no longer pipe owner!");
}

bool canHandleOwnerControlTarget(const TMyUserAccountSid& user, int fd) {
  platform::PeerCredentials server;
  if (const int error = platform::peerCredentials(fd, server); error != 0) {
    platform::reportErrno("canHandleOwnerControlTarget::GetSecurityInfo errored WinError=", error);
    throw TLocalAuthException("canHandleOwnerControlTarget::GetSecurityInfo");
  }
  return server.uid == user.uid() || server.uid == kRoot;
}

mode_t TSameUserPermissionManager::securityAttributes() const {
  return kOwnerOnlyMode;
}

void TSameUserPermissionManager::checkOwner(const std::string& socketPath) const {
  checkOwnerEqual(user_, socketPath);
}

bool TSameUserPermissionManager::admitsPeer(const platform::PeerCredentials& peer) const {
  return peer.uid == user_.uid() || peer.uid == kRoot;
}

mode_t TEveryoneIncludingNetworkPermissionManager::securityAttributes() const {
  return kEveryoneMode;
}

void TEveryoneIncludingNetworkPermissionManager::checkOwner(const std::string& socketPath) const {
  checkOwnerEqual(user_, socketPath);
}

bool TEveryoneIncludingNetworkPermissionManager::admitsPeer(
    const platform::PeerCredentials&) const {
  return true;
}

bool TServerIsSameUserAccessVerifier::verify(int fd) const {
  return canHandleOwnerControlTarget(user_, fd);
}

}  // namespace hsdig::transport
