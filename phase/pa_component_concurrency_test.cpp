#include <gtest/gtest.h>

#include <atomic>
#include <cstring>
#include <random>
#include <thread>
#include <vector>

#include "lumen/phase/pa_component.h"
#include "phase/fake_host_objects.h"

namespace phase_test {
namespace {

using ConcurrencyTest = PhaseHostTest;

constexpr int kValues = 1500;  // per parameter
constexpr int kAveraging = 3;

bool SameBits(TsComplex a, TsComplex b) {
  return std::memcmp(&a, &b, sizeof a) == 0;
}

// One thread feeds PutData point by point while another follows with GetBegin,
// GetAvailableDataCount and GetDataByRef. Every value the consumer reads below the count must
// already be final: bit-identical to a single-threaded run over the same points. The test
// suite also runs this under ThreadSanitizer.
TEST_F(ConcurrencyTest, ConsumerReadsOnlyFinalValuesWhileThePointsArrive) {
  const std::vector<PAParameter> parameters{
      PAParameter(1, false, 1, true, 1, true), PAParameter(2, false, 0, true, 1, false),
      PAParameter(3, false, 2, true, 2, true), PAParameter(4, false, 0, true, 2, false)};
  PAComponent component;
  for (const PAParameter& p : parameters) component.AddParameter(p);
  PAParameter tracked(1, true, 0, true, 0, false);
  component.SetPhaseStitch(tracked, {100, 900}, 4, 3, true);
  component.SetSweepParameters(kValues, false, kAveraging);

  const int pointCount = 3 + 2 * (4 + 2) + kValues * kAveraging * 2;
  std::mt19937 random(99);
  std::uniform_real_distribution<float> value(-2.0f, 2.0f);
  std::vector<TsComplex> acquired(static_cast<std::size_t>(pointCount) * kPointSize);
  for (TsComplex& v : acquired) v = TsComplex(value(random), value(random));

  PAComponent alone = component;
  std::vector<TsComplex> copy = acquired;
  for (int k = 0; k < pointCount; ++k) {
    alone.PutData(copy.data() + k * kPointSize, 1, kPointSize, false, false);
  }
  for (const PAParameter& p : parameters) ASSERT_EQ(alone.GetAvailableDataCount(p), kValues);

  std::atomic<bool> consumerReady{false};
  int mismatches = 0, valuesRead = 0, backwards = 0;
  std::thread consumer([&] {
    consumerReady = true;
    for (bool done = false; !done;) {
      done = true;
      for (const PAParameter& p : parameters) {
        const int begin = component.GetBegin(p);
        const int available = component.GetAvailableDataCount(p);
        const std::vector<TsComplex>& values = component.GetDataByRef(p);
        const std::vector<TsComplex>& expected = alone.GetDataByRef(p);
        if (available < begin) ++backwards;
        for (int i = begin; i < available; ++i) {
          if (!SameBits(values[i], expected[i])) ++mismatches;
          ++valuesRead;
        }
        if (available < kValues) done = false;
      }
    }
  });
  while (!consumerReady) std::this_thread::yield();
  for (int k = 0; k < pointCount; ++k) {
    component.PutData(acquired.data() + k * kPointSize, 1, kPointSize, false, false);
  }
  consumer.join();
  EXPECT_EQ(mismatches, 0);
  EXPECT_EQ(backwards, 0);
  EXPECT_EQ(valuesRead, kValues * static_cast<int>(parameters.size()));  // each value once
}

}  // namespace
}  // namespace phase_test
