// Actions and the remaining configuration functions: auto setup, resets,
// commit and uncommit, calibration, clock, checks of every type, sample
// rate coercion and engine attributes passed through.
#include <cmath>

#include "DigitizerTestSupport.h"

namespace hsdig::test {
namespace {

using ActionsTest = DigitizerTest;

TEST_F(ActionsTest, AutoSetupFitsTheRangeAndTriggersOnTheSignal) {
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_AMPLITUDE, 3.0), VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_OFFSET, 1.0), VI_SUCCESS);
  std::vector<double> wfm(1000);
  hsdigWfmInfo info{};
  EXPECT_EQ(hsdig_Read(vi, "0", 5.0, -1, wfm.data(), &info), HSDIG_WARN_DATA_CLIPPED)
      << "a 6 V swing does not fit the default 1 V range";
  takeError(vi);
  ASSERT_EQ(hsdig_AutoSetup(vi), VI_SUCCESS);
  EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "0"), 10.0) << "the next 1-2-5 step above 7.5 V";
  EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_OFFSET, "0"), 1.0);
  EXPECT_EQ(integer(HSDIG_ATTR_TRIGGER_TYPE), HSDIG_VAL_EDGE_TRIGGER);
  EXPECT_EQ(text(HSDIG_ATTR_TRIGGER_SOURCE), "0");
  EXPECT_EQ(hsdig_Read(vi, "0", 5.0, -1, wfm.data(), &info), VI_SUCCESS);
  ViReal64 frequency = 0;
  ASSERT_EQ(hsdig_FetchMeasurement(vi, "0", 5.0, HSDIG_MEAS_FREQUENCY, &frequency), VI_SUCCESS);
  EXPECT_NEAR(frequency, 1e6, 1e4);
}

