// Translator throughput: translations per second of a plain code and of a
// code with a structured description, and the cost of a translator session
// (warm: interpreter states from the pool; cold: built from scratch). Each
// is printed as a ratio to a baseline measured in the same run: the lookup
// of a static text in a plain C++ map and its formatting, which is what a
// translator without scripts would cost at least.
#include <benchmark/benchmark.h>

#include <cstdio>
#include <map>
#include <string>
#include <vector>

#include "errors/ErrorDescription.h"
#include "errors/Status.h"
#include "errors/translator/TranslatorSession.h"

namespace {

using namespace hsdig;
using namespace hsdig::translator;

constexpr int32_t kCode = static_cast<int32_t>(0xBFFA9157);

Status describedStatus() {
  Status status(static_cast<int32_t>(0xBFFA004C));
  description::addElaboration(status, "kSidlInvalidTag");
  description::addUsage(status, "kUsageTypeRequestedValue", "Bogus");
  description::addEnumUsage(status, "kUsageTypeRequestedValue", 3, 1199999);
  description::addUsage(status, "kUsageTypeAttributeId", static_cast<int32_t>(1050005));
  Status nested(-52006);
  description::addUsage(nested, "kUsageTypeFilePath", "/tmp/lock");
  description::addNestedError(status, nested);
  return status;
}

void baseline(benchmark::State& state) {
  std::map<int32_t, std::string> table;
  for (int32_t i = 0; i < 64; ++i)
    table[kCode - 32 + i] = "The connection to the server timed out.";
  for (auto _ : state) {
    char head[32];
    std::snprintf(head, sizeof head, "0x%08X", static_cast<uint32_t>(kCode));
    std::string text = head;
    text += ": " + table.at(kCode);
    benchmark::DoNotOptimize(text);
  }
}

void plainCode(benchmark::State& state) {
  TranslatorSession session;
  Status code(kCode);
  code.description().SetNull();
  for (auto _ : state) {
    std::string text;
    Status result;
    session.translate(code, 0, kConversionFlags, text, result);
    benchmark::DoNotOptimize(text);
  }
}

void describedCode(benchmark::State& state) {
  TranslatorSession session;
  Status status = describedStatus();
  for (auto _ : state) {
    std::string text;
    Status result;
    session.translate(status, 0, kConversionFlags, text, result);
    benchmark::DoNotOptimize(text);
  }
}

// A session per translation, as the error conversion opens one: warm pool.
void sessionWarm(benchmark::State& state) {
  {
    TranslatorSession prime;
    prime.staticDescription(kCode, 0);
  }
  Status code(kCode);
  code.description().SetNull();
  for (auto _ : state) {
    TranslatorSession session;
    std::string text;
    Status result;
    session.translate(code, 0, kConversionFlags, text, result);
    benchmark::DoNotOptimize(text);
  }
}

// The same with the interpreter state built from scratch every time.
void sessionCold(benchmark::State& state) {
  Status code(kCode);
  code.description().SetNull();
  for (auto _ : state) {
    clearTranslatorPool();
    TranslatorSession session;
    std::string text;
    Status result;
    session.translate(code, 0, kConversionFlags, text, result);
    benchmark::DoNotOptimize(text);
  }
}

BENCHMARK(baseline);
BENCHMARK(plainCode);
BENCHMARK(describedCode);
BENCHMARK(sessionWarm);
BENCHMARK(sessionCold);

// Keeps each benchmark's time per iteration for the summary.
class Recorder : public benchmark::ConsoleReporter {
 public:
  void ReportRuns(const std::vector<Run>& runs) override {
    for (const auto& run : runs) {
      if (run.iterations > 0) nanoseconds[run.benchmark_name()] = run.GetAdjustedRealTime();
    }
    ConsoleReporter::ReportRuns(runs);
  }
  std::map<std::string, double> nanoseconds;
};

}  // namespace

int main(int argc, char** argv) {
  benchmark::Initialize(&argc, argv);
  Recorder recorder;
  benchmark::RunSpecifiedBenchmarks(&recorder);
  auto& ns = recorder.nanoseconds;
  if (!ns.count("baseline")) return 0;
  double base = ns["baseline"];
  std::printf("\nbaseline (map lookup and formatting): %.0f ns\n", base);
  const struct {
    const char* name;
    const char* what;
    bool perSecond;
  } rows[] = {
      {"plainCode", "translations per second, plain code", true},
      {"describedCode", "translations per second, code with a structured description", true},
      {"sessionWarm", "session created (pooled interpreter) and one translation", false},
      {"sessionCold", "session created (new interpreter) and one translation", false},
  };
  for (const auto& row : rows) {
    if (!ns.count(row.name)) continue;
    double t = ns[row.name];
    if (row.perSecond) {
      std::printf("%-62s %10.0f /s  (%.0fx the baseline's time)\n", row.what, 1e9 / t, t / base);
    } else {
      std::printf("%-62s %10.1f us  (%.0fx the baseline's time)\n", row.what, t / 1000.0, t / base);
    }
  }
  return 0;
}
