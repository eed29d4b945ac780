// IviEngineBinding: loads the IVI engine library on first use and resolves
// its functions by name; every IviWrapper operation calls the engine through
// it.
//
// Loading tries "libcvivi.so", then "libivi.so" (bare names: the RUNPATH of
// the library finds them beside it). The engine functions and whether each
// is required come from the engine function table. Outcomes:
// - no library loads: every call answers kEngineNotLoaded (0xBFFA0000);
// - a required function is missing: the library is unloaded again, calls
//   answer kEngineFunctionMissing (0xBFFA0009), and the next call retries;
// - an optional function is missing: only calls of it answer
//   kEngineFunctionMissing.
// Value-returning functions answer 0 instead of a status when they cannot
// be called; the class-driver checks answer the load failure, or 0 when only
// the function is absent. Ivi_GetErrorMessage asked about kEngineNotLoaded
// while no engine loads writes kEngineNotLoadedMessage and answers 0.
//
// Threads: any thread may call. Loading is serialized by a process mutex;
// after a successful load the engine stays loaded for the life of the
// process, also when the binding object goes.
#pragma once

#include <atomic>
#include <mutex>
#include <string>
#include <vector>

#include "session/IviEngineTable.h"

namespace hsdig {

inline constexpr ViStatus kEngineNotLoaded = static_cast<ViStatus>(0xBFFA0000);
inline constexpr ViStatus kEngineFunctionMissing = static_cast<ViStatus>(0xBFFA0009);
inline constexpr const char* kEngineNotLoadedMessage = "Unable to load IVI Engine (ivi.dll)";

class IviEngineBinding {
 public:
  // A binding that tries `libraryNames` in order (names or paths for
  // dlopen). The process binding uses defaultLibraryNames(); tests make their
  // own to point at a missing or incomplete engine.
  explicit IviEngineBinding(std::vector<std::string> libraryNames = defaultLibraryNames());
  ~IviEngineBinding();
  IviEngineBinding(const IviEngineBinding&) = delete;
  IviEngineBinding& operator=(const IviEngineBinding&) = delete;

  static std::vector<std::string> defaultLibraryNames();
  // The process-wide binding, created on first use, never destroyed.
  static IviEngineBinding& process();

  // Loads the engine unless it is loaded: 0, kEngineNotLoaded or
  // kEngineFunctionMissing.
  ViStatus load();
  bool isLoaded() const noexcept { return loaded_.load(std::memory_order_acquire); }
  // Why the last load failed (dlopen's text or the missing function names),
  // for diagnostics and tests.
  std::string lastLoadFailure() const;

  // One member per engine function, with the engine function's parameters.
#define HSDIG_IVI_BINDING_DECLARE(cname, method, avail, kind, support, ret, sess, params, args) \
  ret cname params;
  IVI_ENGINE_FUNCTIONS(HSDIG_IVI_BINDING_DECLARE)
#undef HSDIG_IVI_BINDING_DECLARE

 private:
  struct Functions {
#define HSDIG_IVI_BINDING_FIELD(cname, method, avail, kind, support, ret, sess, params, args) \
  decltype(&::cname) cname = nullptr;
    IVI_ENGINE_FUNCTIONS(HSDIG_IVI_BINDING_FIELD)
#undef HSDIG_IVI_BINDING_FIELD
  };

  const std::vector<std::string> libraryNames_;
  mutable std::mutex mutex_;  // serializes loading; guards lastFailure_
  std::atomic<bool> loaded_{false};
  void* handle_ = nullptr;  // written once under mutex_ before loaded_ is set
  Functions functions_;     // likewise
  std::string lastFailure_;
};

}  // namespace hsdig
