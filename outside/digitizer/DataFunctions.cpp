// Waveform fetch and read in every sample format, cached fetch, scalar and
// array measurements with statistics.
//
// Waveform i of a fetch (channel-major: every record of the first channel
// of the list, then the next channel) starts at element i x numSamples and
// fills timing entry i. Binary samples are the acquisition's 16-bit codes
// shifted to the format's width; each timing entry carries the gain and
// offset that turn them back into volts (volts = sample x gain + offset).
// The scaled formats carry gain 1 and offset 0. Complex formats count a
// (real, imaginary) pair as one sample; the simulated front end has no
// down-converter, so the imaginary part is 0.
#include <algorithm>
#include <cmath>
#include <cstring>

#include "Boundary.h"
#include "Values.h"

using namespace hsdig::sim;

namespace {

enum class Format {
  Real64,
  Binary8,
  Binary16,
  Binary32,
  ComplexReal64,
  ComplexBinary8,
  ComplexBinary16,
  ComplexBinary32
};

Format formatOf(ViInt32 dataType) {
  switch (dataType) {
    case HSDIG_VAL_BINARY8:
      return Format::Binary8;
    case HSDIG_VAL_BINARY16:
      return Format::Binary16;
    case HSDIG_VAL_BINARY32:
      return Format::Binary32;
    case HSDIG_VAL_REAL64:
      return Format::Real64;
    case HSDIG_VAL_COMPLEX_BINARY8:
      return Format::ComplexBinary8;
    case HSDIG_VAL_COMPLEX_BINARY16:
      return Format::ComplexBinary16;
    case HSDIG_VAL_COMPLEX_BINARY32:
      return Format::ComplexBinary32;
    case HSDIG_VAL_COMPLEX_REAL64:
      return Format::ComplexReal64;
    default:
      fail(HSDIG_ERROR_NOT_SUPPORTED,
           "The data type " + std::to_string(dataType) +
               " is not a sample format (1, 2, 4, 8, 1000, 1001, 1002, 1003).");
  }
}

// Converts `n` codes into the format at `out` (element index `at`).
void convert(Format f, const std::int16_t* codes, size_t n, void* out, size_t at, double gain,
             double offset) {
  switch (f) {
    case Format::Binary16:
      std::memcpy(static_cast<std::int16_t*>(out) + at, codes, n * sizeof(std::int16_t));
      break;
    case Format::Binary8: {
      auto* o = static_cast<std::int8_t*>(out) + at;
      for (size_t k = 0; k < n; ++k) o[k] = static_cast<std::int8_t>(codes[k] >> 8);
      break;
    }
    case Format::Binary32: {
      auto* o = static_cast<std::int32_t*>(out) + at;
      for (size_t k = 0; k < n; ++k)
        o[k] = static_cast<std::int32_t>(static_cast<std::uint32_t>(codes[k]) << 16);
      break;
    }
    case Format::Real64: {
      auto* o = static_cast<double*>(out) + at;
      for (size_t k = 0; k < n; ++k) o[k] = codes[k] * gain + offset;
      break;
    }
    case Format::ComplexReal64: {
      auto* o = static_cast<double*>(out) + 2 * at;
      for (size_t k = 0; k < n; ++k) {
        o[2 * k] = codes[k] * gain + offset;
        o[2 * k + 1] = 0.0;
      }
      break;
    }
    case Format::ComplexBinary8: {
      auto* o = static_cast<std::int8_t*>(out) + 2 * at;
      for (size_t k = 0; k < n; ++k) {
        o[2 * k] = static_cast<std::int8_t>(codes[k] >> 8);
        o[2 * k + 1] = 0;
      }
      break;
    }
    case Format::ComplexBinary16: {
      auto* o = static_cast<std::int16_t*>(out) + 2 * at;
      for (size_t k = 0; k < n; ++k) {
        o[2 * k] = codes[k];
        o[2 * k + 1] = 0;
      }
      break;
    }
    case Format::ComplexBinary32: {
      auto* o = static_cast<std::int32_t*>(out) + 2 * at;
      for (size_t k = 0; k < n; ++k) {
        o[2 * k] = static_cast<std::int32_t>(static_cast<std::uint32_t>(codes[k]) << 16);
        o[2 * k + 1] = 0;
      }
      break;
    }
  }
}

// Gain of one sample of the format, from the 16-bit code's gain.
double formatGain(Format f, double gain16) {
  switch (f) {
    case Format::Binary8:
    case Format::ComplexBinary8:
      return gain16 * 256.0;
    case Format::Binary16:
    case Format::ComplexBinary16:
      return gain16;
    case Format::Binary32:
    case Format::ComplexBinary32:
      return gain16 / 65536.0;
    default:
      return 1.0;
  }
}
bool scaled(Format f) {
  return f == Format::Real64 || f == Format::ComplexReal64;
}

std::vector<int> enabledChannels(const Digitizer& d, Acquisition& a, ViConstString list) {
  std::vector<int> channels = parseChannelList(d, list);
  for (int c : channels) {
    if (!a.channels[static_cast<size_t>(c)].enabled) {
      fail(HSDIG_ERROR_INVALID_CHANNEL,
           "Channel " + channelName(c) + " was disabled in this acquisition.");
    }
  }
  materialize(a, channels);
  return channels;
}

ViStatus fetchInto(Digitizer& d, ViConstString list, double timeout, ViInt32 numSamples,
                   Format format, void* wfm, hsdigWfmInfo* info, bool cached) {
  parseChannelList(d, list);
  requirePointer(wfm, "wfm");
  requirePointer(info, "wfmInfo");
  if (numSamples < -1)
    fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
         "numSamples " + std::to_string(numSamples) + " is below -1.");
  std::shared_ptr<Acquisition> acq = cached ? d.cachedData() : d.waitForData(timeout);
  Acquisition& a = *acq;
  std::vector<int> channels = enabledChannels(d, a, list);
  const size_t n =
      numSamples == -1 ? static_cast<size_t>(a.recordLength) : static_cast<size_t>(numSamples);
  const ViInt32 relativeTo = getInt32(d.vi, "", HSDIG_ATTR_FETCH_RELATIVE_TO);
  const std::int64_t requested = getInt64(d.vi, "", HSDIG_ATTR_FETCH_OFFSET) +
                                 (relativeTo == HSDIG_VAL_TRIGGER_RELATIVE ? a.refIndex : 0);
  const size_t start = static_cast<size_t>(std::clamp<std::int64_t>(requested, 0, a.recordLength));
  const size_t actual = std::min(n, static_cast<size_t>(a.recordLength) - start);
  bool clipped = false;
  size_t index = 0;
  for (int c : channels) {
    const ChannelSetup& setup = a.channels[static_cast<size_t>(c)];
    const ChannelData& data = a.data[static_cast<size_t>(c)];
    for (std::int32_t r = 0; r < a.numRecords; ++r, ++index) {
      const std::int16_t* codes =
          data.codes.get() + static_cast<size_t>(r) * static_cast<size_t>(a.recordLength) + start;
      convert(format, codes, actual, wfm, index * n, setup.gain(), setup.offset);
      clipped = clipped || data.clipped[static_cast<size_t>(r)];
      hsdigWfmInfo& w = info[index];
      w = hsdigWfmInfo{};
      w.xIncrement = 1.0 / a.sampleRate;
      w.relativeInitialX =
          (static_cast<double>(start) - a.refIndex) / a.sampleRate + a.triggerDelay;
      w.absoluteInitialX = a.triggerTimes[static_cast<size_t>(r)] + w.relativeInitialX;
      w.actualSamples = static_cast<ViInt32>(actual);
      w.gain = formatGain(format, setup.gain());
      w.offset = scaled(format) ? 0.0 : setup.offset;
    }
  }
  if (clipped) {
    pendingWarningText() =
        "Some samples reached an edge of the vertical range and are clipped; widen the range "
        "or move the offset.";
    return HSDIG_WARN_DATA_CLIPPED;
  }
  return VI_SUCCESS;
}

