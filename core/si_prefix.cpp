#include "lumen/core/si_prefix.h"

#include <algorithm>
#include <cmath>

namespace LumenUtility {

namespace {

constexpr int kLargestExponent = 24;
constexpr int kSmallestExponent = -24;
// One character per power of 1000 from 1e-24 to 1e24; the blank at index 8 is 1e0.
constexpr wchar_t kPrefixes[] = L"yzafpn\u00B5m kMGTPEZY";
// 10^-e for e = -24, -21, ..., 24, as exact decimal literals (10^24 itself is not a double).
constexpr double kScales[] = {1e24, 1e21, 1e18, 1e15,  1e12,  1e9,   1e6,   1e3,  1e0,
                              1e-3, 1e-6, 1e-9, 1e-12, 1e-15, 1e-18, 1e-21, 1e-24};
static_assert(sizeof kPrefixes / sizeof kPrefixes[0] == 18, "17 prefixes and a terminator");
static_assert(sizeof kScales / sizeof kScales[0] == 17, "one scale per prefix");

int PrefixExponent(double value, int maxExponent, int minExponent) {
  const int top = std::min(maxExponent / 3 * 3, kLargestExponent);
  const int bottom = std::max(minExponent / 3 * 3, kSmallestExponent);
  int e = 0;
  if (value != 0.0 && std::isfinite(value)) {
    // |log10| of a finite double is below 330, so the int conversion is safe.
    e = static_cast<int>(std::trunc(std::log10(std::abs(value))));
    e -= ((e % 3) + 3) % 3;
  }
  e = std::max(std::min(e, top), bottom);
  // Limits outside the table (minExponent above 24, maxExponent below -24) still give a
  // prefix from it.
  return std::clamp(e, kSmallestExponent, kLargestExponent);
}

}  // namespace

void GetSIPrefix(double value, double& scale, wchar_t& prefix, int maxExponent, int minExponent) {
  const int index = PrefixExponent(value, maxExponent, minExponent) / 3 + 8;
  scale = kScales[index];
  prefix = kPrefixes[index];
}

void GetSIPrefix(double value, double& scale, char& prefix, int maxExponent, int minExponent) {
  wchar_t wide = L' ';
  GetSIPrefix(value, scale, wide, maxExponent, minExponent);
  prefix = static_cast<char>(wide & 0xFF);
}

}  // namespace LumenUtility
