#include "errors/translator/ManagerLibrary.h"

#include <dlfcn.h>

namespace hsdig::translator {

namespace {

template <typename Fn>
bool resolve(void* handle, const char* name, Fn& out) {
  out = reinterpret_cast<Fn>(dlsym(handle, name));
  return out != nullptr;
}

// A translator of the manager library; destroyed through the manager.
class ManagerXlator : public XlatorInterface {
 public:
  ManagerXlator(ManagerLibrary& library, void* session, const cvxlatormgr_Xlator& xlator)
      : library_(library), session_(session), xlator_(xlator) {}
  ~ManagerXlator() override { library_.destroyXlator(session_, &xlator_); }

  std::string getStaticDesc(int32_t code, int language, int ade) override {
    if (xlator_.getStaticDesc == nullptr) {
      throw TranslationFailure(kCodeInternal, "xlator doesn't support getStaticDesc");
    }
    char* text = nullptr;
    int32_t status = xlator_.getStaticDesc(xlator_.handle, code, language, ade, &text);
    return finish(status, text, "getStaticDesc failed");
  }

  std::string getDynamicDesc(std::string_view errjson, int language, int ade,
                             std::string_view format) override {
    if (xlator_.getDynamicDesc == nullptr) {
      throw TranslationFailure(kCodeInternal, "xlator doesn't support getDynamicDesc");
    }
    std::string json(errjson), fmt(format);
    char* text = nullptr;
    int32_t status =
        xlator_.getDynamicDesc(xlator_.handle, json.c_str(), language, ade, fmt.c_str(), &text);
    return finish(status, text, "getDynamicDesc failed");
  }

 private:
  // Takes over the manager's text; a failure becomes a TranslationFailure.
  std::string finish(int32_t status, char* text, const char* fallback) {
    std::string out = text ? std::string(text) : std::string();
    if (text && xlator_.freeText) xlator_.freeText(text);
    if (status < 0) throw TranslationFailure(status, out.empty() ? std::string(fallback) : out);
    return out;
  }

  ManagerLibrary& library_;
  void* session_;
  cvxlatormgr_Xlator xlator_;
};

}  // namespace

ManagerLibrary::ManagerLibrary(const std::string& path) {
  void* handle = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
  if (handle == nullptr) {
    failure_ = "failed to cvdynlib_load library";
    return;
  }
  if (!resolve(handle, "cvxlatormgr_createSession", createSession) ||
      !resolve(handle, "cvxlatormgr_destroySession", destroySession) ||
      !resolve(handle, "cvxlatormgr_createXlator", createXlator) ||
      !resolve(handle, "cvxlatormgr_destroyXlator", destroyXlator)) {
    failure_ = "cvdynlib_symbol";
    dlclose(handle);
    return;
  }
  handle_ = handle;
}

ManagerLibrary::~ManagerLibrary() {
  if (handle_) dlclose(handle_);
}

ManagerLibrary& ManagerLibrary::process() {
  // Loaded once; never unloaded, since sessions may end during static
  // destruction.
  static ManagerLibrary* instance = new ManagerLibrary(kManagerLibraryName);
  return *instance;
}

ManagerSession::ManagerSession(ManagerLibrary& library) : library_(library) {
  if (library_.createSession(&session_) < 0 || session_ == nullptr) {
    throw TranslationFailure(kCodeOutOfMemory, "failed to allocate Session memory");
  }
}

ManagerSession::~ManagerSession() {
  library_.destroySession(session_);
}

std::unique_ptr<XlatorInterface> ManagerSession::createXlator(const std::string& name) {
  cvxlatormgr_Xlator xlator{};
  int32_t status = library_.createXlator(session_, name.c_str(), &xlator);
  if (status < 0) throw TranslationFailure(status, "failed to create translator " + name);
  return std::make_unique<ManagerXlator>(library_, session_, xlator);
}

}  // namespace hsdig::translator
