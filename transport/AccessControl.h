// Who may serve a pipe name and who may talk to whom.
//
// Server side: a permission manager decides the access mode of the socket
// file it creates, checks that the socket file is owned by this process's
// user (so that another user cannot have taken the name first) and admits or
// refuses each connecting peer by its user id. Client side: an access
// verifier decides whether the process serving the socket is trusted.
//
// On Linux a user is a user id; "the same user" means the same effective uid,
// or root, which stands where SYSTEM and the administrators stand on the
// platform this design comes from. The owner check is exact: a socket file
// of any other user, root included, is not ours.
//
// Managers and verifiers are built once and then only read; their checks may
// run on any thread.
#pragma once

#include <sys/types.h>

#include <cstdint>
#include <string>

#include "platform/Identity.h"

namespace hsdig::transport {

// The user this process acts as (its effective uid), taken at construction.
class TMyUserAccountSid {
 public:
  TMyUserAccountSid();
  uid_t uid() const noexcept { return uid_; }

 private:
  uid_t uid_;
};

// Throws TLocalAuthException "checkOwnerEqual: Current user is no longer pipe
// owner!" unless the file at `socketPath` belongs to `user`; a file that
// cannot be examined throws "checkOwnerEqual::GetSecurityInfo".
void checkOwnerEqual(const TMyUserAccountSid& user, const std::string& socketPath);

// Whether the process serving the connected socket `fd` may be trusted by
// `user`: it runs as that user or as root. Throws TLocalAuthException
// "canHandleOwnerControlTarget::GetSecurityInfo" when the peer's credentials
// cannot be read.
bool canHandleOwnerControlTarget(const TMyUserAccountSid& user, int fd);

class TPurePermissionManager {
 public:
  virtual ~TPurePermissionManager() = default;
  // The access mode of the socket file the server creates.
  virtual mode_t securityAttributes() const = 0;
  // Throws unless the socket file at `socketPath` belongs to this process's user.
  virtual void checkOwner(const std::string& socketPath) const = 0;
  // Whether an accepted peer with these credentials may stay connected. The
  // file mode already keeps others out; this also covers a mode changed
  // after creation and peers that reached the socket some other way.
  virtual bool admitsPeer(const platform::PeerCredentials& peer) const = 0;
};

// Only this process's user (and root) may open the socket or stay connected.
class TSameUserPermissionManager : public TPurePermissionManager {
 public:
  TSameUserPermissionManager() = default;
  TSameUserPermissionManager(const TSameUserPermissionManager&) = delete;
  TSameUserPermissionManager& operator=(const TSameUserPermissionManager&) = delete;

  mode_t securityAttributes() const override;
  void checkOwner(const std::string& socketPath) const override;
  bool admitsPeer(const platform::PeerCredentials& peer) const override;

 private:
  TMyUserAccountSid user_;
};

// Every local user may open the socket and talk; only this user owns it.
class TEveryoneIncludingNetworkPermissionManager : public TPurePermissionManager {
 public:
  TEveryoneIncludingNetworkPermissionManager() = default;
  TEveryoneIncludingNetworkPermissionManager(const TEveryoneIncludingNetworkPermissionManager&) =
      delete;
  TEveryoneIncludingNetworkPermissionManager& operator=(
      const TEveryoneIncludingNetworkPermissionManager&) = delete;

  mode_t securityAttributes() const override;
  void checkOwner(const std::string& socketPath) const override;
  bool admitsPeer(const platform::PeerCredentials& peer) const override;

 private:
  TMyUserAccountSid user_;
};

class TPureAccessVerifier {
 public:
  virtual ~TPureAccessVerifier() = default;
  // Extra open flags of the platform this design comes from; they carry no
  // meaning for a Unix-domain connect and are kept for callers that read them.
  virtual uint32_t openFlags() const = 0;
  // Whether the server at the other end of the connected socket `fd` is trusted.
  virtual bool verify(int fd) const = 0;
};

// Trusts every server.
class TDoNotCareAccessVerifier : public TPureAccessVerifier {
 public:
  uint32_t openFlags() const override { return 0; }
  bool verify(int) const override { return true; }
};

// Trusts a server that runs as this process's user or as root.
class TServerIsSameUserAccessVerifier : public TPureAccessVerifier {
 public:
  static constexpr uint32_t kOpenFlags = 0x00100000;

  TServerIsSameUserAccessVerifier() = default;
  TServerIsSameUserAccessVerifier(const TServerIsSameUserAccessVerifier&) = delete;
  TServerIsSameUserAccessVerifier& operator=(const TServerIsSameUserAccessVerifier&) = delete;

  uint32_t openFlags() const override { return kOpenFlags; }
  bool verify(int fd) const override;

 private:
  TMyUserAccountSid user_;
};

}  // namespace hsdig::transport
