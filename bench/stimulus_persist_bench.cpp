// Packed save and recall of a 20001-point arbitrary array (a measured frequency list, the
// largest common stimulus), each timed in turn with a memcpy of the record's bytes.
#include <benchmark/benchmark.h>

#include <cstring>
#include <vector>

#include "bench_timing.h"
#include "lumen/stimulus.h"

namespace {

using LumenUtility::InputArray;

constexpr int kPoints = 20001;

InputArray MeasuredFrequencies() {
  std::vector<double> points(kPoints);
  for (int i = 0; i < kPoints; ++i) points[i] = 10e6 + 1e5 * i + (i % 7) * 13.0;
  return InputArray(points);
}

// GB_per_s of the operation, memcpy_GB_per_s of the copy, and x_memcpy = how many times the
// operation is slower than copying the record.
void ReportBytes(benchmark::State& state, std::size_t recordBytes,
                 const lumen_bench::SecondsInTurn& seconds) {
  const double bytes = static_cast<double>(recordBytes) * state.iterations();
  state.counters["GB_per_s"] = bytes / seconds.second / 1e9;
  state.counters["memcpy_GB_per_s"] = bytes / seconds.first / 1e9;
  state.counters["x_memcpy"] = seconds.second / seconds.first;
  state.SetBytesProcessed(static_cast<std::int64_t>(bytes));
}

void BM_PackedSaveArbitrary(benchmark::State& state) {
  const InputArray array = MeasuredFrequencies();
  const int size = array.SaveData(nullptr, 0);
  std::vector<unsigned char> record(size), copy(size);
  array.SaveData(record.data(), size);
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [] {},
      [&] { std::memcpy(copy.data(), record.data(), size); },
      [&] { benchmark::DoNotOptimize(array.SaveData(record.data(), size)); });
  ReportBytes(state, size, seconds);
}
BENCHMARK(BM_PackedSaveArbitrary)->UseManualTime();

void BM_PackedRecallArbitrary(benchmark::State& state) {
  const InputArray source = MeasuredFrequencies();
  const int size = source.SaveData(nullptr, 0);
  std::vector<unsigned char> record(size), copy(size);
  source.SaveData(record.data(), size);
  InputArray target;
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [] {},
      [&] { std::memcpy(copy.data(), record.data(), size); },
      [&] { benchmark::DoNotOptimize(target.RecallData(record.data(), size)); });
  if (target != source) state.SkipWithError("recalled array differs");
  ReportBytes(state, size, seconds);
}
BENCHMARK(BM_PackedRecallArbitrary)->UseManualTime();

}  // namespace
