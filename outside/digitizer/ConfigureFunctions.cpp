// Actions and configuration: the acquisition state machine's transitions,
// the Configure functions, triggers, clock, signal export, waveform
// processing, calibration and the register file.
#include <algorithm>
#include <cmath>
#include <cstring>
#include <map>
#include <mutex>

#include "Boundary.h"
#include "Values.h"

using namespace hsdig::sim;

// GCC 12 reports the std::string member of a Value built from an
// initializer list as maybe uninitialized; the variant holds another
// alternative then and never reads it.
#pragma GCC diagnostic ignored "-Wmaybe-uninitialized"

namespace {

// The instrument's non-volatile configuration slot (ExportAttributes /
// ImportAttributes), per resource and model, shared by the sessions of this
// process.
std::mutex storedMutex;
std::map<std::string, std::string>& storedConfigurations() {
  static auto* stored = new std::map<std::string, std::string>();
  return *stored;
}
std::string storedKey(const Digitizer& d) {
  return std::string(d.model.name) + "|" + d.resource;
}

void checkSource(const Digitizer& d, ViConstString source, ViInt32 type) {
  requirePointer(source, "triggerSource");
  if (!validTriggerSource(d, source, type)) {
    fail(HSDIG_ERROR_INVALID_TRIGGER_SOURCE,
         "\"" + std::string(source) + "\" is not a source of this trigger kind on the " +
             d.model.name +
             (type == HSDIG_VAL_DIGITAL_TRIGGER
                  ? " (digital triggers take \"PFI0\", \"PFI1\" or \"Trig0\" to \"Trig7\")."
                  : " (a channel, \"External\", \"PFI0\", \"PFI1\" or \"Trig0\" to \"Trig7\")."));
  }
}

ViStatus configureTrigger(Digitizer& d, ViInt32 type, ViConstString source,
                          std::vector<Change> changes) {
  if (source) {
    checkSource(d, source, type);
    changes.push_back({HSDIG_ATTR_TRIGGER_SOURCE, std::string(source)});
  }
  changes.push_back({HSDIG_ATTR_TRIGGER_TYPE, ViInt32{type}});
  applyChanges(d, {}, changes);
  return VI_SUCCESS;
}

std::vector<int> allChannels(const Digitizer& d) {
  std::vector<int> all;
  for (int c = 0; c < d.model.channels; ++c) all.push_back(c);
  return all;
}

std::vector<int> channelsOrAll(const Digitizer& d, ViConstString list) {
  if (!list || std::string(list).find_first_not_of(" \t") == std::string::npos)
    return allChannels(d);
  return parseChannelList(d, list);
}

void checkRegister(ViInt32 size, ViInt32 offset, bool write) {
  if (size != 1 && size != 2 && size != 4) {
    fail(HSDIG_ERROR_INVALID_REGISTER,
         "The register size " + std::to_string(size) + " is not 1, 2 or 4 bytes.");
  }
  if (offset < 0 || offset > HSDIG_REG_FILE_SIZE - size || offset % size) {
    fail(HSDIG_ERROR_INVALID_REGISTER,
         "The register offset " + std::to_string(offset) +
             " is outside the 4096-byte register file or not a multiple of " +
             std::to_string(size) + ".");
  }
  if (write && offset < HSDIG_REG_SCRATCH) {
    fail(HSDIG_ERROR_INVALID_REGISTER,
         "The registers below 0x10 (identification, revision, channel count, "
         "status) are read-only.");
  }
}

void autoSetup(Digitizer& d) {
  // Fit each enabled channel's range to its signal with a 1-2-5 step and
  // some headroom, centre the offset on it, show about ten periods of the
  // first enabled channel and trigger on its mid level.
  int first = -1;
  for (int c = 0; c < d.model.channels; ++c) {
    std::string ch = channelName(c);
    if (!getBoolean(d.vi, ch.c_str(), HSDIG_ATTR_CHANNEL_ENABLED)) continue;
    if (first < 0) first = c;
    const double att = getReal64(d.vi, ch.c_str(), HSDIG_ATTR_PROBE_ATTENUATION);
    const double amp = getReal64(d.vi, ch.c_str(), HSDIG_ATTR_SIGNAL_AMPLITUDE) * att;
    const double off = getReal64(d.vi, ch.c_str(), HSDIG_ATTR_SIGNAL_OFFSET) * att;
    const double want = std::max(2.0 * amp * 1.25, 0.01);
    double range = 0.01;
    for (double decade = 0.01; decade <= 100.0; decade *= 10.0) {
      for (double step : {1.0, 2.0, 5.0}) {
        if (range < want) range = decade * step;
      }
    }
    range = std::min(range, 100.0);
    applyChanges(d, {c},
                 {{HSDIG_ATTR_VERTICAL_RANGE, range},
                  {HSDIG_ATTR_VERTICAL_OFFSET, std::clamp(off, -50.0, 50.0)},
                  {HSDIG_ATTR_VERTICAL_COUPLING, ViInt32{HSDIG_VAL_DC}}});
  }
  if (first < 0)
    fail(HSDIG_ERROR_INVALID_CHANNEL, "Auto setup needs at least one enabled channel.");
  std::string ch = channelName(first);
  const double f = getReal64(d.vi, ch.c_str(), HSDIG_ATTR_SIGNAL_FREQUENCY);
  const ViInt32 length = getInt32(d.vi, "", HSDIG_ATTR_RECORD_LENGTH);
  double rate = f > 0 ? length * f / 10.0 : d.model.maxSampleRate;
  rate = std::clamp(rate, 1.0e3, d.model.maxSampleRate);
  const double level = getReal64(d.vi, ch.c_str(), HSDIG_ATTR_SIGNAL_OFFSET) *
                       getReal64(d.vi, ch.c_str(), HSDIG_ATTR_PROBE_ATTENUATION);
  applyChanges(d, {},
               {{HSDIG_ATTR_SAMPLE_RATE, rate},
                {HSDIG_ATTR_TRIGGER_TYPE, ViInt32{HSDIG_VAL_EDGE_TRIGGER}},
                {HSDIG_ATTR_TRIGGER_SOURCE, ch},
                {HSDIG_ATTR_TRIGGER_LEVEL, std::clamp(level, -100.0, 100.0)},
                {HSDIG_ATTR_TRIGGER_SLOPE, ViInt32{HSDIG_VAL_POSITIVE}}});
}

void fullReset(Digitizer& d) {
  d.abort();
  resetAttributes(d);
  d.resetState();
  std::fill(d.registers.begin() + HSDIG_REG_SCRATCH, d.registers.end(), 0);
}

}  // namespace

