// Scalar and array measurements of known signals, statistics and
// processing steps.
#include <cmath>
#include <numbers>

#include "DigitizerTestSupport.h"

namespace hsdig::test {
namespace {

class MeasurementTest : public DigitizerTest {
 protected:
  void SetUp() override {
    DigitizerTest::SetUp();
    // 1 MHz sine of 0.4 V peak (0.8 V peak to peak), 100 MS/s, 10 periods.
    horizontal(100e6, 1000);
    ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  }
  double measure(ViInt32 function, const char* channel = "0") {
    ViReal64 v = 0;
    EXPECT_EQ(hsdig_FetchMeasurement(vi, channel, 5.0, function, &v), VI_SUCCESS)
        << takeError(vi).elaboration;
    return v;
  }
};

TEST_F(MeasurementTest, ASineMeasuresAsExpected) {
  const double amplitude = 0.4, period = 1e-6;
  struct Case {
    const char* name;
    ViInt32 function;
    double expected, tolerance;
  };
  const Case cases[] = {
      {"peak to peak", HSDIG_MEAS_VOLTAGE_PEAK_TO_PEAK, 2 * amplitude, 0.002},
      {"maximum", HSDIG_MEAS_VOLTAGE_MAX, amplitude, 0.001},
      {"minimum", HSDIG_MEAS_VOLTAGE_MIN, -amplitude, 0.001},
      {"mean", HSDIG_MEAS_VOLTAGE_AVERAGE, 0.0, 0.001},
      {"RMS", HSDIG_MEAS_VOLTAGE_RMS, amplitude / std::numbers::sqrt2, 0.001},
      {"frequency", HSDIG_MEAS_FREQUENCY, 1e6, 1e6 * 0.001},
      {"period", HSDIG_MEAS_PERIOD, period, period * 0.001},
      // 10 % to 90 % of a sine: (asin(0.8) - asin(-0.8)) / (2 pi) periods.
      {"rise time", HSDIG_MEAS_RISE_TIME, std::asin(0.8) / std::numbers::pi * period,
       0.01 * period},
      {"fall time", HSDIG_MEAS_FALL_TIME, std::asin(0.8) / std::numbers::pi * period,
       0.01 * period},
      {"positive width", HSDIG_MEAS_WIDTH_POS, period / 2, 0.01 * period},
      {"duty cycle", HSDIG_MEAS_DUTY_CYCLE_POS, 50.0, 0.5},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    EXPECT_NEAR(measure(c.function), c.expected, c.tolerance);
  }
  EXPECT_NEAR(measure(HSDIG_MEAS_FREQUENCY, "1"), 2e6, 2e3) << "channel 1 runs at 2 MHz";
}

TEST_F(MeasurementTest, ASquareWaveHasFlatHighAndLow) {
  ASSERT_EQ(hsdig_SetAttributeViInt32(vi, "0", HSDIG_ATTR_SIGNAL_SHAPE, HSDIG_VAL_SHAPE_SQUARE),
            VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_DUTY_CYCLE, 25.0), VI_SUCCESS);
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_OFFSET, 0.1), VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  EXPECT_NEAR(measure(HSDIG_MEAS_VOLTAGE_HIGH), 0.5, 0.01);
  EXPECT_NEAR(measure(HSDIG_MEAS_VOLTAGE_LOW), -0.3, 0.01);
  EXPECT_NEAR(measure(HSDIG_MEAS_AMPLITUDE), 0.8, 0.01);
  EXPECT_NEAR(measure(HSDIG_MEAS_DUTY_CYCLE_POS), 25.0, 1.0);
  EXPECT_NEAR(measure(HSDIG_MEAS_FREQUENCY), 1e6, 1e3);
}

TEST_F(MeasurementTest, StatisticsCountEachAcquisitionOnce) {
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_NOISE, 0.02), VI_SUCCESS);
  for (int i = 0; i < 4; ++i) {
    ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
    measure(HSDIG_MEAS_VOLTAGE_MAX);
    measure(HSDIG_MEAS_VOLTAGE_MAX);  // the same acquisition again
  }
  ViReal64 result = 0, mean = 0, stdev = 0, min = 0, max = 0;
  ViInt32 count = 0;
  ASSERT_EQ(hsdig_FetchMeasurementStats(vi, "0", 5.0, HSDIG_MEAS_VOLTAGE_MAX, &result, &mean,
                                        &stdev, &min, &max, &count),
            VI_SUCCESS);
  EXPECT_EQ(count, 4);
  EXPECT_LE(min, mean);
  EXPECT_LE(mean, max);
  EXPECT_LT(min, max) << "noise makes the maxima differ";
  EXPECT_GT(stdev, 0.0);
  EXPECT_NEAR(mean, 0.4 + 2.5 * 0.02, 0.06);
  ASSERT_EQ(hsdig_ClearWaveformMeasurementStats(vi, "0", HSDIG_MEAS_ALL_MEASUREMENTS), VI_SUCCESS);
  ASSERT_EQ(hsdig_FetchMeasurementStats(vi, "0", 5.0, HSDIG_MEAS_VOLTAGE_MAX, nullptr, nullptr,
                                        nullptr, nullptr, nullptr, &count),
            VI_SUCCESS);
  EXPECT_EQ(count, 1);
}