Trace processedRecord(const Digitizer& d, const Acquisition& a, int channel, int record) {
  Trace t = scaledRecord(a, channel, record);
  for (ViInt32 step : d.processing[static_cast<size_t>(channel)]) t = arrayMeasurement(t, step);
  return t;
}

// The one waveform a scalar measurement reads.
int singleChannel(const Digitizer& d, Acquisition& a, ViConstString list) {
  std::vector<int> channels = enabledChannels(d, a, list);
  if (channels.size() * static_cast<size_t>(a.numRecords) != 1) {
    fail(HSDIG_ERROR_TOO_MANY_WAVEFORMS,
         "\"" + std::string(list) + "\" with " + std::to_string(a.numRecords) +
             " record(s) gives " +
             std::to_string(channels.size() * static_cast<size_t>(a.numRecords)) +
             " waveforms; a scalar measurement returns one value, so name one channel of a "
             "one-record acquisition.");
  }
  return channels[0];
}

void checkScalar(ViInt32 function) {
  if (!isScalarFunction(function)) {
    fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
         "Scalar measurement function " + std::to_string(function) +
             " is not one of HSDIG_MEAS_RISE_TIME (0) to HSDIG_MEAS_AMPLITUDE (15).");
  }
}

// Measures and adds the value to the statistics once per acquisition.
double measure(Digitizer& d, const Acquisition& a, int channel, ViInt32 function,
               MeasurementStats** statsOut = nullptr) {
  const double value = scalarMeasurement(processedRecord(d, a, channel, 0), function);
  MeasurementStats& s = d.stats[{channel, function}];
  if (s.lastAcquisition != a.number) {
    s.lastAcquisition = a.number;
    s.min = s.count ? std::min(s.min, value) : value;
    s.max = s.count ? std::max(s.max, value) : value;
    s.sum += value;
    s.sumSquares += value * value;
    ++s.count;
  }
  s.last = value;
  if (statsOut) *statsOut = &s;
  return value;
}

