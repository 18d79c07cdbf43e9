// The vector-kernel resamplers against a plain memcpy of the same output bytes.
//
// The argument is the grid length; the trace has a hundredth of it (a 201-point sweep drawn on
// a 20001-point grid, as the display does). Each iteration times the memcpy of the resampled
// trace's bytes and the resampler separately on the same buffers, so both rates come from the
// same run and cache state. Counters: values_per_s (grid points resampled per second),
// memcpy_values_per_s (the same number of output values copied), and x_memcpy = how many
// times the resampler is slower than copying its output.
#include <benchmark/benchmark.h>

#include <chrono>
#include <cmath>
#include <cstring>
#include <vector>

#include "bench_timing.h"
#include "lumen/interpolation/tarn_interpolation.h"

namespace {

using LumenUtility::TsComplex;
using Clock = std::chrono::steady_clock;

constexpr double kStart = 1.0e9, kStop = 9.0e9;  // Hz

int TraceLength(int points) {
  return (points - 1) / 100 + 1;
}

std::vector<float> FloatStimulus(int n) {
  std::vector<float> x(n);
  for (int i = 0; i < n; ++i) x[i] = static_cast<float>(kStart + (kStop - kStart) * i / (n - 1));
  return x;
}

std::vector<double> DoubleStimulus(int n) {
  std::vector<double> x(n);
  for (int i = 0; i < n; ++i) x[i] = kStart + (kStop - kStart) * i / (n - 1);
  return x;
}

// Magnitude ripple and a phase winding about a turn every 8 points, like a long cable.
std::vector<TsComplex> Trace(int n) {
  std::vector<TsComplex> v(n);
  for (int i = 0; i < n; ++i)
    v[i] = TsComplex::FromMagPhase(0.5 + 0.3 * std::cos(0.2 * i), -0.8 * i);
  return v;
}

// Times `copy` then `kernel` each iteration; `restore` runs untimed first.
template <typename Restore, typename Copy, typename Kernel>
void Measure(benchmark::State& state, Restore restore, Copy copy, Kernel kernel) {
  const lumen_bench::SecondsInTurn seconds =
      lumen_bench::TimeInTurn<Clock>(state, lumen_bench::Reported::kSecond, restore, copy, kernel);
  lumen_bench::ReportAgainstMemcpy(state, seconds.second, seconds.first);
}

void BM_LinearComplex(benchmark::State& state) {
  const int points = static_cast<int>(state.range(0)), n = TraceLength(points);
  const std::vector<TsComplex> data = Trace(n);
  const std::vector<float> x = FloatStimulus(n);
  const std::vector<TsComplex> factor(points, TsComplex(0.5, 0.25));
  std::vector<TsComplex> resampled(points), result(points), copy(points);
  Measure(
      state, [] {}, [&] { std::memcpy(copy.data(), result.data(), points * sizeof(TsComplex)); },
      [&] {
        LumenUtility::TarnInterpolation(data.data(), x.data(), n, resampled.data(), factor.data(),
                                        result.data(), kStart, kStop, points, points);
      });
}

void BM_LinearMagnitudeAndPhaseCode(benchmark::State& state) {
  const int points = static_cast<int>(state.range(0)), n = TraceLength(points);
  const std::vector<TsComplex> trace = Trace(n);
  std::vector<TsComplex> data = trace;
  const std::vector<float> x = FloatStimulus(n), factor(points, 2.0f);
  std::vector<float> resampled(points), result(points);
  std::vector<std::int16_t> code(points);
  std::vector<TsComplex> copy(points), source(points);
  Measure(
      state, [&] { data = trace; },  // the kernel writes magnitudes over its input
      [&] { std::memcpy(copy.data(), source.data(), points * sizeof(TsComplex)); },
      [&] {
        LumenUtility::TarnInterpolation(data.data(), x.data(), n, resampled.data(), factor.data(),
                                        result.data(), kStart, kStop, points, points, code.data());
      });
}

void BM_CubicWithPhase(benchmark::State& state) {
  const int points = static_cast<int>(state.range(0)), n = TraceLength(points);
  const std::vector<TsComplex> trace = Trace(n);
  std::vector<float> mag(n), wrapped(n), phase(n);
  for (int i = 0; i < n; ++i) {
    mag[i] = static_cast<float>(trace[i].Mag());
    wrapped[i] = static_cast<float>(trace[i].Phase());
  }
  const std::vector<double> x = DoubleStimulus(n);
  const std::vector<TsComplex> operand(points, TsComplex(1.0, -0.5));
  std::vector<float> rmag(points), rphase(points);
  std::vector<TsComplex> resampled(points), result(points), copy(points);
  Measure(
      state, [&] { phase = wrapped; },  // the kernel unwraps the phase in place
      [&] { std::memcpy(copy.data(), result.data(), points * sizeof(TsComplex)); },
      [&] {
        LumenUtility::TarnCubicInterpolation(mag.data(), phase.data(), x.data(), n, rmag.data(),
                                             rphase.data(), resampled.data(), operand.data(),
                                             result.data(), kStart, kStop, points, true);
      });
}

BENCHMARK(BM_LinearComplex)->Arg(20001)->Arg(100001)->UseManualTime();
BENCHMARK(BM_LinearMagnitudeAndPhaseCode)->Arg(20001)->Arg(100001)->UseManualTime();
BENCHMARK(BM_CubicWithPhase)->Arg(20001)->Arg(100001)->UseManualTime();

}  // namespace
