// Status explanation files: the file format, its failures, and their place
// in the static description lookup.
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "TempFolder.h"
#include "errors/translator/ErrorFiles.h"
#include "errors/translator/TranslatorSession.h"

namespace hsdig::translator {
namespace {

using test::TempFolder;

constexpr const char* kHeader = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<cvdocument>\n";

struct FileCase {
  const char* name;
  std::string content;
  int32_t code;
  const char* expectedText;     // nullptr: not found
  const char* expectedFailure;  // "" when none
};

TEST(ErrorFiles, FileFormatAndItsFailures) {
  const FileCase cases[] = {
      {"valid, code in hexadecimal",
       std::string(kHeader) +
           "<cvcomment>\nanything <cverror code=\"1\"> here\n</cvcomment>\n"
           "<cverror code=\"0xBFFA1234\">\nFirst line.\nSecond line.\n</cverror>\n</cvdocument>\n",
       static_cast<int32_t>(0xBFFA1234), "First line.\nSecond line.", ""},
      {"valid, decimal code, tags in other case, blank lines",
       std::string(
           "<?XML VERSION=\"1.0\"?>\n<CVDocument>\n\n<CVERROR CODE='-12'>\nTwelve.\n</CVError>\n"
           "\n</CVDOCUMENT>\n"),
       -12, "Twelve.", ""},
      {"valid, code absent",
       std::string(kHeader) + "<cverror code=\"5\">\nFive.\n</cverror>\n</cvdocument>\n", 6,
       nullptr, ""},
      {"bad section heading",
       std::string(kHeader) + "<cverror code=\"5\">\nFive.\n</cverror>\n<oops>\n", 6, nullptr,
       kBadSectionHeading},
      {"heading without a quote", std::string(kHeader) + "<cverror code=5>\nFive.\n</cverror>\n", 5,
       nullptr, kBadSectionHeading},
      {"missing end of a code",
       std::string(kHeader) + "<cverror code=\"5\">\nFive.\n<cverror code=\"6\">\n", 6, nullptr,
       kMissingEnd},
      {"missing end at the end of the file", std::string(kHeader) + "<cverror code=\"5\">\nFive.\n",
       5, nullptr, kMissingEnd},
      {"wrong declaration", "<?xml version=\"2.0\"?>\n<cvdocument>\n</cvdocument>\n", 5, nullptr,
       kCouldNotRead},
      {"missing document tag", "<?xml version=\"1.0\"?>\n<document>\n", 5, nullptr, kCouldNotRead},
      {"empty file", "", 5, nullptr, kCouldNotRead},
  };
  TempFolder folder;
  int index = 0;
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    auto path = folder.write("case" + std::to_string(index++) + ".err", c.content);
    ErrorFileLookup found = searchErrorFile(path.string(), c.code);
    if (c.expectedText) {
      ASSERT_TRUE(found.text.has_value());
      EXPECT_EQ(*found.text, c.expectedText);
    } else {
      EXPECT_FALSE(found.text.has_value());
    }
    EXPECT_EQ(found.failure, c.expectedFailure);
  }
}

TEST(ErrorFiles, UnreadableFileReportsThatItCouldNotBeOpened) {
  TempFolder folder;
  // A dangling link cannot be opened, whoever runs the test.
  std::filesystem::create_symlink(folder.path() / "nowhere", folder.path() / "broken.txt");
  ErrorFileLookup found = searchErrorFolder(folder.path().string(), 5);
  EXPECT_FALSE(found.text.has_value());
  EXPECT_EQ(found.failure, kCouldNotOpenFile);
  EXPECT_EQ(searchErrorFile((folder.path() / "broken.txt").string(), 5).failure, kCouldNotOpenFile);
}

TEST(ErrorFiles, FolderSearchTakesOnlyExplanationFilesAndSurvivesABrokenOne) {
  TempFolder folder;
  folder.write("a-broken.err", std::string(kHeader) + "<junk>\n");
  folder.write(
      "b-ignored.xml",
      std::string(kHeader) + "<cverror code=\"7\">\nWrong file.\n</cverror>\n</cvdocument>\n");
  folder.write("c-good.TXT",
               std::string(kHeader) + "<cverror code=\"7\">\nSeven.\n</cverror>\n</cvdocument>\n");
  ErrorFileLookup found = searchErrorFolder(folder.path().string(), 7);
  ASSERT_TRUE(found.text.has_value());
  EXPECT_EQ(*found.text, "Seven.");
  // A code that no file defines reports the broken file.
  EXPECT_EQ(searchErrorFolder(folder.path().string(), 8).failure, kBadSectionHeading);
  // A folder that does not exist defines nothing and is not a failure.
  ErrorFileLookup none = searchErrorFolder((folder.path() / "absent").string(), 7);
  EXPECT_FALSE(none.text.has_value());
  EXPECT_EQ(none.failure, "");
}

// The static lookup goes from the term tables to the QM errors folder
// (driver, language, then English; converted from the code page) to the
// shared errors folder (language, then English).
TEST(ErrorFiles, StaticLookupOrder) {
  TempFolder shared;
  auto file = [](int32_t code, const std::string& text) {
    return std::string(kHeader) + "<cverror code=\"" + std::to_string(code) + "\">\n" + text +
           "\n</cverror>\n</cvdocument>\n";
  };
  // 0xE9 is "é" in code page 1252.
  shared.write("QMerrors/hsdig/French/f.err", file(11, "Erreur \xE9tendue."));
  shared.write("QMerrors/hsdig/English/e.err", file(12, "Driver file, English."));
  shared.write("Errors/French/f.txt", file(13, "Fichier partag\xC3\xA9."));
  shared.write("Errors/English/e.txt", file(14, "Shared file, English.") + "");
  // A code that the tables know is never looked up in files.
  shared.write("Errors/English/t.txt", file(static_cast<int32_t>(0xBFFA9157), "From a file."));

  TranslatorSession session(TranslatorOptions{shared.path().string()});
  struct LookupCase {
    int32_t code;
    int language;
    const char* expected;
    bool known;
  };
  const LookupCase cases[] = {
      {11, 1, "Erreur \xC3\xA9tendue.", true},
      {12, 1, "Driver file, English.", true},
      {13, 1, "Fichier partag\xC3\xA9.", true},
      {14, 1, "Shared file, English.", true},
      {14, 0, "Shared file, English.", true},
      {11, 0, "Error description not found", false},
      {15, 1, "Error description not found", false},
      {static_cast<int32_t>(0xBFFA9157), 0, "The connection to the server timed out.", true},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(testing::Message() << c.code << " in language " << c.language);
    bool known = !c.known;
    EXPECT_EQ(session.staticDescription(c.code, c.language, &known), c.expected);
    EXPECT_EQ(known, c.known);
  }
}

TEST(ErrorFiles, ABrokenFileIsReportedAfterTheNotFoundText) {
  TempFolder shared;
  shared.write("Errors/English/bad.err", std::string(kHeader) + "<cverror code=\"1\">\nOne.\n");
  TranslatorSession session(TranslatorOptions{shared.path().string()});
  auto translation = session.render(99, "", 0, kFlagPlain);
  EXPECT_FALSE(translation.complete);
  EXPECT_EQ(translation.text, std::string("Error description not found\n\n") + kMissingEnd);
}

}  // namespace
}  // namespace hsdig::translator
