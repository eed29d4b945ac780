// OptionStringInformation on the real engine, and the ANSI to UTF-8
// conversion.
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <string>

#include "errors/Exception.h"
#include "session/AnsiText.h"
#include "session/OptionStringInformation.h"

namespace hsdig {
namespace {

TEST(OptionStringInformation, SimulatedSessionYieldsItsDriverSetup) {
  struct Case {
    const char* options;
    bool simulated;
    const char* driverSetup;
  };
  const Case cases[] = {
      {"Simulate=1, DriverSetup=Model:A1; BoardType:B2", true, "Model:A1; BoardType:B2"},
      {"Simulate=0,RangeCheck=1", false, ""},
      {"", false, ""},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.options);
    OptionStringInformation info("PXI1Slot2", c.options);
    EXPECT_EQ(info.getResourceName(), "PXI1Slot2");
    EXPECT_EQ(info.getOptionString(), c.options);
    EXPECT_FALSE(info.isLogicalName());
    EXPECT_EQ(info.isSimulated(), c.simulated);
    EXPECT_EQ(info.getDriverSetup(), c.driverSetup);
  }
}

TEST(OptionStringInformation, LongTextsAreCutToTheFixedBuffers) {
  const std::string setup(300, 'x');
  OptionStringInformation info("PXI1Slot2", "DriverSetup=" + setup);
  EXPECT_EQ(info.getOptionString().size(), 255u);
  EXPECT_EQ(info.getDriverSetup(), setup.substr(0, 255 - 12));
}

TEST(OptionStringInformation, LogicalNamesAreResolved) {
  const std::string path = ::testing::TempDir() + "osi-names-" + std::to_string(getpid()) + ".conf";
  std::ofstream(path) << "[Bench]\nResource = PXI1Slot7\nOptions = Simulate=1, "
                         "DriverSetup=Model:Z9\n";
  setenv("CVIVI_LOGICAL_NAMES", path.c_str(), 1);
  OptionStringInformation info("bench", "");
  unsetenv("CVIVI_LOGICAL_NAMES");
  std::remove(path.c_str());
  EXPECT_EQ(info.getResourceName(), "PXI1Slot7");
  EXPECT_TRUE(info.isLogicalName());
  EXPECT_TRUE(info.isSimulated());
  EXPECT_EQ(info.getDriverSetup(), "Model:Z9");
}

TEST(OptionStringInformation, EngineFailuresThrow) {
  try {
    OptionStringInformation info("PXI1Slot2", "Simulate=1, Turbo=1");
    FAIL() << "no exception";
  } catch (const Exception& e) {
    EXPECT_EQ(e.status().code(), IVI_ERROR_BAD_OPTION_NAME);
  }
}

TEST(AnsiText, ConvertsFromTheCodePageAndRejectsInvalidText) {
  struct Case {
    std::string text;
    const char* codeSet;
    std::string expected;
  };
  const Case cases[] = {
      {"PXI1Slot2", "CP932", "PXI1Slot2"},     {"Caf\xE9", "CP1252", "Caf\xC3\xA9"},
      {"\x80", "CP1252", "\xE2\x82\xAC"},      {"\x82\xA0", "CP932", "\xE3\x81\x82"},
      {"\xB0\xA1", "CP949", "\xEA\xB0\x80"},   {"\xC4\xE3", "GB18030", "\xE4\xBD\xA0"},
      {"Caf\xC3\xA9", "UTF-8", "Caf\xC3\xA9"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.codeSet);
    EXPECT_EQ(ansiToUtf8(c.text, c.codeSet), c.expected);
  }
  struct Bad {
    std::string text;
    const char* codeSet;
  };
  const Bad bad[] = {{"Caf\xE9", "UTF-8"}, {"\x82", "CP932"}, {"\xFF", "no-such-code-set"}};
  for (const auto& b : bad) {
    SCOPED_TRACE(b.codeSet);
    try {
      ansiToUtf8(b.text, b.codeSet);
      ADD_FAILURE() << "no exception";
    } catch (const Exception& e) {
      EXPECT_EQ(e.status().code(), kTextConversionFailed);
    }
  }
  // Without setlocale the C locale stands for UTF-8.
  EXPECT_EQ(ansiCodeSet(), "UTF-8");
}

}  // namespace
}  // namespace hsdig
