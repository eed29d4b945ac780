// Every error class of the driver returns its own status and leaves the
// session's error information set: primary error, secondary error and an
// elaboration that names the function.
#include <functional>

#include "DigitizerTestSupport.h"

namespace hsdig::test {
namespace {

using ErrorTest = DigitizerTest;

TEST_F(ErrorTest, EachClassReturnsItsCodeAndSetsTheErrorInformation) {
  ViReal64 real = 0;
  ViInt32 integer = 0;
  std::vector<double> wfm(1000);
  hsdigWfmInfo info{};
  struct Case {
    const char* name;
    std::function<ViStatus()> call;
    ViStatus expected;
    const char* function;
    ViStatus secondary;
  };
  const Case cases[] = {
      {"invalid channel",
       [&] { return hsdig_GetAttributeViReal64(vi, "7", HSDIG_ATTR_VERTICAL_RANGE, &real); },
       HSDIG_ERROR_INVALID_CHANNEL, "hsdig_GetAttributeViReal64", 0},
      {"channel on a session attribute",
       [&] { return hsdig_SetAttributeViInt32(vi, "0", HSDIG_ATTR_RECORD_LENGTH, 10); },
       HSDIG_ERROR_INVALID_CHANNEL, "hsdig_SetAttributeViInt32", 0},
      {"invalid attribute", [&] { return hsdig_GetAttributeViInt32(vi, "", 4242, &integer); },
       HSDIG_ERROR_INVALID_ATTRIBUTE, "hsdig_GetAttributeViInt32", IVI_ERROR_INVALID_ATTRIBUTE},
      {"attribute type",
       [&] { return hsdig_GetAttributeViInt32(vi, "0", HSDIG_ATTR_VERTICAL_RANGE, &integer); },
       HSDIG_ERROR_ATTRIBUTE_TYPE, "hsdig_GetAttributeViInt32", 0},
      {"value out of range",
       [&] { return hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_VERTICAL_RANGE, 1e6); },
       HSDIG_ERROR_VALUE_OUT_OF_RANGE, "hsdig_SetAttributeViReal64", 0},
      {"check out of range",
       [&] { return hsdig_CheckAttributeViInt32(vi, "", HSDIG_ATTR_NUM_RECORDS, 0); },
       HSDIG_ERROR_VALUE_OUT_OF_RANGE, "hsdig_CheckAttributeViInt32", 0},
      {"read-only", [&] { return hsdig_SetAttributeViString(vi, "", HSDIG_ATTR_MODEL, "HSD-8"); },
       HSDIG_ERROR_ATTRIBUTE_ACCESS, "hsdig_SetAttributeViString", 0},
      {"null pointer",
       [&] { return hsdig_GetAttributeViReal64(vi, "0", HSDIG_ATTR_VERTICAL_RANGE, nullptr); },
       HSDIG_ERROR_NULL_POINTER, "hsdig_GetAttributeViReal64", 0},
      {"null channel list", [&] { return hsdig_ConfigureVertical(vi, nullptr, 1, 0, 1, 1, 1); },
       HSDIG_ERROR_NULL_POINTER, "hsdig_ConfigureVertical", 0},
      {"buffer too small",
       [&] {
         std::vector<ViInt8> small(16);
         return hsdig_ExportAttributeConfigurationBuffer(vi, 16, small.data());
       },
       HSDIG_ERROR_BUFFER_TOO_SMALL, "hsdig_ExportAttributeConfigurationBuffer", 0},
      {"fetch time-out",
       [&] {
         hsdig_ConfigureTriggerSoftware(vi, 0, 0);
         hsdig_InitiateAcquisition(vi);
         ViStatus st = hsdig_Fetch(vi, "0", 0.001, 1000, wfm.data(), &info);
         hsdig_Abort(vi);
         hsdig_ConfigureTriggerImmediate(vi);
         return st;
       },
       HSDIG_ERROR_FETCH_TIMEOUT, "hsdig_Fetch", 0},
      {"no acquisition", [&] { return hsdig_Fetch(vi, "0", 1.0, 1000, wfm.data(), &info); },
       HSDIG_ERROR_NO_ACQUISITION, "hsdig_Fetch", 0},
      {"memory",
       [&] {
         hsdig_ConfigureHorizontalTiming(vi, 1e6, 67108864, 0, 2, VI_TRUE);
         ViStatus st = hsdig_InitiateAcquisition(vi);
         hsdig_ConfigureHorizontalTiming(vi, 1e6, 1000, 0, 1, VI_TRUE);
         return st;
       },
       HSDIG_ERROR_ACQUISITION_MEMORY, "hsdig_InitiateAcquisition", 0},
      {"trigger source", [&] { return hsdig_ConfigureTriggerEdge(vi, "Moon", 0, 1, 1, 0, 0); },
       HSDIG_ERROR_INVALID_TRIGGER_SOURCE, "hsdig_ConfigureTriggerEdge", 0},
      {"register", [&] { return hsdig_ReadRegister(vi, 4, 4096, &integer); },
       HSDIG_ERROR_INVALID_REGISTER, "hsdig_ReadRegister", 0},
      {"unsupported format", [&] { return hsdig_CachedFetch(vi, "0", 10, 3, wfm.data(), &info); },
       HSDIG_ERROR_NOT_SUPPORTED, "hsdig_CachedFetch", 0},
      {"file", [&] { return hsdig_ExportAttributeConfigurationFile(vi, "/nonexistent/dir/x.cfg"); },
       HSDIG_ERROR_FILE_ACCESS, "hsdig_ExportAttributeConfigurationFile", 0},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    takeError(vi);
    EXPECT_EQ(c.call(), c.expected);
    ErrorInfo e = takeError(vi);
    EXPECT_EQ(e.primary, c.expected);
    EXPECT_EQ(e.secondary, c.secondary);
    EXPECT_NE(e.elaboration.find(c.function), std::string::npos) << e.elaboration;
    EXPECT_GT(e.elaboration.size(), std::string(c.function).size() + 10)
        << "the elaboration says what was wrong";
  }
}

TEST_F(ErrorTest, TheFirstErrorOfASessionStaysUntilItIsRead) {
  ViReal64 v = 0;
  EXPECT_EQ(hsdig_GetAttributeViReal64(vi, "9", HSDIG_ATTR_VERTICAL_RANGE, &v),
            HSDIG_ERROR_INVALID_CHANNEL);
  EXPECT_EQ(hsdig_GetAttributeViReal64(vi, "0", HSDIG_ATTR_VERTICAL_RANGE, nullptr),
            HSDIG_ERROR_NULL_POINTER);
  EXPECT_EQ(takeError(vi).primary, HSDIG_ERROR_INVALID_CHANNEL);
  EXPECT_EQ(takeError(vi).primary, 0) << "reading hands the error over";
  EXPECT_EQ(hsdig_GetAttributeViReal64(vi, "0", HSDIG_ATTR_VERTICAL_RANGE, &v), VI_SUCCESS);
  EXPECT_EQ(takeError(vi).primary, 0) << "success leaves nothing behind";
}

TEST(DigitizerStatusTable, CodesAreDistinctAndInTheDriverBlock) {
  std::vector<ViStatus> codes;
#define HSDIG_COLLECT(NAME, code, text) codes.push_back(static_cast<ViStatus>(code));
  HSDIG_DRIVER_STATUS(HSDIG_COLLECT)
#undef HSDIG_COLLECT
  std::sort(codes.begin(), codes.end());
  EXPECT_EQ(std::adjacent_find(codes.begin(), codes.end()), codes.end());
  for (ViStatus c : codes) {
    SCOPED_TRACE(c);
    const std::uint32_t u = static_cast<std::uint32_t>(c);
    EXPECT_TRUE((u & 0xFFFFFF00u) == 0xBFFA5000u || (u & 0xFFFFFF00u) == 0x3FFA5000u);
  }
}

}  // namespace
}  // namespace hsdig::test
