// The simulated digitizer's inner model: instrument models, the per-session
// state behind an engine session, the acquisition state machine, the
// acquisition memory and the helpers that the exported functions share.
//
// Thread promises: every exported function runs under the engine's session
// lock (Ivi_LockSession) for its whole run, and a Digitizer is touched only
// by the thread that holds its session's lock. The registry of sessions has
// its own mutex, held only to find, add or remove a session.
#pragma once

#include <array>
#include <chrono>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "IviEngine.h"
#include "hsdig.h"

namespace hsdig::sim {

using Clock = std::chrono::steady_clock;

// ---- Models ----------------------------------------------------------------
struct Model {
  const char* name;
  int channels;
  int resolution;        // ADC bits; samples are 16-bit codes with the low bits zero
  double maxSampleRate;  // samples per second
  double bandwidth;      // hertz, first-order roll-off
  std::int64_t memory;   // samples per channel (records x record length)
};
// nullptr for an unknown name (compared without regard to case).
const Model* findModel(std::string_view name);
const Model& defaultModel();
const std::vector<Model>& allModels();

// ---- Errors ----------------------------------------------------------------
// Thrown inside the driver and turned into a status plus error information
// at the exported boundary.
struct DriverError {
  ViStatus code;
  std::string elaboration;
  ViStatus secondary = 0;
};
[[noreturn]] void fail(ViStatus code, std::string elaboration, ViStatus secondary = 0);
// Fails with the driver's class of an engine error (negative status); a
// warning or success returns it.
ViStatus checkEngine(ViStatus engineStatus, std::string_view what);
// The English text of a driver status, or nullptr.
const char* statusText(ViStatus code);

// ---- Attributes --------------------------------------------------------------
struct AttributeInfo {
  ViAttr id;
  const char* name;  // without the HSDIG_ATTR_ prefix
  ViInt32 type;      // IVI_VAL_INT32 ...
  bool perChannel;
  double numericDefault;
  const char* stringDefault;
  double min;
  double max;
  bool readOnly;
};
const AttributeInfo* findAttribute(ViAttr id);
const std::vector<AttributeInfo>& allAttributes();

// ---- Acquisition -----------------------------------------------------------
struct ChannelSetup {
  bool enabled = true;
  double range = 1, offset = 0, attenuation = 1, bandwidth = 0;
  ViInt32 coupling = HSDIG_VAL_DC;
  ViInt32 shape = HSDIG_VAL_SHAPE_SINE;
  double frequency = 1e6, amplitude = 0.4, signalOffset = 0, noise = 0, phase = 0, duty = 50;
  // Volts at the probe tip of one 16-bit code and at code 0.
  double gain() const { return range / 65536.0; }
};

struct ChannelData {
  // numRecords x recordLength codes. Left uninitialised on allocation: the
  // generator writes every element before anything reads it.
  std::unique_ptr<std::int16_t[]> codes;
  std::vector<std::uint8_t> clipped;  // per record
};

enum class AcqState { Idle, Committed, Acquiring, Complete };

struct Acquisition {
  std::uint64_t number = 0;
  double sampleRate = 0;
  std::int32_t recordLength = 0;
  std::int32_t numRecords = 0;
  std::int32_t refIndex = 0;  // sample of the trigger within a record
  int resolution = 16;        // ADC bits
  std::vector<ChannelSetup> channels;
  ViInt32 triggerType = HSDIG_VAL_IMMEDIATE_TRIGGER;
  double triggerDelay = 0, holdoff = 0, clockDelay = 0;
  // Signal time of each record's trigger, seconds since the session opened.
  std::vector<double> triggerTimes;
  bool waitsForSoftwareTrigger = false;
  bool neverTriggers = false;  // the trigger condition cannot occur
  Clock::time_point initiatedAt;
  Clock::time_point completesAt;
  std::int64_t startNanoseconds = 0;  // since the session opened
  std::int64_t wallNanoseconds = 0;   // system time at initiation
  std::vector<ChannelData> data;      // by channel; empty for disabled channels
};

struct MeasurementStats {
  std::uint64_t lastAcquisition = 0;
  double last = 0, sum = 0, sumSquares = 0, min = 0, max = 0;
  std::int32_t count = 0;
};

class Digitizer {
 public:
  Digitizer(ViSession vi, const Model& model, std::string resource);

  const ViSession vi;
  const Model& model;
  const std::string resource;
  const Clock::time_point opened = Clock::now();

