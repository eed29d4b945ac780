// Configuration: attributes of all six types, channel lists, the string size
// protocol, retrieval modes, models, export and import.
#include <cstdio>
#include <fstream>
#include <variant>

#include "DigitizerTestSupport.h"

namespace hsdig::test {
namespace {

using ConfigurationTest = DigitizerTest;

TEST_F(ConfigurationTest, EveryTypeRoundTrips) {
  {
    ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "1", HSDIG_ATTR_VERTICAL_RANGE, 2.5), VI_SUCCESS);
    EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "1"), 2.5);
    EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "0"), 1.0) << "other channels keep their value";
  }
  {
    ASSERT_EQ(hsdig_SetAttributeViInt32(vi, "", HSDIG_ATTR_RECORD_LENGTH, 4096), VI_SUCCESS);
    EXPECT_EQ(integer(HSDIG_ATTR_RECORD_LENGTH), 4096);
  }
  {
    ASSERT_EQ(hsdig_SetAttributeViInt64(vi, "", HSDIG_ATTR_FETCH_OFFSET, -12345), VI_SUCCESS);
    ViInt64 v = 0;
    ASSERT_EQ(hsdig_GetAttributeViInt64(vi, "", HSDIG_ATTR_FETCH_OFFSET, &v), VI_SUCCESS);
    EXPECT_EQ(v, -12345);
  }
  {
    ASSERT_EQ(hsdig_SetAttributeViBoolean(vi, "2", HSDIG_ATTR_CHANNEL_ENABLED, VI_FALSE),
              VI_SUCCESS);
    ViBoolean v = VI_TRUE;
    ASSERT_EQ(hsdig_GetAttributeViBoolean(vi, "2", HSDIG_ATTR_CHANNEL_ENABLED, &v), VI_SUCCESS);
    EXPECT_EQ(v, VI_FALSE);
  }
  {
    ASSERT_EQ(hsdig_SetAttributeViSession(vi, "", HSDIG_ATTR_REFERENCE_SESSION, 77), VI_SUCCESS);
    ViSession v = 0;
    ASSERT_EQ(hsdig_GetAttributeViSession(vi, "", HSDIG_ATTR_REFERENCE_SESSION, &v), VI_SUCCESS);
    EXPECT_EQ(v, 77u);
  }
  {
    ASSERT_EQ(hsdig_SetAttributeViString(vi, "3", HSDIG_ATTR_CHANNEL_LABEL, "probe on U7"),
              VI_SUCCESS);
    EXPECT_EQ(text(HSDIG_ATTR_CHANNEL_LABEL, "3"), "probe on U7");
  }
}

TEST_F(ConfigurationTest, ChannelListsNameOneOrSeveralChannels) {
  struct Case {
    const char* list;
    std::vector<int> channels;
  };
  const Case cases[] = {
      {"0", {0}}, {"0,1", {0, 1}}, {"0-3", {0, 1, 2, 3}}, {" 2 , 3 ", {2, 3}}, {"1:2", {1, 2}}};
  double value = 0.5;
  for (const Case& c : cases) {
    SCOPED_TRACE(c.list);
    value += 0.25;
    ASSERT_EQ(hsdig_ConfigureVertical(vi, c.list, value, 0.0, HSDIG_VAL_DC, 1.0, VI_TRUE),
              VI_SUCCESS);
    for (int ch = 0; ch < 4; ++ch) {
      bool named = std::find(c.channels.begin(), c.channels.end(), ch) != c.channels.end();
      if (named) {
        EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, std::to_string(ch).c_str()), value);
      }
    }
    ViInt32 count = 0;
    ASSERT_EQ(hsdig_ParseNumberOfChannels(vi, c.list, &count), VI_SUCCESS);
    EXPECT_EQ(count, static_cast<ViInt32>(c.channels.size()));
  }
  for (const char* bad : {"", "4", "0,0", "x", "0-9", "1,"}) {
    SCOPED_TRACE(bad);
    EXPECT_EQ(hsdig_ConfigureVertical(vi, bad, 1.0, 0.0, HSDIG_VAL_DC, 1.0, VI_TRUE),
              HSDIG_ERROR_INVALID_CHANNEL);
    EXPECT_EQ(takeError(vi).primary, HSDIG_ERROR_INVALID_CHANNEL);
  }
}

