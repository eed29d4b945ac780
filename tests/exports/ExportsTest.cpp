// libhsdigRemote.so exports the hsdigRemote_ functions and the four SetQLRT*
// binding functions, and nothing else: every other symbol, ours or that of a
// library linked into it, stays hidden.
#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

#include "support/ElfSymbols.h"

namespace {

using hsdig::test::exportedSymbols;

bool allowed(const std::string& name) {
  static const std::set<std::string> binding = {"SetQLRTModule", "SetQLRTTLSIndex",
                                                "SetQLRTModuleHook", "SetQLRTTLSIndexHook"};
  return name.rfind("hsdigRemote_", 0) == 0 || binding.count(name) != 0;
}

TEST(Exports, OnlyTheLibraryInterfaceIsExported) {
  std::vector<std::string> names = exportedSymbols(HSDIG_LIBRARY_PATH);
  for (const auto& name : names) {
    EXPECT_TRUE(allowed(name)) << "unexpected export: " << name;
  }
}

TEST(Exports, TheReaderSeesExportsOfAnotherLibrary) {
  // Guards the test above against passing on a reader that finds nothing:
  // Thrift's library exports its global diagnostic output.
  std::vector<std::string> names = exportedSymbols(HSDIG_THRIFT_LIBRARY);
  bool found = false;
  for (const auto& name : names) found = found || name == "_ZN6apache6thrift12GlobalOutputE";
  EXPECT_TRUE(found) << names.size() << " symbols read";
}

}  // namespace
