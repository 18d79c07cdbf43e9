#include "lumen/core/math_util.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

TEST(MathUtil, ResolutionRoundsTiesAwayFromZeroAndMinMaxResClampsFirst) {
  EXPECT_EQ(MathUtil::Resolution(2.5, 1), 3.0);
  EXPECT_EQ(MathUtil::Resolution(-2.5, 1), -3.0);
  EXPECT_EQ(MathUtil::Resolution(2.4999, 1), 2.0);
  EXPECT_EQ(MathUtil::Resolution(-2.4999, 1), -2.0);
  EXPECT_DOUBLE_EQ(MathUtil::Resolution(1.234, 0.01), 1.23);
  EXPECT_DOUBLE_EQ(MathUtil::Resolution(1.2e9 + 3, 1e6), 1.2e9);
  EXPECT_EQ(MathUtil::Resolution(7, 0), 7.0);
  EXPECT_EQ(MathUtil::Resolution(7, -1), 7.0);
  EXPECT_EQ(MathUtil::Resolution(7, kNaN), 7.0);
  EXPECT_TRUE(std::isnan(MathUtil::Resolution(kNaN, 1)));

  // MinMaxRes clamps before rounding.
  EXPECT_EQ(MathUtil::MinMaxRes(15, 0, 10, 3), 9.0);
  EXPECT_EQ(MathUtil::MinMaxRes(-4, -3.2, 10, 1), -3.0);
  EXPECT_EQ(MathUtil::MinMaxRes(4.4, 0, 10, 0), 4.4);
  EXPECT_EQ(MathUtil::MinMaxRes(5, 8, 2, 0), 8.0);  // min wins an inverted range
  EXPECT_EQ(MathUtil::MinMaxRes(kInf, 0, 10, 0.5), 10.0);
}

TEST(MathUtil, ValidCheckCountsSignificantDigits) {
  struct Case {
    double value;
    int digits;
    bool valid;
  } cases[] = {
      {1.23, 3, true},
      {1.23, 2, false},
      {-1.23, 3, true},
      {-1.23, 2, false},
      {1234500, 5, true},
      {1234500, 4, false},
      {0.000123, 3, true},
      {0.000123, 2, false},
      {9.99, 3, true},
      {9.99, 1, false},
      {0.1 + 0.2, 1, true},
      {1e300, 1, true},
      {123456789012345.0, 15, true},
      {123456789012345.0, 14, false},
      {0.1234567890123456, 15, true},  // past the fifteenth digit is not looked at
      {5e-19, 3, false},               // nothing below 1e-18 is kept: rounds to 1e-18
      {2e-18, 1, true},
      {0.0, 1, true},
      {1.5, 0, true},
      {1.5, -2, true},
  };
  for (const Case& c : cases) {
    EXPECT_EQ(MathUtil::ValidCheck(c.value, c.digits), c.valid) << c.value << " " << c.digits;
  }
  EXPECT_FALSE(MathUtil::ValidCheck(kNaN, 3));
  EXPECT_FALSE(MathUtil::ValidCheck(kInf, 3));
  EXPECT_FALSE(MathUtil::ValidCheck(std::numeric_limits<double>::denorm_min(), 3));
}

}  // namespace