ViStatus fetchMeasurement(Digitizer& d, ViConstString list, double timeout, ViInt32 function,
                          ViReal64* result) {
  requirePointer(result, "result");
  checkScalar(function);
  parseChannelList(d, list);
  auto a = d.waitForData(timeout);
  *result = measure(d, *a, singleChannel(d, *a, list), function);
  return VI_SUCCESS;
}

}  // namespace

extern "C" {

#define HSDIG_FETCH(Function, T, format)                                                  \
  ViStatus hsdig_##Function(ViSession vi, ViConstString channelList, ViReal64 timeout,    \
                            ViInt32 numSamples, T wfm[], hsdigWfmInfo wfmInfo[]) {        \
    return callDriver(vi, "hsdig_" #Function, [&](Digitizer& d) {                         \
      return fetchInto(d, channelList, timeout, numSamples, format, wfm, wfmInfo, false); \
    });                                                                                   \
  }
HSDIG_FETCH(Fetch, ViReal64, Format::Real64)
HSDIG_FETCH(FetchBinary8, ViInt8, Format::Binary8)
HSDIG_FETCH(FetchBinary16, ViInt16, Format::Binary16)
HSDIG_FETCH(FetchBinary32, ViInt32, Format::Binary32)
HSDIG_FETCH(FetchComplex, ViReal64, Format::ComplexReal64)
HSDIG_FETCH(FetchComplexBinary16, ViInt16, Format::ComplexBinary16)
#undef HSDIG_FETCH

ViStatus hsdig_Read(ViSession vi, ViConstString channelList, ViReal64 timeout, ViInt32 numSamples,
                    ViReal64 wfm[], hsdigWfmInfo wfmInfo[]) {
  return callDriver(vi, "hsdig_Read", [&](Digitizer& d) {
    parseChannelList(d, channelList);
    requirePointer(wfm, "wfm");
    requirePointer(wfmInfo, "wfmInfo");
    d.initiate();
    return fetchInto(d, channelList, timeout, numSamples, Format::Real64, wfm, wfmInfo, false);
  });
}

ViStatus hsdig_CachedFetch(ViSession vi, ViConstString channelList, ViInt32 numSamples,
                           ViInt32 dataType, void* wfm, hsdigWfmInfo wfmInfo[]) {
  return callDriver(vi, "hsdig_CachedFetch", [&](Digitizer& d) {
    const Format format = formatOf(dataType);
    return fetchInto(d, channelList, 0, numSamples, format, wfm, wfmInfo, true);
  });
}

ViStatus hsdig_FetchMeasurement(ViSession vi, ViConstString channelList, ViReal64 timeout,
                                ViInt32 scalarMeasFunction, ViReal64* result) {
  return callDriver(vi, "hsdig_FetchMeasurement", [&](Digitizer& d) {
    return fetchMeasurement(d, channelList, timeout, scalarMeasFunction, result);
  });
}

ViStatus hsdig_ReadMeasurement(ViSession vi, ViConstString channelList, ViReal64 timeout,
                               ViInt32 scalarMeasFunction, ViReal64* result) {
  return callDriver(vi, "hsdig_ReadMeasurement", [&](Digitizer& d) {
    requirePointer(result, "result");
    checkScalar(scalarMeasFunction);
    parseChannelList(d, channelList);
    d.initiate();
    return fetchMeasurement(d, channelList, timeout, scalarMeasFunction, result);
  });
}

