// PutData throughput: 4 parameters (two ratioed, two not) over 2 acquisition IDs, a sweep of
// 1601 stored values each, averaging counts 1 and 16, stitching off and on (3 leading points,
// two breaks of 5 settling points with capture and realign points). Every iteration starts a
// sweep and feeds it in one PutData call; a memcpy of the same point buffers is timed in turn
// as the baseline. Counters: points_per_s (acquired points consumed per second),
// memcpy_points_per_s (point buffers copied per second), x_memcpy (how many times PutData is
// slower than copying its input), allocations (heap allocations inside the timed loops,
// expected 0).
#include <benchmark/benchmark.h>

#include <cstring>
#include <random>
#include <string>
#include <vector>

#include "alloc_counter.h"
#include "bench_timing.h"
#include "lumen/phase/pa_component.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

namespace {

using LumenUtility::TsComplex;

constexpr int kPointSize = 9;  // receiver values per point
constexpr int kStoredValues = 1601;

// Reference receivers of ports 1..4 at slots 0..3, test receivers 1..4 at 4..7.
class BenchTestSet final : public ITestSet {
 public:
  int GetPortCount() override { return 2; }  // no receiver substitution
  int ReceiverToSlot(int index, bool reference, bool) override {
    return reference ? index - 1 : 3 + index;
  }
  void ClassifyReceiver(int, int& testIndex, int& refPort, bool) override {
    testIndex = -1;
    refPort = 1;
  }
  int GetReceiverPosition(const std::wstring&) override { return 1; }
};

void BM_PutData(benchmark::State& state) {
  static BenchTestSet testSet;
  LumenUtility::RegisterHostObject<ITestSet>(LumenUtility::kHostCategoryApplication, 0,
                                             &testSet);
  const int averaging = static_cast<int>(state.range(0));
  const bool stitching = state.range(1) != 0;

  PAComponent component;
  component.AddParameter(PAParameter(1, false, 1, true, 1, true));
  component.AddParameter(PAParameter(2, false, 0, true, 1, false));
  component.AddParameter(PAParameter(3, false, 2, true, 2, true));
  component.AddParameter(PAParameter(4, false, 0, true, 2, false));
  int points = kStoredValues * averaging * 2;
  if (stitching) {
    PAParameter tracked(1, true, 0, true, 0, false);
    component.SetPhaseStitch(tracked, {400, 1200}, 5, 3, true);
    points += 3 + 2 * (5 + 2);
  }

  std::mt19937 random(2024);
  std::uniform_real_distribution<float> value(-1.0f, 1.0f);
  std::vector<TsComplex> acquired(static_cast<std::size_t>(points) * kPointSize);
  for (TsComplex& v : acquired) v = TsComplex(value(random), value(random));
  std::vector<TsComplex> buffers = acquired, copy(acquired.size());
  const std::size_t bytes = acquired.size() * sizeof(TsComplex);

  component.SetSweepParameters(kStoredValues, false, averaging);  // sizes the records
  const lumen_bench::AllocationScope allocations;
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond,
      [&] {
        std::memcpy(buffers.data(), acquired.data(), bytes);  // stitching turns them in place
        component.SetSweepParameters(kStoredValues, false, averaging);
      },
      [&] { std::memcpy(copy.data(), buffers.data(), bytes); },
      [&] { component.PutData(buffers.data(), points, kPointSize, false, false); });

  const double allocationCount = static_cast<double>(allocations.Totals().count);
  const double total = static_cast<double>(points) * state.iterations();
  state.counters["points_per_s"] = total / seconds.second;
  state.counters["memcpy_points_per_s"] = total / seconds.first;
  state.counters["x_memcpy"] = seconds.second / seconds.first;
  state.counters["allocations"] = allocationCount;
  state.SetLabel(std::string(stitching ? "stitching" : "no stitching") + ", averaging " +
                 std::to_string(averaging));
  LumenUtility::RemoveHostObject<ITestSet>(LumenUtility::kHostCategoryApplication, &testSet);
}
BENCHMARK(BM_PutData)
    ->ArgNames({"averaging", "stitch"})
    ->Args({1, 0})
    ->Args({16, 0})
    ->Args({1, 1})
    ->Args({16, 1})
    ->UseManualTime();

}  // namespace
