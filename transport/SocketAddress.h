// The address of a Unix-domain socket file.
#pragma once

#include <sys/socket.h>
#include <sys/un.h>

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <string>

namespace hsdig::transport {

// `path` must fit (resolvePipePath has checked it); a longer one is cut,
// which an unresolved caller would notice as "no such socket".
class SocketAddress {
 public:
  explicit SocketAddress(const std::string& path) {
    address_.sun_family = AF_UNIX;
    const size_t length = std::min(path.size(), sizeof address_.sun_path - 1);
    std::memcpy(address_.sun_path, path.data(), length);
    length_ = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + length + 1);
  }
  const sockaddr* get() const { return reinterpret_cast<const sockaddr*>(&address_); }
  socklen_t length() const { return length_; }

 private:
  sockaddr_un address_{};
  socklen_t length_;
};

}  // namespace hsdig::transport