TEST_F(ConfigurationTest, StringGettersFollowTheSizeProtocol) {
  ASSERT_EQ(hsdig_SetAttributeViString(vi, "0", HSDIG_ATTR_CHANNEL_LABEL, "abcdefgh"), VI_SUCCESS);
  EXPECT_EQ(hsdig_GetAttributeViString(vi, "0", HSDIG_ATTR_CHANNEL_LABEL, 0, nullptr), 9);
  char small[5] = {'x', 'x', 'x', 'x', 'x'};
  char guard[4] = {'g', 'g', 'g', 'g'};
  EXPECT_EQ(hsdig_GetAttributeViString(vi, "0", HSDIG_ATTR_CHANNEL_LABEL, 4, small), 9);
  EXPECT_STREQ(small, "abc");
  EXPECT_EQ(small[4], 'x') << "nothing past the given size is written";
  EXPECT_EQ(guard[0], 'g');
  char exact[9];
  EXPECT_EQ(hsdig_GetAttributeViString(vi, "0", HSDIG_ATTR_CHANNEL_LABEL, 9, exact), VI_SUCCESS);
  EXPECT_STREQ(exact, "abcdefgh");
  EXPECT_EQ(hsdig_GetAttributeWithOptionsViString(vi, "", HSDIG_ATTR_MODEL,
                                                  HSDIG_VAL_RETRIEVE_CURRENT, 0, nullptr),
            6);
  EXPECT_EQ(hsdig_GetChannelNameFromString(vi, "1-4", 0, nullptr), 8);
  char names[8];
  EXPECT_EQ(hsdig_GetChannelNameFromString(vi, "1-4", 8, names), VI_SUCCESS);
  EXPECT_STREQ(names, "0,1,2,3");
  EXPECT_EQ(hsdig_GetAttributeViString(vi, "0", HSDIG_ATTR_CHANNEL_LABEL, 4, nullptr),
            HSDIG_ERROR_NULL_POINTER);
}

TEST_F(ConfigurationTest, RetrievalModesGiveCurrentDefaultAndRange) {
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "", HSDIG_ATTR_REF_POSITION, 25.0), VI_SUCCESS);
  struct Case {
    ViInt32 mode;
    double expected;
  };
  for (const Case& c :
       {Case{HSDIG_VAL_RETRIEVE_CURRENT, 25.0}, Case{HSDIG_VAL_RETRIEVE_DEFAULT, 50.0},
        Case{HSDIG_VAL_RETRIEVE_MIN, 0.0}, Case{HSDIG_VAL_RETRIEVE_MAX, 100.0}}) {
    SCOPED_TRACE(c.mode);
    ViReal64 v = -1;
    ASSERT_EQ(hsdig_GetAttributeWithOptionsViReal64(vi, "", HSDIG_ATTR_REF_POSITION, c.mode, &v),
              VI_SUCCESS);
    EXPECT_EQ(v, c.expected);
  }
  ViInt32 i = 0;
  EXPECT_EQ(hsdig_GetAttributeWithOptionsViInt32(vi, "", HSDIG_ATTR_RECORD_LENGTH, 9, &i),
            HSDIG_ERROR_VALUE_OUT_OF_RANGE);
}

