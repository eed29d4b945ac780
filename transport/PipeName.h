// Pipe names and where their sockets live.
//
// A pipe name is derived from a resource name by pipeNameForResource; client
// and server derive it alike. On Linux a pipe is a Unix-domain stream socket
// file: a bare name lives in the machine-wide socket folder, a Windows pipe
// path "\\.\pipe\NAME" is mapped to that folder, an absolute Linux path is
// used as it stands, and anything else is refused.
#pragma once

#include <string>
#include <string_view>

namespace hsdig::transport {

inline constexpr std::string_view kPipeNamePrefix = "HSDIG_20.0_";
inline constexpr const char* kDefaultSocketFolder = "/tmp/.hsdig-pipes";

// "HSDIG_20.0_" followed by the decimal djb2 hash (unsigned 64-bit, each byte
// taken as signed 8-bit) of the resource name with every white-space byte
// removed and ASCII upper case lowered.
std::string pipeNameForResource(std::string_view resourceName);

// Where a pipe name leads. `error` is 0 for a usable path, else the errno an
// open or a listen reports for it (EINVAL for a refused form, ENAMETOOLONG
// for a path that does not fit a socket address). `inSocketFolder` is true
// when the path lies in the socket folder, which listen creates on demand.
struct PipePath {
  std::string path;
  int error = 0;
  bool inSocketFolder = false;
};
PipePath resolvePipePath(std::string_view pipeName);

// The socket folder: kDefaultSocketFolder unless a test redirected it.
std::string socketFolder();

// Makes sure `folder` is a directory fit to hold sockets of several users:
// created with mode 1777 when missing; an existing one must be a real
// directory (not a symbolic link) and, when others may write to it, sticky.
// Returns 0 or the errno that describes the failure.
int ensureSocketFolder(const std::string& folder);

namespace testing {
// Points the socket folder somewhere else for the rest of the process (an
// empty string restores the default), so that tests running side by side
// never share sockets. Production code never calls this and the folder is
// never taken from the environment.
void setSocketFolderForTesting(const std::string& folder);
}  // namespace testing

}  // namespace hsdig::transport
