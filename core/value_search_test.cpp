#include "lumen/core/value_search.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>
#include <vector>

namespace LumenUtility {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kUnset = -99.0;

// Position found, or kUnset when the search returns false (checking position is untouched).
double Search(const std::vector<float>& data, double start, bool right, float target,
              double low = -1e9, double high = 1e9) {
  double position = kUnset;
  const bool found = ValueSearch(start, data.data(), static_cast<int>(data.size()), low, high,
                                 right, target, position);
  EXPECT_EQ(found, position != kUnset);
  return position;
}

double ValueAt(const std::vector<float>& data, double x) {
  const int i = static_cast<int>(std::floor(x));
  const double f = x - i;
  return f == 0 ? data[i] : data[i] + (double{data[i + 1]} - data[i]) * f;
}

TEST(ValueSearch, StrictCrossingsInBothDirections) {
  const std::vector<float> hill = {0, 1, 2, 3, 2, 1, 0};
  EXPECT_DOUBLE_EQ(Search(hill, 0, true, 1.5f), 1.5);
  EXPECT_DOUBLE_EQ(Search(hill, 6, false, 1.5f), 4.5);
  EXPECT_DOUBLE_EQ(Search(hill, 2, true, 1.5f), 4.5);     // the rising side is behind
  EXPECT_DOUBLE_EQ(Search(hill, 2.5, false, 1.5f), 1.5);  // through the near partial interval
  EXPECT_DOUBLE_EQ(Search(hill, 0, true, 3.0f), 3.0);     // touching a point is a crossing
  EXPECT_NEAR(Search(hill, 1.2, true, 1.3f), 1.3, 1e-6);
  EXPECT_EQ(Search(hill, 0, true, 3.5f), kUnset);

  // Fractional start: the near partial interval is searched from the start only.
  const std::vector<float> ramp = {0, 10};
  EXPECT_DOUBLE_EQ(Search(ramp, 0.5, true, 7.0f), 0.7);
  EXPECT_EQ(Search(ramp, 0.5, false, 7.0f), kUnset);
  EXPECT_DOUBLE_EQ(Search(ramp, 0.5, false, 2.0f), 0.2);
  // Range and start inside one interval.
  EXPECT_DOUBLE_EQ(Search(ramp, 0.2, true, 5.0f, 0.1, 0.8), 0.5);
  EXPECT_DOUBLE_EQ(Search(ramp, 0.8, false, 5.0f, 0.1, 0.8), 0.5);
  EXPECT_EQ(Search(ramp, 0.2, true, 9.0f, 0.1, 0.8), kUnset);
  // Descending data and a far partial interval cut by the range.
  const std::vector<float> down = {4, 3, 2, 1};
  EXPECT_DOUBLE_EQ(Search(down, 0, true, 1.5f, 0, 2.75), 2.5);
  EXPECT_EQ(Search(down, 0, true, 1.1f, 0, 2.75), kUnset);
  EXPECT_NEAR(Search(down, 3, false, 3.8f, 0.1, 3), 0.2, 1e-6);  // single precision
}

TEST(ValueSearch, FlatRunsRunToTheEndOfTheRange) {
  // A run lying on the target never stops the walk; it ends at the range's far end.
  const std::vector<float> shelfRight = {3, 2, 2, 2};
  EXPECT_DOUBLE_EQ(Search(shelfRight, 1, true, 2.0f), 3.0);
  EXPECT_DOUBLE_EQ(Search(shelfRight, 1, true, 2.0f, 0, 2.5), 2.5);
  const std::vector<float> shelfLeft = {2, 2, 2, 3};
  EXPECT_DOUBLE_EQ(Search(shelfLeft, 2, false, 2.0f), 0.0);
  EXPECT_DOUBLE_EQ(Search(shelfLeft, 2, false, 2.0f, 0.5, 9), 0.5);
  // Leaving the run is a strict crossing at its last point.
  EXPECT_DOUBLE_EQ(Search(shelfLeft, 0, true, 2.0f), 2.0);
  EXPECT_DOUBLE_EQ(Search(shelfRight, 3, false, 2.0f), 1.0);
  // Within one interval a flat pair gives the end in the search direction.
  const std::vector<float> level = {1, 1};
  EXPECT_DOUBLE_EQ(Search(level, 0.25, true, 1.0f, 0.25, 0.75), 0.75);
  EXPECT_DOUBLE_EQ(Search(level, 0.75, false, 1.0f, 0.25, 0.75), 0.25);
  // When the walk ends on data that never reaches the target (NaN), the last flat point
  // met is the answer.
  const float nan = std::numeric_limits<float>::quiet_NaN();
  EXPECT_DOUBLE_EQ(Search({2, 2, 2, nan}, 0, true, 2.0f), 2.0);
  EXPECT_DOUBLE_EQ(Search({nan, 2, 2, 2}, 3, false, 2.0f), 1.0);
}

TEST(ValueSearch, InvalidRequestsFailWithoutWriting) {
  const std::vector<float> data = {0, 1, 2};
  double position = kUnset;
  EXPECT_FALSE(ValueSearch(0, nullptr, 3, 0, 2, true, 1, position));
  EXPECT_FALSE(ValueSearch(0, data.data(), 0, 0, 2, true, 1, position));
  EXPECT_FALSE(ValueSearch(0, data.data(), -4, 0, 2, true, 1, position));
  EXPECT_EQ(position, kUnset);
  EXPECT_EQ(Search(data, 0, true, 1, 2, 1), kUnset);      // inverted range
  EXPECT_EQ(Search(data, 2.5, true, 1, 0, 2), kUnset);    // start right of the range
  EXPECT_EQ(Search(data, -0.5, false, 1, 0, 2), kUnset);  // start left of the range
  EXPECT_EQ(Search(data, kNaN, true, 1), kUnset);
  EXPECT_EQ(Search(data, 0, true, 1, kNaN, 2), kUnset);
  EXPECT_EQ(Search(data, 0, true, 1, 0, kNaN), kUnset);
  EXPECT_EQ(Search(data, 0, true, 1, 5, 9), kUnset);  // range beyond the data
  EXPECT_EQ(Search(data, 0, false, 1, -9, -5), kUnset);
  EXPECT_DOUBLE_EQ(Search(data, -1e300, true, 1.5f), 1.5);  // start before the data
  EXPECT_DOUBLE_EQ(Search(data, std::numeric_limits<double>::infinity(), false, 0.5f), 0.5);
  // One point.
  EXPECT_DOUBLE_EQ(Search({5}, 0, true, 5.0f), 0.0);
  EXPECT_DOUBLE_EQ(Search({5}, 0, false, 5.0f), 0.0);
  EXPECT_EQ(Search({5}, 0, true, 4.0f), kUnset);
}

TEST(ValueSearch, FindsTheFirstCrossingOnRandomTraces) {
  // Small integer values make ties, flat runs and exact hits common.
  std::mt19937 rng(17);
  std::uniform_int_distribution<int> level(0, 3);
  std::uniform_real_distribution<double> where(-2.0, 30.0);
  const float targets[] = {0.5f, 1.0f, 1.5f, 2.0f, 3.0f};
  int found = 0;
  for (int trial = 0; trial < 3000; ++trial) {
    std::vector<float> data(1 + trial % 29);
    for (float& x : data) x = static_cast<float>(level(rng));
    const double last = data.size() - 1.0;
    const bool right = trial % 2 == 0;
    const float target = targets[trial % 5];
    double start = where(rng), low = where(rng), high = where(rng);
    if (trial % 3 == 0) start = std::round(start);
    if (low > high) std::swap(low, high);
    const double position = Search(data, start, right, target, low, high);
    const double from = right ? std::max({start, low, 0.0}) : std::min({start, high, last});
    const double to = right ? std::min(high, last) : std::max(low, 0.0);
    const double nearEnd = std::min(from, to), farEnd = std::max(from, to);
    if (right ? from > to : from < to) {  // nothing to search
      ASSERT_EQ(position, kUnset) << trial;
      continue;
    }
    if (position == kUnset) {
      // Nothing in the searched span reaches the target: all samples lie on one side.
      std::vector<double> samples;
      for (double x = nearEnd; x < farEnd; x = std::floor(x) + 1)
        samples.push_back(ValueAt(data, x));
      samples.push_back(ValueAt(data, farEnd));
      size_t above = 0;
      for (double v : samples) {
        ASSERT_NE(v, target) << trial;
        above += v > target;
      }
      ASSERT_TRUE(above == 0 || above == samples.size())
          << trial << " " << start << " " << low << " " << high << " " << data.size();
      continue;
    }
    ++found;
    ASSERT_GE(position, nearEnd - 1e-6) << trial;
    ASSERT_LE(position, farEnd + 1e-6) << trial;
    ASSERT_NEAR(ValueAt(data, position), target, 1e-5) << trial;
    // No whole interval strictly between the start and the answer changes across the target.
    for (int i = static_cast<int>(std::ceil(nearEnd)); i + 1 <= farEnd; ++i) {
      const bool between = right ? i + 1 < position : i > position;
      const float a = data[i], b = data[i + 1];
      if (between && a != b) {
        ASSERT_FALSE(std::min(a, b) <= target && target <= std::max(a, b))
            << trial << " interval " << i;
      }
    }
  }
  EXPECT_GT(found, 1000);
}

}  // namespace
}  // namespace LumenUtility
