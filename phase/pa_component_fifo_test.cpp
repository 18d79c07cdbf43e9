#include <gtest/gtest.h>

#include <stdexcept>
#include <vector>

#include "lumen/phase/pa_component.h"
#include "phase/fake_host_objects.h"

namespace phase_test {
namespace {

using FifoTest = PhaseHostTest;

const PAParameter kPlain(1, false, 0, true, 0, false);  // slot 4

// `count` point buffers in one block, point k's slot 4 holding k + 0.25j.
std::vector<TsComplex> Points(int count) {
  std::vector<TsComplex> points(static_cast<std::size_t>(count) * kPointSize);
  for (int k = 0; k < count; ++k) points[k * kPointSize + 4] = TsComplex(k, 0.25);
  return points;
}

std::vector<std::size_t> WriteSizes(const FakeFifo& fifo) {
  std::vector<std::size_t> sizes;
  for (const auto& run : fifo.writes) sizes.push_back(run.size());
  return sizes;
}

TEST_F(FifoTest, StreamsFullRunsDuringTheCallAndTheRestAtItsEnd) {
  PAComponent component;
  component.AddParameter(kPlain);
  component.SetSweepParameters(1, false, 1);
  std::vector<TsComplex> points = Points(PAComponent::kFifoRun + 5);
  component.PutData(points.data(), PAComponent::kFifoRun + 5, kPointSize, false, true);
  ASSERT_EQ(WriteSizes(fifo()), (std::vector<std::size_t>{20001, 5}));
  EXPECT_EQ(fifo().writes[0][20000], TsComplex(20000, 0.25));
  EXPECT_EQ(fifo().writes[1][4], TsComplex(20005, 0.25));
  EXPECT_EQ(component.GetAvailableDataCount(kPlain), 0);

  // Exactly one run: one Write, no empty one after it.
  fifo().writes.clear();
  points = Points(PAComponent::kFifoRun);
  component.PutData(points.data(), PAComponent::kFifoRun, kPointSize, false, true);
  EXPECT_EQ(WriteSizes(fifo()), std::vector<std::size_t>{20001});
}

TEST_F(FifoTest, StreamsAveragesWithoutAnArrayToHoldThem) {
  PAComponent component;
  const PAParameter ratio(1, false, 1, true, 0, true);
  component.AddParameter(ratio);
  component.SetSweepParameters(0, false, 2);
  std::vector<TsComplex> points = Points(4);
  for (int k = 0; k < 4; ++k) points[k * kPointSize] = TsComplex(2, 0);  // reference port 1
  component.PutData(points.data(), 4, kPointSize, false, true);
  EXPECT_EQ(fifo().writes,
            (std::vector<std::vector<TsComplex>>{{{0.25, 0.125}, {1.25, 0.125}}}));
}

TEST_F(FifoTest, MissingOrFailingFifoLosesNoValue) {
  PAComponent component;
  component.AddParameter(kPlain);
  component.SetSweepParameters(1, false, 1);
  std::vector<TsComplex> points = Points(2);
  {
    const HostObjectsMissing missing;
    LumenUtility::RegisterHostObject<ITestSet>(LumenUtility::kHostCategoryApplication, 0,
                                               &testSet());
    ExpectLumenError([&] { component.PutData(points.data(), 2, kPointSize, false, true); },
                     LumenUtility::E_POINTER, L"no FIFO is registered");
  }
  fifo().failing = true;
  EXPECT_THROW(component.PutData(points.data(), 2, kPointSize, false, true), std::runtime_error);
  fifo().failing = false;
  component.PutData(points.data() + kPointSize, 1, kPointSize, false, true);
  // The values of the failed call come first; the call that found no FIFO consumed nothing.
  EXPECT_EQ(fifo().writes,
            (std::vector<std::vector<TsComplex>>{{{0, 0.25}, {1, 0.25}, {1, 0.25}}}));
}

}  // namespace
}  // namespace phase_test
