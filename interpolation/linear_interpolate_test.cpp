#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "lumen/interpolation/linear_interpolation.h"
#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {
namespace {

const double kNaN = std::numeric_limits<double>::quiet_NaN();

// Runs `call` and returns the exception it throws, failing the test when it throws none.
template <typename Call>
LumenException Thrown(Call call) {
  try {
    call();
  } catch (const LumenException& e) {
    return e;
  }
  ADD_FAILURE() << "no LumenException thrown";
  return LumenException(S_OK);
}

TEST(LinearInterpolateArray, InterpolatesAndReadsNoNeighbourAtWholeIndex) {
  // Exactly three elements on the heap, so a sanitized build reports any read of a fourth.
  const std::vector<double> values{10, 20, 30};
  EXPECT_EQ(LinearInterpolate(values.data(), 1.5), 25.0);
  EXPECT_EQ(LinearInterpolate(values.data(), 2.0), 30.0);
  EXPECT_EQ(LinearInterpolate(static_cast<const double*>(nullptr), 1.0), 0.0);
  EXPECT_TRUE(std::isnan(LinearInterpolate(values.data(), kNaN)));

  // Float elements are widened first: the result is the double sum rounded once.
  const std::vector<float> floats{0.1f, 0.7f};
  const double expected = 0.1f + 0.3 * (static_cast<double>(0.7f) - 0.1f);
  EXPECT_EQ(LinearInterpolate(floats.data(), 0.3), static_cast<float>(expected));
  EXPECT_EQ(LinearInterpolate(floats.data(), 1.0), 0.7f);
}

TEST(LinearInterpolateVector, EmptyAndOutOfRangeIndicesStayInsideTheVector) {
  EXPECT_EQ(LinearInterpolate(std::vector<double>{}, 1.5), 0.0);
  EXPECT_EQ(LinearInterpolate(std::vector<TsComplex>{}, 1.5), TsComplex(0, 0));

  const std::vector<double> values{10, 20, 30};
  EXPECT_EQ(LinearInterpolate(values, 0.25), 12.5);
  for (double past : {2.5, 1e300}) EXPECT_EQ(LinearInterpolate(values, past), 30.0) << past;
  EXPECT_EQ(LinearInterpolate(values, -0.5), 10.0);
  EXPECT_TRUE(std::isnan(LinearInterpolate(values, kNaN)));

  const std::vector<TsComplex> complex{{1, -1}, {3, 5}};
  EXPECT_EQ(LinearInterpolate(complex, -3.0), complex.front());
  EXPECT_EQ(LinearInterpolate(complex, 0.5), TsComplex(2, 2));
  for (double past : {1.0, 7.5}) EXPECT_EQ(LinearInterpolate(complex, past), complex.back());
  const TsComplex nan = LinearInterpolate(complex, kNaN);
  EXPECT_TRUE(std::isnan(nan.re) && std::isnan(nan.im));
}

TEST(LinearInterpolateStimulus, PullsBackAThousandthPastTheEndAndRejectsTheRest) {
  const InputArray stimulus(100.0, 500.0, 5, Linear);  // 100, 200, ..., 500
  EXPECT_EQ(LinearInterpolate(stimulus, 4.0005), 500.0);
  EXPECT_EQ(LinearInterpolate(stimulus, 0.0), 100.0);
  EXPECT_DOUBLE_EQ(LinearInterpolate(stimulus, 3.25), 425.0);

  for (double bad : {4.002, -0.1, kNaN, 1e300}) {
    const LumenException e = Thrown([&] { LinearInterpolate(stimulus, bad); });
    EXPECT_EQ(e.GetCode(), LUMEN_E_BOUNDS) << bad;
    EXPECT_EQ(e.GetMessage(), L"Bounds checking failure for LinearInterpolate.") << bad;
  }
  EXPECT_EQ(Thrown([] { LinearInterpolate(InputArray(), 0.0); }).GetCode(), LUMEN_E_BOUNDS);
  // One point: only index 0 (and the pull-back) is inside.
  EXPECT_EQ(LinearInterpolate(InputArray(7.0, 1), 0.0005), 7.0);
}

TEST(LogInterpolate, InterpolatesOnALogScaleBetweenNeighbours) {
  const InputArray stimulus(std::vector<double>{1e6, 1e8, 1e9});
  EXPECT_NEAR(LogInterpolate(stimulus, 0.5), 1e7, 1e7 * 1e-14);
  EXPECT_NEAR(LogInterpolate(stimulus, 1.5), std::sqrt(1e17), 1e8 * 1e-14);
  EXPECT_EQ(LogInterpolate(stimulus, 0.0), 1e6);
  EXPECT_EQ(LogInterpolate(stimulus, 2.0), 1e9);
  for (double bad : {-0.5, 2.5, kNaN}) {
    EXPECT_EQ(Thrown([&] { LogInterpolate(stimulus, bad); }).GetCode(), LUMEN_E_BOUNDS) << bad;
  }
}

TEST(FindNearestIndex, CrossesSegmentsAndTheGapsBetweenThem) {
  // 0, 1, ..., 10 then a gap to 20, 22, 24.
  InputArray stimulus(0.0, 10.0, 11, Linear);
  stimulus.push_back(Segment(std::vector<double>{20, 22, 24}));
  EXPECT_EQ(FindNearestIndex(stimulus, 0.0, 3.5), 3.5);
  EXPECT_EQ(FindNearestIndex(stimulus, 0.0, 23.0), 12.5);
  // Between the segments: a fraction between overall indices 10 and 11.
  EXPECT_DOUBLE_EQ(FindNearestIndex(stimulus, 0.0, 12.5), 10.25);
  // Beyond both ends: the nearer end.
  EXPECT_EQ(FindNearestIndex(stimulus, 0.0, -3.0), 0.0);
  EXPECT_EQ(FindNearestIndex(stimulus, 0.0, 30.0), 13.0);
  EXPECT_EQ(FindNearestIndex(stimulus, 0.0, kNaN), 0.0);
  EXPECT_EQ(FindNearestIndex(InputArray(), 5.0, 1.0), 0.0);
  // A repeated value inside explicit points: the segment reports its last crossing.
  EXPECT_EQ(FindNearestIndex(InputArray(std::vector<double>{1, 2, 2, 3}), 0.0, 2.0), 2.0);
}

TEST(FindNearestIndex, PicksTheNearestCrossingOrTheNearerEndWithTheLastOnATie) {
  // 0 .. 10 .. 0: both ends are 0, so any value outside is equally far from both.
  const InputArray tent(std::vector<double>{0, 10, 0});
  EXPECT_EQ(FindNearestIndex(tent, 0.0, -1.0), 2.0);
  EXPECT_EQ(FindNearestIndex(tent, 0.0, 11.0), 2.0);
  EXPECT_EQ(FindNearestIndex(InputArray(std::vector<double>{0, 10}), 1.0, -1.0), 0.0);

  // Rises over 0 .. 10 and falls over 11 .. 21: the value 5 is crossed at 5 and at 16.
  InputArray stimulus(0.0, 10.0, 11, Linear);
  stimulus.push_back(Segment(10.0, 0.0, 11, Linear));
  EXPECT_EQ(FindNearestIndex(stimulus, 0.0, 5.0), 5.0);
  EXPECT_EQ(FindNearestIndex(stimulus, 15.0, 5.0), 16.0);
  // 10 is reached at 10 and 11 (the gap has no width); index 10.5 is equally far from both and
  // the earlier crossing stays.
  EXPECT_EQ(FindNearestIndex(stimulus, 10.5, 10.0), 10.0);

  // Inside one arbitrary segment that crosses 0.5 twice (0, 1, 0, 1): looking from index 0 the
  // segment answers its last crossing, looking from beyond its start its first.
  InputArray zigzag(Segment(std::vector<double>{0, 1, 0, 1}));
  InputArray shifted(5.0, 1);
  shifted += zigzag;
  EXPECT_EQ(FindNearestIndex(zigzag, 0.0, 0.5), 2.5);
  EXPECT_EQ(FindNearestIndex(shifted, 9.0, 0.5), 1.5);
}

TEST(Direction, IgnoresEqualNeighboursAndRejectsMixedOrEmpty) {
  auto direction = [](std::vector<double> v) {
    return Direction(static_cast<std::int32_t>(v.size()), v.data());
  };
  EXPECT_EQ(direction({1, 2, 2, 3}), SLOPE_ASCENDING);
  EXPECT_EQ(direction({3, 3, 1}), SLOPE_DESCENDING);
  for (auto mixed : {std::vector<double>{1, 3, 2}, {3, 1, 2}, {}}) {
    EXPECT_EQ(direction(mixed), SLOPE_MIXED);
  }
  EXPECT_EQ(direction({5}), SLOPE_ASCENDING);
  EXPECT_EQ(direction({5, 5, 5}), SLOPE_ASCENDING);
  EXPECT_EQ(Direction(-1, nullptr), SLOPE_MIXED);
}

}  // namespace
}  // namespace LumenUtility
