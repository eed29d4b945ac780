// Fetch throughput of the simulated digitizer: one acquired record of 16 M
// samples fetched in every sample format, next to memcpy of the same number
// of output bytes in the same run. Prints samples per second and the ratio
// fetch time / memcpy time per format (1.0: as cheap as one copy).
#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstring>
#include <map>
#include <string>
#include <vector>

#include "hsdig.h"

namespace {

constexpr ViInt32 kSamples = 16 * 1024 * 1024;
ViSession session = 0;

struct Format {
  const char* name;
  ViInt32 dataType;
  size_t bytes;  // per sample
};
const Format kFormats[] = {
    {"Binary16", HSDIG_VAL_BINARY16, 2},
    {"Binary8", HSDIG_VAL_BINARY8, 1},
    {"Binary32", HSDIG_VAL_BINARY32, 4},
    {"Real64", HSDIG_VAL_REAL64, 8},
    {"ComplexBinary16", HSDIG_VAL_COMPLEX_BINARY16, 4},
    {"ComplexReal64", HSDIG_VAL_COMPLEX_REAL64, 16},
};

std::vector<char>& buffer() {
  static std::vector<char> b(static_cast<size_t>(kSamples) * 16);
  return b;
}

ViStatus fetch(const Format& f, void* out, hsdigWfmInfo* info) {
  switch (f.dataType) {
    case HSDIG_VAL_BINARY16:
      return hsdig_FetchBinary16(session, "0", 10.0, kSamples, static_cast<ViInt16*>(out), info);
    case HSDIG_VAL_BINARY8:
      return hsdig_FetchBinary8(session, "0", 10.0, kSamples, static_cast<ViInt8*>(out), info);
    case HSDIG_VAL_BINARY32:
      return hsdig_FetchBinary32(session, "0", 10.0, kSamples, static_cast<ViInt32*>(out), info);
    case HSDIG_VAL_REAL64:
      return hsdig_Fetch(session, "0", 10.0, kSamples, static_cast<ViReal64*>(out), info);
    case HSDIG_VAL_COMPLEX_BINARY16:
      return hsdig_FetchComplexBinary16(session, "0", 10.0, kSamples, static_cast<ViInt16*>(out),
                                        info);
    default:
      return hsdig_FetchComplex(session, "0", 10.0, kSamples, static_cast<ViReal64*>(out), info);
  }
}

void BM_Fetch(benchmark::State& state, const Format* f) {
  hsdigWfmInfo info{};
  for (auto _ : state) {
    if (fetch(*f, buffer().data(), &info) < 0) state.SkipWithError("fetch failed");
    benchmark::DoNotOptimize(buffer().data());
  }
  state.SetItemsProcessed(state.iterations() * kSamples);
}

void BM_Memcpy(benchmark::State& state, const Format* f) {
  const size_t bytes = static_cast<size_t>(kSamples) * f->bytes;
  static std::vector<char> source(static_cast<size_t>(kSamples) * 16, 1);
  for (auto _ : state) {
    std::memcpy(buffer().data(), source.data(), bytes);
    benchmark::DoNotOptimize(buffer().data());
    benchmark::ClobberMemory();
  }
  state.SetItemsProcessed(state.iterations() * kSamples);
}

void BM_Acquire(benchmark::State& state) {
  std::vector<ViInt16> out(kSamples);
  hsdigWfmInfo info{};
  for (auto _ : state) {
    hsdig_InitiateAcquisition(session);
    hsdig_FetchBinary16(session, "0", 10.0, kSamples, out.data(), &info);
  }
  state.SetItemsProcessed(state.iterations() * kSamples);
}

// Keeps the per-iteration time of every run for the ratio table.
class RatioReporter : public benchmark::ConsoleReporter {
 public:
  void ReportRuns(const std::vector<Run>& runs) override {
    for (const Run& r : runs) {
      if (r.iterations > 0)
        seconds[r.benchmark_name()] = r.real_accumulated_time / static_cast<double>(r.iterations);
    }
    ConsoleReporter::ReportRuns(runs);
  }
  std::map<std::string, double> seconds;
};

}  // namespace

int main(int argc, char** argv) {
  benchmark::Initialize(&argc, argv);
  if (hsdig_InitWithOptions(const_cast<ViRsrc>("SIM::BENCH"), VI_FALSE, VI_FALSE, "", &session) <
          0 ||
      hsdig_ConfigureHorizontalTiming(session, 250e6, kSamples, 0.0, 1, VI_TRUE) < 0 ||
      hsdig_SetAttributeViReal64(session, "0", HSDIG_ATTR_SIGNAL_NOISE, 0.01) < 0 ||
      hsdig_InitiateAcquisition(session) < 0) {
    std::fprintf(stderr, "cannot set up the simulated digitizer\n");
    return 1;
  }
  // The first fetch waits for the acquisition and fills its memory; the
  // measured fetches only move data.
  hsdigWfmInfo info{};
  if (hsdig_FetchBinary16(session, "0", 10.0, kSamples, reinterpret_cast<ViInt16*>(buffer().data()),
                          &info) < 0) {
    std::fprintf(stderr, "the first fetch failed\n");
    return 1;
  }
  for (const Format& f : kFormats) {
    benchmark::RegisterBenchmark((std::string("Fetch/") + f.name).c_str(), BM_Fetch, &f)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark((std::string("Memcpy/") + f.name).c_str(), BM_Memcpy, &f)
        ->Unit(benchmark::kMillisecond);
  }
  benchmark::RegisterBenchmark("AcquireAndFetch/Binary16", BM_Acquire)
      ->Unit(benchmark::kMillisecond);
  RatioReporter reporter;
  benchmark::RunSpecifiedBenchmarks(&reporter);
  std::printf("\n%-16s %16s %16s %12s\n", "format", "fetch samples/s", "memcpy samples/s",
              "fetch/memcpy");
  for (const Format& f : kFormats) {
    auto fetchIt = reporter.seconds.find(std::string("Fetch/") + f.name);
    auto copyIt = reporter.seconds.find(std::string("Memcpy/") + f.name);
    if (fetchIt == reporter.seconds.end() || copyIt == reporter.seconds.end()) continue;
    std::printf("%-16s %16.3e %16.3e %12.2f\n", f.name, kSamples / fetchIt->second,
                kSamples / copyIt->second, fetchIt->second / copyIt->second);
  }
  hsdig_close(session);
  benchmark::Shutdown();
  return 0;
}
