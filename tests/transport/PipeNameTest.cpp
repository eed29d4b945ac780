#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <string>

#include "TransportTestSupport.h"
#include "transport/PipeName.h"

namespace hsdig::transport {
namespace {

TEST(PipeNameTest, NamesFollowTheHashRule) {
  struct Case {
    const char* what;
    std::string resource;
    std::string expected;
  };
  // 5381 * 33 = 177573; each byte is then added as a signed 8-bit value.
  const Case cases[] = {
      {"empty name", "", "HSDIG_20.0_5381"},
      {"one letter", "a", "HSDIG_20.0_177670"},
      {"upper case is lowered", "A", "HSDIG_20.0_177670"},
      {"two letters", "ab", "HSDIG_20.0_5863208"},
      {"white space of every kind is removed", " \ta\n\v\f\rb ", "HSDIG_20.0_5863208"},
      {"only white space", " \t \r\n", "HSDIG_20.0_5381"},
      {"byte 0x80 counts as -128", "\x80", "HSDIG_20.0_177445"},
      {"byte 0xFF counts as -1", "\xff", "HSDIG_20.0_177572"},
      {"a two-byte UTF-8 letter", "\xc3\x89", "HSDIG_20.0_5857777"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    EXPECT_EQ(pipeNameForResource(c.resource), c.expected);
  }
}

TEST(PipeNameTest, BlanksAndCaseGiveTheSamePipe) {
  const std::string reference = pipeNameForResource("pxi1slot2");
  for (const char* variant : {"PXI1Slot2", "  pxi1slot2  ", "PXI1 Slot2", "\tPxI1sLoT2\n"}) {
    SCOPED_TRACE(variant);
    EXPECT_EQ(pipeNameForResource(variant), reference);
  }
  EXPECT_NE(pipeNameForResource("PXI1Slot3"), reference);
}

TEST(PipeNameTest, LongNamesWrapAroundWithoutLeadingZeros) {
  const std::string name = pipeNameForResource(std::string(64, 'z'));
  ASSERT_EQ(name.rfind("HSDIG_20.0_", 0), 0u);
  const std::string digits = name.substr(11);
  ASSERT_FALSE(digits.empty());
  EXPECT_NE(digits.front(), '0');
  EXPECT_LE(digits.size(), 20u);
  EXPECT_EQ(digits.find_first_not_of("0123456789"), std::string::npos);
}

class PipePathTest : public test::TransportTest {};

TEST_F(PipePathTest, NamesMapToTheSocketFolderOrAreRefused) {
  struct Case {
    const char* what;
    std::string name;
    int error;
    std::string path;  // expected when error is 0
    bool inFolder;
  };
  const std::string f = folder();
  const Case cases[] = {
      {"bare name", "HSDIG_20.0_1", 0, f + "/HSDIG_20.0_1", true},
      {"windows pipe path", "\\\\.\\pipe\\HSDIG_20.0_1", 0, f + "/HSDIG_20.0_1", true},
      {"windows prefix in upper case", "\\\\.\\PIPE\\x", 0, f + "/x", true},
      {"absolute path used as it stands", "/run/some.sock", 0, "/run/some.sock", false},
      {"remote pipe path", "\\\\server\\pipe\\x", EINVAL, "", false},
      {"two backslashes inside a name", "abc\\\\def", EINVAL, "", false},
      {"empty name", "", EINVAL, "", false},
      {"windows path without a name", "\\\\.\\pipe\\", EINVAL, "", false},
      {"climbing out of the folder", "..", EINVAL, "", false},
      {"relative path", "a/b", EINVAL, "", false},
      {"mapped name with a slash", "\\\\.\\pipe\\../x", EINVAL, "", false},
      {"embedded NUL", std::string("a\0b", 3), EINVAL, "", false},
      {"too long for a socket address", std::string(120, 'n'), ENAMETOOLONG, "", true},
      {"absolute path too long", "/" + std::string(110, 'n'), ENAMETOOLONG, "", false},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    const PipePath resolved = resolvePipePath(c.name);
    EXPECT_EQ(resolved.error, c.error);
    if (c.error == 0) {
      EXPECT_EQ(resolved.path, c.path);
      EXPECT_EQ(resolved.inSocketFolder, c.inFolder);
    }
  }
}

TEST_F(PipePathTest, SocketFolderIsCreatedForEveryUserAndCheckedWhenPresent) {
  const std::string fresh = folder() + "/fresh";
  ::umask(077);
  ASSERT_EQ(ensureSocketFolder(fresh), 0);
  ::umask(022);
  struct stat info {};
  ASSERT_EQ(::lstat(fresh.c_str(), &info), 0);
  EXPECT_TRUE(S_ISDIR(info.st_mode));
  EXPECT_EQ(info.st_mode & 07777, 01777u);
  EXPECT_EQ(ensureSocketFolder(fresh), 0) << "an existing good folder is kept";

  const std::string open = folder() + "/open";
  ASSERT_EQ(::mkdir(open.c_str(), 0777), 0);
  ASSERT_EQ(::chmod(open.c_str(), 0777), 0);
  EXPECT_EQ(ensureSocketFolder(open), EPERM) << "writable by all but not sticky";

  const std::string link = folder() + "/link";
  ASSERT_EQ(::symlink(fresh.c_str(), link.c_str()), 0);
  EXPECT_EQ(ensureSocketFolder(link), ENOTDIR) << "a symbolic link is not followed";
}

TEST_F(PipePathTest, TheDefaultFolderIsMachineWide) {
  testing::setSocketFolderForTesting("");
  EXPECT_EQ(socketFolder(), "/tmp/.hsdig-pipes");
  EXPECT_EQ(resolvePipePath("x").path, "/tmp/.hsdig-pipes/x");
  testing::setSocketFolderForTesting(folder());
  EXPECT_EQ(socketFolder(), folder());
}

}  // namespace
}  // namespace hsdig::transport
