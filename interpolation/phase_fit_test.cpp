#include "interpolation/phase_fit.h"

#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "lumen/interpolation/circular_interpolation.h"

namespace LumenUtility {
namespace {

TEST(SolveByInverse3x3, PivotsPastAZeroAndReportsSingularSystems) {
  // A zero in the first pivot position needs a row swap. Solution (1, 2, 3).
  const double m[3][3] = {{0, 2, 1}, {1, 1, 1}, {4, 2, 1}};
  const double b[3] = {0 + 4 + 3, 1 + 2 + 3, 4 + 4 + 3};
  double v[3] = {-1, -1, -1};
  ASSERT_TRUE(SolveByInverse3x3(m, b, v));
  EXPECT_NEAR(v[0], 1, 1e-12);
  EXPECT_NEAR(v[1], 2, 1e-12);
  EXPECT_NEAR(v[2], 3, 1e-12);

  const double singular[3][3] = {{1, 2, 3}, {2, 4, 6}, {0, 1, 1}};
  double untouched[3] = {7, 7, 7};
  EXPECT_FALSE(SolveByInverse3x3(singular, b, untouched));
  EXPECT_EQ(untouched[0], 7);
}

TEST(PhaseFit, SingularFitsLeaveTheFirstPassAlone) {
  // Steps of 1 Hz at 1 GHz: the quadratic systems' last pivot is about 1e-18, far below the
  // singular threshold, so no point has a fit and the phase fit must change nothing.
  std::vector<double> x;
  std::vector<TsComplex> d;
  for (int k = 0; k < 8; ++k) {
    x.push_back(1e9 + k);
    d.push_back(TsComplex::FromMagPhase(1.0 + 0.05 * k, 0.4 * k * k));
  }
  const std::vector<double> newX{1e9 + 0.5, 1e9 + 2.25, 1e9 + 6.5};
  std::vector<TsComplex> fitted(3), plain(3);
  bool flag = false;
  ASSERT_EQ(CircularInterpolation(InputArray(x), d.data(), InputArray(newX), fitted.data(), &flag,
                                  INTERP_MAG_PHASE),
            INTERP_DONE);
  for (int k = 0; k < 3; ++k) {
    plain[k] = LinearInterpolateUsingMagPhase(x[0], x[1], d[0], d[1], newX[k]);
  }
  plain[1] = LinearInterpolateUsingMagPhase(x[2], x[3], d[2], d[3], newX[1]);
  plain[2] = LinearInterpolateUsingMagPhase(x[6], x[7], d[6], d[7], newX[2]);
  EXPECT_EQ(fitted, plain);
}

}  // namespace
}  // namespace LumenUtility
