// Whole-trace formats against a plain memcpy of the same trace bytes.
//
// Each iteration times the memcpy and the format separately on the same data, so both rates
// come from the same run and cache state. Counters: values_per_s (the format),
// memcpy_values_per_s (8-byte points copied), and x_memcpy = how many times the format is
// slower than copying the trace.
#include <benchmark/benchmark.h>

#include <chrono>
#include <cmath>
#include <cstring>
#include <random>
#include <vector>

#include "bench_timing.h"
#include "lumen/core/vector_formats.h"

namespace {

using LumenUtility::TsComplex;
using Clock = std::chrono::steady_clock;

// A measured-looking trace: slowly varying magnitude, phase winding several turns.
std::vector<TsComplex> MakeTrace(int n) {
  std::mt19937 rng(3);
  std::normal_distribution<double> noise(0.0, 0.01);
  std::vector<TsComplex> v(n);
  for (int i = 0; i < n; ++i) {
    const double mag = 0.5 + 0.4 * std::cos(i * 1e-3) + noise(rng);
    v[i] = TsComplex::FromMagPhase(mag, -0.05 * i);
  }
  return v;
}

void BM_FormatUnwrappedPhase(benchmark::State& state) {
  const int n = static_cast<int>(state.range(0));
  const std::vector<TsComplex> trace = MakeTrace(n);
  std::vector<TsComplex> copy(n);
  std::vector<float> phase(n);
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn<Clock>(
      state, lumen_bench::Reported::kSecond, [] {},
      [&] { std::memcpy(copy.data(), trace.data(), n * sizeof(TsComplex)); },
      [&] { LumenUtility::FormatUnwrappedPhase(trace.data(), phase.data(), 0, n); });
  benchmark::DoNotOptimize(copy.data());
  lumen_bench::ReportAgainstMemcpy(state, seconds.second, seconds.first);
}

void BM_ToLogMag(benchmark::State& state) {
  const int n = static_cast<int>(state.range(0));
  const std::vector<TsComplex> trace = MakeTrace(n);
  std::vector<TsComplex> work(n);
  // The copy both restores the input that ToLogMag overwrites and is the baseline.
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn<Clock>(
      state, lumen_bench::Reported::kSecond, [] {},
      [&] { std::memcpy(work.data(), trace.data(), n * sizeof(TsComplex)); },
      [&] { LumenUtility::ToLogMag(work); });
  lumen_bench::ReportAgainstMemcpy(state, seconds.second, seconds.first);
}

BENCHMARK(BM_FormatUnwrappedPhase)->Arg(20001)->Arg(100001)->UseManualTime();
BENCHMARK(BM_ToLogMag)->Arg(20001)->Arg(100001)->UseManualTime();

}  // namespace