ViStatus hsdig_FetchMeasurementStats(ViSession vi, ViConstString channelList, ViReal64 timeout,
                                     ViInt32 scalarMeasFunction, ViReal64* result, ViReal64* mean,
                                     ViReal64* stdev, ViReal64* min, ViReal64* max,
                                     ViInt32* numInStats) {
  return callDriver(vi, "hsdig_FetchMeasurementStats", [&](Digitizer& d) {
    checkScalar(scalarMeasFunction);
    parseChannelList(d, channelList);
    auto a = d.waitForData(timeout);
    MeasurementStats* s = nullptr;
    const double value = measure(d, *a, singleChannel(d, *a, channelList), scalarMeasFunction, &s);
    const double m = s->sum / s->count;
    const double variance = std::max(0.0, s->sumSquares / s->count - m * m);
    if (result) *result = value;
    if (mean) *mean = m;
    if (stdev) *stdev = std::sqrt(variance);
    if (min) *min = s->min;
    if (max) *max = s->max;
    if (numInStats) *numInStats = s->count;
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ClearWaveformMeasurementStats(ViSession vi, ViConstString channelList,
                                             ViInt32 clearableMeasurementFunction) {
  return callDriver(vi, "hsdig_ClearWaveformMeasurementStats", [&](Digitizer& d) {
    std::vector<int> channels;
    if (!channelList || std::string(channelList).find_first_not_of(" \t") == std::string::npos) {
      for (int c = 0; c < d.model.channels; ++c) channels.push_back(c);
    } else {
      channels = parseChannelList(d, channelList);
    }
    if (clearableMeasurementFunction != HSDIG_MEAS_ALL_MEASUREMENTS)
      checkScalar(clearableMeasurementFunction);
    for (auto it = d.stats.begin(); it != d.stats.end();) {
      const bool channelMatches =
          std::find(channels.begin(), channels.end(), it->first.first) != channels.end();
      const bool functionMatches = clearableMeasurementFunction == HSDIG_MEAS_ALL_MEASUREMENTS ||
                                   it->first.second == clearableMeasurementFunction;
      it = channelMatches && functionMatches ? d.stats.erase(it) : std::next(it);
    }
    return VI_SUCCESS;
  });
}

ViStatus hsdig_FetchArrayMeasurement(ViSession vi, ViConstString channelList, ViReal64 timeout,
                                     ViInt32 arrayMeasFunction, ViInt32 measWfmSize,
                                     ViReal64 measWfm[], hsdigWfmInfo wfmInfo[]) {
  return callDriver(vi, "hsdig_FetchArrayMeasurement", [&](Digitizer& d) {
    parseChannelList(d, channelList);
    requirePointer(measWfm, "measWfm");
    requirePointer(wfmInfo, "wfmInfo");
    if (!isArrayFunction(arrayMeasFunction)) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "Array measurement function " +
                                               std::to_string(arrayMeasFunction) +
                                               " is not one of 1000 to 1008.");
    }
    if (measWfmSize < -1)
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "measWfmSize " + std::to_string(measWfmSize) + " is below -1.");
    auto a = d.waitForData(timeout);
    std::vector<int> channels = enabledChannels(d, *a, channelList);
    const size_t room =
        measWfmSize == -1
            ? static_cast<size_t>(arrayMeasurementSize(a->recordLength, arrayMeasFunction))
            : static_cast<size_t>(measWfmSize);
    size_t index = 0;
    for (int c : channels) {
      for (std::int32_t r = 0; r < a->numRecords; ++r, ++index) {
        Trace t = arrayMeasurement(processedRecord(d, *a, c, r), arrayMeasFunction);
        const size_t count = std::min(room, t.y.size());
        if (count) std::memcpy(measWfm + index * room, t.y.data(), count * sizeof(double));
        hsdigWfmInfo& w = wfmInfo[index];
        w = hsdigWfmInfo{};
        w.relativeInitialX = t.x0;
        w.absoluteInitialX = arrayMeasFunction >= HSDIG_MEAS_FFT_AMP_SPECTRUM_VOLTS_RMS
                                 ? t.x0
                                 : a->triggerTimes[static_cast<size_t>(r)] + t.x0;
        w.xIncrement = t.dx;
        w.actualSamples = static_cast<ViInt32>(count);
        w.gain = 1.0;
      }
    }
    return VI_SUCCESS;
  });
}

}  // extern "C"