TEST_F(ConfigurationTest, ResetAndSetByUser) {
  ViBoolean set = VI_TRUE;
  ASSERT_EQ(hsdig_AttributeWasSetByUser(vi, "1", HSDIG_ATTR_VERTICAL_OFFSET, &set), VI_SUCCESS);
  EXPECT_EQ(set, VI_FALSE);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "1", HSDIG_ATTR_VERTICAL_OFFSET, 0.25), VI_SUCCESS);
  ASSERT_EQ(hsdig_AttributeWasSetByUser(vi, "1", HSDIG_ATTR_VERTICAL_OFFSET, &set), VI_SUCCESS);
  EXPECT_EQ(set, VI_TRUE);
  ASSERT_EQ(hsdig_ResetAttribute(vi, "1", HSDIG_ATTR_VERTICAL_OFFSET), VI_SUCCESS);
  EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_OFFSET, "1"), 0.0);
  ASSERT_EQ(hsdig_AttributeWasSetByUser(vi, "1", HSDIG_ATTR_VERTICAL_OFFSET, &set), VI_SUCCESS);
  EXPECT_EQ(set, VI_FALSE);
  // The per-channel default frequency survives a reset.
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "2", HSDIG_ATTR_SIGNAL_FREQUENCY, 5e3), VI_SUCCESS);
  ASSERT_EQ(hsdig_ResetAllAttributes(vi), VI_SUCCESS);
  EXPECT_EQ(real(HSDIG_ATTR_SIGNAL_FREQUENCY, "2"), 3e6);

  ViInt32 flags = -1;
  ViBoolean supported = VI_FALSE;
  ASSERT_EQ(hsdig_GetAttributeFlags(vi, HSDIG_ATTR_MODEL, &flags, &supported), VI_SUCCESS);
  EXPECT_EQ(supported, VI_TRUE);
  EXPECT_TRUE(flags & IVI_VAL_NOT_USER_WRITABLE);
  ASSERT_EQ(hsdig_GetAttributeFlags(vi, 999, &flags, &supported), VI_SUCCESS);
  EXPECT_EQ(supported, VI_FALSE);
}

TEST(DigitizerModels, DriverSetupChoosesTheModelAndChannelCount) {
  struct Case {
    const char* options;
    const char* model;
    ViInt32 channels;
  };
  const Case cases[] = {{"", "HSD-4", 4},
                        {"Simulate=1,DriverSetup=Model:HSD-1", "HSD-1", 1},
                        {"DriverSetup=Model:hsd-2; Serial:A17", "HSD-2", 2},
                        {"DriverSetup=Language:en;Model:HSD-8", "HSD-8", 8}};
  for (const Case& c : cases) {
    SCOPED_TRACE(c.options);
    ViSession vi = openSession(c.options);
    ASSERT_NE(vi, 0u);
    char model[16];
    ASSERT_EQ(hsdig_GetAttributeViString(vi, "", HSDIG_ATTR_MODEL, sizeof model, model),
              VI_SUCCESS);
    EXPECT_STREQ(model, c.model);
    ViInt32 count = 0;
    ASSERT_EQ(hsdig_GetAttributeViInt32(vi, "", IVI_ATTR_CHANNEL_COUNT, &count), VI_SUCCESS);
    EXPECT_EQ(count, c.channels);
    std::string last = std::to_string(c.channels);
    EXPECT_EQ(hsdig_ParseNumberOfChannels(vi, last.c_str(), &count), HSDIG_ERROR_INVALID_CHANNEL);
    EXPECT_EQ(hsdig_close(vi), VI_SUCCESS);
  }
  ViSession vi = 0;
  EXPECT_EQ(hsdig_InitWithOptions(const_cast<ViRsrc>("SIM"), VI_FALSE, VI_FALSE,
                                  "DriverSetup=Model:XYZ", &vi),
            HSDIG_ERROR_INVALID_MODEL);
  EXPECT_EQ(vi, 0u);
  EXPECT_EQ(takeError(0).primary, HSDIG_ERROR_INVALID_MODEL);
  EXPECT_EQ(hsdig_InitWithOptions(const_cast<ViRsrc>("SIM"), VI_FALSE, VI_FALSE, "Bogus=1", &vi),
            HSDIG_ERROR_OPTION_STRING);
}