TEST_F(ActionsTest, ResetsCommitAndCalibration) {
  ViInt32 state = 0;
  ASSERT_EQ(hsdig_Commit(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_Uncommit(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_GetSessionState(vi, "", &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_STATE_IDLE);
  ASSERT_EQ(hsdig_ConfigureTriggerSoftware(vi, 0, 0), VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_Disable(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_AcquisitionStatus(vi, &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_ACQ_STATUS_UNKNOWN);

  ASSERT_EQ(hsdig_WriteRegister(vi, 1, 0x20, 0x5A), VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_VERTICAL_RANGE, 5.0), VI_SUCCESS);
  ASSERT_EQ(hsdig_ResetDevice(vi), VI_SUCCESS);
  EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "0"), 1.0);
  EXPECT_EQ(integer(HSDIG_ATTR_TRIGGER_TYPE), HSDIG_VAL_IMMEDIATE_TRIGGER);
  ViInt32 reg = -1;
  ASSERT_EQ(hsdig_ReadRegister(vi, 1, 0x20, &reg), VI_SUCCESS);
  EXPECT_EQ(reg, 0);

  ASSERT_EQ(hsdig_CalSelfCalibrate(vi, nullptr, HSDIG_VAL_CAL_NORMAL), VI_SUCCESS);
  ASSERT_EQ(hsdig_CalSelfCalibrate(vi, "1", HSDIG_VAL_CAL_RESTRICTED), VI_SUCCESS);
  EXPECT_EQ(hsdig_CalSelfCalibrate(vi, "1", 7), HSDIG_ERROR_VALUE_OUT_OF_RANGE);
  EXPECT_EQ(real(HSDIG_ATTR_LAST_CAL_TEMPERATURE, "3"), real(HSDIG_ATTR_DEVICE_TEMPERATURE));
  ASSERT_EQ(hsdig_CableSenseSignalStart(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_CableSenseSignalStop(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_ProbeCompensationSignalStop(vi), VI_SUCCESS);
}

TEST_F(ActionsTest, HorizontalAndChannelSettings) {
  ASSERT_EQ(hsdig_ConfigureHorizontalTiming(vi, 1e9, 500, 50.0, 2, VI_TRUE), VI_SUCCESS);
  ViReal64 rate = 0;
  ASSERT_EQ(hsdig_SampleRate(vi, &rate), VI_SUCCESS);
  EXPECT_EQ(rate, 250e6) << "coerced to the HSD-4's maximum";
  ViInt32 mode = -1;
  ASSERT_EQ(hsdig_SampleMode(vi, &mode), VI_SUCCESS);
  EXPECT_EQ(mode, HSDIG_VAL_REAL_TIME);
  ASSERT_EQ(hsdig_ConfigureAcquisition(vi, HSDIG_VAL_FLEXRES), VI_SUCCESS);
  EXPECT_EQ(integer(HSDIG_ATTR_ACQUISITION_TYPE), HSDIG_VAL_FLEXRES);
  EXPECT_EQ(hsdig_ConfigureAcquisition(vi, 9), HSDIG_ERROR_VALUE_OUT_OF_RANGE);
  ASSERT_EQ(hsdig_AdjustSampleClockRelativeDelay(vi, 1e-9), VI_SUCCESS);
  EXPECT_EQ(real(HSDIG_ATTR_SAMPLE_CLOCK_DELAY), 1e-9);
  ASSERT_EQ(hsdig_ConfigureChanCharacteristics(vi, "0-1", 50.0, 20e6), VI_SUCCESS);
  EXPECT_EQ(real(HSDIG_ATTR_INPUT_IMPEDANCE, "1"), 50.0);
  EXPECT_EQ(hsdig_ConfigureChanCharacteristics(vi, "0", 75.0, 20e6),
            HSDIG_ERROR_VALUE_OUT_OF_RANGE);
  takeError(vi);
  // A 20 MHz bandwidth limit attenuates channel 0's 1 MHz sine a little
  // (first order: 1 / sqrt(1 + (1/20)^2)).
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  ViReal64 max = 0;
  ASSERT_EQ(hsdig_SetAttributeViInt32(vi, "", HSDIG_ATTR_NUM_RECORDS, 1), VI_SUCCESS);
  ASSERT_EQ(hsdig_ReadMeasurement(vi, "0", 5.0, HSDIG_MEAS_VOLTAGE_MAX, &max), VI_SUCCESS);
  EXPECT_NEAR(max, 0.4 / std::sqrt(1.0 + 1.0 / 400.0), 0.002);
}

TEST_F(ActionsTest, ChecksOfEveryTypeValidateWithoutChanging) {
  struct Case {
    const char* name;
    ViStatus ok, bad;
  };
  const Case cases[] = {
      {"ViInt32", hsdig_CheckAttributeViInt32(vi, "", HSDIG_ATTR_RECORD_LENGTH, 10),
       hsdig_CheckAttributeViInt32(vi, "", HSDIG_ATTR_RECORD_LENGTH, 0)},
      {"ViInt64", hsdig_CheckAttributeViInt64(vi, "", HSDIG_ATTR_FETCH_OFFSET, 10),
       hsdig_CheckAttributeViInt64(vi, "", HSDIG_ATTR_FETCH_OFFSET, ViInt64(1) << 40)},
      {"ViReal64", hsdig_CheckAttributeViReal64(vi, "2", HSDIG_ATTR_VERTICAL_OFFSET, 1.0),
       hsdig_CheckAttributeViReal64(vi, "2", HSDIG_ATTR_VERTICAL_OFFSET, 99.0)},
      {"ViBoolean", hsdig_CheckAttributeViBoolean(vi, "2", HSDIG_ATTR_CHANNEL_ENABLED, VI_FALSE),
       hsdig_CheckAttributeViBoolean(vi, "2", HSDIG_ATTR_CHANNEL_ENABLED, 2)},
      {"ViSession", hsdig_CheckAttributeViSession(vi, "", HSDIG_ATTR_REFERENCE_SESSION, 5),
       hsdig_CheckAttributeViSession(vi, "", HSDIG_ATTR_RECORD_LENGTH, 5)},
      {"ViString", hsdig_CheckAttributeViString(vi, "", HSDIG_ATTR_TRIGGER_SOURCE, "External"),
       hsdig_CheckAttributeViString(vi, "", HSDIG_ATTR_TRIGGER_SOURCE, "9")},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    EXPECT_EQ(c.ok, VI_SUCCESS);
    EXPECT_LT(c.bad, 0);
  }
  EXPECT_EQ(integer(HSDIG_ATTR_RECORD_LENGTH), 1000);
  EXPECT_EQ(text(HSDIG_ATTR_TRIGGER_SOURCE), "0");
  ViBoolean b = 0;
  ASSERT_EQ(hsdig_GetAttributeWithOptionsViBoolean(vi, "1", HSDIG_ATTR_CHANNEL_ENABLED,
                                                   HSDIG_VAL_RETRIEVE_DEFAULT, &b),
            VI_SUCCESS);
  EXPECT_EQ(b, VI_TRUE);
  ViInt64 i64 = 0;
  ASSERT_EQ(hsdig_GetAttributeWithOptionsViInt64(vi, "", HSDIG_ATTR_FETCH_OFFSET,
                                                 HSDIG_VAL_RETRIEVE_MAX, &i64),
            VI_SUCCESS);
  EXPECT_EQ(i64, 67108864);
  ViSession s = 1;
  ASSERT_EQ(hsdig_GetAttributeWithOptionsViSession(vi, "", HSDIG_ATTR_REFERENCE_SESSION,
                                                   HSDIG_VAL_RETRIEVE_CURRENT, &s),
            VI_SUCCESS);
  EXPECT_EQ(s, 0u);
  ViInt32 i32 = 0;
  ASSERT_EQ(hsdig_GetAttributeWithOptionsViInt32(vi, "", HSDIG_ATTR_NUM_RECORDS,
                                                 HSDIG_VAL_RETRIEVE_MAX, &i32),
            VI_SUCCESS);
  EXPECT_EQ(i32, 100000);
  // Engine attributes pass through.
  EXPECT_EQ(text(IVI_ATTR_IO_RESOURCE_DESCRIPTOR), "SIM::DIGITIZER0");
  ASSERT_EQ(hsdig_SetAttributeViBoolean(vi, "", IVI_ATTR_RANGE_CHECK, VI_FALSE), VI_SUCCESS);
}

}  // namespace
}  // namespace hsdig::test
