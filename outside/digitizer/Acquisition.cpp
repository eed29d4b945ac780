// The acquisition state machine and the signal generator.
//
// States: Idle -> (Commit) Committed -> (InitiateAcquisition) Acquiring ->
// (the trigger and the records' time) Complete. Abort returns to Committed;
// Uncommit and reset to Idle. A completed acquisition stays readable until
// the next one completes; CachedFetch reads it.
//
// The acquisition memory holds 16-bit codes (volts = code x range / 65536 +
// offset) and is filled per channel, the first time a channel's data of a
// complete acquisition is needed, so every fetch format is a conversion of
// the same codes and channels nobody reads cost nothing.
#include <algorithm>
#include <cmath>
#include <cstring>
#include <ctime>
#include <numbers>
#include <thread>

#include "Digitizer.h"

namespace hsdig::sim {

namespace {

double fraction(double x) {
  return x - std::floor(x);
}

double shapeAt(ViInt32 shape, double p, double duty) {
  switch (shape) {
    case HSDIG_VAL_SHAPE_SINE:
      return std::sin(2 * std::numbers::pi * p);
    case HSDIG_VAL_SHAPE_SQUARE:
      return p < duty / 100.0 ? 1.0 : -1.0;
    case HSDIG_VAL_SHAPE_TRIANGLE:
      return p < 0.5 ? -1.0 + 4.0 * p : 3.0 - 4.0 * p;
    case HSDIG_VAL_SHAPE_SAWTOOTH:
      return -1.0 + 2.0 * p;
    default:
      return 0.0;
  }
}

// Amplitude and DC part of a channel's signal at the probe tip, after
// coupling, bandwidth and probe.
struct Levels {
  double ac = 0, dc = 0;
};
Levels levelsOf(const ChannelSetup& c) {
  Levels l;
  if (c.coupling == HSDIG_VAL_GND) return l;
  double bw = c.bandwidth > 0 ? c.bandwidth : 1e30;
  double h =
      c.shape == HSDIG_VAL_SHAPE_DC ? 0.0 : 1.0 / std::sqrt(1.0 + std::pow(c.frequency / bw, 2));
  l.ac = c.attenuation * c.amplitude * h;
  l.dc = c.coupling == HSDIG_VAL_DC ? c.attenuation * c.signalOffset : 0.0;
  return l;
}

// A small deterministic generator (xorshift64*) for noise.
struct Noise {
  std::uint64_t s;
  explicit Noise(std::uint64_t seed) : s(seed * 0x9E3779B97F4A7C15ull + 0x2545F4914F6CDD1Dull) {
    if (s == 0) s = 1;
  }
  double uniform() {
    s ^= s >> 12;
    s ^= s << 25;
    s ^= s >> 27;
    return static_cast<double>((s * 0x2545F4914F6CDD1Dull) >> 11) * 0x1.0p-53;
  }
};

// 65536 normal deviates (unit variance), made once; a record reads them
// with its own start and odd stride, so noise differs between records,
// channels and acquisitions and still costs one load per sample.
const std::vector<float>& noiseTable() {
  static const std::vector<float> table = [] {
    std::vector<float> t(65536);
    Noise n(12345);
    for (size_t i = 0; i < t.size(); i += 2) {
      // Box-Muller: two deviates from two uniforms.
      const double u = std::max(n.uniform(), 1e-300), v = n.uniform();
      const double r = std::sqrt(-2.0 * std::log(u));
      t[i] = static_cast<float>(r * std::cos(2 * std::numbers::pi * v));
      t[i + 1] = static_cast<float>(r * std::sin(2 * std::numbers::pi * v));
    }
    return t;
  }();
  return table;
}

void generateRecord(const Acquisition& a, const ChannelSetup& c, int channel, int record,
                    std::int16_t* out, std::uint8_t& clipped, int resolution) {
  const std::int32_t n = a.recordLength;
  const Levels lv = levelsOf(c);
  const double lsb = c.gain();
  const double invLsb = 1.0 / lsb;
  const double t0 = a.triggerTimes[static_cast<size_t>(record)] + a.triggerDelay + a.clockDelay -
                    a.refIndex / a.sampleRate;
  const double cyclesPerSample = c.frequency / a.sampleRate;
  const double p0 = fraction(c.frequency * t0 + c.phase / 360.0);
  const std::int32_t mask = ~((1 << (16 - resolution)) - 1);
  const double base = (lv.dc - c.offset) * invLsb;
  const double scale = lv.ac * invLsb;
  bool clip = false;
  Noise seed(a.number * 1000003ull + static_cast<std::uint64_t>(channel) * 7919ull +
             static_cast<std::uint64_t>(record));
  const double noiseScale = c.noise * c.attenuation * invLsb;
  const float* noise = noiseTable().data();
  std::uint32_t noiseIndex = static_cast<std::uint32_t>(seed.uniform() * 65536.0) & 0xFFFF;
  const std::uint32_t noiseStride =
      (static_cast<std::uint32_t>(seed.uniform() * 65536.0) | 1) & 0xFFFF;
  // A noise-free signal whose period is a whole number of samples repeats
  // exactly: one period is computed and then copied over the record.
  std::int32_t length = n;
  if (noiseScale == 0) {
    if (scale == 0) {
      length = std::min<std::int32_t>(n, 1);
    } else if (cyclesPerSample > 0) {
      const double period = 1.0 / cyclesPerSample;
      const double whole = std::round(period);
      if (whole >= 1 && whole <= n / 2 && std::fabs(period - whole) <= 1e-9 * period) {
        length = static_cast<std::int32_t>(whole);
      }
    }
  }
  auto store = [&](std::int32_t k, double codeValue) {
    if (noiseScale > 0) {
      codeValue += noiseScale * noise[noiseIndex];
      noiseIndex = (noiseIndex + noiseStride) & 0xFFFF;
    }
    // Rounds to the nearest code; the shift keeps the conversion's operand
    // positive, so truncation is rounding down (and needs no library call).
    std::int32_t q;
    if (codeValue >= 32767.5) {
      q = 32767;
      clip = true;
    } else if (codeValue < -32768.5) {
      q = -32768;
      clip = true;
    } else {
      q = static_cast<std::int32_t>(codeValue + 32768.5) - 32768;
    }
    out[k] = static_cast<std::int16_t>(q & mask);
  };
  if (c.shape == HSDIG_VAL_SHAPE_SINE && scale != 0) {
    // Chebyshev recurrence, reseeded every block so rounding cannot drift.
    const double w = 2 * std::numbers::pi * cyclesPerSample;
    const double twoCos = 2 * std::cos(w);
    constexpr std::int32_t kBlock = 1024;
    for (std::int32_t start = 0; start < length; start += kBlock) {
      const double theta = 2 * std::numbers::pi * fraction(p0 + start * cyclesPerSample);
      double prev = std::sin(theta - w), cur = std::sin(theta);
      const std::int32_t end = std::min(length, start + kBlock);
      for (std::int32_t k = start; k < end; ++k) {
        store(k, base + scale * cur);
        const double next = twoCos * cur - prev;
        prev = cur;
        cur = next;
      }
    }
  } else {
    double p = p0;
    for (std::int32_t k = 0; k < length; ++k) {
      store(k, base + scale * shapeAt(c.shape, p, c.duty));
      p += cyclesPerSample;
      if (p >= 1.0) p -= std::floor(p);
    }
  }
  for (std::int32_t done = length; done < n;) {
    const std::int32_t chunk = std::min(done, n - done);
    std::memcpy(out + done, out, static_cast<size_t>(chunk) * sizeof(std::int16_t));
    done += chunk;
  }
  clipped = clip ? 1 : 0;
}

// The channel index a trigger source names, or -1.
int channelOf(const Digitizer& d, const std::string& source) {
  if (source.empty() || source.size() > 3) return -1;
  for (char c : source) {
    if (c < '0' || c > '9') return -1;
  }
  const int channel = std::atoi(source.c_str());
  return channel < d.model.channels ? channel : -1;
}

std::int64_t nanosecondsSince(Clock::time_point from) {
  return std::chrono::duration_cast<std::chrono::nanoseconds>(Clock::now() - from).count();
}

}  // namespace

double signalAt(const ChannelSetup& c, double cycles) {
  Levels lv = levelsOf(c);
  return lv.dc + lv.ac * shapeAt(c.shape, fraction(cycles), c.duty);
}

void materialize(Acquisition& a, const std::vector<int>& channels) {
  const size_t perChannel = static_cast<size_t>(a.recordLength) * static_cast<size_t>(a.numRecords);
  a.data.resize(a.channels.size());
  for (int c : channels) {
    ChannelData& d = a.data[static_cast<size_t>(c)];
    if (d.codes || !a.channels[static_cast<size_t>(c)].enabled) continue;
    d.codes.reset(new std::int16_t[perChannel]);
    d.clipped.assign(static_cast<size_t>(a.numRecords), 0);
    for (std::int32_t r = 0; r < a.numRecords; ++r) {
      generateRecord(a, a.channels[static_cast<size_t>(c)], c, r,
                     d.codes.get() + static_cast<size_t>(r) * static_cast<size_t>(a.recordLength),
                     d.clipped[static_cast<size_t>(r)], a.resolution);
    }
  }
}

void planTriggers(Digitizer& d, Acquisition& a, const std::string& source, double level,
                  ViInt32 slope) {
  const double recordTime = a.recordLength / a.sampleRate + a.holdoff;
  const double start = a.startNanoseconds * 1e-9;
  a.triggerTimes.resize(static_cast<size_t>(a.numRecords));
  // A channel source triggers where its signal crosses the level with the
  // slope; every record then shows the same part of the signal. A source
  // whose signal never crosses the level never triggers.
  const int channel = channelOf(d, source);
  if (channel >= 0) {
    const ChannelSetup& c = a.channels[static_cast<size_t>(channel)];
    if (c.frequency <= 0 || c.shape == HSDIG_VAL_SHAPE_DC || levelsOf(c).ac == 0) {
      a.neverTriggers = true;
      return;
    }
    constexpr int kSteps = 4096;
    double crossing = -1;
    double prev = signalAt(c, c.phase / 360.0);
    for (int k = 1; k <= kSteps && crossing < 0; ++k) {
      double p = static_cast<double>(k) / kSteps;
      double v = signalAt(c, p + c.phase / 360.0);
      bool rising = prev < level && v >= level;
      bool falling = prev > level && v <= level;
      if ((slope == HSDIG_VAL_POSITIVE && rising) || (slope == HSDIG_VAL_NEGATIVE && falling)) {
        double frac = v != prev ? (level - prev) / (v - prev) : 0.0;
        crossing = (k - 1 + frac) / kSteps;
      }
      prev = v;
    }
    if (crossing < 0) {
      a.neverTriggers = true;
      return;
    }
    const double period = 1.0 / c.frequency;
    // The first crossing after the start, then whole periods apart.
    double first = (std::floor(start / period) + 1 + crossing) * period;
    double step = std::ceil(recordTime / period) * period;
    for (std::int32_t r = 0; r < a.numRecords; ++r)
      a.triggerTimes[static_cast<size_t>(r)] = first + r * step;
    return;
  }
  for (std::int32_t r = 0; r < a.numRecords; ++r) {
    a.triggerTimes[static_cast<size_t>(r)] = start + a.refIndex / a.sampleRate + r * recordTime;
  }
}

void Digitizer::update() {
  if (state == AcqState::Acquiring && current && !current->neverTriggers &&
      !current->waitsForSoftwareTrigger && Clock::now() >= current->completesAt) {
    state = AcqState::Complete;
    lastComplete = current;
  }
}

std::shared_ptr<Acquisition> Digitizer::waitForData(double timeout) {
  update();
  if (!current || state == AcqState::Idle || state == AcqState::Committed) {
    fail(HSDIG_ERROR_NO_ACQUISITION,
         "Initiate an acquisition before fetching; the last one was aborted or none was started.");
  }
  if (state == AcqState::Acquiring) {
    const bool cannotComplete = current->neverTriggers || current->waitsForSoftwareTrigger;
    const auto limit = timeout < 0 ? Clock::time_point::max()
                                   : Clock::now() + std::chrono::duration_cast<Clock::duration>(
                                                        std::chrono::duration<double>(timeout));
    if (cannotComplete || current->completesAt > limit) {
      // Nothing can trigger while this call holds the session, so waiting
      // without limit would never end: such a wait fails at once.
      if (timeout > 0 && limit != Clock::time_point::max()) std::this_thread::sleep_until(limit);
      const char* why = current->waitsForSoftwareTrigger ? "the software trigger has not been sent"
                        : current->neverTriggers
                            ? "the trigger condition does not occur on the source signal"
                            : "the records are not yet acquired";
      fail(HSDIG_ERROR_FETCH_TIMEOUT, "The acquisition did not complete within " +
                                          std::to_string(timeout) + " s: " + why + ".");
    }
    std::this_thread::sleep_until(current->completesAt);
    update();
  }
  return current;
}

std::shared_ptr<Acquisition> Digitizer::cachedData() {
  update();
  std::shared_ptr<Acquisition> a = state == AcqState::Complete ? current : lastComplete;
  if (!a)
    fail(HSDIG_ERROR_NO_ACQUISITION, "No acquisition has completed yet, so nothing is cached.");
  return a;
}

void Digitizer::commit() {
  const std::int64_t length = getInt32(vi, "", HSDIG_ATTR_RECORD_LENGTH);
  const std::int64_t records = getInt32(vi, "", HSDIG_ATTR_NUM_RECORDS);
  if (length * records > model.memory) {
    fail(HSDIG_ERROR_ACQUISITION_MEMORY,
         std::to_string(records) + " records of " + std::to_string(length) + " samples need " +
             std::to_string(length * records) + " samples per channel; the " + model.name +
             " holds " + std::to_string(model.memory) + ".");
  }
  const ViInt32 type = getInt32(vi, "", HSDIG_ATTR_TRIGGER_TYPE);
  if (type != HSDIG_VAL_IMMEDIATE_TRIGGER && type != HSDIG_VAL_SOFTWARE_TRIGGER) {
    std::string source = getString(vi, "", HSDIG_ATTR_TRIGGER_SOURCE);
    bool channel = channelOf(*this, source) >= 0;
    bool external = source == "External" || source == "PFI0" || source == "PFI1";
    if (!channel && !external) {
      fail(HSDIG_ERROR_INVALID_TRIGGER_SOURCE, "The trigger source \"" + source +
                                                   "\" is not a channel of the " + model.name +
                                                   ", \"External\", \"PFI0\" or \"PFI1\".");
    }
  }
  if (state == AcqState::Idle) state = AcqState::Committed;
}

void Digitizer::initiate() {
  commit();
  auto a = std::make_shared<Acquisition>();
  a->number = ++acquisitions;
  a->sampleRate = effectiveSampleRate(*this);
  a->resolution = model.resolution;
  a->recordLength = getInt32(vi, "", HSDIG_ATTR_RECORD_LENGTH);
  a->numRecords = getInt32(vi, "", HSDIG_ATTR_NUM_RECORDS);
  a->refIndex = static_cast<std::int32_t>(
      std::lround(getReal64(vi, "", HSDIG_ATTR_REF_POSITION) / 100.0 * a->recordLength));
  a->triggerType = getInt32(vi, "", HSDIG_ATTR_TRIGGER_TYPE);
  a->triggerDelay = getReal64(vi, "", HSDIG_ATTR_TRIGGER_DELAY);
  a->holdoff = getReal64(vi, "", HSDIG_ATTR_TRIGGER_HOLDOFF);
  a->clockDelay = getReal64(vi, "", HSDIG_ATTR_SAMPLE_CLOCK_DELAY);
  for (int c = 0; c < model.channels; ++c) {
    std::string ch = channelName(c);
    const char* n = ch.c_str();
    ChannelSetup s;
    s.enabled = getBoolean(vi, n, HSDIG_ATTR_CHANNEL_ENABLED);
    s.range = getReal64(vi, n, HSDIG_ATTR_VERTICAL_RANGE);
    s.offset = getReal64(vi, n, HSDIG_ATTR_VERTICAL_OFFSET);
    s.coupling = getInt32(vi, n, HSDIG_ATTR_VERTICAL_COUPLING);
    s.attenuation = getReal64(vi, n, HSDIG_ATTR_PROBE_ATTENUATION);
    double limit = getReal64(vi, n, HSDIG_ATTR_MAX_INPUT_FREQUENCY);
    s.bandwidth = limit > 0 ? std::min(limit, model.bandwidth) : model.bandwidth;
    s.shape = getInt32(vi, n, HSDIG_ATTR_SIGNAL_SHAPE);
    s.frequency = getReal64(vi, n, HSDIG_ATTR_SIGNAL_FREQUENCY);
    s.amplitude = getReal64(vi, n, HSDIG_ATTR_SIGNAL_AMPLITUDE);
    s.signalOffset = getReal64(vi, n, HSDIG_ATTR_SIGNAL_OFFSET);
    s.noise = getReal64(vi, n, HSDIG_ATTR_SIGNAL_NOISE);
    s.phase = getReal64(vi, n, HSDIG_ATTR_SIGNAL_PHASE);
    s.duty = getReal64(vi, n, HSDIG_ATTR_SIGNAL_DUTY_CYCLE);
    a->channels.push_back(s);
  }
  a->initiatedAt = Clock::now();
  a->startNanoseconds = nanosecondsSince(opened);
  timespec wall{};
  clock_gettime(CLOCK_REALTIME, &wall);
  a->wallNanoseconds = static_cast<std::int64_t>(wall.tv_sec) * 1000000000 + wall.tv_nsec;

  std::string source = getString(vi, "", HSDIG_ATTR_TRIGGER_SOURCE);
  switch (a->triggerType) {
    case HSDIG_VAL_EDGE_TRIGGER:
    case HSDIG_VAL_HYSTERESIS_TRIGGER:
    case HSDIG_VAL_WIDTH_TRIGGER:
    case HSDIG_VAL_GLITCH_TRIGGER:
      planTriggers(
          *this, *a, source, getReal64(vi, "", HSDIG_ATTR_TRIGGER_LEVEL),
          a->triggerType == HSDIG_VAL_EDGE_TRIGGER || a->triggerType == HSDIG_VAL_HYSTERESIS_TRIGGER
              ? getInt32(vi, "", HSDIG_ATTR_TRIGGER_SLOPE)
              : (getInt32(vi, "", HSDIG_ATTR_TRIGGER_POLARITY) == HSDIG_VAL_POLARITY_NEGATIVE
                     ? HSDIG_VAL_NEGATIVE
                     : HSDIG_VAL_POSITIVE));
      break;
    case HSDIG_VAL_WINDOW_TRIGGER:
    case HSDIG_VAL_RUNT_TRIGGER: {
      // Entering the window (or a runt pulse) happens where the signal
      // crosses the lower boundary upwards.
      double low = getReal64(vi, "", HSDIG_ATTR_TRIGGER_LOW_LEVEL);
      planTriggers(*this, *a, source, low, HSDIG_VAL_POSITIVE);
      break;
    }
    case HSDIG_VAL_SOFTWARE_TRIGGER:
      a->waitsForSoftwareTrigger = true;
      planTriggers(*this, *a, "", 0, HSDIG_VAL_POSITIVE);
      break;
    default:  // immediate, digital, video: free running
      planTriggers(*this, *a, "", 0, HSDIG_VAL_POSITIVE);
      break;
  }
  const double seconds = a->numRecords * (a->recordLength / a->sampleRate + a->holdoff) +
                         std::max(0.0, a->triggerDelay);
  a->completesAt = a->initiatedAt + std::chrono::duration_cast<Clock::duration>(
                                        std::chrono::duration<double>(std::min(seconds, 1.0e6)));
  current = std::move(a);
  state = AcqState::Acquiring;
  setInternal(vi, "", HSDIG_ATTR_ACQUISITION_START_TIME, ViInt64{current->startNanoseconds});
  setInternal(vi, "", HSDIG_ATTR_ACQUISITION_COUNT, static_cast<ViInt64>(acquisitions));
  update();
}

std::int32_t Digitizer::sizingRecords() {
  update();
  if (!current && !lastComplete) return getInt32(vi, "", HSDIG_ATTR_NUM_RECORDS);
  return std::max(current ? current->numRecords : 0, lastComplete ? lastComplete->numRecords : 0);
}

std::int32_t Digitizer::sizingLength() {
  update();
  if (!current && !lastComplete) return getInt32(vi, "", HSDIG_ATTR_RECORD_LENGTH);
  return std::max(current ? current->recordLength : 0,
                  lastComplete ? lastComplete->recordLength : 0);
}

void Digitizer::abort() {
  update();
  if (state == AcqState::Acquiring) {
    current.reset();
    state = AcqState::Committed;
  }
}

void Digitizer::resetState() {
  current.reset();
  lastComplete.reset();
  state = AcqState::Idle;
  for (auto& p : processing) p.clear();
  for (auto& e : equalization) e.clear();
  stats.clear();
}

}  // namespace hsdig::sim
