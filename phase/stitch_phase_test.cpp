#include "lumen/phase/stitch_phase.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstring>
#include <utility>
#include <vector>

#include "phase/stitch_sweep.h"

namespace phase_test {
namespace {

using LumenUtility::TsComplex;

constexpr double kHalfPi = 1.570796326794896;

double Distance(TsComplex a, TsComplex b) {
  return std::hypot(double{a.re} - b.re, double{a.im} - b.im);
}

// Positions (0-based, counting every point) that ApplyStitch discards in a run of n points.
std::vector<int> Discarded(StitchPhase& stitch, int n) {
  std::vector<int> discarded;
  for (int k = 0; k < n; ++k) {
    TsComplex point[5] = {{1, 2}, {3, 4}, {5, 6}, {7, 8}, {9, 10}};
    if (stitch.ApplyStitch(point)) discarded.push_back(k);
  }
  return discarded;
}

TEST(StitchPhase, DisabledKeepsEveryPointBitIdentical) {
  StitchPhase stitch;
  stitch.SetState(false, {0, 1}, 3, 2, 0, true);
  std::vector<TsComplex> point{{1.5f, -0.25f}, {-0.0f, 1e-40f}, {3, 4}, {5, 6}, {7, 8}};
  const std::vector<TsComplex> before = point;
  for (int k = 0; k < 10; ++k) EXPECT_FALSE(stitch.ApplyStitch(point.data()));
  EXPECT_EQ(0, std::memcmp(point.data(), before.data(), sizeof(TsComplex) * point.size()));
  EXPECT_EQ(stitch.ComputeNewSweepSize(201), 201);
}

TEST(StitchPhase, DiscardsLeadingSettlingAndReferencePoints) {
  StitchPhase stitch;
  stitch.SetState(true, {}, 0, 2, 0, false);
  EXPECT_EQ(Discarded(stitch, 6), (std::vector<int>{0, 1}));

  stitch.SetState(true, {3}, 2, 0, 0, false);
  EXPECT_EQ(Discarded(stitch, 10), (std::vector<int>{4, 5}));
  stitch.SetState(true, {3}, 2, 0, 0, true);  // capture 4, settling 5 and 6, realign 7
  EXPECT_EQ(Discarded(stitch, 10), (std::vector<int>{4, 5, 6, 7}));

  // Leading points shift everything; a second break counts past the first one's points.
  stitch.SetState(true, {1, 2}, 1, 1, 0, true);
  EXPECT_EQ(Discarded(stitch, 12), (std::vector<int>{0, 3, 4, 5, 7, 8, 9}));
  stitch.StartOfSweep();
  EXPECT_EQ(Discarded(stitch, 12), (std::vector<int>{0, 3, 4, 5, 7, 8, 9}));
}

TEST(StitchPhase, SweepSizeLosesSettlingAndLeadingPointsOnly) {
  StitchPhase stitch;
  stitch.SetState(true, {50, 120}, 5, 3, 0, false);
  EXPECT_EQ(stitch.ComputeNewSweepSize(201), 188);
  stitch.SetState(true, {50, 120}, 5, 3, 0, true);
  EXPECT_EQ(stitch.ComputeNewSweepSize(201), 188);
  stitch.SetState(true, {1, 2, 3}, 1 << 30, 0, 0, false);
  EXPECT_EQ(stitch.ComputeNewSweepSize(0), INT_MIN);  // clamped, not wrapped
}

TEST(StitchPhase, RealignOffsetIsTheAngleOfReferenceOverRealignValue) {
  StitchPhase stitch;
  const TsComplex reference(0.6f, -0.8f);
  const TsComplex behind = reference * TsComplex(0, -1);  // the reference turned by -90 degrees
  for (const auto& [realign, offset] : {std::pair{reference, 0.0}, std::pair{behind, kHalfPi}}) {
    stitch.SetState(true, {0}, 1, 0, 2, true);
    TsComplex kept[5], capture[5], settling[5], again[5], after[5];
    capture[2] = reference;
    again[2] = realign;
    after[2] = realign;
    EXPECT_FALSE(stitch.ApplyStitch(kept));
    EXPECT_TRUE(stitch.ApplyStitch(capture));
    EXPECT_TRUE(stitch.ApplyStitch(settling));
    EXPECT_TRUE(stitch.ApplyStitch(again));
    EXPECT_EQ(stitch.GetPhaseOffset(), offset);
    EXPECT_LE(Distance(again[2], reference), 1e-6);  // the realign value is turned back too
    EXPECT_FALSE(stitch.ApplyStitch(after));
    EXPECT_LE(Distance(after[2], reference), 1e-6);
  }
}

// Property: across two breaks with reference points, every kept value comes out as it would
// have been without the jumps (to 1e-5 of its magnitude, about 40 float roundings); without
// reference points nothing is measured, so kept points come out as acquired.
TEST(StitchPhase, ReferencePointsRemoveTheJumpsOfTwoBreaks) {
  for (const bool hasReference : {true, false}) {
    StitchSweep sweep = MakeStitchSweep(16, {4, 9}, {2.0, -2.5}, 3, 2, hasReference, 5);
    StitchPhase stitch;
    stitch.SetState(true, {4, 9}, 3, 2, 1, hasReference);
    std::vector<std::vector<TsComplex>> kept;
    for (std::vector<TsComplex>& point : sweep.acquired) {
      if (!stitch.ApplyStitch(point.data())) kept.push_back(point);
    }
    ASSERT_EQ(kept.size(), sweep.truth.size()) << hasReference;
    const auto& expected = hasReference ? sweep.truth : sweep.raw;
    for (std::size_t m = 0; m < kept.size(); ++m) {
      for (int k = 0; k < 5; ++k) {
        EXPECT_LE(Distance(kept[m][k], expected[m][k]), 1e-5 * (1 + k)) << m << ' ' << k;
      }
    }
  }
}

TEST(StitchPhase, NullPointsRunAgainstZerosAndStateResets) {
  StitchPhase stitch;
  stitch.SetState(true, {0}, 1, 1, 7, true);  // a tracked slot outside the scratch buffer
  const std::vector<bool> expected{true, false, true, true, true, false};
  for (const bool discard : expected) EXPECT_EQ(stitch.ApplyStitch(nullptr), discard);
  EXPECT_EQ(stitch.GetPhaseOffset(), kHalfPi);  // 0 over 0 is 0 + 0j, whose angle is +90 deg

  TsComplex point[8] = {};
  point[7] = TsComplex(1, 1);
  stitch.SetState(true, {0}, 0, 0, 7, true);
  stitch.ApplyStitch(point);
  stitch.ApplyStitch(point);  // capture
  EXPECT_EQ(stitch.GetReferenceValue(), TsComplex(1, 1));
  stitch.StartOfSweep();
  EXPECT_EQ(stitch.GetPointCounter(), 0);
  EXPECT_EQ(stitch.GetReferenceValue(), TsComplex(1, 1));
  stitch.SetState(true, {}, 0, 0, 0, false);
  EXPECT_EQ(stitch.GetReferenceValue(), TsComplex());
}

}  // namespace
}  // namespace phase_test
