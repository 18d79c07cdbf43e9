// Circular interpolation (INTERP_CIRCULAR, phase fit included) of a 100,001-point trace onto
// 100,001 new points interleaved with the old ones, against a baseline loop that spends per
// point what one point of the resampling fundamentally needs: hypot, atan2, cos, sin and one
// complex multiply.
//
// Each iteration times the resampling and, separately, the baseline over as many points, so
// both figures come from the same run and cache state. Counters: ns_per_point,
// baseline_ns_per_point, x_baseline = how many times the resampling costs the baseline, and
// allocs_per_call. "Even" has exactly equal stimulus steps (the arc is used); "Ragged" has
// random steps (magnitude/phase everywhere).
#include <benchmark/benchmark.h>

#include <cmath>
#include <random>
#include <vector>

#include "alloc_counter.h"
#include "bench_timing.h"
#include "lumen/interpolation/circular_interpolation.h"

namespace {

using LumenUtility::InputArray;
using LumenUtility::TsComplex;

struct Case {
  InputArray oldStimulus;
  InputArray newStimulus;
  std::vector<TsComplex> data;
};

// A reflection trace: delay turning 3 degrees per point, slowly rippling magnitude. Old points
// from 10 MHz in 100 kHz steps (exact in binary), or with random steps of 50 to 150 kHz.
Case MakeCase(int n, bool ragged) {
  std::mt19937 rng(11);
  std::uniform_real_distribution<double> step(0.5e5, 1.5e5);
  std::vector<double> oldX(n), newX(n);
  double f = 1e7;
  for (int k = 0; k < n; ++k) {
    oldX[k] = f;
    f += ragged ? step(rng) : 1e5;
  }
  const double span = oldX[n - 1] - oldX[0];
  for (int k = 0; k < n; ++k) newX[k] = oldX[0] + span * (k + 0.5) / n;
  std::vector<TsComplex> data(n);
  for (int k = 0; k < n; ++k) {
    data[k] = TsComplex::FromMagPhase(0.5 + 0.2 * std::cos(k * 1e-3), -0.0523 * k);
  }
  return {InputArray(oldX), InputArray(newX), data};
}

void Baseline(const std::vector<TsComplex>& in, std::vector<TsComplex>& out) {
  const double wr = 0.6, wi = 0.8;
  for (std::size_t k = 0; k < in.size(); ++k) {
    const double m = std::hypot(double{in[k].re}, double{in[k].im});
    const double a = std::atan2(double{in[k].im}, double{in[k].re}) + 0.01;
    const double re = m * std::cos(a), im = m * std::sin(a);
    out[k] = TsComplex(re * wr - im * wi, re * wi + im * wr);
  }
}

void Run(benchmark::State& state, bool ragged) {
  const int n = static_cast<int>(state.range(0));
  const Case c = MakeCase(n, ragged);
  std::vector<TsComplex> out(n), baselineOut(n);
  // Keep the stimulus arrays' flattened points out of the timed calls.
  c.oldStimulus.GetRawArray();
  c.newStimulus.GetRawArray();
  lumen_bench::AllocationTotals allocations;
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kFirst, [] {},
      [&] {
        const lumen_bench::AllocationScope scope;
        bool interpolated = false;
        LumenUtility::CircularInterpolation(c.oldStimulus, c.data.data(), c.newStimulus, out.data(),
                                            &interpolated, LumenUtility::INTERP_CIRCULAR);
        allocations = scope.Totals();
      },
      [&] { Baseline(c.data, baselineOut); });
  const double points = static_cast<double>(n) * state.iterations();
  state.counters["ns_per_point"] = 1e9 * seconds.first / points;
  state.counters["baseline_ns_per_point"] = 1e9 * seconds.second / points;
  state.counters["x_baseline"] = seconds.first / seconds.second;
  state.counters["allocs_per_call"] = static_cast<double>(allocations.count);
}

void BM_CircularInterpolationEven(benchmark::State& state) {
  Run(state, false);
}
void BM_CircularInterpolationRagged(benchmark::State& state) {
  Run(state, true);
}

BENCHMARK(BM_CircularInterpolationEven)
    ->Arg(100001)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);
BENCHMARK(BM_CircularInterpolationRagged)
    ->Arg(100001)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond);

}  // namespace
