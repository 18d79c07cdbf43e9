#include "interpolation/circular_core.h"

#include <gtest/gtest.h>

#include <random>
#include <vector>

namespace LumenUtility {
namespace {

// The interval search as a plain bisection from lo to the last point, kept as the yardstick
// for the galloping shortcut: where equal old points meet the value, the probe order decides
// which of them is reported.
int PlainBisection(const std::vector<double>& x, double value, int lo, bool& found) {
  const int n = static_cast<int>(x.size());
  found = false;
  if (value < x[0]) return 1;
  if (value > x[n - 1]) return n - 1;
  int hi = n - 1;
  for (;;) {
    const int mid = (lo + hi) / 2;
    if (x[mid] == value) {
      found = true;
      return mid;
    }
    if (x[mid] > value) {
      hi = mid;
      continue;
    }
    if (x[mid + 1] == value) {
      found = true;
      return mid + 1;
    }
    if (x[mid + 1] > value) return mid + 1;
    lo = mid + 1;
  }
}

TEST(LocateInterval, ReportsThePointTheBisectionProbesFirst) {
  std::mt19937 rng(99);
  for (int trial = 0; trial < 20000; ++trial) {
    // Ascending integers with long runs of repeats, values between and beyond them.
    const int n = 2 + static_cast<int>(rng() % 40);
    std::vector<double> x{static_cast<double>(rng() % 3)};
    while (static_cast<int>(x.size()) < n) x.push_back(x.back() + (rng() % 3 == 0 ? 1 : 0));
    const double value = static_cast<double>(rng() % (static_cast<int>(x.back()) + 3)) - 1 +
                         (rng() % 4 == 0 ? 0.5 : 0.0);
    // A start the search may use: at or below the value.
    int lo = static_cast<int>(rng() % n);
    while (lo > 0 && x[lo] > value) --lo;
    bool expectedFound = false, found = false;
    const int expected = PlainBisection(x, value, lo, expectedFound);
    ASSERT_EQ(LocateInterval(x.data(), n, value, lo, found), expected)
        << "n " << n << " value " << value << " lo " << lo;
    ASSERT_EQ(found, expectedFound);
  }
}

}  // namespace
}  // namespace LumenUtility
