// The optional translator manager library and the translators it makes.
//
// The process-wide instance loads "libcvxlator.so" once, on first use, and
// resolves the four entry points by name; when the library is absent or an
// entry point is missing, the built-in translator is used and the reason is
// kept ("failed to cvdynlib_load library", "cvdynlib_symbol"). The library
// stays loaded until the process ends. Loading is thread-safe; the sessions
// and translators it hands out are used by one thread at a time.
#pragma once

#include <memory>
#include <string>

#include "errors/translator/Translator.h"
#include "errors/translator/cvxlatormgr.h"

namespace hsdig::translator {

inline constexpr const char* kManagerLibraryName = "libcvxlator.so";

class ManagerLibrary {
 public:
  // Loads the library at `path` (a bare name is searched as dlopen does).
  explicit ManagerLibrary(const std::string& path);
  ~ManagerLibrary();
  ManagerLibrary(const ManagerLibrary&) = delete;
  ManagerLibrary& operator=(const ManagerLibrary&) = delete;

  // The process-wide instance over kManagerLibraryName.
  static ManagerLibrary& process();

  bool available() const noexcept { return handle_ != nullptr; }
  // Why the library is not available ("" when it is).
  const std::string& failure() const noexcept { return failure_; }

  cvxlatormgr_createSession_fn createSession = nullptr;
  cvxlatormgr_destroySession_fn destroySession = nullptr;
  cvxlatormgr_createXlator_fn createXlator = nullptr;
  cvxlatormgr_destroyXlator_fn destroyXlator = nullptr;

 private:
  void* handle_ = nullptr;
  std::string failure_;
};

// One session of the manager library. Throws TranslationFailure
// ("failed to allocate Session memory") when the manager cannot make one.
class ManagerSession {
 public:
  explicit ManagerSession(ManagerLibrary& library);
  ~ManagerSession();
  ManagerSession(const ManagerSession&) = delete;
  ManagerSession& operator=(const ManagerSession&) = delete;

  // A translator of that name, owned by the caller.
  std::unique_ptr<XlatorInterface> createXlator(const std::string& name);

 private:
  ManagerLibrary& library_;
  void* session_ = nullptr;
};

}  // namespace hsdig::translator