// A distinctive configuration, and a check that it is in force.
void configure(ViSession vi) {
  ASSERT_EQ(hsdig_ConfigureVertical(vi, "0-1", 4.0, 0.5, HSDIG_VAL_AC, 10.0, VI_TRUE), VI_SUCCESS);
  ASSERT_EQ(hsdig_ConfigureHorizontalTiming(vi, 50e6, 2048, 10.0, 3, VI_FALSE), VI_SUCCESS);
  ASSERT_EQ(hsdig_ConfigureTriggerEdge(vi, "1", 0.2, HSDIG_VAL_NEGATIVE,
                                       HSDIG_VAL_TRIGGER_COUPLING_AC, 1e-6, 2e-6),
            VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViString(vi, "2", HSDIG_ATTR_CHANNEL_LABEL,
                                       "with spaces, commas\nand a newline"),
            VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViInt64(vi, "", HSDIG_ATTR_FETCH_OFFSET, 17), VI_SUCCESS);
}
class ExportImportTest : public DigitizerTest {
 protected:
  void expectConfigured() {
    EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "1"), 4.0);
    EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_OFFSET, "0"), 0.5);
    EXPECT_EQ(integer(HSDIG_ATTR_VERTICAL_COUPLING, "1"), HSDIG_VAL_AC);
    EXPECT_EQ(real(HSDIG_ATTR_PROBE_ATTENUATION, "0"), 10.0);
    EXPECT_EQ(real(HSDIG_ATTR_SAMPLE_RATE), 50e6);
    EXPECT_EQ(integer(HSDIG_ATTR_RECORD_LENGTH), 2048);
    EXPECT_EQ(integer(HSDIG_ATTR_NUM_RECORDS), 3);
    EXPECT_EQ(integer(HSDIG_ATTR_TRIGGER_TYPE), HSDIG_VAL_EDGE_TRIGGER);
    EXPECT_EQ(text(HSDIG_ATTR_TRIGGER_SOURCE), "1");
    EXPECT_EQ(real(HSDIG_ATTR_TRIGGER_HOLDOFF), 1e-6);
    EXPECT_EQ(text(HSDIG_ATTR_CHANNEL_LABEL, "2"), "with spaces, commas\nand a newline");
  }
  void expectDefaults() {
    EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "1"), 1.0);
    EXPECT_EQ(integer(HSDIG_ATTR_RECORD_LENGTH), 1000);
    EXPECT_EQ(integer(HSDIG_ATTR_TRIGGER_TYPE), HSDIG_VAL_IMMEDIATE_TRIGGER);
    EXPECT_EQ(text(HSDIG_ATTR_CHANNEL_LABEL, "2"), "");
  }
  std::vector<ViInt8> exportBuffer() {
    ViStatus size = hsdig_ExportAttributeConfigurationBuffer(vi, 0, nullptr);
    EXPECT_GT(size, 0);
    std::vector<ViInt8> buffer(static_cast<size_t>(size));
    EXPECT_EQ(hsdig_ExportAttributeConfigurationBuffer(vi, size - 1, buffer.data()),
              HSDIG_ERROR_BUFFER_TOO_SMALL);
    takeError(vi);
    EXPECT_EQ(hsdig_ExportAttributeConfigurationBuffer(vi, size, buffer.data()), VI_SUCCESS);
    return buffer;
  }
};

