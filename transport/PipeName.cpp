#include "transport/PipeName.h"

#include <sys/stat.h>
#include <sys/un.h>

#include <cerrno>
#include <cstdint>
#include <mutex>

namespace hsdig::transport {

namespace {

constexpr std::string_view kWindowsPipePrefix = "\\\\.\\pipe\\";

std::mutex& folderMutex() {
  static std::mutex mutex;
  return mutex;
}
std::string& folderOverride() {
  static std::string folder;
  return folder;
}

bool isWhiteSpace(char c) {
  return c == ' ' || c == '\t' || c == '\n' || c == '\v' || c == '\f' || c == '\r';
}

bool startsWithIgnoringAsciiCase(std::string_view text, std::string_view prefix) {
  if (text.size() < prefix.size()) return false;
  for (size_t i = 0; i < prefix.size(); ++i) {
    char a = text[i], b = prefix[i];
    if (a >= 'A' && a <= 'Z') a = static_cast<char>(a - 'A' + 'a');
    if (b >= 'A' && b <= 'Z') b = static_cast<char>(b - 'A' + 'a');
    if (a != b) return false;
  }
  return true;
}

// A name that may stand as one file name inside the socket folder.
bool isPlainFileName(std::string_view name) {
  return !name.empty() && name != "." && name != ".." &&
         name.find_first_of(std::string_view("/\0", 2)) == std::string_view::npos;
}

PipePath checked(PipePath result) {
  if (result.error == 0 && result.path.size() >= sizeof(sockaddr_un::sun_path))
    result.error = ENAMETOOLONG;
  return result;
}

}  // namespace

std::string pipeNameForResource(std::string_view resourceName) {
  uint64_t hash = 5381;
  for (const char c : resourceName) {
    if (isWhiteSpace(c)) continue;
    const char lowered = (c >= 'A' && c <= 'Z') ? static_cast<char>(c - 'A' + 'a') : c;
    const auto byte = static_cast<int64_t>(static_cast<int8_t>(lowered));
    hash = hash * 33 + static_cast<uint64_t>(byte);
  }
  return std::string(kPipeNamePrefix) + std::to_string(hash);
}

PipePath resolvePipePath(std::string_view pipeName) {
  if (pipeName.find(std::string_view("\0", 1)) != std::string_view::npos)
    return {std::string(pipeName), EINVAL, false};
  if (pipeName.find("\\\\") != std::string_view::npos) {
    // A full Windows path. Only the local pipe namespace has a meaning here.
    if (!startsWithIgnoringAsciiCase(pipeName, kWindowsPipePrefix))
      return {std::string(pipeName), EINVAL, false};
    pipeName.remove_prefix(kWindowsPipePrefix.size());
  } else if (!pipeName.empty() && pipeName.front() == '/') {
    return checked({std::string(pipeName), 0, false});
  }
  if (!isPlainFileName(pipeName)) return {std::string(pipeName), EINVAL, false};
  return checked({socketFolder() + "/" + std::string(pipeName), 0, true});
}

std::string socketFolder() {
  std::lock_guard lock(folderMutex());
  return folderOverride().empty() ? std::string(kDefaultSocketFolder) : folderOverride();
}

int ensureSocketFolder(const std::string& folder) {
  constexpr mode_t kFolderMode = S_ISVTX | S_IRWXU | S_IRWXG | S_IRWXO;
  if (::mkdir(folder.c_str(), kFolderMode) == 0) {
    // mkdir applies the umask; the folder is meant for every user.
    if (::chmod(folder.c_str(), kFolderMode) != 0) return errno;
    return 0;
  }
  if (errno != EEXIST) return errno;
  struct stat info {};
  if (::lstat(folder.c_str(), &info) != 0) return errno;
  if (!S_ISDIR(info.st_mode)) return ENOTDIR;
  // Others who may write into a folder that is not sticky could remove or
  // replace this user's sockets.
  if ((info.st_mode & (S_IWGRP | S_IWOTH)) != 0 && (info.st_mode & S_ISVTX) == 0) return EPERM;
  return 0;
}

namespace testing {
void setSocketFolderForTesting(const std::string& folder) {
  std::lock_guard lock(folderMutex());
  folderOverride() = folder;
}
}  // namespace testing

}  // namespace hsdig::transport
