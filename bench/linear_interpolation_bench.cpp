// Trace resampling with LinearInterpolation on one arbitrary (explicit-point) segment, where
// every new point must be located by search rather than computed from a segment description.
//
// Each iteration resamples the N-point trace once and, timed separately, a 1,001-point trace
// of the same shape as many times as it takes to produce as many output points. Counters:
// ns_per_point (N points), ns_per_point_1001, and x_1001 = how many times a point of the
// N-point trace costs more than one of the 1,001-point trace (a search that grows as log N
// keeps this near 1; a linear scan would make it N / 1001).
#include <benchmark/benchmark.h>

#include <cmath>
#include <random>
#include <vector>

#include "bench_timing.h"
#include "lumen/interpolation/linear_interpolation.h"

namespace {

using LumenUtility::InputArray;
using LumenUtility::TsComplex;

struct Case {
  InputArray oldStimulus;
  InputArray newStimulus;
  std::vector<TsComplex> data;
  std::vector<TsComplex> out;
};

// Old points 1 GHz apart on average with random spacing; new points fall between them.
Case MakeCase(int n) {
  std::mt19937 rng(7);
  std::uniform_real_distribution<double> step(0.5e6, 1.5e6);
  std::vector<double> oldPoints(n), newPoints(n);
  double f = 1e9;
  for (int k = 0; k < n; ++k) {
    oldPoints[k] = f;
    const double next = f + step(rng);
    newPoints[k] = k + 1 < n ? 0.5 * (f + next) : f;
    f = next;
  }
  Case c{InputArray(oldPoints), InputArray(newPoints), std::vector<TsComplex>(n), {}};
  for (int k = 0; k < n; ++k) c.data[k] = TsComplex::FromMagPhase(0.5, -0.01 * k);
  return c;
}

void BM_LinearInterpolationArbitrary(benchmark::State& state) {
  const int n = static_cast<int>(state.range(0));
  constexpr int kSmall = 1001;
  Case big = MakeCase(n);
  Case small = MakeCase(kSmall);
  const int repeats = (n + kSmall - 1) / kSmall;
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kFirst, [] {},
      [&] { LinearInterpolation(big.oldStimulus, big.newStimulus, big.data, big.out); },
      [&] {
        for (int r = 0; r < repeats; ++r) {
          LinearInterpolation(small.oldStimulus, small.newStimulus, small.data, small.out);
          benchmark::ClobberMemory();
        }
      });
  const double bigNs = 1e9 * seconds.first / (static_cast<double>(n) * state.iterations());
  const double smallNs =
      1e9 * seconds.second / (static_cast<double>(kSmall) * repeats * state.iterations());
  state.counters["ns_per_point"] = bigNs;
  state.counters["ns_per_point_1001"] = smallNs;
  state.counters["x_1001"] = bigNs / smallNs;
}

BENCHMARK(BM_LinearInterpolationArbitrary)
    ->Arg(1001)
    ->Arg(10001)
    ->Arg(100001)
    ->UseManualTime()
    ->Unit(benchmark::kMicrosecond);

}  // namespace
