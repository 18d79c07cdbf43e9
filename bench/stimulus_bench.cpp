// Costs of the stimulus types on a 20001-point sweep, the analyzer's largest common trace.
#include <benchmark/benchmark.h>

#include <random>

#include "alloc_counter.h"
#include "lumen/stimulus.h"

namespace {

using LumenUtility::InputArray;
using LumenUtility::Segment;

constexpr int kPoints = 20001;

void SetAllocationCounters(benchmark::State& state, const lumen_bench::AllocationScope& scope) {
  const lumen_bench::AllocationTotals totals = scope.Totals();
  state.counters["allocs/iter"] =
      benchmark::Counter(static_cast<double>(totals.count) / state.iterations());
  state.counters["bytes/iter"] =
      benchmark::Counter(static_cast<double>(totals.bytes) / state.iterations());
}

// Reads every point of a linear array that was never flattened: one segment, no allocation.
void BM_LinearArrayPointReads(benchmark::State& state) {
  const InputArray sweep(10e6, 20e9, kPoints, LumenUtility::Linear);
  lumen_bench::AllocationScope scope;
  for (auto _ : state) {
    double sum = 0;
    for (unsigned int i = 0; i < sweep.size(); ++i) sum += sweep[i];
    benchmark::DoNotOptimize(sum);
  }
  SetAllocationCounters(state, scope);
  state.counters["segments"] = sweep.NumSegments();
  state.counters["flattened"] = sweep.GetSegments().front().IsArbitrary();
  state.SetItemsProcessed(state.iterations() * kPoints);
}
BENCHMARK(BM_LinearArrayPointReads);

// Segment queries that must not materialise points.
void BM_LinearSegmentQueries(benchmark::State& state) {
  const Segment segment(10e6, 20e9, kPoints, LumenUtility::Linear);
  const Segment other(10e6, 20e9, kPoints, LumenUtility::Log);
  lumen_bench::AllocationScope scope;
  double value = 12.345e9;
  for (auto _ : state) {
    benchmark::DoNotOptimize(segment.at(12345));
    benchmark::DoNotOptimize(segment.Find(value, false));
    benchmark::DoNotOptimize(segment.min_element() + segment.max_element());
    benchmark::DoNotOptimize(segment == other);
    value += 1.0;
  }
  SetAllocationCounters(state, scope);
}
BENCHMARK(BM_LinearSegmentQueries);

// Building the one flattened vector of a fresh copy.
void BM_LinearArrayFlatten(benchmark::State& state) {
  const InputArray sweep(10e6, 20e9, kPoints, LumenUtility::Linear);
  for (auto _ : state) {
    InputArray copy(sweep.GetSegment(0));
    benchmark::DoNotOptimize(copy.GetRawArray());
  }
  state.SetItemsProcessed(state.iterations() * kPoints);
}
BENCHMARK(BM_LinearArrayFlatten);

// Compacting 20001 arbitrary points (a measured frequency list with a few jumps).
void BM_OptimizeRepresentationArbitrary(benchmark::State& state) {
  std::vector<double> points(kPoints);
  std::mt19937 random(7);
  double f = 10e6;
  for (double& p : points) {
    f += (random() % 1000 == 0) ? 1e6 : 1e5;
    p = f;
  }
  for (auto _ : state) {
    InputArray array(points);
    array.OptimizeRepresentation();
    benchmark::DoNotOptimize(array.NumSegments());
    state.counters["segments"] = array.NumSegments();
  }
  state.SetItemsProcessed(state.iterations() * kPoints);
}
BENCHMARK(BM_OptimizeRepresentationArbitrary);

}  // namespace