TEST_F(MeasurementTest, ArrayMeasurementsAndProcessing) {
  ViInt32 size = 0;
  ASSERT_EQ(hsdig_ActualMeasWfmSize(vi, HSDIG_MEAS_FFT_AMP_SPECTRUM_VOLTS_RMS, &size), VI_SUCCESS);
  ASSERT_EQ(size, 513) << "1000 samples padded to 1024";
  std::vector<double> spectrum(static_cast<size_t>(size));
  hsdigWfmInfo info{};
  ASSERT_EQ(hsdig_FetchArrayMeasurement(vi, "0", 5.0, HSDIG_MEAS_FFT_AMP_SPECTRUM_VOLTS_RMS, -1,
                                        spectrum.data(), &info),
            VI_SUCCESS);
  EXPECT_EQ(info.actualSamples, size);
  EXPECT_DOUBLE_EQ(info.xIncrement, 100e6 / 1024);
  size_t peak = std::max_element(spectrum.begin(), spectrum.end()) - spectrum.begin();
  EXPECT_NEAR(peak * info.xIncrement, 1e6, info.xIncrement);
  // 1 MHz lies between bins, so leakage spreads some of its power.
  EXPECT_NEAR(spectrum[peak], 0.4 / std::numbers::sqrt2, 0.1);

  std::vector<double> negated(1000);
  ASSERT_EQ(hsdig_ActualMeasWfmSize(vi, HSDIG_MEAS_ARRAY_NEGATE, &size), VI_SUCCESS);
  ASSERT_EQ(size, 1000);
  ASSERT_EQ(hsdig_FetchArrayMeasurement(vi, "0", 5.0, HSDIG_MEAS_ARRAY_NEGATE, 1000, negated.data(),
                                        &info),
            VI_SUCCESS);
  std::vector<double> wfm(1000);
  ASSERT_EQ(hsdig_Fetch(vi, "0", 5.0, 1000, wfm.data(), &info), VI_SUCCESS);
  for (int k = 0; k < 1000; ++k)
    ASSERT_EQ(negated[static_cast<size_t>(k)], -wfm[static_cast<size_t>(k)]);

  // A processing step changes what scalar measurements see, not the data.
  ASSERT_EQ(hsdig_AddWaveformProcessing(vi, "0", HSDIG_MEAS_ARRAY_SQUARE), VI_SUCCESS);
  EXPECT_NEAR(measure(HSDIG_MEAS_VOLTAGE_AVERAGE), 0.08, 0.001)
      << "mean of the squared sine: A^2 / 2";
  ASSERT_EQ(hsdig_ClearWaveformProcessing(vi, "0"), VI_SUCCESS);
  EXPECT_NEAR(measure(HSDIG_MEAS_VOLTAGE_AVERAGE), 0.0, 0.001);
}

TEST_F(MeasurementTest, ScalarMeasurementsNeedOneWaveform) {
  ViReal64 v = 0;
  EXPECT_EQ(hsdig_FetchMeasurement(vi, "0,1", 5.0, HSDIG_MEAS_VOLTAGE_MAX, &v),
            HSDIG_ERROR_TOO_MANY_WAVEFORMS);
  EXPECT_EQ(takeError(vi).primary, HSDIG_ERROR_TOO_MANY_WAVEFORMS);
  ASSERT_EQ(hsdig_SetAttributeViInt32(vi, "0", HSDIG_ATTR_SIGNAL_SHAPE, HSDIG_VAL_SHAPE_DC),
            VI_SUCCESS);
  ASSERT_EQ(hsdig_InitiateAcquisition(vi), VI_SUCCESS);
  EXPECT_EQ(hsdig_FetchMeasurement(vi, "0", 5.0, HSDIG_MEAS_FREQUENCY, &v),
            HSDIG_ERROR_MEASUREMENT);
  EXPECT_EQ(takeError(vi).primary, HSDIG_ERROR_MEASUREMENT);
  EXPECT_EQ(hsdig_ReadMeasurement(vi, "0", 5.0, HSDIG_MEAS_VOLTAGE_AVERAGE, &v), VI_SUCCESS);
}

}  // namespace
}  // namespace hsdig::test
