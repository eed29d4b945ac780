// Sole owner of one file descriptor.
//
// The descriptor is closed when the owner is destroyed or reset; ownership
// moves, it is never copied. A value of -1 means "owns nothing".
#pragma once

#include <utility>

namespace hsdig::platform {

class UniqueFd {
 public:
  UniqueFd() noexcept = default;
  explicit UniqueFd(int fd) noexcept : fd_(fd) {}
  UniqueFd(UniqueFd&& other) noexcept : fd_(other.release()) {}
  UniqueFd& operator=(UniqueFd&& other) noexcept {
    if (this != &other) reset(other.release());
    return *this;
  }
  UniqueFd(const UniqueFd&) = delete;
  UniqueFd& operator=(const UniqueFd&) = delete;
  ~UniqueFd() { reset(); }

  int get() const noexcept { return fd_; }
  bool valid() const noexcept { return fd_ >= 0; }
  explicit operator bool() const noexcept { return valid(); }

  // Gives up ownership without closing.
  int release() noexcept { return std::exchange(fd_, -1); }
  // Closes the owned descriptor (if any) and takes `fd`. close() is never
  // retried on EINTR: on Linux the descriptor is gone either way.
  void reset(int fd = -1) noexcept;

 private:
  int fd_ = -1;
};

}  // namespace hsdig::platform
