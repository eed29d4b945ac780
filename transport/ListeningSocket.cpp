#include "transport/ListeningSocket.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <thrift/transport/TTransportException.h>
#include <unistd.h>

#include <cerrno>

#include "platform/Diagnostic.h"
#include "platform/Retry.h"
#include "platform/Syscalls.h"
#include "transport/SocketAddress.h"

namespace hsdig::transport {

namespace {

using apache::thrift::transport::TTransportException;

[[noreturn]] void creationFailed(int error) {
  platform::reportErrno("TPipeServer::TCreateNamedPipe() GLE=", error);
  throw TTransportException(TTransportException::NOT_OPEN,
                            platform::errnoText("TCreateNamedPipe() failed: ", error));
}

std::string folderOf(const std::string& path) {
  return path.substr(0, path.rfind('/'));
}

// An exclusive lock on "<path>.lock" for the duration of a socket file's
// creation. The lock file stays: removing it would let a waiter lock a file
// that no longer has the name. It is readable by all so that another user
// may later serve the name once this user's server is gone.
class NameLock {
 public:
  int acquire(const std::string& lockPath) {
    constexpr int kFlags = O_RDONLY | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK;
    constexpr mode_t kMode = S_IRUSR | S_IWUSR | S_IRGRP | S_IROTH;
    for (int attempt = 0; attempt < 4 && !fd_; ++attempt) {
      // Opening an existing file without O_CREAT: in a sticky folder the
      // kernel may refuse O_CREAT on another user's file.
      fd_.reset(::open(lockPath.c_str(), kFlags));
      if (fd_) break;
      if (errno != ENOENT) return errno;
      fd_.reset(::open(lockPath.c_str(), kFlags | O_CREAT | O_EXCL, kMode));
      if (fd_) {
        if (::fchmod(fd_.get(), kMode) != 0) return errno;
        break;
      }
      if (errno != EEXIST) return errno;
    }
    if (!fd_) return EAGAIN;
    struct stat info {};
    if (::fstat(fd_.get(), &info) != 0) return errno;
    if (!S_ISREG(info.st_mode)) return EINVAL;
    if (platform::retryOnEintr([&] { return ::flock(fd_.get(), LOCK_EX); }) != 0) return errno;
    return 0;
  }

 private:
  platform::UniqueFd fd_;
};

enum class Probe { kAnswers, kRefuses, kGone, kFailed };

// Whether a server still listens on the socket file at `path`.
Probe probe(const SocketAddress& address, int& error) {
  platform::UniqueFd socket(
      platform::sys::socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
  if (!socket) {
    error = errno;
    return Probe::kFailed;
  }
  const int rc = platform::retryOnEintr(
      [&] { return platform::sys::connect(socket.get(), address.get(), address.length()); });
  if (rc == 0 || errno == EAGAIN) return Probe::kAnswers;
  if (errno == ECONNREFUSED) return Probe::kRefuses;
  if (errno == ENOENT) return Probe::kGone;
  error = errno;
  return Probe::kFailed;
}

}  // namespace

ListeningSocket::ListeningSocket(const PipePath& path, const TPurePermissionManager& manager,
                                 int backlog)
    : path_(path.path) {
  if (path.error != 0) creationFailed(path.error);
  if (path.inSocketFolder) {
    if (const int error = ensureSocketFolder(folderOf(path_)); error != 0) creationFailed(error);
  }
  NameLock lock;
  if (const int error = lock.acquire(path_ + ".lock"); error != 0) creationFailed(error);

  fd_.reset(platform::sys::socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
  if (!fd_) creationFailed(errno);
  const mode_t mode = manager.securityAttributes();
  // bind() creates the file with the socket's own mode less the umask.
  if (::fchmod(fd_.get(), mode) != 0) creationFailed(errno);

  const SocketAddress address(path_);
  struct stat existing {};
  if (::lstat(path_.c_str(), &existing) == 0) {
    manager.checkOwner(path_);
    if (!S_ISSOCK(existing.st_mode)) creationFailed(EADDRINUSE);
    int error = 0;
    switch (probe(address, error)) {
      case Probe::kAnswers:
        creationFailed(EADDRINUSE);
      case Probe::kRefuses:
        if (::unlink(path_.c_str()) != 0 && errno != ENOENT) creationFailed(errno);
        break;
      case Probe::kGone:
        break;
      case Probe::kFailed:
        creationFailed(error);
    }
  } else if (errno != ENOENT) {
    creationFailed(errno);
  }

  if (platform::sys::bind(fd_.get(), address.get(), address.length()) != 0) creationFailed(errno);
  struct stat created {};
  if (::lstat(path_.c_str(), &created) != 0) {
    const int error = errno;
    fd_.reset();
    creationFailed(error);
  }
  device_ = created.st_dev;
  inode_ = created.st_ino;
  fileOwned_ = true;
  // From here the file is ours; a failure removes it again (destructor).
  try {
    // Widening (the everyone mode under a restrictive umask) is safe now.
    if (::chmod(path_.c_str(), mode) != 0) creationFailed(errno);
    manager.checkOwner(path_);
    if (platform::sys::listen(fd_.get(), backlog) != 0) creationFailed(errno);
  } catch (...) {
    removeFile();
    throw;
  }
}

ListeningSocket::~ListeningSocket() {
  removeFile();
}

void ListeningSocket::removeFile() noexcept {
  if (!fileOwned_.exchange(false)) return;
  struct stat current {};
  if (::lstat(path_.c_str(), &current) != 0) return;
  if (current.st_dev == device_ && current.st_ino == inode_) ::unlink(path_.c_str());
}

}  // namespace hsdig::transport
