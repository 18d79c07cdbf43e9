// Trace resampling with LinearInterpolation on one arbitrary (explicit-point) segment, where
// every new point must be located by search rather than computed from a segment description.
//
// Each iteration resamples the N-point trace once and, timed separately, a 1,001-point trace
// of the same shape as many times as it takes to produce as many output points. Counters:
// ns_per_point (N points), ns_per_point_1001, and x_1001 = how many times a point of the
// N-point trace costs more than one of the 1,001-point trace (a search that grows as log N
// keeps this near 1; a linear scan would make it N / 1001).
#include <benchmark/benchmark.h>

#include <time.h>

#include <chrono>
#include <cmath>
#include <random>
#include <vector>

#include "lumen/interpolation/linear_interpolation.h"

namespace {

using LumenUtility::InputArray;
using LumenUtility::TsComplex;
// The thread's CPU time: on a shared machine, time spent preempted would otherwise land on
// whichever of the two compared loops happened to be running.
struct Clock {
  using time_point = std::chrono::duration<double>;
  static time_point now() {
    timespec t;
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &t);
    return time_point(t.tv_sec + 1e-9 * t.tv_nsec);
  }
};

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

double Seconds(Clock::time_point a, Clock::time_point b) {
  return (b - a).count();
}

void BM_LinearInterpolationArbitrary(benchmark::State& state) {
  const int n = static_cast<int>(state.range(0));
  constexpr int kSmall = 1001;
  Case big = MakeCase(n);
  Case small = MakeCase(kSmall);
  const int repeats = (n + kSmall - 1) / kSmall;
  double bigSeconds = 0.0, smallSeconds = 0.0;
  for (auto _ : state) {
    const auto t0 = Clock::now();
    LinearInterpolation(big.oldStimulus, big.newStimulus, big.data, big.out);
    benchmark::ClobberMemory();
    const auto t1 = Clock::now();
    for (int r = 0; r < repeats; ++r) {
      LinearInterpolation(small.oldStimulus, small.newStimulus, small.data, small.out);
      benchmark::ClobberMemory();
    }
    const auto t2 = Clock::now();
    bigSeconds += Seconds(t0, t1);
    smallSeconds += Seconds(t1, t2);
    state.SetIterationTime(Seconds(t0, t1));
  }
  const double bigNs = 1e9 * bigSeconds / (static_cast<double>(n) * state.iterations());
  const double smallNs =
      1e9 * smallSeconds / (static_cast<double>(kSmall) * repeats * state.iterations());
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
