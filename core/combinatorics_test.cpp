#include "lumen/core/combinatorics.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>

namespace LumenUtility {
namespace {

TEST(Combinatorics, FactorialIsExactTo20AndWrapsToZeroFrom66) {
  EXPECT_EQ(NA_Factorial(-5), 1);
  EXPECT_EQ(NA_Factorial(0), 1);
  EXPECT_EQ(NA_Factorial(5), 120);
  EXPECT_EQ(NA_Factorial(20), 2432902008176640000LL);
  EXPECT_NE(NA_Factorial(65), 0);  // 63 factors of two
  EXPECT_EQ(NA_Factorial(66), 0);
  EXPECT_EQ(NA_Factorial(std::numeric_limits<std::int32_t>::max()), 0);  // and quickly
}

TEST(Combinatorics, CombinationFollowsPascalsTriangleUntilItOverflows) {
  EXPECT_EQ(Combination(5, 0), 0);
  EXPECT_EQ(Combination(5, 5), 1);
  EXPECT_EQ(Combination(0, 0), 0);
  EXPECT_EQ(Combination(-3, -3), 0);
  EXPECT_EQ(Combination(3, 5), 0);

  // Rows built by addition in 64 bits (exact through row 66); k = 0 is 0 by definition.
  std::int64_t row[67] = {1};
  for (int n = 1; n < 67; ++n) {
    for (int k = n; k >= 1; --k) row[k] += row[k - 1];
    for (int k = 1; k < n; ++k) {
      const std::int64_t expected =
          row[k] <= std::numeric_limits<std::int32_t>::max() ? row[k] : -1;
      ASSERT_EQ(Combination(n, k), expected) << n << " " << k;
      if (n <= 20) {
        ASSERT_EQ(Combination(n, k), NA_Factorial(n) / (NA_Factorial(n - k) * NA_Factorial(k)));
      }
    }
  }
  EXPECT_EQ(Combination(33, 16), 1166803110);
  EXPECT_EQ(Combination(34, 16), -1);
  EXPECT_EQ(Combination(100000, 1), 100000);
  EXPECT_EQ(Combination(100000, 99999), 100000);
  EXPECT_EQ(Combination(std::numeric_limits<std::int32_t>::max(), 2), -1);
}

}  // namespace
}  // namespace LumenUtility
