// Queries: sizes and states, channel names, coefficients, frequency
// response, timestamps, stream endpoints, revision and self test.
#include <cmath>
#include <cstdio>
#include <cstring>
#include <numbers>

#include "Boundary.h"
#include "Values.h"

using namespace hsdig::sim;

namespace {

void put(ViInt32* out, ViInt32 value) {
  if (out) *out = value;
}

int oneChannel(const Digitizer& d, ViConstString channel) {
  std::vector<int> channels = parseChannelList(d, channel);
  if (channels.size() != 1) {
    fail(HSDIG_ERROR_INVALID_CHANNEL,
         "\"" + std::string(channel) + "\" names more than one channel.");
  }
  return channels[0];
}

ViStatus coefficients(Digitizer& d, ViConstString list, ViInt32 bufferSize,
                      hsdigCoefficientInfo* info, ViInt32* count, bool normalization) {
  requirePointer(count, "numberOfCoefficientSets");
  std::vector<int> channels = parseChannelList(d, list);
  if (bufferSize < 0) fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "bufferSize is negative.");
  if (bufferSize > 0) requirePointer(info, "coefficientInfo");
  // Scaling turns 16-bit codes into volts; normalization into the fraction
  // of full scale (-1 to 1).
  for (size_t i = 0; i < channels.size() && i < static_cast<size_t>(bufferSize); ++i) {
    std::string ch = channelName(channels[i]);
    hsdigCoefficientInfo c{};
    if (normalization) {
      c.gain = 1.0 / 32768.0;
    } else {
      c.gain = getReal64(d.vi, ch.c_str(), HSDIG_ATTR_VERTICAL_RANGE) / 65536.0;
      c.offset = getReal64(d.vi, ch.c_str(), HSDIG_ATTR_VERTICAL_OFFSET);
    }
    info[i] = c;
  }
  *count = static_cast<ViInt32>(channels.size());
  return VI_SUCCESS;
}

void copyFixed(const std::string& text, ViChar* buffer) {
  if (!buffer) return;
  std::snprintf(buffer, 256, "%s", text.c_str());
}

}  // namespace

