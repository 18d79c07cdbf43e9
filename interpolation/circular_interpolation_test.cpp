#include "lumen/interpolation/circular_interpolation.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numeric>
#include <random>
#include <vector>

namespace LumenUtility {
namespace {

constexpr double kPi = 3.141592653589793;
const TsComplex kUnwritten(-777, 777);

double Distance(TsComplex a, TsComplex b) {
  return std::hypot(a.re - b.re, a.im - b.im);
}

// Points on the circle about `centre` with `radius`, turning `step` radians per point.
std::vector<TsComplex> OnCircle(int n, TsComplex centre, double radius, double step) {
  std::vector<TsComplex> v(n);
  for (int k = 0; k < n; ++k) v[k] = centre + TsComplex::FromMagPhase(radius, 0.3 + step * k);
  return v;
}

struct Result {
  tagInterpStatus status;
  bool interpolated;
  std::vector<TsComplex> out;
};

Result Resample(const std::vector<double>& oldX, const std::vector<TsComplex>& oldD,
                const std::vector<double>& newX, InterpolateType type, bool extrapolate = false) {
  Result r{INTERP_DONE, true, std::vector<TsComplex>(newX.size(), kUnwritten)};
  const InputArray oldStimulus(oldX), newStimulus(newX);
  r.status = extrapolate ? CircularInterpolationEx(oldStimulus, oldD.data(), newStimulus,
                                                   r.out.data(), &r.interpolated)
                         : CircularInterpolation(oldStimulus, oldD.data(), newStimulus,
                                                 r.out.data(), &r.interpolated, type);
  return r;
}

std::vector<double> Grid(double start, double step, int n) {
  std::vector<double> v(n);
  for (int k = 0; k < n; ++k) v[k] = start + step * k;
  return v;
}

TEST(LinearInterpolateUsingMagPhase, MagnitudeIsLinearAndPhaseTakesTheShorterTurn) {
  const TsComplex quarter = LinearInterpolateUsingMagPhase(0, 1, {1, 0}, {0, 1}, 0.5);
  EXPECT_LT(Distance(quarter, TsComplex::FromMagPhase(1, kPi / 4)), 1e-6);
  EXPECT_EQ(LinearInterpolateUsingMagPhase(0, 1, {1, 0}, {2, 0}, 0.5), TsComplex(1.5, 0));
  EXPECT_EQ(LinearInterpolateUsingMagPhase(0, 1, {0, 0}, {0, 0}, 0.5), TsComplex(0, 0));
  // Beyond the ends the magnitude line is extended.
  EXPECT_EQ(LinearInterpolateUsingMagPhase(10, 20, {1, 0}, {2, 0}, 30), TsComplex(3, 0));
  // From 170 to -170 degrees the shorter way passes 180 degrees, not 0.
  const double a = 170 * kPi / 180;
  const TsComplex across = LinearInterpolateUsingMagPhase(0, 1, {std::cos(a), std::sin(a)},
                                                          {std::cos(a), -std::sin(a)}, 0.5);
  EXPECT_LT(Distance(across, TsComplex(-1, 0)), 1e-6);
}

TEST(CircularInterpolation, PointsWithinTheMatchToleranceCopyTheLowerOldValue) {
  const std::vector<double> x = Grid(1e9, 1e6, 7);
  const std::vector<TsComplex> d = OnCircle(7, {0.2f, 0.1f}, 0.5, 0.4);
  for (InterpolateType type : {INTERP_MAG_PHASE, INTERP_CIRCULAR, INTERP_CIRCULAR_NO_PHASE_FIT}) {
    const Result r = Resample(x, d, x, type);
    EXPECT_EQ(r.status, INTERP_UNCHANGED);
    EXPECT_FALSE(r.interpolated);
    EXPECT_EQ(r.out, d);
  }
  // Old points 0.05 apart at 2 and 2.05: a new point between them, or on the upper one, takes
  // the lower one's value; 0.05 above the last point takes the last value.
  const std::vector<double> close{0, 1, 2, 2.05, 3, 4};
  const std::vector<TsComplex> v{{1, 0}, {2, 0}, {3, 1}, {4, 2}, {5, 3}, {6, 4}};
  const Result r = Resample(close, v, {1.05, 2.02, 2.05, 3.95, 4.05}, INTERP_MAG_PHASE, true);
  EXPECT_EQ(r.status, INTERP_UNCHANGED);
  EXPECT_FALSE(r.interpolated);
  EXPECT_EQ(r.out, (std::vector<TsComplex>{v[1], v[2], v[2], v[5], v[5]}));
}

TEST(CircularInterpolation, EvenlySpacedCircleStaysOnTheCircle) {
  // Turns of 9 to 23 degrees per point about a centre off the origin: a chord midpoint would
  // lie up to 1 - cos(11.5 deg) = 2 % of the radius inside the circle.
  const TsComplex centre(0.3f, -0.2f);
  const double radius = 0.4;
  auto angle = [](double k) { return 0.3 + 0.15 * k + 0.01 * k * k; };
  const std::vector<double> x = Grid(1e9, 1e6, 9);
  std::vector<TsComplex> d;
  for (int k = 0; k < 9; ++k) d.push_back(centre + TsComplex::FromMagPhase(radius, angle(k)));
  const std::vector<double> fine = Grid(1e9, 0.25e6, 33);
  const Result r = Resample(x, d, fine, INTERP_CIRCULAR_NO_PHASE_FIT);
  ASSERT_EQ(r.status, INTERP_DONE);
  EXPECT_TRUE(r.interpolated);
  for (std::size_t k = 0; k < fine.size(); ++k) {
    EXPECT_NEAR(Distance(r.out[k], centre), radius, 2e-6) << k;
    // Each point lies at the stimulus' share of its own interval's turn.
    const int i = std::min(static_cast<int>(k / 4), 7);
    const double t = k / 4.0 - i;
    const double expected = angle(i) + t * (angle(i + 1) - angle(i));
    const double actual = std::atan2(r.out[k].im - centre.im, r.out[k].re - centre.re);
    EXPECT_NEAR(std::remainder(actual - expected, 2 * kPi), 0, 1e-5) << k;
  }
}

TEST(CircularInterpolation, PhaseFitFollowsADelayExactly) {
  // Constant magnitude, phase -2 pi f tau with tau = 1.3 ns: 168 degrees per step. The fitted
  // parabolas reproduce a linear phase, so every resampled point lands on the ideal response.
  const double tau = 1.3e-9;
  const std::vector<double> x = Grid(1e9, 3.6e8, 12);
  std::vector<TsComplex> d;
  for (double f : x) d.push_back(TsComplex::FromMagPhase(0.7, -2 * kPi * f * tau));
  const std::vector<double> fine = Grid(1.05e9, 0.9e8, 40);
  const Result r = Resample(x, d, fine, INTERP_CIRCULAR);
  ASSERT_EQ(r.status, INTERP_DONE);
  for (std::size_t k = 0; k < fine.size(); ++k) {
    const TsComplex ideal = TsComplex::FromMagPhase(0.7, -2 * kPi * fine[k] * tau);
    EXPECT_LT(Distance(r.out[k], ideal), 2e-5) << k;
  }
}

// Value at f of the parabola through (x[i + j], y[i + j]), j = -1, 0, 1 (Lagrange form).
double Parabola(const std::vector<double>& x, const std::vector<double>& y, int i, double f) {
  double sum = 0;
  for (int j = i - 1; j <= i + 1; ++j) {
    double term = y[j];
    for (int m = i - 1; m <= i + 1; ++m) {
      if (m != j) term *= (f - x[m]) / (x[j] - x[m]);
    }
    sum += term;
  }
  return sum;
}

TEST(CircularInterpolation, PhaseFitBlendsTheNeighbouringParabolas) {
  // Cubic phase on a ragged grid. Interior points whose two steps are within a factor of 5 get
  // the parabola through themselves and their neighbours (not 7 and 7.15: steps 0.9 / 0.15 and
  // 0.15 / 0.85). Between old points p - 1 and p the phase is the blend of the two parabolas,
  // weighted by the position, or the one there is; with none the first pass stays.
  const std::vector<double> x{0, 1, 1.8, 3, 3.7, 5, 6.1, 7, 7.15, 8};
  auto phase = [](double f) { return 0.01 * f * f * f + 0.1 * f * f - 0.5 * f; };
  std::vector<double> phi;
  std::vector<TsComplex> d;
  for (double f : x) {
    d.push_back(TsComplex::FromMagPhase(1 + 0.1 * f, phase(f)));
    // The unwrapped phase of the float data.
    phi.push_back(d.back().Phase() +
                  2 * kPi * std::round((phase(f) - d.back().Phase()) / (2 * kPi)));
  }
  const int n = static_cast<int>(x.size());
  auto fitted = [&](int i) { return i >= 1 && i <= n - 2 && i != 7 && i != 8; };
  std::vector<double> fine = Grid(0.5, 0.25, 31);
  fine.push_back(x[3]);
  const Result result = Resample(x, d, fine, INTERP_CIRCULAR);
  const Result plain = Resample(x, d, fine, INTERP_CIRCULAR_NO_PHASE_FIT);
  for (std::size_t k = 0; k + 1 < fine.size(); ++k) {
    const double f = fine[k];
    const int p =
        std::min(static_cast<int>(std::lower_bound(x.begin(), x.end(), f) - x.begin()), n - 1);
    const double w = (f - x[p - 1]) / (x[p] - x[p - 1]);
    double expected;
    if (fitted(p) && fitted(p - 1)) {
      expected = w * Parabola(x, phi, p, f) + (1 - w) * Parabola(x, phi, p - 1, f);
    } else if (fitted(p) || fitted(p - 1)) {
      expected = Parabola(x, phi, fitted(p) ? p : p - 1, f);
    } else {
      EXPECT_EQ(result.out[k], plain.out[k]) << f;
      continue;
    }
    EXPECT_NEAR(std::remainder(result.out[k].Phase() - expected, 2 * kPi), 0, 2e-5) << f;
    // The fit keeps the first pass's magnitude.
    EXPECT_NEAR(result.out[k].Mag(), plain.out[k].Mag(), 1e-6) << f;
  }
  // A new point on an old one keeps the old value untouched.
  EXPECT_EQ(result.out.back(), d[3]);
}

TEST(CircularInterpolation, UnevenStepFallsBackToMagPhaseWhereItsTripleIsUneven) {
  // One step of 1.5 among steps of 1: the intervals whose point triple contains it
  // ([2, 3] with 2, 3, 4.5 and [3, 4.5] with 3, 4.5, 5.5) use magnitude and phase.
  const TsComplex centre(0.5f, 0.5f);
  const std::vector<double> x{0, 1, 2, 3, 4.5, 5.5, 6.5};
  std::vector<TsComplex> d;
  for (double f : x) d.push_back(centre + TsComplex::FromMagPhase(0.3, 0.5 * f));
  const std::vector<double> newX{0.5, 1.5, 2.5, 3.75, 5, 6};
  const Result r = Resample(x, d, newX, INTERP_CIRCULAR_NO_PHASE_FIT);
  ASSERT_EQ(r.status, INTERP_DONE);
  EXPECT_EQ(r.out[2], LinearInterpolateUsingMagPhase(2, 3, d[2], d[3], 2.5));
  EXPECT_EQ(r.out[3], LinearInterpolateUsingMagPhase(3, 4.5, d[3], d[4], 3.75));
  for (int k : {0, 1, 4, 5}) EXPECT_NEAR(Distance(r.out[k], centre), 0.3, 1e-6) << k;
  // Off the circle: magnitude/phase about the origin is not the arc about (0.5, 0.5).
  EXPECT_GT(std::fabs(Distance(r.out[2], centre) - 0.3), 1e-4);
}

TEST(CircularInterpolation, RangeIsCheckedUnlessExtrapolating) {
  const std::vector<double> x = Grid(0, 1, 6);
  const std::vector<TsComplex> d = OnCircle(6, {0, 0}, 1, 0.3);
  const std::vector<double> wide{-1, 2.5, 6};
  Result r = Resample(x, d, wide, INTERP_CIRCULAR);
  EXPECT_EQ(r.status, INTERP_OUT_OF_RANGE);
  EXPECT_TRUE(r.interpolated);  // untouched
  EXPECT_EQ(r.out, std::vector<TsComplex>(3, kUnwritten));

  r = Resample(x, d, wide, INTERP_CIRCULAR, true);
  EXPECT_EQ(r.status, INTERP_DONE);
  // Extrapolated along the first and last arcs: still on the unit circle, continuing the turn
  // (OnCircle starts at 0.3 rad and turns 0.3 rad per unit).
  EXPECT_LT(Distance(r.out[0], TsComplex::FromMagPhase(1, 0.3 - 0.3)), 1e-5);
  EXPECT_LT(Distance(r.out[2], TsComplex::FromMagPhase(1, 0.3 + 6 * 0.3)), 1e-5);
}

TEST(CircularInterpolation, OldStimulusOrderDoesNotChangeTheResult) {
  const std::vector<double> x = Grid(2e9, 5e6, 10);
  const std::vector<TsComplex> d = OnCircle(10, {0.1f, 0.4f}, 0.35, 0.5);
  const std::vector<double> newX{2.0125e9, 2.0333e9, 2.01e9, 2.04e9, 2.0449e9, 2.001e9};
  const Result sorted = Resample(x, d, newX, INTERP_CIRCULAR);
  ASSERT_EQ(sorted.status, INTERP_DONE);

  std::vector<int> order(x.size());
  std::iota(order.begin(), order.end(), 0);
  std::vector<std::vector<int>> orders{order, order, order, order};
  std::reverse(orders[1].begin(), orders[1].end());
  std::shuffle(orders[2].begin(), orders[2].end(), std::mt19937(5));
  // Out of order only at the last point: judged over all points, it still gets sorted.
  std::swap(orders[3][8], orders[3][9]);
  for (const std::vector<int>& o : orders) {
    std::vector<double> ox;
    std::vector<TsComplex> od;
    for (int k : o) {
      ox.push_back(x[k]);
      od.push_back(d[k]);
    }
    const Result r = Resample(ox, od, newX, INTERP_CIRCULAR);
    EXPECT_EQ(r.status, INTERP_DONE);
    EXPECT_EQ(r.out, sorted.out);
  }
}

TEST(CircularInterpolation, FewOldOrNoNewPointsInterpolateMagPhaseCopyOrReturn) {
  const std::vector<TsComplex> two{{1, 0}, {0, 2}};
  const std::vector<double> newX{5, 12.5, 20, 25};
  Result r = Resample({10, 20}, two, newX, INTERP_CIRCULAR, true);
  EXPECT_EQ(r.status, INTERP_DONE);
  for (int k : {0, 1, 3}) {
    EXPECT_EQ(r.out[k], LinearInterpolateUsingMagPhase(10, 20, two[0], two[1], newX[k])) << k;
  }
  EXPECT_EQ(r.out[2], two[1]);

  r = Resample({10}, {{3, 4}}, {9.95, 40}, INTERP_CIRCULAR, true);
  EXPECT_EQ(r.status, INTERP_DONE);
  EXPECT_EQ(r.out, std::vector<TsComplex>(2, TsComplex(3, 4)));
  r = Resample({10}, {{3, 4}}, {10.05}, INTERP_CIRCULAR, true);
  EXPECT_EQ(r.status, INTERP_UNCHANGED);
  EXPECT_FALSE(r.interpolated);

  r = Resample({}, {}, {1, 2}, INTERP_CIRCULAR, true);
  EXPECT_EQ(r.status, INTERP_OUT_OF_RANGE);
  EXPECT_EQ(r.out, std::vector<TsComplex>(2, kUnwritten));

  // An empty new stimulus is answered without reading it.
  bool flag = true;
  EXPECT_EQ(CircularInterpolation(3, nullptr, nullptr, 0, nullptr, nullptr, &flag, INTERP_CIRCULAR),
            INTERP_UNCHANGED);
  EXPECT_FALSE(flag);
  flag = true;
  EXPECT_EQ(CircularInterpolationUsingBandBreaks(InputArray(), nullptr, InputArray(), nullptr,
                                                 {1.0}, &flag),
            INTERP_UNCHANGED);
  EXPECT_FALSE(flag);
}

TEST(CircularInterpolation, FloatPairsAndInPlaceBuffersMatchTheComplexForm) {
  const std::vector<double> x = Grid(0, 1, 8);
  const std::vector<TsComplex> d = OnCircle(8, {0.2f, 0}, 0.5, 0.2);
  const std::vector<double> newX = Grid(0.5, 1, 7);
  const Result expected = Resample(x, d, newX, INTERP_CIRCULAR, true);

  std::vector<float> pairs(2 * newX.size());
  bool flag = false;
  EXPECT_EQ(CircularInterpolationEx(8, x.data(), reinterpret_cast<const float*>(d.data()), 7,
                                    newX.data(), pairs.data(), &flag),
            INTERP_DONE);
  EXPECT_TRUE(flag);
  for (std::size_t k = 0; k < newX.size(); ++k) {
    EXPECT_EQ(TsComplex(pairs[2 * k], pairs[2 * k + 1]), expected.out[k]) << k;
  }

  // Output written over the old data it is computed from.
  std::vector<TsComplex> buffer = d;
  EXPECT_EQ(CircularInterpolationEx(InputArray(x), buffer.data(), InputArray(newX), buffer.data(),
                                    nullptr),
            INTERP_DONE);
  EXPECT_EQ(std::vector<TsComplex>(buffer.begin(), buffer.begin() + 7), expected.out);
}

}  // namespace
}  // namespace LumenUtility
