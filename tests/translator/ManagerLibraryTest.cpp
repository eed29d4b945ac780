// The optional translator manager library: used when present, the built-in
// translator when it is absent, incomplete or cannot make a session.
#include <gtest/gtest.h>

#include <dlfcn.h>

#include <filesystem>
#include <string>

#include "errors/translator/ManagerLibrary.h"
#include "errors/translator/TranslatorSession.h"

namespace hsdig::translator {
namespace {

constexpr int32_t kTimedOut = static_cast<int32_t>(0xBFFA9157);

std::string libraryPath(const char* name) {
  auto self = std::filesystem::read_symlink("/proc/self/exe");
  return (self.parent_path().parent_path() / "lib" / name).string();
}

std::string builtInText(int32_t code) {
  TranslatorSession session(TranslatorOptions{"/nonexistent", nullptr, true});
  return session.staticDescription(code, 0);
}

// The fake's own control functions, reached through a second reference to
// the same loaded library.
class FakeControl {
 public:
  explicit FakeControl(const std::string& path)
      : handle_(dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL)) {}
  ~FakeControl() {
    if (handle_) dlclose(handle_);
  }
  void failSessions(int fail) {
    reinterpret_cast<void (*)(int)>(dlsym(handle_, "fake_cvxlator_setFailSessions"))(fail);
  }
  int live() { return reinterpret_cast<int (*)()>(dlsym(handle_, "fake_cvxlator_live"))(); }

 private:
  void* handle_;
};

TEST(ManagerLibrary, TranslatorsComeFromTheManagerWhenItIsThere) {
  std::string path = libraryPath("libhsdig_fake_cvxlator.so");
  ManagerLibrary library(path);
  ASSERT_TRUE(library.available()) << library.failure();
  FakeControl control(path);
  {
    TranslatorSession session(TranslatorOptions{"/nonexistent", &library});
    EXPECT_TRUE(session.managed());
    std::string json = R"({"translator":"mxlator_hsdig","translator_info":{"ordered_data":[]}})";
    struct Case {
      const char* name;
      std::string description;
      const char* format;
      std::string expected;
    };
    const Case cases[] = {
        {"code only", "", "json1", "managed static -1074097833 in 2"},
        {"with a description", json, "json1", "managed static -1074097833 in 2\n\nmanaged: json1"},
        {"unsupported format falls back to the static form", json, "json2",
         "managed static -1074097833 in 2"},
        {"a translator the manager does not know: code only", R"({"translator":"other"})", "json1",
         "managed static -1074097833 in 2"},
    };
    for (const auto& c : cases) {
      SCOPED_TRACE(c.name);
      EXPECT_EQ(session.render(kTimedOut, c.description, 2, kFlagPlain, c.format).text, c.expected);
    }
    EXPECT_GT(control.live(), 0);
  }
  // Translators and the session were given back to the manager.
  EXPECT_EQ(control.live(), 0);
}

TEST(ManagerLibrary, BuiltInTranslatorStandsInWhenTheManagerCannotServe) {
  std::string path = libraryPath("libhsdig_fake_cvxlator.so");
  ManagerLibrary library(path);
  ASSERT_TRUE(library.available());
  FakeControl control(path);
  control.failSessions(1);
  TranslatorSession session(TranslatorOptions{"/nonexistent", &library});
  control.failSessions(0);
  EXPECT_FALSE(session.managed());
  EXPECT_EQ(session.render(kTimedOut, "", 0, kFlagPlain).text, builtInText(kTimedOut));
}

TEST(ManagerLibrary, AbsentOrIncompleteLibrariesAreNotUsed) {
  struct Case {
    std::string path;
    const char* failure;
  };
  const Case cases[] = {
      {libraryPath("libhsdig_fake_cvxlator_incomplete.so"), "cvdynlib_symbol"},
      {libraryPath("libhsdig_no_such_library.so"), "failed to cvdynlib_load library"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.path);
    ManagerLibrary library(c.path);
    EXPECT_FALSE(library.available());
    EXPECT_EQ(library.failure(), c.failure);
    TranslatorSession session(TranslatorOptions{"/nonexistent", &library});
    EXPECT_FALSE(session.managed());
    EXPECT_EQ(session.render(kTimedOut, "", 0, kFlagPlain).text, builtInText(kTimedOut));
  }
  // No manager library is installed beside the test programs.
  EXPECT_FALSE(ManagerLibrary::process().available());
}

}  // namespace
}  // namespace hsdig::translator