TEST_F(ExportImportTest, ImportOfAnExportRestoresTheConfiguration) {
  configure(vi);
  std::vector<ViInt8> buffer = exportBuffer();
  ASSERT_EQ(hsdig_reset(vi), VI_SUCCESS);
  expectDefaults();
  ASSERT_EQ(hsdig_ImportAttributeConfigurationBuffer(vi, static_cast<ViInt32>(buffer.size()),
                                                     buffer.data()),
            VI_SUCCESS);
  expectConfigured();

  const std::string path =
      ::testing::TempDir() + "hsdig_config_" + std::to_string(::getpid()) + ".txt";
  ASSERT_EQ(hsdig_ExportAttributeConfigurationFile(vi, path.c_str()), VI_SUCCESS);
  ASSERT_EQ(hsdig_ResetAllAttributes(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_ImportAttributeConfigurationFile(vi, path.c_str()), VI_SUCCESS);
  expectConfigured();
  std::remove(path.c_str());

  ASSERT_EQ(hsdig_SaveAttributes(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_ResetAllAttributes(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_RestoreAttributes(vi), VI_SUCCESS);
  expectConfigured();
}

TEST_F(ExportImportTest, ExportAttributesReachAnotherSessionOfTheSameInstrument) {
  configure(vi);
  ASSERT_EQ(hsdig_ExportAttributes(vi), VI_SUCCESS);
  ViSession other = openSession("", "SIM::DIGITIZER0");
  std::swap(vi, other);
  expectDefaults();
  ASSERT_EQ(hsdig_ImportAttributes(vi), VI_SUCCESS);
  expectConfigured();
  std::swap(vi, other);
  EXPECT_EQ(hsdig_close(other), VI_SUCCESS);
  ViSession elsewhere = openSession("", "SIM::NEVER-EXPORTED");
  EXPECT_EQ(hsdig_ImportAttributes(elsewhere), HSDIG_ERROR_CONFIGURATION_DATA);
  EXPECT_EQ(hsdig_close(elsewhere), VI_SUCCESS);
}

TEST_F(ExportImportTest, ADamagedImportFailsCleanlyAndChangesNothing) {
  configure(vi);
  std::vector<ViInt8> good = exportBuffer();
  ASSERT_EQ(hsdig_reset(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "1", HSDIG_ATTR_VERTICAL_RANGE, 0.2), VI_SUCCESS);
  std::string text(good.begin(), good.end());
  auto replaced = [&](const std::string& from, const std::string& to) {
    std::string t = text;
    size_t at = t.find(from);
    EXPECT_NE(at, std::string::npos) << from;
    return at == std::string::npos ? t : t.replace(at, from.size(), to);
  };
  struct Case {
    const char* what;
    std::string data;
  };
  const Case cases[] = {
      {"empty", ""},
      {"truncated", text.substr(0, text.size() / 2)},
      {"one byte flipped", replaced("RECORD_LENGTH - 2048", "RECORD_LENGTH - 2049")},
      {"checksum removed", text.substr(0, text.rfind("checksum"))},
      {"another model", replaced("model HSD-4", "model HSD-2")},
      {"garbage", std::string(300, '\xff')},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.what);
    EXPECT_EQ(
        hsdig_ImportAttributeConfigurationBuffer(vi, static_cast<ViInt32>(c.data.size()),
                                                 reinterpret_cast<const ViInt8*>(c.data.data())),
        HSDIG_ERROR_CONFIGURATION_DATA);
    ErrorInfo e = takeError(vi);
    EXPECT_EQ(e.primary, HSDIG_ERROR_CONFIGURATION_DATA);
    EXPECT_FALSE(e.elaboration.empty());
    EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "1"), 0.2);
    EXPECT_EQ(integer(HSDIG_ATTR_RECORD_LENGTH), 1000);
  }
  EXPECT_EQ(hsdig_ImportAttributeConfigurationFile(vi, "/nonexistent/dir/config.txt"),
            HSDIG_ERROR_FILE_ACCESS);
}

