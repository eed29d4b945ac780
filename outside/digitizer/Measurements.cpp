// Scalar and array measurements on scaled records.
//
// Scalar levels follow the usual pulse conventions: high and low are the
// most common values near the top and bottom of the waveform (its maximum
// and minimum when no level dominates, as for a sine); edges are timed
// between the 10 % and 90 % levels; periods and widths are measured at the
// 50 % level with a hysteresis of 10 % of the amplitude, averaged over every
// complete cycle of the record.
#include <algorithm>
#include <cmath>
#include <complex>
#include <numeric>

#include "Digitizer.h"

namespace hsdig::sim {

namespace {

struct Levels {
  double min, max, high, low;
};

Levels levelsOf(const std::vector<double>& y) {
  auto [mn, mx] = std::minmax_element(y.begin(), y.end());
  Levels l{*mn, *mx, *mx, *mn};
  const double span = *mx - *mn;
  if (span <= 0) return l;
  constexpr int kBins = 256;
  std::vector<int> bins(kBins, 0);
  for (double v : y) {
    int b = std::min(kBins - 1, static_cast<int>((v - *mn) / span * kBins));
    ++bins[static_cast<size_t>(b)];
  }
  // A level dominates when its bin holds at least 10 % of the samples.
  auto mode = [&](int from, int to) {
    int best = -1;
    for (int b = from; b < to; ++b) {
      if (best < 0 || bins[static_cast<size_t>(b)] > bins[static_cast<size_t>(best)]) best = b;
    }
    return bins[static_cast<size_t>(best)] * 10 >= static_cast<int>(y.size()) ? best : -1;
  };
  int hi = mode(kBins / 2, kBins), lo = mode(0, kBins / 2);
  if (hi >= 0) l.high = *mn + (hi + 0.5) * span / kBins;
  if (lo >= 0) l.low = *mn + (lo + 0.5) * span / kBins;
  return l;
}

// Times (in samples, interpolated) where y crosses `level` upwards or
// downwards, with hysteresis.
struct Crossings {
  std::vector<double> rising, falling;
};
Crossings crossingsOf(const std::vector<double>& y, double level, double hysteresis) {
  Crossings c;
  int armed = 0;  // -1 below level - h, +1 above level + h
  for (size_t k = 0; k < y.size(); ++k) {
    if (y[k] < level - hysteresis) {
      if (armed == 1 && k > 0) {
        // Find the sample where it passed the level.
        size_t j = k;
        while (j > 0 && y[j - 1] <= level) --j;
        double a = y[j > 0 ? j - 1 : 0], b = y[j];
        c.falling.push_back((j > 0 ? j - 1 : 0) + (a != b ? (a - level) / (a - b) : 0.0));
      }
      armed = -1;
    } else if (y[k] > level + hysteresis) {
      if (armed == -1 && k > 0) {
        size_t j = k;
        while (j > 0 && y[j - 1] >= level) --j;
        double a = y[j > 0 ? j - 1 : 0], b = y[j];
        c.rising.push_back((j > 0 ? j - 1 : 0) + (a != b ? (level - a) / (b - a) : 0.0));
      }
      armed = 1;
    }
  }
  return c;
}

double firstCrossingBefore(const std::vector<double>& y, double at, double level, bool rising) {
  // Last sample before `at` on the far side of `level`, interpolated.
  for (long k = static_cast<long>(at); k > 0; --k) {
    double a = y[static_cast<size_t>(k - 1)], b = y[static_cast<size_t>(k)];
    if (rising ? (a <= level && b > level) : (a >= level && b < level)) {
      return (k - 1) + (b != a ? (level - a) / (b - a) : 0.0);
    }
  }
  return -1;
}
double firstCrossingAfter(const std::vector<double>& y, double at, double level, bool rising) {
  for (size_t k = static_cast<size_t>(std::max(0.0, at)) + 1; k < y.size(); ++k) {
    double a = y[k - 1], b = y[k];
    if (rising ? (a < level && b >= level) : (a > level && b <= level)) {
      return (k - 1) + (b != a ? (level - a) / (b - a) : 0.0);
    }
  }
  return -1;
}

[[noreturn]] void cannot(const char* what) {
  fail(HSDIG_ERROR_MEASUREMENT, std::string("The waveform has ") + what + ".");
}

double meanDifference(const std::vector<double>& t) {
  if (t.size() < 2) cannot("fewer than two edges of one direction, so no full cycle");
  return (t.back() - t.front()) / static_cast<double>(t.size() - 1);
}

double edgeTime(const std::vector<double>& y, const Levels& l, bool rising) {
  const double amp = l.high - l.low;
  const double lo = l.low + 0.1 * amp, hi = l.low + 0.9 * amp;
  Crossings c = crossingsOf(y, l.low + 0.5 * amp, 0.1 * amp);
  const auto& mids = rising ? c.rising : c.falling;
  double sum = 0;
  int count = 0;
  for (double m : mids) {
    double a = firstCrossingBefore(y, m, rising ? lo : hi, rising);
    double b = firstCrossingAfter(y, m, rising ? hi : lo, rising);
    if (a >= 0 && b >= 0) {
      sum += b - a;
      ++count;
    }
  }
  if (count == 0) cannot(rising ? "no complete rising edge" : "no complete falling edge");
  return sum / count;
}

void fft(std::vector<std::complex<double>>& a) {
  const size_t n = a.size();
  for (size_t i = 1, j = 0; i < n; ++i) {
    size_t bit = n >> 1;
    for (; j & bit; bit >>= 1) j ^= bit;
    j ^= bit;
    if (i < j) std::swap(a[i], a[j]);
  }
  for (size_t len = 2; len <= n; len <<= 1) {
    const double ang = -2 * M_PI / static_cast<double>(len);
    const std::complex<double> wl(std::cos(ang), std::sin(ang));
    for (size_t i = 0; i < n; i += len) {
      std::complex<double> w(1);
      for (size_t j = 0; j < len / 2; ++j) {
        auto u = a[i + j], v = a[i + j + len / 2] * w;
        a[i + j] = u + v;
        a[i + j + len / 2] = u - v;
        w *= wl;
      }
    }
  }
}

size_t paddedLength(std::int32_t n) {
  size_t p = 1;
  while (p < static_cast<size_t>(std::max(n, 1))) p <<= 1;
  return p;
}

}  // namespace

Trace scaledRecord(const Acquisition& a, int channel, int record) {
  const ChannelData& d = a.data[static_cast<size_t>(channel)];
  const ChannelSetup& c = a.channels[static_cast<size_t>(channel)];
  Trace t;
  t.y.resize(static_cast<size_t>(a.recordLength));
  const std::int16_t* codes =
      d.codes.get() + static_cast<size_t>(record) * static_cast<size_t>(a.recordLength);
  const double gain = c.gain();
  for (size_t k = 0; k < t.y.size(); ++k) t.y[k] = codes[k] * gain + c.offset;
  t.dx = 1.0 / a.sampleRate;
  t.x0 = -a.refIndex / a.sampleRate + a.triggerDelay;
  return t;
}

bool isScalarFunction(ViInt32 f) {
  return f >= HSDIG_MEAS_RISE_TIME && f <= HSDIG_MEAS_AMPLITUDE;
}
bool isArrayFunction(ViInt32 f) {
  return f >= HSDIG_MEAS_ARRAY_NONE && f <= HSDIG_MEAS_FFT_AMP_SPECTRUM_DB;
}

double scalarMeasurement(const Trace& t, ViInt32 function) {
  const std::vector<double>& y = t.y;
  if (y.empty()) cannot("no samples");
  const Levels l = levelsOf(y);
  const double amp = l.high - l.low;
  auto cycles = [&] {
    if (amp <= 0) cannot("no amplitude");
    return crossingsOf(y, l.low + 0.5 * amp, 0.1 * amp);
  };
  switch (function) {
    case HSDIG_MEAS_VOLTAGE_MAX:
      return l.max;
    case HSDIG_MEAS_VOLTAGE_MIN:
      return l.min;
    case HSDIG_MEAS_VOLTAGE_PEAK_TO_PEAK:
      return l.max - l.min;
    case HSDIG_MEAS_VOLTAGE_HIGH:
      return l.high;
    case HSDIG_MEAS_VOLTAGE_LOW:
      return l.low;
    case HSDIG_MEAS_AMPLITUDE:
      return amp;
    case HSDIG_MEAS_VOLTAGE_AVERAGE:
      return std::accumulate(y.begin(), y.end(), 0.0) / static_cast<double>(y.size());
    case HSDIG_MEAS_VOLTAGE_RMS: {
      double s = 0;
      for (double v : y) s += v * v;
      return std::sqrt(s / static_cast<double>(y.size()));
    }
    case HSDIG_MEAS_PERIOD: {
      Crossings c = cycles();
      return meanDifference(c.rising.size() >= 2 ? c.rising : c.falling) * t.dx;
    }
    case HSDIG_MEAS_FREQUENCY: {
      Crossings c = cycles();
      return 1.0 / (meanDifference(c.rising.size() >= 2 ? c.rising : c.falling) * t.dx);
    }
    case HSDIG_MEAS_RISE_TIME:
      if (amp <= 0) cannot("no amplitude");
      return edgeTime(y, l, true) * t.dx;
    case HSDIG_MEAS_FALL_TIME:
      if (amp <= 0) cannot("no amplitude");
      return edgeTime(y, l, false) * t.dx;
    case HSDIG_MEAS_WIDTH_POS:
    case HSDIG_MEAS_WIDTH_NEG:
    case HSDIG_MEAS_DUTY_CYCLE_POS:
    case HSDIG_MEAS_DUTY_CYCLE_NEG: {
      Crossings c = cycles();
      const bool positive =
          function == HSDIG_MEAS_WIDTH_POS || function == HSDIG_MEAS_DUTY_CYCLE_POS;
      const auto& from = positive ? c.rising : c.falling;
      const auto& to = positive ? c.falling : c.rising;
      double sum = 0;
      int count = 0;
      for (double s : from) {
        auto next = std::upper_bound(to.begin(), to.end(), s);
        if (next != to.end()) {
          sum += *next - s;
          ++count;
        }
      }
      if (count == 0) cannot("no complete pulse");
      double width = sum / count;
      if (function == HSDIG_MEAS_WIDTH_POS || function == HSDIG_MEAS_WIDTH_NEG) return width * t.dx;
      return 100.0 * width / meanDifference(c.rising.size() >= 2 ? c.rising : c.falling);
    }
    default:
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "Scalar measurement function " +
                                               std::to_string(function) +
                                               " is not one of HSDIG_MEAS_RISE_TIME (0) to "
                                               "HSDIG_MEAS_AMPLITUDE (15).");
  }
}