  AcqState state = AcqState::Idle;
  std::shared_ptr<Acquisition> current;  // initiated, maybe complete
  std::shared_ptr<Acquisition> lastComplete;
  std::uint64_t acquisitions = 0;
  std::array<std::uint8_t, HSDIG_REG_FILE_SIZE> registers{};
  std::vector<std::vector<ViInt32>> processing;           // per channel
  std::vector<std::vector<double>> equalization;          // per channel
  std::map<std::pair<int, int>, MeasurementStats> stats;  // (channel, function)
  std::optional<std::string> savedConfiguration;

  // Moves Acquiring to Complete when the acquisition's time has come.
  void update();
  // Waits up to `timeout` seconds (negative: no limit) for the current
  // acquisition; fails with NO_ACQUISITION or FETCH_TIMEOUT. Returns the
  // complete acquisition; its data is filled by materialize.
  std::shared_ptr<Acquisition> waitForData(double timeout);
  // The acquisition a cached fetch reads: the current one when complete,
  // else the last complete one.
  std::shared_ptr<Acquisition> cachedData();
  // What a caller sizes fetch buffers from: the largest record count and
  // record length of the acquisitions a fetch or cached fetch may read (the
  // current one and the last complete one), or the configuration when
  // there is none. A buffer sized so holds whatever either writes.
  std::int32_t sizingRecords();
  std::int32_t sizingLength();
  void initiate();
  void commit();
  void abort();
  void resetState();
};

// The session's digitizer; fails with INVALID_SESSION.
Digitizer& digitizerOf(ViSession vi);
void addDigitizer(ViSession vi, std::unique_ptr<Digitizer> d);
void removeDigitizer(ViSession vi);

// ---- Channels ----------------------------------------------------------------
// Parses "0", "0,1", "0-3", "0:3" (spaces allowed) into channel indices, in
// the order named; fails with INVALID_CHANNEL on an empty list, an unknown
// name or a repeated channel.
std::vector<int> parseChannelList(const Digitizer& d, ViConstString list);
std::string channelName(int index);

// ---- Typed attribute access inside the driver (no user flags) ---------------
ViInt32 getInt32(ViSession vi, const char* channel, ViAttr id);
ViInt64 getInt64(ViSession vi, const char* channel, ViAttr id);
ViReal64 getReal64(ViSession vi, const char* channel, ViAttr id);
bool getBoolean(ViSession vi, const char* channel, ViAttr id);
std::string getString(ViSession vi, const char* channel, ViAttr id);
void setInternal(ViSession vi, const char* channel, ViAttr id, ViInt32 value);
void setInternal(ViSession vi, const char* channel, ViAttr id, ViInt64 value);
void setInternal(ViSession vi, const char* channel, ViAttr id, ViReal64 value);
void setInternalBoolean(ViSession vi, const char* channel, ViAttr id, bool value);
void setInternal(ViSession vi, const char* channel, ViAttr id, const std::string& value);
// Defines every attribute of the table on a new engine session.
void defineAttributes(ViSession vi, const Model& model, const std::string& serial);
// Puts every writable attribute back to its default.
void resetAttributes(Digitizer& d);
// Resets one attribute of one channel (-1: a session attribute).
void resetOne(ViSession vi, int channel, ViAttr id);
// The defaults that differ per channel: channel c's signal runs at
// (c + 1) MHz, so the channels of a fresh session are told apart.
void applyChannelDefaults(ViSession vi, int channel);
double effectiveSampleRate(const Digitizer& d);

// ---- Configuration text (export/import) ---------------------------------------
std::string exportConfiguration(Digitizer& d);
// Validates the whole text first; applies it only when all of it is valid,
// so a damaged text changes nothing.
void importConfiguration(Digitizer& d, std::string_view text);

// ---- Signals ------------------------------------------------------------------
// Fills the acquisition memory of the enabled channels named that are not
// filled yet.
void materialize(Acquisition& a, const std::vector<int>& channels);
// Trigger times of the records, or sets neverTriggers.
void planTriggers(Digitizer& d, Acquisition& a, const std::string& source, double level,
                  ViInt32 slope);
// Noise-free probe-tip voltage of a channel at signal phase p (cycles).
double signalAt(const ChannelSetup& c, double cycles);

// ---- Measurements ----------------------------------------------------------------
struct Trace {
  std::vector<double> y;
  double x0 = 0, dx = 1;
};
Trace scaledRecord(const Acquisition& a, int channel, int record);
double scalarMeasurement(const Trace& t, ViInt32 function);
Trace arrayMeasurement(const Trace& t, ViInt32 function);
std::int32_t arrayMeasurementSize(std::int32_t recordLength, ViInt32 function);
bool isScalarFunction(ViInt32 function);
bool isArrayFunction(ViInt32 function);

}  // namespace hsdig::sim
