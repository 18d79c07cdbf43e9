#include "lumen/core/si_prefix.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

namespace LumenUtility {
namespace {

struct Choice {
  double scale;
  wchar_t prefix;
  bool operator==(const Choice&) const = default;
};

Choice Pick(double value, int maxExponent = 24, int minExponent = -24) {
  Choice c{0.0, L'?'};
  GetSIPrefix(value, c.scale, c.prefix, maxExponent, minExponent);
  return c;
}

TEST(SIPrefix, EveryPowerOfAThousandHasItsPrefix) {
  const std::wstring table = L"yzafpn\u00B5m kMGTPEZY";
  for (int k = -8; k <= 8; ++k) {
    const wchar_t expected = table[k + 8];
    // Below 1 the exponent truncates toward zero before it is lowered, so 0.999 shows as
    // 0.999 and 999e-6 as 0.999m: mantissas up to 99 keep their prefix on both sides.
    for (double mantissa : {1.0, 2.5, 99.0}) {
      for (double sign : {1.0, -1.0}) {
        const double value = sign * mantissa * std::pow(10.0, 3 * k);
        const Choice c = Pick(value);
        EXPECT_EQ(c.prefix, expected) << value;
        EXPECT_DOUBLE_EQ(c.scale, std::pow(10.0, -3 * k)) << value;
        EXPECT_NEAR(std::abs(value * c.scale), mantissa, 1e-9 * mantissa) << value;
      }
    }
  }
}

TEST(SIPrefix, TruncationTowardZeroAndLimits) {
  EXPECT_EQ(Pick(1.5e9), (Choice{1e-9, L'G'}));
  EXPECT_EQ(Pick(0.05), (Choice{1e3, L'm'}));
  EXPECT_EQ(Pick(0.5), (Choice{1.0, L' '}));  // log10 0.5 = -0.3 truncates to 0
  EXPECT_EQ(Pick(999e-6).prefix, L'm');
  EXPECT_EQ(Pick(999e3).prefix, L'k');
  EXPECT_EQ(Pick(0.0).prefix, L' ');
  EXPECT_EQ(Pick(1e9, 6), (Choice{1e-6, L'M'}));
  EXPECT_EQ(Pick(1e9, 8).prefix, L'M');  // limits are cut to multiples of 3 toward zero
  EXPECT_EQ(Pick(1e-12, 24, -7).prefix, L'\u00B5');
  EXPECT_EQ(Pick(1e40).prefix, L'Y');
  EXPECT_EQ(Pick(1e-40), (Choice{1e24, L'y'}));
  EXPECT_EQ(Pick(5.0, 100, 90).prefix, L'Y');  // limits beyond the table
  EXPECT_EQ(Pick(5.0, -90, -100).prefix, L'y');
  EXPECT_EQ(Pick(std::numeric_limits<double>::quiet_NaN()).prefix, L' ');
  EXPECT_EQ(Pick(-std::numeric_limits<double>::infinity()).prefix, L' ');
  EXPECT_EQ(Pick(std::numeric_limits<double>::denorm_min()).prefix, L'y');

  double scale = 0;
  char narrow = 0;
  GetSIPrefix(3e-6, scale, narrow, 24, -24);
  EXPECT_EQ(static_cast<unsigned char>(narrow), 0xB5);  // micro, narrowed to its low byte
}

}  // namespace
}  // namespace LumenUtility