std::int32_t arrayMeasurementSize(std::int32_t n, ViInt32 function) {
  if (function == HSDIG_MEAS_FFT_AMP_SPECTRUM_VOLTS_RMS ||
      function == HSDIG_MEAS_FFT_AMP_SPECTRUM_DB) {
    return static_cast<std::int32_t>(paddedLength(n) / 2 + 1);
  }
  return n;
}

Trace arrayMeasurement(const Trace& in, ViInt32 function) {
  Trace out = in;
  std::vector<double>& y = out.y;
  const size_t n = y.size();
  switch (function) {
    case HSDIG_MEAS_ARRAY_NONE:
      break;
    case HSDIG_MEAS_ARRAY_NEGATE:
      for (double& v : y) v = -v;
      break;
    case HSDIG_MEAS_ARRAY_ABSOLUTE:
      for (double& v : y) v = std::fabs(v);
      break;
    case HSDIG_MEAS_ARRAY_SQUARE:
      for (double& v : y) v = v * v;
      break;
    case HSDIG_MEAS_ARRAY_DC_REMOVE: {
      double mean = n ? std::accumulate(y.begin(), y.end(), 0.0) / static_cast<double>(n) : 0.0;
      for (double& v : y) v -= mean;
      break;
    }
    case HSDIG_MEAS_ARRAY_DERIVATIVE:
      for (size_t k = 0; k < n; ++k) {
        size_t a = k ? k - 1 : 0, b = k + 1 < n ? k + 1 : k;
        y[k] = b > a ? (in.y[b] - in.y[a]) / ((b - a) * in.dx) : 0.0;
      }
      break;
    case HSDIG_MEAS_ARRAY_INTEGRAL: {
      double sum = 0;
      for (size_t k = 0; k < n; ++k) {
        if (k) sum += 0.5 * (in.y[k - 1] + in.y[k]) * in.dx;
        y[k] = sum;
      }
      break;
    }
    case HSDIG_MEAS_FFT_AMP_SPECTRUM_VOLTS_RMS:
    case HSDIG_MEAS_FFT_AMP_SPECTRUM_DB: {
      const size_t p = paddedLength(static_cast<std::int32_t>(n));
      // 16 bytes per padded point: larger spectra would take gigabytes.
      if (p > (size_t(1) << 24)) {
        fail(HSDIG_ERROR_NOT_SUPPORTED,
             "Spectra are computed for records of up to 16777216 samples, not " +
                 std::to_string(n) + ".");
      }
      std::vector<std::complex<double>> a(p);
      for (size_t k = 0; k < n; ++k) a[k] = in.y[k];
      fft(a);
      y.assign(p / 2 + 1, 0.0);
      const double norm = n ? 1.0 / static_cast<double>(n) : 0.0;
      for (size_t k = 0; k <= p / 2; ++k) {
        // Peak amplitude 2|X|/N for k > 0, as RMS; the DC bin is its value.
        double mag = std::abs(a[k]) * norm;
        double rms = k == 0 ? mag : mag * std::sqrt(2.0);
        y[k] = function == HSDIG_MEAS_FFT_AMP_SPECTRUM_DB ? 20.0 * std::log10(std::max(rms, 1e-15))
                                                          : rms;
      }
      out.x0 = 0;
      out.dx = 1.0 / (in.dx * static_cast<double>(p));
      break;
    }
    default:
      fail(HSDIG_ERROR_VALUE_OUT_OF_RANGE, "Array measurement function " +
                                               std::to_string(function) +
                                               " is not one of HSDIG_MEAS_ARRAY_NONE (1000) to "
                                               "HSDIG_MEAS_FFT_AMP_SPECTRUM_DB (1008).");
  }
  return out;
}

}  // namespace hsdig::sim