TEST_F(ConfigurationTest, RegistersCoefficientsAndQueries) {
  ASSERT_EQ(hsdig_WriteRegister(vi, 4, 0x40, 0x12345678), VI_SUCCESS);
  ViInt32 v = 0;
  ASSERT_EQ(hsdig_ReadRegister(vi, 2, 0x42, &v), VI_SUCCESS);
  EXPECT_EQ(v, 0x1234);
  ASSERT_EQ(hsdig_ReadRegister(vi, 4, HSDIG_REG_ID, &v), VI_SUCCESS);
  EXPECT_EQ(v, 0x48534447);
  EXPECT_EQ(hsdig_WriteRegister(vi, 4, HSDIG_REG_ID, 1), HSDIG_ERROR_INVALID_REGISTER);
  EXPECT_EQ(hsdig_ReadRegister(vi, 4, 0x41, &v), HSDIG_ERROR_INVALID_REGISTER);
  EXPECT_EQ(hsdig_ReadRegister(vi, 3, 0x40, &v), HSDIG_ERROR_INVALID_REGISTER);
  takeError(vi);

  ASSERT_EQ(hsdig_ConfigureVertical(vi, "2", 2.0, 0.25, HSDIG_VAL_DC, 1.0, VI_TRUE), VI_SUCCESS);
  hsdigCoefficientInfo c[4]{};
  ViInt32 count = 0;
  ASSERT_EQ(hsdig_GetScalingCoefficients(vi, "1,2", 4, c, &count), VI_SUCCESS);
  EXPECT_EQ(count, 2);
  EXPECT_EQ(c[1].gain, 2.0 / 65536);
  EXPECT_EQ(c[1].offset, 0.25);
  ASSERT_EQ(hsdig_GetNormalizationCoefficients(vi, "0-3", 0, nullptr, &count), VI_SUCCESS);
  EXPECT_EQ(count, 4);

  const double eq[3] = {0.25, 0.5, 0.25};
  ASSERT_EQ(hsdig_ConfigureEqualizationFilterCoefficients(vi, "0", 3, eq), VI_SUCCESS);
  double back[5] = {9, 9, 9, 9, 9};
  ASSERT_EQ(hsdig_GetEqualizationFilterCoefficients(vi, "0", 5, back), VI_SUCCESS);
  EXPECT_EQ(back[1], 0.5);
  EXPECT_EQ(back[4], 0.0);

  double f[101], a[101], p[101];
  ViInt32 points = 0;
  ASSERT_EQ(hsdig_GetFrequencyResponse(vi, "0", 101, f, a, p, &points), VI_SUCCESS);
  EXPECT_EQ(points, 101);
  EXPECT_NEAR(a[50], -3.0103, 1e-3) << "-3 dB at the bandwidth";

  char driverRev[256], instrRev[256];
  ASSERT_EQ(hsdig_revision_query(vi, driverRev, instrRev), VI_SUCCESS);
  EXPECT_NE(std::string(instrRev).find("HSD-4"), std::string::npos);
  ViInt16 result = -1;
  char message[256];
  ASSERT_EQ(hsdig_self_test(vi, &result, message), VI_SUCCESS);
  EXPECT_EQ(result, 0);

  ViInt32 handle = 0;
  ASSERT_EQ(hsdig_GetStreamEndpointHandle(vi, "DataStream3", &handle), VI_SUCCESS);
  EXPECT_NE(handle, 0);
  EXPECT_EQ(hsdig_GetStreamEndpointHandle(vi, "DataStream4", &handle),
            HSDIG_ERROR_VALUE_OUT_OF_RANGE);

  ASSERT_EQ(hsdig_ExportSignal(vi, HSDIG_VAL_REF_TRIGGER, "", "PFI1"), VI_SUCCESS);
  EXPECT_EQ(text(HSDIG_ATTR_EXPORTED_REF_TRIGGER_TERMINAL), "PFI1");
  EXPECT_EQ(hsdig_ExportSignal(vi, HSDIG_VAL_REF_TRIGGER, "", "Nowhere"),
            HSDIG_ERROR_INVALID_TRIGGER_SOURCE);
  ASSERT_EQ(hsdig_ConfigureClock(vi, "RefIn", "ClkOut", "SyncIn", VI_TRUE), VI_SUCCESS);
  EXPECT_EQ(text(HSDIG_ATTR_INPUT_CLOCK_SOURCE), "RefIn");
  ASSERT_EQ(hsdig_RequestPrivilege(vi, HSDIG_VAL_PRIVILEGE_OBSERVE), VI_SUCCESS);
  EXPECT_EQ(integer(HSDIG_ATTR_PRIVILEGE_LEVEL), 1);
  ASSERT_EQ(hsdig_ProbeCompensationSignalStart(vi), VI_SUCCESS);
  ViBoolean on = VI_FALSE;
  ASSERT_EQ(hsdig_GetAttributeViBoolean(vi, "", HSDIG_ATTR_PROBE_COMPENSATION_ENABLED, &on),
            VI_SUCCESS);
  EXPECT_EQ(on, VI_TRUE);
}

