// The library's exceptions.
//
// Inside the library failures are exceptions; every export catches them at
// its boundary and turns them into a ViStatus (RemoteErrorConverter).
// - ExceptionBase: anything that carries a Status.
// - Exception: the library's own failure; its Status records the throw site.
// - HostErrorException: a driver status code with its text, raised where a
//   status reported by the other side (or read from a session) is an error.
#pragma once

#include <cstdint>
#include <exception>
#include <source_location>
#include <string>

#include "errors/Status.h"

namespace hsdig {

class ExceptionBase : public std::exception {
 public:
  ~ExceptionBase() override = default;
  virtual const Status& status() const noexcept = 0;
};

class Exception : public ExceptionBase {
 public:
  // A failure with `code`, thrown at `where`.
  explicit Exception(int32_t code,
                     const std::source_location& where = std::source_location::current());
  // A failure carrying a copy of `status` (code and description). The throw
  // site is recorded unless the status already holds a source location.
  explicit Exception(const Status& status,
                     const std::source_location& where = std::source_location::current());

  const Status& status() const noexcept override { return status_; }
  Status& status() noexcept { return status_; }
  const std::source_location& where() const noexcept { return where_; }
  const char* what() const noexcept override { return what_.c_str(); }

 private:
  Status status_;
  std::source_location where_;
  std::string what_;
};

class HostErrorException : public std::exception {
 public:
  // `text` is copied; a null text reads as empty.
  HostErrorException(int32_t code, const char* text);
  HostErrorException(int32_t code, std::string text) : code_(code), text_(std::move(text)) {}
  HostErrorException(const HostErrorException&) = default;
  HostErrorException& operator=(const HostErrorException&) = default;

  int32_t code() const noexcept { return code_; }
  const std::string& text() const noexcept { return text_; }
  const char* what() const noexcept override { return text_.c_str(); }

 private:
  int32_t code_;
  std::string text_;
};

// Throws Exception(code) at the caller's site when `code` is negative.
inline void throwIfError(int32_t code,
                         const std::source_location& where = std::source_location::current()) {
  if (code < 0) throw Exception(code, where);
}

}  // namespace hsdig
