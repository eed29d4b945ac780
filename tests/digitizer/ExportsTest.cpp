// libhsdig.so exports exactly the driver functions of the table plus the two
// host functions, read from its dynamic symbol table.
#include <dlfcn.h>

#include <set>
#include <string>

#include "DigitizerTestSupport.h"
#include "support/ElfSymbols.h"

namespace {

std::string libraryPath() {
  Dl_info info{};
  if (!dladdr(reinterpret_cast<void*>(&hsdig_close), &info) || !info.dli_fname) return {};
  return info.dli_fname;
}

TEST(DigitizerExports, ExactlyTheTableAndTheHostFunctions) {
  std::set<std::string> expected;
#define HSDIG_NAME(name, params, args) expected.insert("hsdig_" #name);
  HSDIG_DRIVER_FUNCTIONS(HSDIG_NAME)
  ASSERT_EQ(expected.size(), size_t{HSDIG_DRIVER_FUNCTION_COUNT});
  HSDIG_HOST_FUNCTIONS(HSDIG_NAME)
#undef HSDIG_NAME
  const std::string path = libraryPath();
  ASSERT_NE(path.find("libhsdig.so"), std::string::npos) << path;
  std::set<std::string> exported;
  for (const std::string& name : hsdig::test::exportedSymbols(path.c_str())) {
    if (name.rfind("_init", 0) == 0 || name.rfind("_fini", 0) == 0) continue;
    exported.insert(name);
  }
  EXPECT_EQ(exported, expected);
}

// A handle that is no session is refused with its own error, recorded on
// the calling thread's session 0, and outputs stay untouched.
TEST(DigitizerExports, AnUnknownSessionIsRefusedBeforeAnythingElse) {
  constexpr ViSession kNoSession = 0x7FFFFFF0;
  hsdig::test::takeError(0);
  ViReal64 value = 0;
  hsdigWfmInfo info{};
  struct Case {
    const char* name;
    ViStatus status;
  };
  const Case cases[] = {
      {"hsdig_Abort", hsdig_Abort(kNoSession)},
      {"hsdig_ConfigureVertical", hsdig_ConfigureVertical(kNoSession, "0", 1, 0, 1, 1, 1)},
      {"hsdig_GetAttributeViReal64",
       hsdig_GetAttributeViReal64(kNoSession, "0", HSDIG_ATTR_VERTICAL_RANGE, &value)},
      {"hsdig_Fetch", hsdig_Fetch(kNoSession, "0", 0, 1, &value, &info)},
      {"hsdig_close", hsdig_close(kNoSession)},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    EXPECT_EQ(c.status, HSDIG_ERROR_INVALID_SESSION);
  }
  // Error information keeps the first error of the thread's session 0.
  hsdig::test::ErrorInfo e = hsdig::test::takeError(0);
  EXPECT_EQ(e.primary, HSDIG_ERROR_INVALID_SESSION);
  EXPECT_NE(e.elaboration.find("hsdig_Abort"), std::string::npos) << e.elaboration;
  EXPECT_EQ(value, 0.0);
  EXPECT_EQ(info.actualSamples, 0);
}

}  // namespace