TEST_F(ConfigurationTest, EveryTriggerKindIsConfigured) {
  struct Case {
    const char* name;
    ViStatus status;
    ViInt32 type;
  };
  const Case cases[] = {
      {"edge", hsdig_ConfigureTriggerEdge(vi, "0", 0.1, HSDIG_VAL_POSITIVE, 1, 0, 0),
       HSDIG_VAL_EDGE_TRIGGER},
      {"hysteresis",
       hsdig_ConfigureTriggerHysteresis(vi, "1", 0.1, 0.05, HSDIG_VAL_POSITIVE, 1, 0, 0),
       HSDIG_VAL_HYSTERESIS_TRIGGER},
      {"window",
       hsdig_ConfigureTriggerWindow(vi, "External", -0.1, 0.1, HSDIG_VAL_ENTERING_WINDOW, 1, 0, 0),
       HSDIG_VAL_WINDOW_TRIGGER},
      {"width", hsdig_ConfigureTriggerWidth(vi, "0", 0.0, 1e-7, 1e-6, 0, HSDIG_VAL_WITHIN, 1, 0, 0),
       HSDIG_VAL_WIDTH_TRIGGER},
      {"runt", hsdig_ConfigureTriggerRunt(vi, "0", -0.1, 0.3, 0, 1, 0, 0), HSDIG_VAL_RUNT_TRIGGER},
      {"glitch", hsdig_ConfigureTriggerGlitch(vi, "0", 0.0, 1e-8, 0, HSDIG_VAL_LESS_THAN, 1, 0, 0),
       HSDIG_VAL_GLITCH_TRIGGER},
      {"video",
       hsdig_ConfigureTriggerVideo(vi, "0", VI_TRUE, HSDIG_VAL_PAL, HSDIG_VAL_VIDEO_LINE_NUMBER,
                                   600, 0, 1, 0, 0),
       HSDIG_VAL_VIDEO_TRIGGER},
      {"digital", hsdig_ConfigureTriggerDigital(vi, "PFI0", HSDIG_VAL_POSITIVE, 0, 0),
       HSDIG_VAL_DIGITAL_TRIGGER},
      {"software", hsdig_ConfigureTriggerSoftware(vi, 0, 0), HSDIG_VAL_SOFTWARE_TRIGGER},
      {"immediate", hsdig_ConfigureTriggerImmediate(vi), HSDIG_VAL_IMMEDIATE_TRIGGER},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    EXPECT_EQ(c.status, VI_SUCCESS);
  }
  ASSERT_EQ(hsdig_ConfigureTriggerRunt(vi, "0", -0.1, 0.3, 0, 1, 0, 0), VI_SUCCESS);
  EXPECT_EQ(integer(HSDIG_ATTR_TRIGGER_TYPE), HSDIG_VAL_RUNT_TRIGGER);
  EXPECT_EQ(real(HSDIG_ATTR_TRIGGER_HIGH_LEVEL), 0.3);
  EXPECT_EQ(hsdig_ConfigureTriggerDigital(vi, "0", HSDIG_VAL_POSITIVE, 0, 0),
            HSDIG_ERROR_INVALID_TRIGGER_SOURCE);
  EXPECT_EQ(hsdig_ConfigureTriggerVideo(vi, "0", VI_TRUE, HSDIG_VAL_NTSC,
                                        HSDIG_VAL_VIDEO_LINE_NUMBER, 600, 0, 1, 0, 0),
            HSDIG_ERROR_VALUE_OUT_OF_RANGE);
  EXPECT_EQ(integer(HSDIG_ATTR_TRIGGER_TYPE), HSDIG_VAL_RUNT_TRIGGER)
      << "a refused configuration changes nothing";
}

}  // namespace
}  // namespace hsdig::test
