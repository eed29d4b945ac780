// The engine exports every function of the engine function table, and the
// functions marked not supported say so.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "IviEngine.h"

namespace {

struct Row {
  const char* name;
  bool supported;
};

#define ROW(cname, method, avail, kind, support, ret, sess, params, args) \
  {#cname, IVI_ENGINE_CAT(SUPPORTED_, support)},
#define SUPPORTED_IMPL true
#define SUPPORTED_NSUP false
const std::vector<Row> kRows = {IVI_ENGINE_FUNCTIONS(ROW)};

TEST(EngineExports, EveryTableFunctionIsExported) {
  void* engine = dlopen("libcvivi.so", RTLD_NOW | RTLD_LOCAL);
  ASSERT_NE(engine, nullptr) << dlerror();
  for (const auto& row : kRows) {
    SCOPED_TRACE(row.name);
    EXPECT_NE(dlsym(engine, row.name), nullptr);
  }
  // Nothing of the engine's inside leaks out.
  EXPECT_EQ(dlsym(engine, "_ZN5cvivi11findSessionEj"), nullptr);
  dlclose(engine);
}

TEST(EngineExports, NotSupportedFunctionsSaySo) {
  EXPECT_EQ(Ivi_ReadToFile(1, 0, "x", 1, 0, nullptr), IVI_ERROR_FUNCTION_NOT_SUPPORTED);
  EXPECT_EQ(Ivi_ClassDriverNew("a", "b", nullptr, nullptr), IVI_ERROR_FUNCTION_NOT_SUPPORTED);
  EXPECT_EQ(IviScope_InterchangeCheck(1, "f"), IVI_ERROR_FUNCTION_NOT_SUPPORTED);
  EXPECT_EQ(Ivi_GetConfigStoreHandle(nullptr), IVI_ERROR_FUNCTION_NOT_SUPPORTED);
  size_t unsupported = 0;
  for (const auto& row : kRows) unsupported += row.supported ? 0 : 1;
  EXPECT_EQ(kRows.size(), 232u);
  EXPECT_EQ(unsupported, 38u) << "update the README's list of not-supported functions";
}

}  // namespace