extern "C" {

ViStatus hsdig_ActualNumWfms(ViSession vi, ViConstString channelList, ViInt32* numWfms) {
  return callDriver(vi, "hsdig_ActualNumWfms", [&](Digitizer& d) {
    requirePointer(numWfms, "numWfms");
    std::vector<int> channels = parseChannelList(d, channelList);
    *numWfms = static_cast<ViInt32>(channels.size()) * d.sizingRecords();
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ActualRecordLength(ViSession vi, ViInt32* recordLength) {
  return callDriver(vi, "hsdig_ActualRecordLength", [&](Digitizer& d) {
    requirePointer(recordLength, "recordLength");
    *recordLength = d.sizingLength();
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ActualMeasWfmSize(ViSession vi, ViInt32 arrayMeasFunction,
                                 ViInt32* measWaveformSize) {
  return callDriver(vi, "hsdig_ActualMeasWfmSize", [&](Digitizer& d) {
    requirePointer(measWaveformSize, "measWaveformSize");
    if (!isArrayFunction(arrayMeasFunction)) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "Array measurement function " +
                                               std::to_string(arrayMeasFunction) +
                                               " is not one of 1000 to 1008.");
    }
    *measWaveformSize = arrayMeasurementSize(d.sizingLength(), arrayMeasFunction);
    return VI_SUCCESS;
  });
}

ViStatus hsdig_AcquisitionStatus(ViSession vi, ViInt32* acquisitionStatus) {
  return callDriver(vi, "hsdig_AcquisitionStatus", [&](Digitizer& d) {
    requirePointer(acquisitionStatus, "acquisitionStatus");
    d.update();
    *acquisitionStatus = d.state == AcqState::Acquiring  ? HSDIG_VAL_ACQ_IN_PROGRESS
                         : d.state == AcqState::Complete ? HSDIG_VAL_ACQ_COMPLETE
                                                         : HSDIG_VAL_ACQ_STATUS_UNKNOWN;
    return VI_SUCCESS;
  });
}

ViStatus hsdig_GetSessionState(ViSession vi, ViConstString channelName, ViInt32* sessionState) {
  return callDriver(vi, "hsdig_GetSessionState", [&](Digitizer& d) {
    requirePointer(sessionState, "sessionState");
    d.update();
    ViInt32 state = static_cast<ViInt32>(d.state);
    if (channelName && std::string(channelName).find_first_not_of(" \t") != std::string::npos) {
      int c = oneChannel(d, channelName);
      if (!getBoolean(d.vi, hsdig::sim::channelName(c).c_str(), HSDIG_ATTR_CHANNEL_ENABLED)) {
        state = HSDIG_VAL_STATE_DISABLED;
      }
    }
    *sessionState = state;
    return VI_SUCCESS;
  });
}

ViStatus hsdig_SampleRate(ViSession vi, ViReal64* sampleRate) {
  return callDriver(vi, "hsdig_SampleRate", [&](Digitizer& d) {
    requirePointer(sampleRate, "sampleRate");
    *sampleRate = effectiveSampleRate(d);
    return VI_SUCCESS;
  });
}

ViStatus hsdig_SampleMode(ViSession vi, ViInt32* sampleMode) {
  return callDriver(vi, "hsdig_SampleMode", [&](Digitizer& d) {
    requirePointer(sampleMode, "sampleMode");
    *sampleMode = getInt32(d.vi, "", HSDIG_ATTR_SAMPLE_MODE);
    return VI_SUCCESS;
  });
}

ViStatus hsdig_ParseNumberOfChannels(ViSession vi, ViConstString channel, ViInt32* numChannels) {
  return callDriver(vi, "hsdig_ParseNumberOfChannels", [&](Digitizer& d) {
    requirePointer(numChannels, "numChannels");
    *numChannels = static_cast<ViInt32>(parseChannelList(d, channel).size());
    return VI_SUCCESS;
  });
}

ViStatus hsdig_GetChannelNameFromString(ViSession vi, ViConstString index, ViInt32 bufferSize,
                                        ViChar name[]) {
  return callDriver(vi, "hsdig_GetChannelNameFromString", [&](Digitizer& d) {
    requirePointer(index, "index");
    // Indices count from 1 and take the channel-list forms: "1", "1,3", "1-4".
    std::string shifted;
    std::string text = index;
    std::string number;
    auto flush = [&] {
      if (number.empty()) return;
      long i = std::strtol(number.c_str(), nullptr, 10);
      if (i < 1 || i > d.model.channels) {
        fail(HSDIG_ERROR_INVALID_CHANNEL,
             "Index " + number + " is not 1 to " + std::to_string(d.model.channels) + ".");
      }
      shifted += std::to_string(i - 1);
      number.clear();
    };
    for (char c : text) {
      if (c >= '0' && c <= '9' && number.size() < 9) {
        number += c;
      } else if (c == ',' || c == '-' || c == ':' || c == ' ') {
        flush();
        shifted += c;
      } else {
        fail(HSDIG_ERROR_INVALID_CHANNEL, "\"" + text + "\" is not a list of channel indices.");
      }
    }
    flush();
    std::vector<int> channels = parseChannelList(d, shifted.c_str());
    std::string names;
    for (int c : channels) names += (names.empty() ? "" : ",") + channelName(c);
    return copyString(names, bufferSize, name, "name");
  });
}

ViStatus hsdig_GetStartTimestampInformation(ViSession vi, ViInt32* t1, ViInt32* t2, ViInt32* t3,
                                            ViInt32* t4, ViReal64* deviceTime) {
  return callDriver(vi, "hsdig_GetStartTimestampInformation", [&](Digitizer& d) {
    d.update();
    std::shared_ptr<Acquisition> a = d.current ? d.current : d.lastComplete;
    if (!a)
      fail(HSDIG_ERROR_NO_ACQUISITION, "No acquisition has started, so it has no start time.");
    // System time as a 128-bit fixed-point number of seconds since
    // 1970-01-01 UTC: T1:T2 the whole seconds, T3:T4 the fraction, most
    // significant word first.
    const std::uint64_t seconds = static_cast<std::uint64_t>(a->wallNanoseconds / 1000000000);
    const std::uint64_t nanos = static_cast<std::uint64_t>(a->wallNanoseconds % 1000000000);
    const std::uint64_t fraction =
        static_cast<std::uint64_t>((static_cast<unsigned __int128>(nanos) << 64) / 1000000000u);
    put(t1, static_cast<ViInt32>(seconds >> 32));
    put(t2, static_cast<ViInt32>(seconds & 0xFFFFFFFFu));
    put(t3, static_cast<ViInt32>(fraction >> 32));
    put(t4, static_cast<ViInt32>(fraction & 0xFFFFFFFFu));
    if (deviceTime) *deviceTime = a->startNanoseconds * 1e-9;
    return VI_SUCCESS;
  });
}

ViStatus hsdig_GetStreamEndpointHandle(ViSession vi, ViConstString streamName,
                                       ViInt32* writerHandle) {
  return callDriver(vi, "hsdig_GetStreamEndpointHandle", [&](Digitizer& d) {
    requirePointer(streamName, "streamName");
    requirePointer(writerHandle, "writerHandle");
    // One data stream per channel, "DataStream0" to "DataStream<N-1>".
    const std::string name = streamName;
    const std::string prefix = "DataStream";
    if (name.compare(0, prefix.size(), prefix) != 0 ||
        !isChannelName(d, name.substr(prefix.size()))) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "\"" + name + "\" is not a stream of the " +
                                               d.model.name + " (\"DataStream0\" to \"DataStream" +
                                               std::to_string(d.model.channels - 1) + "\").");
    }
    *writerHandle = static_cast<ViInt32>(0x10000 + (d.vi & 0xFFFF) * 16 +
                                         std::atoi(name.c_str() + prefix.size()));
    return VI_SUCCESS;
  });
}

ViStatus hsdig_GetEqualizationFilterCoefficients(ViSession vi, ViConstString channel,
                                                 ViInt32 numberOfCoefficients,
                                                 ViReal64 coefficients[]) {
  return callDriver(vi, "hsdig_GetEqualizationFilterCoefficients", [&](Digitizer& d) {
    int c = oneChannel(d, channel);
    if (numberOfCoefficients < 0)
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "numberOfCoefficients is negative.");
    if (numberOfCoefficients > 0) requirePointer(coefficients, "coefficients");
    const std::vector<double>& stored = d.equalization[static_cast<size_t>(c)];
    for (ViInt32 i = 0; i < numberOfCoefficients; ++i) {
      coefficients[i] =
          static_cast<size_t>(i) < stored.size() ? stored[static_cast<size_t>(i)] : 0.0;
    }
    return VI_SUCCESS;
  });
}

ViStatus hsdig_GetFrequencyResponse(ViSession vi, ViConstString channel, ViInt32 bufferSize,
                                    ViReal64 frequencies[], ViReal64 amplitudes[],
                                    ViReal64 phases[], ViInt32* numberOfFrequencies) {
  return callDriver(vi, "hsdig_GetFrequencyResponse", [&](Digitizer& d) {
    int c = oneChannel(d, channel);
    if (bufferSize < 0) fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "bufferSize is negative.");
    if (bufferSize > 0) {
      requirePointer(frequencies, "frequencies");
      requirePointer(amplitudes, "amplitudes");
      requirePointer(phases, "phases");
    }
    // The front end is a first-order low-pass at the channel's bandwidth:
    // 101 points from 0 to twice the bandwidth, amplitude in dB, phase in
    // degrees.
    constexpr ViInt32 kPoints = 101;
    const double limit = getReal64(d.vi, channelName(c).c_str(), HSDIG_ATTR_MAX_INPUT_FREQUENCY);
    const double bw = limit > 0 ? std::min(limit, d.model.bandwidth) : d.model.bandwidth;
    for (ViInt32 i = 0; i < std::min(bufferSize, kPoints); ++i) {
      const double f = 2.0 * bw * i / (kPoints - 1);
      frequencies[i] = f;
      amplitudes[i] = -10.0 * std::log10(1.0 + (f / bw) * (f / bw));
      phases[i] = -std::atan(f / bw) * 180.0 / std::numbers::pi;
    }
    put(numberOfFrequencies, kPoints);
    return VI_SUCCESS;
  });
}

ViStatus hsdig_GetScalingCoefficients(ViSession vi, ViConstString channelList, ViInt32 bufferSize,
                                      hsdigCoefficientInfo coefficientInfo[],
                                      ViInt32* numberOfCoefficientSets) {
  return callDriver(vi, "hsdig_GetScalingCoefficients", [&](Digitizer& d) {
    return coefficients(d, channelList, bufferSize, coefficientInfo, numberOfCoefficientSets,
                        false);
  });
}

ViStatus hsdig_GetNormalizationCoefficients(ViSession vi, ViConstString channelList,
                                            ViInt32 bufferSize,
                                            hsdigCoefficientInfo coefficientInfo[],
                                            ViInt32* numberOfCoefficientSets) {
  return callDriver(vi, "hsdig_GetNormalizationCoefficients", [&](Digitizer& d) {
    return coefficients(d, channelList, bufferSize, coefficientInfo, numberOfCoefficientSets, true);
  });
}

ViStatus hsdig_revision_query(ViSession vi, ViChar driverRev[256], ViChar instrRev[256]) {
  return callDriver(vi, "hsdig_revision_query", [&](Digitizer& d) {
    copyFixed("20.0.0 (simulated digitizer)", driverRev);
    copyFixed(std::string(d.model.name) + " firmware 3.2.1", instrRev);
    return VI_SUCCESS;
  });
}

ViStatus hsdig_self_test(ViSession vi, ViInt16* testResult, ViChar testMessage[256]) {
  return callDriver(vi, "hsdig_self_test", [&](Digitizer& d) {
    // Checks what the simulation can check: the identification registers
    // and the acquisition memory of one sample per channel.
    d.abort();
    const bool registersOk = d.registers[0] == 0x47 && d.registers[3] == 0x48 &&
                             d.registers[HSDIG_REG_CHANNELS] == d.model.channels;
    if (testResult) *testResult = registersOk ? 0 : 1;
    copyFixed(registersOk ? "Self test passed."
                          : "Self test failed: the identification registers are wrong.",
              testMessage);
    return VI_SUCCESS;
  });
}

}  // extern "C"
