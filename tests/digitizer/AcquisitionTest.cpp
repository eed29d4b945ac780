// The acquisition state machine, the sample formats, multi-record fetches
// with their timing records, clipping and cached fetch.
#include <cmath>
#include <functional>

#include "DigitizerTestSupport.h"

namespace hsdig::test {
namespace {

using AcquisitionTest = DigitizerTest;

TEST_F(AcquisitionTest, StatesFollowInitiateCompleteAndAbort) {
  ViInt32 state = -5;
  ASSERT_EQ(hsdig_AcquisitionStatus(vi, &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_ACQ_STATUS_UNKNOWN);
  ASSERT_EQ(hsdig_GetSessionState(vi, "", &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_STATE_IDLE);
  ASSERT_EQ(hsdig_Commit(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_GetSessionState(vi, nullptr, &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_STATE_COMMITTED);

  // A software trigger holds the acquisition until it is sent.
  ASSERT_EQ(hsdig_ConfigureTriggerSoftware(vi, 0, 0), VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_AcquisitionStatus(vi, &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_ACQ_IN_PROGRESS);
  std::vector<double> wfm(1000);
  hsdigWfmInfo info{};
  EXPECT_EQ(hsdig_Fetch(vi, "0", 0.02, 1000, wfm.data(), &info), HSDIG_ERROR_FETCH_TIMEOUT);
  ErrorInfo e = takeError(vi);
  EXPECT_EQ(e.primary, HSDIG_ERROR_FETCH_TIMEOUT);
  EXPECT_NE(e.elaboration.find("software trigger"), std::string::npos) << e.elaboration;
  EXPECT_EQ(hsdig_Fetch(vi, "0", -1, 1000, wfm.data(), &info), HSDIG_ERROR_FETCH_TIMEOUT)
      << "a wait that nothing can end fails rather than hang";
  takeError(vi);
  ASSERT_EQ(hsdig_SendSoftwareTriggerEdge(vi, HSDIG_VAL_SOFTWARE_TRIGGER_START), VI_SUCCESS);
  EXPECT_EQ(hsdig_Fetch(vi, "0", 5.0, 1000, wfm.data(), &info), VI_SUCCESS);
  EXPECT_EQ(info.actualSamples, 1000);
  ASSERT_EQ(hsdig_AcquisitionStatus(vi, &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_ACQ_COMPLETE);

  // Abort ends a waiting acquisition; fetching then has nothing to wait for.
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_Abort(vi), VI_SUCCESS);
  EXPECT_EQ(hsdig_Fetch(vi, "0", 1.0, 1000, wfm.data(), &info), HSDIG_ERROR_NO_ACQUISITION);
  EXPECT_EQ(takeError(vi).primary, HSDIG_ERROR_NO_ACQUISITION);
  // The earlier complete acquisition stays cached.
  EXPECT_EQ(hsdig_CachedFetch(vi, "0", 1000, HSDIG_VAL_REAL64, wfm.data(), &info), VI_SUCCESS);
}

TEST_F(AcquisitionTest, AnEdgeTriggerOnALevelTheSignalNeverReachesTimesOut) {
  ASSERT_EQ(hsdig_ConfigureTriggerEdge(vi, "0", 0.9, HSDIG_VAL_POSITIVE, 1, 0, 0), VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  std::vector<double> wfm(1000);
  hsdigWfmInfo info{};
  EXPECT_EQ(hsdig_Fetch(vi, "0", 0.01, -1, wfm.data(), &info), HSDIG_ERROR_FETCH_TIMEOUT);
  takeError(vi);
  ASSERT_EQ(hsdig_ConfigureTriggerEdge(vi, "0", 0.1, HSDIG_VAL_POSITIVE, 1, 0, 0), VI_SUCCESS);
  EXPECT_EQ(hsdig_Read(vi, "0", 5.0, -1, wfm.data(), &info), VI_SUCCESS);
}

TEST_F(AcquisitionTest, TheFormatsAgreeWithinOneCode) {
  horizontal(100e6, 1000);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_NOISE, 0.01), VI_SUCCESS);
  ASSERT_EQ(hsdig_ConfigureVertical(vi, "0", 2.0, 0.1, HSDIG_VAL_DC, 1.0, VI_TRUE), VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  const int n = 1000;
  std::vector<double> volts(n);
  hsdigWfmInfo scaledInfo{};
  ASSERT_EQ(hsdig_Fetch(vi, "0", 5.0, n, volts.data(), &scaledInfo), VI_SUCCESS);
  EXPECT_EQ(scaledInfo.gain, 1.0);
  EXPECT_EQ(scaledInfo.offset, 0.0);

  std::vector<ViInt8> b8(n);
  std::vector<ViInt16> b16(n);
  std::vector<ViInt32> b32(n);
  std::vector<double> complex(2 * n);
  std::vector<ViInt16> complex16(2 * n);
  hsdigWfmInfo i8{}, i16{}, i32{}, ic{}, ic16{};
  ASSERT_EQ(hsdig_FetchBinary8(vi, "0", 5.0, n, b8.data(), &i8), VI_SUCCESS);
  ASSERT_EQ(hsdig_FetchBinary16(vi, "0", 5.0, n, b16.data(), &i16), VI_SUCCESS);
  ASSERT_EQ(hsdig_FetchBinary32(vi, "0", 5.0, n, b32.data(), &i32), VI_SUCCESS);
  ASSERT_EQ(hsdig_FetchComplex(vi, "0", 5.0, n, complex.data(), &ic), VI_SUCCESS);
  ASSERT_EQ(hsdig_FetchComplexBinary16(vi, "0", 5.0, n, complex16.data(), &ic16), VI_SUCCESS);
  struct Case {
    const char* format;
    const hsdigWfmInfo& info;
    std::function<double(int)> sample;
  };
  const Case cases[] = {
      {"binary8", i8, [&](int k) { return double(b8[k]); }},
      {"binary16", i16, [&](int k) { return double(b16[k]); }},
      {"binary32", i32, [&](int k) { return double(b32[k]); }},
      {"complex binary16", ic16, [&](int k) { return double(complex16[2 * k]); }},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.format);
    EXPECT_EQ(c.info.offset, 0.1);
    EXPECT_EQ(c.info.actualSamples, n);
    EXPECT_EQ(c.info.xIncrement, scaledInfo.xIncrement);
    double worst = 0;
    for (int k = 0; k < n; ++k) {
      worst = std::max(worst, std::fabs(c.sample(k) * c.info.gain + c.info.offset - volts[k]));
    }
    EXPECT_LE(worst, c.info.gain) << "within one code of the format";
  }
  for (int k = 0; k < n; ++k) {
    ASSERT_EQ(complex[2 * k], volts[k]);
    ASSERT_EQ(complex[2 * k + 1], 0.0);
    ASSERT_EQ(complex16[2 * k + 1], 0);
  }
  // The 14-bit model leaves the two low bits of every 16-bit code clear.
  for (ViInt16 s : b16) ASSERT_EQ(s & 3, 0);
}

TEST_F(AcquisitionTest, MultiRecordFetchesFillOneTimingRecordPerWaveform) {
  const ViInt32 records = 3, length = 500;
  horizontal(100e6, length, records, 20.0);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  ViInt32 count = 0;
  ASSERT_EQ(hsdig_ActualNumWfms(vi, "0-1", &count), VI_SUCCESS);
  ASSERT_EQ(count, 2 * records);
  ViInt32 recordLength = 0;
  ASSERT_EQ(hsdig_ActualRecordLength(vi, &recordLength), VI_SUCCESS);
  ASSERT_EQ(recordLength, length);
  // Ask for fewer samples than a record holds: each waveform gets exactly
  // that many, laid out back to back.
  const ViInt32 wanted = 400;
  std::vector<double> wfm(static_cast<size_t>(count * wanted) + 1, 42.0);
  std::vector<hsdigWfmInfo> info(static_cast<size_t>(count) + 1);
  ASSERT_EQ(hsdig_Fetch(vi, "0-1", 5.0, wanted, wfm.data(), info.data()), VI_SUCCESS);
  EXPECT_EQ(wfm.back(), 42.0) << "nothing past count x numSamples is written";
  EXPECT_EQ(info.back().actualSamples, 0);
  for (ViInt32 i = 0; i < count; ++i) {
    SCOPED_TRACE(i);
    const hsdigWfmInfo& w = info[static_cast<size_t>(i)];
    EXPECT_EQ(w.actualSamples, wanted);
    EXPECT_DOUBLE_EQ(w.xIncrement, 1e-8);
    EXPECT_DOUBLE_EQ(w.relativeInitialX, -100 * 1e-8) << "20 % of 500 samples before the trigger";
    EXPECT_EQ(w.gain, 1.0);
    if (i % records) {
      EXPECT_GT(w.absoluteInitialX, info[static_cast<size_t>(i - 1)].absoluteInitialX);
    }
  }
  // Channel 0 runs at 1 MHz and channel 1 at 2 MHz by default.
  double differ = 0;
  for (ViInt32 k = 0; k < wanted; ++k)
    differ += std::fabs(wfm[static_cast<size_t>(k)] - wfm[static_cast<size_t>(3 * wanted + k)]);
  EXPECT_GT(differ, 1.0) << "channel 0 and channel 1 carry different signals";

  // A channel triggered acquisition shows the same part of the signal in
  // every record.
  ASSERT_EQ(hsdig_ConfigureTriggerEdge(vi, "0", 0.0, HSDIG_VAL_POSITIVE, 1, 0, 0), VI_SUCCESS);
  ASSERT_EQ(hsdig_Read(vi, "0", 5.0, wanted, wfm.data(), info.data()), VI_SUCCESS);
  for (ViInt32 k = 0; k < wanted; ++k) {
    ASSERT_NEAR(wfm[static_cast<size_t>(k)], wfm[static_cast<size_t>(2 * wanted + k)],
                2.0 / 65536 * 4);
  }
  // The trigger point sits at the reference position, on a rising zero.
  EXPECT_LE(wfm[99], 0.0005);
  EXPECT_GE(wfm[101], -0.0005);
  EXPECT_GT(wfm[105], wfm[95]);
}

TEST_F(AcquisitionTest, SignalsFollowVerticalSettingsAndClip) {
  horizontal(100e6, 1000);
  ASSERT_EQ(hsdig_SetAttributeViInt32(vi, "0", HSDIG_ATTR_SIGNAL_SHAPE, HSDIG_VAL_SHAPE_DC),
            VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_OFFSET, 0.3), VI_SUCCESS);
  struct Case {
    const char* what;
    double range, offset, attenuation;
    ViInt32 coupling;
    double expected;
    ViStatus status;
  };
  const Case cases[] = {
      {"DC coupled", 1.0, 0.0, 1.0, HSDIG_VAL_DC, 0.3, VI_SUCCESS},
      {"AC coupled removes DC", 1.0, 0.0, 1.0, HSDIG_VAL_AC, 0.0, VI_SUCCESS},
      {"ground", 1.0, 0.0, 1.0, HSDIG_VAL_GND, 0.0, VI_SUCCESS},
      {"probe x10", 10.0, 0.0, 10.0, HSDIG_VAL_DC, 3.0, VI_SUCCESS},
      {"clipped at the top", 0.4, 0.0, 1.0, HSDIG_VAL_DC, 0.2 - 0.4 / 65536 * 4,
       HSDIG_WARN_DATA_CLIPPED},
      {"offset brings it back", 0.4, 0.25, 1.0, HSDIG_VAL_DC, 0.3, VI_SUCCESS},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.what);
    ASSERT_EQ(
        hsdig_ConfigureVertical(vi, "0", c.range, c.offset, c.coupling, c.attenuation, VI_TRUE),
        VI_SUCCESS);
    std::vector<double> wfm(1000);
    hsdigWfmInfo info{};
    EXPECT_EQ(hsdig_Read(vi, "0", 5.0, 1000, wfm.data(), &info), c.status);
    EXPECT_NEAR(wfm[500], c.expected, c.range / 65536 * 4);
    if (c.status > 0) {
      ErrorInfo e = takeError(vi);
      EXPECT_EQ(e.primary, HSDIG_WARN_DATA_CLIPPED);
      EXPECT_NE(e.elaboration.find("clipped"), std::string::npos);
    }
  }
}

TEST_F(AcquisitionTest, TimestampsAndDisabledChannels) {
  ViInt32 t[4] = {};
  ViReal64 device = -1;
  EXPECT_EQ(hsdig_GetStartTimestampInformation(vi, &t[0], &t[1], &t[2], &t[3], &device),
            HSDIG_ERROR_NO_ACQUISITION);
  takeError(vi);
  ASSERT_EQ(hsdig_SetAttributeViBoolean(vi, "3", HSDIG_ATTR_CHANNEL_ENABLED, VI_FALSE), VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  ASSERT_EQ(hsdig_GetStartTimestampInformation(vi, &t[0], &t[1], &t[2], &t[3], &device),
            VI_SUCCESS);
  const std::uint64_t seconds = (std::uint64_t(std::uint32_t(t[0])) << 32) | std::uint32_t(t[1]);
  EXPECT_GT(seconds, 1600000000u) << "seconds since 1970";
  EXPECT_GE(device, 0.0);
  std::vector<double> wfm(2000);
  std::vector<hsdigWfmInfo> info(2);
  EXPECT_EQ(hsdig_Fetch(vi, "2,3", 5.0, 1000, wfm.data(), info.data()),
            HSDIG_ERROR_INVALID_CHANNEL);
  ViInt32 state = 0;
  ASSERT_EQ(hsdig_GetSessionState(vi, "3", &state), VI_SUCCESS);
  EXPECT_EQ(state, HSDIG_VAL_STATE_DISABLED);
}

}  // namespace
}  // namespace hsdig::test

namespace hsdig::test {
namespace {

// A caller sizes a cached fetch from ActualNumWfms and ActualRecordLength
// while a new, smaller acquisition is still waiting: the buffer must hold
// what the cached (older, larger) acquisition writes.
TEST_F(AcquisitionTest, SizesCoverTheCachedAcquisitionWhileANewOneWaits) {
  horizontal(100e6, 300, 4);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  std::vector<double> first(1200);
  std::vector<hsdigWfmInfo> firstInfo(4);
  ASSERT_EQ(hsdig_Fetch(vi, "0", 5.0, 300, first.data(), firstInfo.data()), VI_SUCCESS);
  horizontal(100e6, 100, 1);
  ASSERT_EQ(hsdig_ConfigureTriggerSoftware(vi, 0, 0), VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  ViInt32 wfms = 0, length = 0;
  ASSERT_EQ(hsdig_ActualNumWfms(vi, "0", &wfms), VI_SUCCESS);
  ASSERT_EQ(hsdig_ActualRecordLength(vi, &length), VI_SUCCESS);
  EXPECT_EQ(wfms, 4);
  EXPECT_EQ(length, 300);
  std::vector<ViInt16> cached(static_cast<size_t>(wfms * length) + 1, 7);
  std::vector<hsdigWfmInfo> info(static_cast<size_t>(wfms) + 1);
  ASSERT_EQ(hsdig_CachedFetch(vi, "0", length, HSDIG_VAL_BINARY16, cached.data(), info.data()),
            VI_SUCCESS);
  EXPECT_EQ(cached.back(), 7);
  EXPECT_EQ(info[3].actualSamples, 300);
  EXPECT_EQ(info[4].actualSamples, 0);
  EXPECT_NEAR(cached[5] * info[0].gain + info[0].offset, first[5], 1e-12);
}

}  // namespace
}  // namespace hsdig::test
