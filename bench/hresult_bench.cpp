// FromHRESULT lookup cost: over every mapped code, and over random codes that have no entry
// (the common case when logs carry platform codes). Reports seconds per lookup
// ("per_lookup", shown in ns) and the heap allocations made while looking up (expected 0).
#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <random>
#include <vector>

#include "alloc_counter.h"
#include "lumen/util/from_hresult.h"
#include "util/from_hresult_table.h"

namespace {

void RunLookups(benchmark::State& state, const std::vector<HRESULT>& codes) {
  const lumen_bench::AllocationScope allocations;
  for (auto _ : state) {
    for (const HRESULT code : codes) benchmark::DoNotOptimize(FromHRESULT(code));
  }
  state.counters["allocations"] = static_cast<double>(allocations.Totals().count);
  state.counters["per_lookup"] =
      benchmark::Counter(static_cast<double>(state.iterations() * codes.size()),
                         benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

void BM_FromHResultListedCodes(benchmark::State& state) {
  std::vector<HRESULT> codes;
  for (const auto& entry : LumenUtility::HResultErrorNumbers()) {
    codes.push_back(static_cast<HRESULT>(entry.code));
  }
  // Shuffled so the branch predictor does not learn the table's order.
  std::shuffle(codes.begin(), codes.end(), std::mt19937(12345));
  RunLookups(state, codes);
}
BENCHMARK(BM_FromHResultListedCodes);

void BM_FromHResultUnlistedCodes(benchmark::State& state) {
  std::mt19937 random(6789);
  std::vector<HRESULT> codes;
  while (codes.size() < 4096) {
    const auto code = static_cast<HRESULT>(random());
    if (FromHRESULT(code) == LumenUtility::kUnmappedErrorNumber) codes.push_back(code);
  }
  RunLookups(state, codes);
}
BENCHMARK(BM_FromHResultUnlistedCodes);

}  // namespace
