// hsdig-error: texts, exit statuses and usage, through the tool's function
// and through the real program.
#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cstdio>
#include <filesystem>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "TempFolder.h"
#include "errors/translator/TranslatorSession.h"
#include "tools/hsdig-error/ErrorTool.h"

namespace hsdig::tools {
namespace {

struct ToolRun {
  int status;
  std::string out;
  std::string err;
};

ToolRun run(const std::vector<std::string>& args) {
  std::ostringstream out, err;
  int status = runErrorTool(args, out, err, translator::TranslatorOptions{"/nonexistent"});
  return {status, out.str(), err.str()};
}

std::string staticText(int32_t code, int language) {
  translator::TranslatorSession session(translator::TranslatorOptions{"/nonexistent"});
  return session.staticDescription(code, language);
}

TEST(ErrorTool, TextsAndExitStatuses) {
  const int32_t timedOut = static_cast<int32_t>(0xBFFA9157);
  struct Case {
    std::vector<std::string> args;
    int status;
    std::string out;  // exact, or empty to skip
  };
  const Case cases[] = {
      {{"0xBFFA9157", "--lang", "fr"}, kExitOk, staticText(timedOut, 1) + "\n"},
      {{"--lang", "de", "-1074097833"}, kExitOk, staticText(timedOut, 2) + "\n"},
      {{"0xbffa9157"}, kExitOk, staticText(timedOut, 0) + "\n"},
      {{"0xBFFA9403"}, kExitOk, staticText(-52003, 0) + "\n"},
      {{"-52003", "--lang", "ch"}, kExitOk, staticText(-52003, 5) + "\n"},
      {{"12345"}, kExitUnknownCode, "Error description not found\n"},
      {{"0"}, kExitOk, "\n"},
      {{}, kExitUsage, ""},
      {{"0xBFFA9157", "--lang", "xx"}, kExitUsage, ""},
      {{"0xBFFA9157", "--lang"}, kExitUsage, ""},
      {{"0xBFFA9157", "12"}, kExitUsage, ""},
      {{"0x1FFFFFFFF"}, kExitUsage, ""},
      {{"-2147483649"}, kExitUsage, ""},
      {{"12abc"}, kExitUsage, ""},
      {{"--bogus"}, kExitUsage, ""},
      {{"--list", "5"}, kExitUsage, ""},
      {{"5", "--description", "/nonexistent/file.json"}, kExitUsage, ""},
  };
  for (const auto& c : cases) {
    std::string joined;
    for (const auto& a : c.args) joined += a + " ";
    SCOPED_TRACE(joined);
    ToolRun r = run(c.args);
    EXPECT_EQ(r.status, c.status);
    if (!c.out.empty()) {
      EXPECT_EQ(r.out, c.out);
    }
    if (c.status == kExitUsage) {
      EXPECT_NE(r.err.find("hsdig-error"), std::string::npos) << r.err;
    }
  }
}

TEST(ErrorTool, DescriptionFileAddsTheDetails) {
  test::TempFolder folder;
  auto file =
      folder.write("d.json", R"({"translator":"mxlator_hsdig","translator_info":{"version":1,)"
                             R"("is_debug":false,"ordered_data":[{"type":"usage",)"
                             R"("usage":"kUsageTypeParameterName","value":"wfm"}]}})");
  ToolRun r = run({"0xBFFA0058", "--description", file.string()});
  EXPECT_EQ(r.status, kExitOk);
  EXPECT_EQ(r.out, staticText(static_cast<int32_t>(0xBFFA0058), 0) + "\n\nParameter name: wfm\n");
}

TEST(ErrorTool, ListAndHelp) {
  ToolRun list = run({"--list"});
  EXPECT_EQ(list.status, kExitOk);
  EXPECT_NE(list.out.find("0xBFFA9157  -1074097833  " +
                          staticText(static_cast<int32_t>(0xBFFA9157), 0) + "\n"),
            std::string::npos);
  // Infrastructure codes are listed as callers see them.
  EXPECT_NE(list.out.find("0xBFFA9400  -1074097152  "), std::string::npos);
  ToolRun help = run({"--help"});
  EXPECT_EQ(help.status, kExitOk);
  EXPECT_NE(help.out.find("--description FILE"), std::string::npos);
}

// The real program, next to this test program in the build tree.
TEST(ErrorTool, ProgramPrintsTheFrenchTextAndExitsZero) {
  auto self = std::filesystem::read_symlink("/proc/self/exe");
  auto program = self.parent_path() / "hsdig-error";
  ASSERT_TRUE(std::filesystem::exists(program)) << program;
  struct Case {
    std::string args;
    int status;
    std::string out;
  };
  const Case cases[] = {
      {"0xBFFA9157 --lang fr", 0, staticText(static_cast<int32_t>(0xBFFA9157), 1) + "\n"},
      {"777", 1, "Error description not found\n"},
      {"--lang", 2, ""},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.args);
    std::string command = program.string() + " " + c.args + " 2>/dev/null";
    std::unique_ptr<FILE, int (*)(FILE*)> pipe(popen(command.c_str(), "r"), pclose);
    ASSERT_TRUE(pipe);
    std::string out;
    std::array<char, 4096> buffer{};
    std::size_t n = 0;
    while ((n = fread(buffer.data(), 1, buffer.size(), pipe.get())) > 0)
      out.append(buffer.data(), n);
    int status = pclose(pipe.release());
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), c.status);
    EXPECT_EQ(out, c.out);
  }
}

}  // namespace
}  // namespace hsdig::tools
