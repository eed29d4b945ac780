#include "session/IviEngineBinding.h"

#include <dlfcn.h>

#include <cstring>

namespace hsdig {
namespace {

// What a call answers when the engine cannot be used, by row kind.
#define HSDIG_IVI_LOAD_FAILED_STATUS(ret, st) (st)
#define HSDIG_IVI_LOAD_FAILED_CLASS(ret, st) (st)
#define HSDIG_IVI_LOAD_FAILED_VALUE(ret, st) (ret{})
#define HSDIG_IVI_ABSENT_STATUS(ret) kEngineFunctionMissing
#define HSDIG_IVI_ABSENT_CLASS(ret) (ret{})
#define HSDIG_IVI_ABSENT_VALUE(ret) (ret{})

// One tag type per engine function, so that a function with its own
// load-failure answer can overload loadFailed().
#define HSDIG_IVI_TAG(cname, method, avail, kind, support, ret, sess, params, args) \
  struct Tag_##cname {};
IVI_ENGINE_FUNCTIONS(HSDIG_IVI_TAG)
#undef HSDIG_IVI_TAG

template <class Tag, class... Args>
ViStatus loadFailed(Tag, ViStatus status, Args&&...) {
  return status;
}

// Callers ask the engine for the text of its own load failure: they get it
// although there is no engine to ask.
ViStatus loadFailed(Tag_Ivi_GetErrorMessage, ViStatus status, ViStatus statusCode,
                    ViChar* message) {
  if (status != kEngineNotLoaded || statusCode != kEngineNotLoaded || !message) return status;
  std::memcpy(message, kEngineNotLoadedMessage, std::strlen(kEngineNotLoadedMessage) + 1);
  return VI_SUCCESS;
}

// dlopen of a bare name searches the RUNPATH of the object that calls it.
// When a sanitizer runtime interposes dlopen, the caller is that runtime and
// the RUNPATH is lost; the folders it names ($ORIGIN and $ORIGIN/../lib of
// the object holding this code) are therefore also tried explicitly.
void* openLibrary(const std::string& name, std::string& failure) {
  if (void* handle = dlopen(name.c_str(), RTLD_NOW | RTLD_LOCAL)) return handle;
  const char* why = dlerror();
  failure += (why ? why : name) + std::string("\n");
  if (name.find('/') != std::string::npos) return nullptr;
  Dl_info self{};
  if (!dladdr(reinterpret_cast<void*>(&openLibrary), &self) || !self.dli_fname) return nullptr;
  std::string origin = self.dli_fname;
  const size_t slash = origin.rfind('/');
  if (slash == std::string::npos) return nullptr;
  origin.resize(slash);
  for (const std::string& folder : {origin, origin + "/../lib"}) {
    const std::string path = folder + "/" + name;
    if (void* handle = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL)) return handle;
    dlerror();
  }
  return nullptr;
}

}  // namespace

IviEngineBinding::IviEngineBinding(std::vector<std::string> libraryNames)
    : libraryNames_(std::move(libraryNames)) {}

// A loaded engine stays loaded for the life of the process, whichever
// binding loaded it: its sessions, and pointers it handed out, outlive any
// one binding object.
IviEngineBinding::~IviEngineBinding() = default;

std::vector<std::string> IviEngineBinding::defaultLibraryNames() {
  return {"libcvivi.so", "libivi.so"};
}

IviEngineBinding& IviEngineBinding::process() {
  static auto* binding = new IviEngineBinding();  // stays loaded until the process ends
  return *binding;
}

std::string IviEngineBinding::lastLoadFailure() const {
  std::lock_guard lock(mutex_);
  return lastFailure_;
}

ViStatus IviEngineBinding::load() {
  if (isLoaded()) return VI_SUCCESS;
  std::lock_guard lock(mutex_);
  if (isLoaded()) return VI_SUCCESS;  // another thread loaded it meanwhile
  void* handle = nullptr;
  lastFailure_.clear();
  for (const auto& name : libraryNames_) {
    handle = openLibrary(name, lastFailure_);
    if (handle) break;
  }
  if (!handle) return kEngineNotLoaded;

  Functions found;
  std::string missing;
#define HSDIG_IVI_RESOLVE(cname, method, avail, kind, support, ret, sess, params, args) \
  found.cname = reinterpret_cast<decltype(found.cname)>(dlsym(handle, #cname));         \
  if (!found.cname && HSDIG_IVI_IS_REQUIRED(avail)) missing += #cname " ";
  IVI_ENGINE_FUNCTIONS(HSDIG_IVI_RESOLVE)
#undef HSDIG_IVI_RESOLVE
  if (!missing.empty()) {
    // Not this engine: let the next call try again from the start.
    dlclose(handle);
    lastFailure_ = "missing required engine functions: " + missing;
    return kEngineFunctionMissing;
  }
  functions_ = found;
  handle_ = handle;
  loaded_.store(true, std::memory_order_release);
  return VI_SUCCESS;
}

#define HSDIG_IVI_BINDING_DEFINE(cname, method, avail, kind, support, ret, sess, params, args) \
  ret IviEngineBinding::cname params {                                                         \
    if (ViStatus st = load(); st != VI_SUCCESS) {                                              \
      (void)st;                                                                                \
      return IVI_ENGINE_CAT(HSDIG_IVI_LOAD_FAILED_, kind)(                                     \
          ret, loadFailed(Tag_##cname{}, st, HSDIG_IVI_UNPAREN args));                         \
    }                                                                                          \
    if (!functions_.cname) return IVI_ENGINE_CAT(HSDIG_IVI_ABSENT_, kind)(ret);                \
    return functions_.cname args;                                                              \
  }
IVI_ENGINE_FUNCTIONS(HSDIG_IVI_BINDING_DEFINE)
#undef HSDIG_IVI_BINDING_DEFINE

}  // namespace hsdig
