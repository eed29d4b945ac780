#include "Demo.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

#include "hsdig.h"
#include "hsdigAttributes.h"
#include "hsdigRemote/hsdigRemote.h"

namespace hsdig::demo {

namespace {

// Reports a refused call with the library's text for its status. Returns
// true when the job can go on (success or a warning).
bool accepted(std::FILE* out, ViStatus status, const char* what) {
  if (status == 0) return true;
  char text[1024] = "";
  hsdigRemote_GetErrorMessage(0, status, static_cast<ViInt32>(sizeof text), text);
  std::fprintf(out, "%s: %s 0x%08X\n  %s\n", what, status < 0 ? "error" : "warning",
               static_cast<unsigned>(status), text);
  return status > 0;
}

void plot(std::FILE* out, const std::vector<double>& samples, double range, int width, int height) {
  std::vector<std::string> rows(static_cast<size_t>(height), std::string(width, ' '));
  const size_t n = samples.size();
  for (int x = 0; x < width; ++x) {
    const double v = samples[static_cast<size_t>(x) * n / static_cast<size_t>(width)];
    const double top = range / 2;
    int y = static_cast<int>(std::lround((top - v) / range * (height - 1)));
    y = std::clamp(y, 0, height - 1);
    rows[static_cast<size_t>(y)][static_cast<size_t>(x)] = '*';
  }
  for (int y = 0; y < height; ++y) {
    const double level = range / 2 - range * y / (height - 1);
    std::fprintf(out, "%+6.2f V |%s\n", level, rows[static_cast<size_t>(y)].c_str());
  }
}

}  // namespace

int run(const Options& options, std::FILE* out) {
  const std::string setup = "Simulate=1,DriverSetup=Model:" + options.model;
  char resource[] = "SimulatedDigitizer";
  ViSession vi = 0;
  if (!accepted(out, hsdig_InitWithOptions(resource, VI_FALSE, VI_TRUE, setup.c_str(), &vi),
                "opening the simulated digitizer")) {
    return 1;
  }
  ViInt32 channels = 0;  // the engine's channel count attribute
  hsdig_GetAttributeViInt32(vi, "", 1050203, &channels);
  std::fprintf(out, "Simulated digitizer %s with %d channels, session %u\n\n",
               options.model.c_str(), channels, vi);

  // Channel 0: a sine at the chosen frequency; channel 1: a square wave of
  // half that frequency with a little noise. Trigger on channel 0's rising
  // edge at 0 V.
  const double range = 2.0;
  const ViInt32 points = 2000;
  ViInt32 length = 0;
  std::vector<double> samples;
  std::vector<hsdigWfmInfo> info(1);
  const bool configured =
      accepted(out, hsdig_ConfigureVertical(vi, "0,1", range, 0.0, HSDIG_VAL_DC, 1.0, VI_TRUE),
               "configuring the vertical range") &&
      accepted(out,
               hsdig_SetAttributeViInt32(vi, "1", HSDIG_ATTR_SIGNAL_SHAPE, HSDIG_VAL_SHAPE_SQUARE),
               "choosing the square wave") &&
      accepted(
          out,
          hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_SIGNAL_FREQUENCY, options.frequencyHz),
          "setting the frequency") &&
      accepted(
          out,
          hsdig_SetAttributeViReal64(vi, "1", HSDIG_ATTR_SIGNAL_FREQUENCY, options.frequencyHz / 2),
          "setting the frequency") &&
      accepted(out, hsdig_SetAttributeViReal64(vi, "1", HSDIG_ATTR_SIGNAL_NOISE, 0.01),
               "setting the noise") &&
      accepted(out, hsdig_ConfigureHorizontalTiming(vi, 100.0e6, points, 0.0, 1, VI_TRUE),
               "configuring the timing") &&
      accepted(out,
               hsdig_ConfigureTriggerEdge(vi, "0", 0.0, HSDIG_VAL_POSITIVE,
                                          HSDIG_VAL_TRIGGER_COUPLING_DC, 0.0, 0.0),
               "configuring the trigger") &&
      accepted(out, hsdig_InitiateAcquisition(vi), "starting the acquisition") &&
      accepted(out, hsdig_ActualRecordLength(vi, &length), "asking for the record length");
  if (configured) {
    samples.resize(static_cast<size_t>(length));
  }
  if (!configured || !accepted(out, hsdig_Fetch(vi, "0", 5.0, length, samples.data(), info.data()),
                               "fetching channel 0")) {
    hsdig_close(vi);
    return 1;
  }

  std::fprintf(out, "%-9s %12s %12s %14s %12s\n", "channel", "Vpp", "RMS", "frequency",
               "rise time");
  for (const char* channel : {"0", "1"}) {
    double vpp = 0, rms = 0, frequency = 0, rise = 0;
    hsdig_FetchMeasurement(vi, channel, 5.0, HSDIG_MEAS_VOLTAGE_PEAK_TO_PEAK, &vpp);
    hsdig_FetchMeasurement(vi, channel, 5.0, HSDIG_MEAS_VOLTAGE_RMS, &rms);
    hsdig_FetchMeasurement(vi, channel, 5.0, HSDIG_MEAS_FREQUENCY, &frequency);
    hsdig_FetchMeasurement(vi, channel, 5.0, HSDIG_MEAS_RISE_TIME, &rise);
    std::fprintf(out, "%-9s %10.3f V %10.3f V %11.3f kHz %9.1f ns\n", channel, vpp, rms,
                 frequency / 1e3, rise * 1e9);
  }
  // Three periods of channel 0 fill the plot.
  const double samplesPerPeriod = 1.0 / (options.frequencyHz * info[0].xIncrement);
  const size_t shown = std::clamp<size_t>(static_cast<size_t>(3 * samplesPerPeriod),
                                          static_cast<size_t>(options.width), samples.size());
  std::fprintf(out, "\nChannel 0, the first %zu of %d samples at %.0f MS/s:\n", shown, length,
               1.0 / info[0].xIncrement / 1e6);
  plot(out, std::vector<double>(samples.begin(), samples.begin() + static_cast<long>(shown)), range,
       options.width, options.height);

  // A refused call, and the text the library gives for it.
  std::fprintf(out, "\nAsking for a vertical range of -5 V on channel 9:\n");
  const ViStatus status = hsdig_ConfigureVertical(vi, "9", -5.0, 0.0, HSDIG_VAL_DC, 1.0, VI_TRUE);
  char text[1024] = "";
  hsdigRemote_GetErrorMessage(0, status, static_cast<ViInt32>(sizeof text), text);
  std::fprintf(out, "  status 0x%08X: %s\n", static_cast<unsigned>(status), text);

  hsdig_close(vi);
  return 0;
}

}  // namespace hsdig::demo