extern "C" {

// ---- Actions ----
ViStatus hsdig_Abort(ViSession vi) {
  return callDriver(vi, "hsdig_Abort", [](Digitizer& d) {
    d.abort();
    return VI_SUCCESS;
  });
}
ViStatus hsdig_AutoSetup(ViSession vi) {
  return callDriver(vi, "hsdig_AutoSetup", [](Digitizer& d) {
    d.abort();
    autoSetup(d);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_Commit(ViSession vi) {
  return callDriver(vi, "hsdig_Commit", [](Digitizer& d) {
    d.commit();
    return VI_SUCCESS;
  });
}
ViStatus hsdig_Uncommit(ViSession vi) {
  return callDriver(vi, "hsdig_Uncommit", [](Digitizer& d) {
    d.abort();
    d.state = AcqState::Idle;
    return VI_SUCCESS;
  });
}
ViStatus hsdig_Disable(ViSession vi) {
  return callDriver(vi, "hsdig_Disable", [](Digitizer& d) {
    d.abort();
    return VI_SUCCESS;
  });
}
ViStatus hsdig_InitiateAcquisition(ViSession vi) {
  return callDriver(vi, "hsdig_InitiateAcquisition", [](Digitizer& d) {
    d.initiate();
    return VI_SUCCESS;
  });
}
ViStatus hsdig_reset(ViSession vi) {
  return callDriver(vi, "hsdig_reset", [](Digitizer& d) {
    fullReset(d);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ResetDevice(ViSession vi) {
  return callDriver(vi, "hsdig_ResetDevice", [](Digitizer& d) {
    fullReset(d);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ResetAllAttributes(ViSession vi) {
  return callDriver(vi, "hsdig_ResetAllAttributes", [](Digitizer& d) {
    resetAttributes(d);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_SaveAttributes(ViSession vi) {
  return callDriver(vi, "hsdig_SaveAttributes", [](Digitizer& d) {
    d.savedConfiguration = exportConfiguration(d);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_RestoreAttributes(ViSession vi) {
  return callDriver(vi, "hsdig_RestoreAttributes", [](Digitizer& d) {
    if (!d.savedConfiguration)
      fail(HSDIG_ERROR_CONFIGURATION_DATA, "No configuration was saved in this session.");
    importConfiguration(d, *d.savedConfiguration);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ExportAttributes(ViSession vi) {
  return callDriver(vi, "hsdig_ExportAttributes", [](Digitizer& d) {
    std::string text = exportConfiguration(d);
    std::lock_guard lock(storedMutex);
    storedConfigurations()[storedKey(d)] = std::move(text);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ImportAttributes(ViSession vi) {
  return callDriver(vi, "hsdig_ImportAttributes", [](Digitizer& d) {
    std::string text;
    {
      std::lock_guard lock(storedMutex);
      auto it = storedConfigurations().find(storedKey(d));
      if (it == storedConfigurations().end()) {
        fail(HSDIG_ERROR_CONFIGURATION_DATA,
             "The instrument holds no exported configuration for \"" + d.resource + "\".");
      }
      text = it->second;
    }
    importConfiguration(d, text);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_RequestPrivilege(ViSession vi, ViInt32 privilegeLevel) {
  return callDriver(vi, "hsdig_RequestPrivilege", [&](Digitizer& d) {
    if (privilegeLevel < HSDIG_VAL_PRIVILEGE_NONE || privilegeLevel > HSDIG_VAL_PRIVILEGE_CONTROL) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "The privilege level " + std::to_string(privilegeLevel) + " is not 0 to 3.");
    }
    setInternal(d.vi, "", HSDIG_ATTR_PRIVILEGE_LEVEL, ViInt32{privilegeLevel});
    return VI_SUCCESS;
  });
}

#define HSDIG_SIGNAL_SWITCH(Function, attribute, on)             \
  ViStatus hsdig_##Function(ViSession vi) {                      \
    return callDriver(vi, "hsdig_" #Function, [](Digitizer& d) { \
      setInternalBoolean(d.vi, "", attribute, on);               \
      return VI_SUCCESS;                                         \
    });                                                          \
  }
HSDIG_SIGNAL_SWITCH(ProbeCompensationSignalStart, HSDIG_ATTR_PROBE_COMPENSATION_ENABLED, true)
HSDIG_SIGNAL_SWITCH(ProbeCompensationSignalStop, HSDIG_ATTR_PROBE_COMPENSATION_ENABLED, false)
HSDIG_SIGNAL_SWITCH(CableSenseSignalStart, HSDIG_ATTR_CABLE_SENSE_ENABLED, true)
HSDIG_SIGNAL_SWITCH(CableSenseSignalStop, HSDIG_ATTR_CABLE_SENSE_ENABLED, false)
#undef HSDIG_SIGNAL_SWITCH

// ---- Configuration ----
ViStatus hsdig_ConfigureVertical(ViSession vi, ViConstString channelList, ViReal64 range,
                                 ViReal64 offset, ViInt32 coupling, ViReal64 probeAttenuation,
                                 ViBoolean enabled) {
  return callDriver(vi, "hsdig_ConfigureVertical", [&](Digitizer& d) {
    std::vector<int> channels = parseChannelList(d, channelList);
    applyChanges(d, channels,
                 {{HSDIG_ATTR_VERTICAL_RANGE, range},
                  {HSDIG_ATTR_VERTICAL_OFFSET, offset},
                  {HSDIG_ATTR_VERTICAL_COUPLING, coupling},
                  {HSDIG_ATTR_PROBE_ATTENUATION, probeAttenuation},
                  {HSDIG_ATTR_CHANNEL_ENABLED, ViBoolean(enabled ? VI_TRUE : VI_FALSE)}});
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ConfigureChanCharacteristics(ViSession vi, ViConstString channelList,
                                            ViReal64 inputImpedance, ViReal64 maxInputFrequency) {
  return callDriver(vi, "hsdig_ConfigureChanCharacteristics", [&](Digitizer& d) {
    std::vector<int> channels = parseChannelList(d, channelList);
    applyChanges(d, channels,
                 {{HSDIG_ATTR_INPUT_IMPEDANCE, inputImpedance},
                  {HSDIG_ATTR_MAX_INPUT_FREQUENCY, maxInputFrequency}});
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ConfigureHorizontalTiming(ViSession vi, ViReal64 minSampleRate, ViInt32 minNumPts,
                                         ViReal64 refPosition, ViInt32 numRecords,
                                         ViBoolean enforceRealtime) {
  return callDriver(vi, "hsdig_ConfigureHorizontalTiming", [&](Digitizer& d) {
    applyChanges(d, {},
                 {{HSDIG_ATTR_SAMPLE_RATE, minSampleRate},
                  {HSDIG_ATTR_RECORD_LENGTH, minNumPts},
                  {HSDIG_ATTR_REF_POSITION, refPosition},
                  {HSDIG_ATTR_NUM_RECORDS, numRecords},
                  {HSDIG_ATTR_ENFORCE_REALTIME, ViBoolean(enforceRealtime ? VI_TRUE : VI_FALSE)}});
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ConfigureAcquisition(ViSession vi, ViInt32 acquisitionType) {
  return callDriver(vi, "hsdig_ConfigureAcquisition", [&](Digitizer& d) {
    applyChanges(d, {}, {{HSDIG_ATTR_ACQUISITION_TYPE, acquisitionType}});
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ConfigureClock(ViSession vi, ViConstString inputClockSource,
                              ViConstString outputClockSource, ViConstString clockSyncPulseSource,
                              ViBoolean masterEnabled) {
  return callDriver(vi, "hsdig_ConfigureClock", [&](Digitizer& d) {
    requirePointer(inputClockSource, "inputClockSource");
    requirePointer(outputClockSource, "outputClockSource");
    requirePointer(clockSyncPulseSource, "clockSyncPulseSource");
    applyChanges(d, {},
                 {{HSDIG_ATTR_INPUT_CLOCK_SOURCE, std::string(inputClockSource)},
                  {HSDIG_ATTR_OUTPUT_CLOCK_SOURCE, std::string(outputClockSource)},
                  {HSDIG_ATTR_CLOCK_SYNC_PULSE_SOURCE, std::string(clockSyncPulseSource)},
                  {HSDIG_ATTR_MASTER_ENABLED, ViBoolean(masterEnabled ? VI_TRUE : VI_FALSE)}});
    return VI_SUCCESS;
  });
}
ViStatus hsdig_AdjustSampleClockRelativeDelay(ViSession vi, ViReal64 delay) {
  return callDriver(vi, "hsdig_AdjustSampleClockRelativeDelay", [&](Digitizer& d) {
    applyChanges(d, {}, {{HSDIG_ATTR_SAMPLE_CLOCK_DELAY, delay}});
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ConfigureEqualizationFilterCoefficients(ViSession vi, ViConstString channelList,
                                                       ViInt32 numberOfCoefficients,
                                                       const ViReal64 coefficients[]) {
  return callDriver(vi, "hsdig_ConfigureEqualizationFilterCoefficients", [&](Digitizer& d) {
    constexpr ViInt32 kMax = 64;
    std::vector<int> channels = parseChannelList(d, channelList);
    if (numberOfCoefficients < 0 || numberOfCoefficients > kMax) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "The equalization filter takes 0 to 64 coefficients, not " +
               std::to_string(numberOfCoefficients) + ".");
    }
    if (numberOfCoefficients > 0) requirePointer(coefficients, "coefficients");
    for (ViInt32 i = 0; i < numberOfCoefficients; ++i) {
      if (!std::isfinite(coefficients[i]))
        fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
             "Coefficient " + std::to_string(i) + " is not finite.");
    }
    for (int c : channels) {
      d.equalization[static_cast<size_t>(c)].assign(coefficients,
                                                    coefficients + numberOfCoefficients);
      setInternalBoolean(d.vi, channelName(c).c_str(), HSDIG_ATTR_EQUALIZATION_FILTER_ENABLED,
                         numberOfCoefficients > 0);
    }
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ConfigureTriggerEdge(ViSession vi, ViConstString triggerSource, ViReal64 level,
                                    ViInt32 slope, ViInt32 triggerCoupling, ViReal64 holdoff,
                                    ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerEdge", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    return configureTrigger(d, HSDIG_VAL_EDGE_TRIGGER, triggerSource,
                            {{HSDIG_ATTR_TRIGGER_LEVEL, level},
                             {HSDIG_ATTR_TRIGGER_SLOPE, slope},
                             {HSDIG_ATTR_TRIGGER_COUPLING, triggerCoupling},
                             {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
                             {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerHysteresis(ViSession vi, ViConstString triggerSource, ViReal64 level,
                                          ViReal64 hysteresis, ViInt32 slope,
                                          ViInt32 triggerCoupling, ViReal64 holdoff,
                                          ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerHysteresis", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    return configureTrigger(d, HSDIG_VAL_HYSTERESIS_TRIGGER, triggerSource,
                            {{HSDIG_ATTR_TRIGGER_LEVEL, level},
                             {HSDIG_ATTR_TRIGGER_HYSTERESIS, hysteresis},
                             {HSDIG_ATTR_TRIGGER_SLOPE, slope},
                             {HSDIG_ATTR_TRIGGER_COUPLING, triggerCoupling},
                             {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
                             {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerWindow(ViSession vi, ViConstString triggerSource, ViReal64 lowLevel,
                                      ViReal64 highLevel, ViInt32 windowMode,
                                      ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerWindow", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    if (lowLevel > highLevel)
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "The window's low level is above its high level.");
    return configureTrigger(d, HSDIG_VAL_WINDOW_TRIGGER, triggerSource,
                            {{HSDIG_ATTR_TRIGGER_LOW_LEVEL, lowLevel},
                             {HSDIG_ATTR_TRIGGER_HIGH_LEVEL, highLevel},
                             {HSDIG_ATTR_TRIGGER_WINDOW_MODE, windowMode},
                             {HSDIG_ATTR_TRIGGER_COUPLING, triggerCoupling},
                             {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
                             {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerWidth(ViSession vi, ViConstString triggerSource, ViReal64 level,
                                     ViReal64 lowThreshold, ViReal64 highThreshold,
                                     ViInt32 polarity, ViInt32 condition, ViInt32 triggerCoupling,
                                     ViReal64 holdoff, ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerWidth", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    if (lowThreshold > highThreshold)
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "The low width threshold is above the high one.");
    return configureTrigger(d, HSDIG_VAL_WIDTH_TRIGGER, triggerSource,
                            {{HSDIG_ATTR_TRIGGER_LEVEL, level},
                             {HSDIG_ATTR_TRIGGER_WIDTH_LOW, lowThreshold},
                             {HSDIG_ATTR_TRIGGER_WIDTH_HIGH, highThreshold},
                             {HSDIG_ATTR_TRIGGER_POLARITY, polarity},
                             {HSDIG_ATTR_TRIGGER_WIDTH_CONDITION, condition},
                             {HSDIG_ATTR_TRIGGER_COUPLING, triggerCoupling},
                             {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
                             {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerRunt(ViSession vi, ViConstString triggerSource,
                                    ViReal64 lowThreshold, ViReal64 highThreshold, ViInt32 polarity,
                                    ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerRunt", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    if (lowThreshold > highThreshold)
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "The runt's low threshold is above its high threshold.");
    return configureTrigger(d, HSDIG_VAL_RUNT_TRIGGER, triggerSource,
                            {{HSDIG_ATTR_TRIGGER_LOW_LEVEL, lowThreshold},
                             {HSDIG_ATTR_TRIGGER_HIGH_LEVEL, highThreshold},
                             {HSDIG_ATTR_TRIGGER_POLARITY, polarity},
                             {HSDIG_ATTR_TRIGGER_COUPLING, triggerCoupling},
                             {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
                             {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerGlitch(ViSession vi, ViConstString triggerSource, ViReal64 level,
                                      ViReal64 width, ViInt32 polarity, ViInt32 glitchCondition,
                                      ViInt32 triggerCoupling, ViReal64 holdoff, ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerGlitch", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    return configureTrigger(d, HSDIG_VAL_GLITCH_TRIGGER, triggerSource,
                            {{HSDIG_ATTR_TRIGGER_LEVEL, level},
                             {HSDIG_ATTR_TRIGGER_GLITCH_WIDTH, width},
                             {HSDIG_ATTR_TRIGGER_POLARITY, polarity},
                             {HSDIG_ATTR_TRIGGER_GLITCH_CONDITION, glitchCondition},
                             {HSDIG_ATTR_TRIGGER_COUPLING, triggerCoupling},
                             {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
                             {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerVideo(ViSession vi, ViConstString triggerSource,
                                     ViBoolean enableDcRestore, ViInt32 signalFormat, ViInt32 event,
                                     ViInt32 lineNumber, ViInt32 polarity, ViInt32 triggerCoupling,
                                     ViReal64 holdoff, ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerVideo", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    const ViInt32 lines =
        signalFormat == HSDIG_VAL_NTSC || signalFormat == HSDIG_VAL_M_PAL ? 525 : 625;
    if (event == HSDIG_VAL_VIDEO_LINE_NUMBER && (lineNumber < 1 || lineNumber > lines)) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "Line " + std::to_string(lineNumber) +
                                               " does not exist in a " + std::to_string(lines) +
                                               "-line frame.");
    }
    return configureTrigger(
        d, HSDIG_VAL_VIDEO_TRIGGER, triggerSource,
        {{HSDIG_ATTR_TRIGGER_VIDEO_DC_RESTORE, ViBoolean(enableDcRestore ? VI_TRUE : VI_FALSE)},
         {HSDIG_ATTR_TRIGGER_VIDEO_FORMAT, signalFormat},
         {HSDIG_ATTR_TRIGGER_VIDEO_EVENT, event},
         {HSDIG_ATTR_TRIGGER_VIDEO_LINE, std::max<ViInt32>(lineNumber, 1)},
         {HSDIG_ATTR_TRIGGER_POLARITY, polarity},
         {HSDIG_ATTR_TRIGGER_COUPLING, triggerCoupling},
         {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
         {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerDigital(ViSession vi, ViConstString triggerSource, ViInt32 slope,
                                       ViReal64 holdoff, ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerDigital", [&](Digitizer& d) {
    requirePointer(triggerSource, "triggerSource");
    return configureTrigger(d, HSDIG_VAL_DIGITAL_TRIGGER, triggerSource,
                            {{HSDIG_ATTR_TRIGGER_SLOPE, slope},
                             {HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff},
                             {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerSoftware(ViSession vi, ViReal64 holdoff, ViReal64 delay) {
  return callDriver(vi, "hsdig_ConfigureTriggerSoftware", [&](Digitizer& d) {
    return configureTrigger(
        d, HSDIG_VAL_SOFTWARE_TRIGGER, nullptr,
        {{HSDIG_ATTR_TRIGGER_HOLDOFF, holdoff}, {HSDIG_ATTR_TRIGGER_DELAY, delay}});
  });
}
ViStatus hsdig_ConfigureTriggerImmediate(ViSession vi) {
  return callDriver(vi, "hsdig_ConfigureTriggerImmediate", [&](Digitizer& d) {
    return configureTrigger(d, HSDIG_VAL_IMMEDIATE_TRIGGER, nullptr, {});
  });
}
ViStatus hsdig_SendSoftwareTriggerEdge(ViSession vi, ViInt32 whichTrigger) {
  return callDriver(vi, "hsdig_SendSoftwareTriggerEdge", [&](Digitizer& d) {
    if (whichTrigger < HSDIG_VAL_SOFTWARE_TRIGGER_START ||
        whichTrigger > HSDIG_VAL_SOFTWARE_TRIGGER_ARM_REFERENCE) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "whichTrigger " + std::to_string(whichTrigger) + " is not 0 to 3.");
    }
    d.update();
    // The start and reference triggers release an acquisition that waits
    // for software; the others (and a trigger nobody waits for) are accepted
    // and change nothing.
    if (d.state == AcqState::Acquiring && d.current->waitsForSoftwareTrigger &&
        (whichTrigger == HSDIG_VAL_SOFTWARE_TRIGGER_START ||
         whichTrigger == HSDIG_VAL_SOFTWARE_TRIGGER_REFERENCE)) {
      Acquisition& a = *d.current;
      a.waitsForSoftwareTrigger = false;
      a.startNanoseconds =
          std::chrono::duration_cast<std::chrono::nanoseconds>(Clock::now() - d.opened).count();
      planTriggers(d, a, "", 0, HSDIG_VAL_POSITIVE);
      const double seconds = a.numRecords * (a.recordLength / a.sampleRate + a.holdoff) +
                             std::max(0.0, a.triggerDelay);
      a.completesAt = Clock::now() + std::chrono::duration_cast<Clock::duration>(
                                         std::chrono::duration<double>(std::min(seconds, 1.0e6)));
      d.update();
    }
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ExportSignal(ViSession vi, ViInt32 signal, ViConstString signalIdentifier,
                            ViConstString outputTerminal) {
  return callDriver(vi, "hsdig_ExportSignal", [&](Digitizer& d) {
    static constexpr ViAttr terminals[] = {
        HSDIG_ATTR_EXPORTED_REF_CLOCK_TERMINAL, HSDIG_ATTR_EXPORTED_START_TRIGGER_TERMINAL,
        HSDIG_ATTR_EXPORTED_REF_TRIGGER_TERMINAL, HSDIG_ATTR_EXPORTED_END_OF_RECORD_TERMINAL,
        HSDIG_ATTR_EXPORTED_READY_FOR_START_TERMINAL};
    if (signal < 0 || signal > HSDIG_VAL_READY_FOR_START_EVENT) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "The signal " + std::to_string(signal) +
                                               " is not one of HSDIG_VAL_REF_CLOCK (0) "
                                               "to HSDIG_VAL_READY_FOR_START_EVENT (4).");
    }
    requirePointer(outputTerminal, "outputTerminal");
    // The identifier names an instance of the signal; this instrument has
    // one of each, so only "" (or a null pointer) is accepted.
    if (signalIdentifier && *signalIdentifier) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "The signal identifier \"" +
                                               std::string(signalIdentifier) +
                                               "\" is not known; this instrument takes \"\".");
    }
    applyChanges(d, {}, {{terminals[signal], std::string(outputTerminal)}});
    return VI_SUCCESS;
  });
}
ViStatus hsdig_AddWaveformProcessing(ViSession vi, ViConstString channelList,
                                     ViInt32 measFunction) {
  return callDriver(vi, "hsdig_AddWaveformProcessing", [&](Digitizer& d) {
    std::vector<int> channels = parseChannelList(d, channelList);
    if (!isArrayFunction(measFunction)) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "Processing steps are array measurement functions (1000 to 1008), not " +
               std::to_string(measFunction) + ".");
    }
    for (int c : channels) {
      if (d.processing[static_cast<size_t>(c)].size() >= 16) {
        fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
             "Channel " + channelName(c) + " already has 16 processing steps.");
      }
    }
    for (int c : channels) d.processing[static_cast<size_t>(c)].push_back(measFunction);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ClearWaveformProcessing(ViSession vi, ViConstString channelList) {
  return callDriver(vi, "hsdig_ClearWaveformProcessing", [&](Digitizer& d) {
    for (int c : channelsOrAll(d, channelList)) d.processing[static_cast<size_t>(c)].clear();
    return VI_SUCCESS;
  });
}
ViStatus hsdig_CalSelfCalibrate(ViSession vi, ViConstString channelList, ViInt32 option) {
  return callDriver(vi, "hsdig_CalSelfCalibrate", [&](Digitizer& d) {
    std::vector<int> channels = channelsOrAll(d, channelList);
    if (option != HSDIG_VAL_CAL_NORMAL && option != HSDIG_VAL_CAL_RESTRICTED) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "The calibration option " + std::to_string(option) + " is not 0 or 1.");
    }
    d.abort();
    const double temperature = getReal64(d.vi, "", HSDIG_ATTR_DEVICE_TEMPERATURE);
    for (int c : channels)
      setInternal(d.vi, channelName(c).c_str(), HSDIG_ATTR_LAST_CAL_TEMPERATURE, temperature);
    return VI_SUCCESS;
  });
}
ViStatus hsdig_WriteRegister(ViSession vi, ViInt32 size, ViInt32 offset, ViInt32 value) {
  return callDriver(vi, "hsdig_WriteRegister", [&](Digitizer& d) {
    checkRegister(size, offset, true);
    const std::uint32_t v = static_cast<std::uint32_t>(value);
    const std::int64_t low = -(std::int64_t(1) << (8 * size - 1));
    const std::int64_t high = (std::int64_t(1) << (8 * size)) - 1;
    if (size < 4 && (value < low || value > high)) {
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE,
           "The value does not fit in " + std::to_string(size) + " bytes.");
    }
    for (int i = 0; i < size; ++i)
      d.registers[static_cast<size_t>(offset + i)] = (v >> (8 * i)) & 0xFF;
    return VI_SUCCESS;
  });
}
ViStatus hsdig_ReadRegister(ViSession vi, ViInt32 size, ViInt32 offset, ViInt32* value) {
  return callDriver(vi, "hsdig_ReadRegister", [&](Digitizer& d) {
    requirePointer(value, "value");
    checkRegister(size, offset, false);
    d.update();
    const std::uint8_t status =
        (d.state == AcqState::Acquiring ? 1 : 0) | (d.state == AcqState::Complete ? 2 : 0);
    d.registers[HSDIG_REG_STATUS] = status;
    std::uint32_t v = 0;
    for (int i = 0; i < size; ++i)
      v |= std::uint32_t(d.registers[static_cast<size_t>(offset + i)]) << (8 * i);
    *value = static_cast<ViInt32>(v);
    return VI_SUCCESS;
  });
}

}  // extern "C"
