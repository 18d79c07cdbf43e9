#include "lumen/interpolation/tarn_interpolation.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>
#include <vector>

#include "lumen/platform/error_codes.h"

namespace LumenUtility {
namespace {

constexpr double kPi = 3.14159265358979323846;
constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();

// Real linear resampling through the phase-code overload without a phase code.
std::vector<float> Linear(std::vector<float> y, const std::vector<float>& x, double start,
                          double stop, int points) {
  std::vector<TsComplex> data((y.size() + 1) / 2);
  std::copy(y.begin(), y.end(), reinterpret_cast<float*>(data.data()));
  std::vector<float> out(points, 12345.0f), ones(points, 1.0f), result(points);
  TarnInterpolation(data.data(), x.data(), static_cast<int>(y.size()), out.data(), ones.data(),
                    result.data(), start, stop, points, points, nullptr);
  for (int k = 0; k < points; ++k) {  // a factor of 1 changes nothing
    EXPECT_TRUE(out[k] == result[k] || (std::isnan(out[k]) && std::isnan(result[k]))) << k;
  }
  return out;
}

std::vector<float> Cubic(std::vector<float> y, const std::vector<double>& x, double start,
                         double stop, int points) {
  std::vector<float> mag(points, 12345.0f), phase(points);
  std::vector<TsComplex> resampled(points), ones(points, TsComplex(1.0)), result(points);
  TarnCubicInterpolation(y.data(), nullptr, x.data(), static_cast<int>(y.size()), mag.data(),
                         phase.data(), resampled.data(), ones.data(), result.data(), start, stop,
                         points, false);
  return mag;
}

// Plain double-precision linear interpolation at g inside [x.front(), x.back()].
double ReferenceLinear(const std::vector<float>& y, const std::vector<float>& x, double g) {
  std::size_t j = 0;
  while (j + 2 < x.size() && x[j + 1] < g) ++j;
  const double t = (g - x[j]) / (double{x[j + 1]} - x[j]);
  return y[j] + t * (double{y[j + 1]} - y[j]);
}

std::vector<float> Range(int n, float first, float step) {
  std::vector<float> v(n);
  for (int i = 0; i < n; ++i) v[i] = first + step * static_cast<float>(i);
  return v;
}

TEST(TarnInterpolation, LinearGridsInsideBeforeAndBeyondTheData) {
  const std::vector<float> x{0, 1, 2}, y{0, 10, 20};
  EXPECT_EQ(Linear(y, x, 0, 2, 5), (std::vector<float>{0, 5, 10, 15, 20}));
  EXPECT_EQ(Linear(y, x, -1, 2, 4), (std::vector<float>{-10, 0, 10, 20}));
  EXPECT_EQ(Linear(y, x, 0, 4, 5), (std::vector<float>{0, 10, 20, -999, -999}));
  // Grid entirely beyond the data: nothing is reached.
  EXPECT_EQ(Linear(y, x, 5, 7, 3), (std::vector<float>{-999, -999, -999}));

  // Complex data: both parts follow, then the per-point factor multiplies.
  const std::vector<TsComplex> data{{0, 0}, {10, -1}, {20, -2}};
  const std::vector<TsComplex> factor{{1, 0}, {0, 1}, {2, 0}, {1, 1}};
  std::vector<TsComplex> resampled(4), result(4, TsComplex(7, 7));
  TarnInterpolation(data.data(), x.data(), 3, resampled.data(), factor.data(), result.data(), -1, 2,
                    4, 3);
  EXPECT_EQ(resampled, (std::vector<TsComplex>{{-10, 1}, {0, 0}, {10, -1}, {20, -2}}));
  EXPECT_EQ(result, (std::vector<TsComplex>{{-10, 1}, {0, 0}, {20, -2}, {7, 7}}));
}

TEST(TarnInterpolation, LinearGridPointsUseTheirIntervalUpToTheStopInEitherDirection) {
  // Grid steps that do not divide the stimulus spacing, finer and coarser than it: every
  // grid point inside the data matches plain linear interpolation.
  std::mt19937 rng(7);
  std::uniform_real_distribution<float> value(-1.0f, 1.0f);
  for (const int points : {7, 33, 101, 1000}) {
    const std::vector<float> x = Range(101, 1.0e6f, 2.5e4f);
    std::vector<float> y(x.size());
    for (float& v : y) v = value(rng);
    const double start = 1.0e6 + 3.0e3, stop = 3.5e6 - 7.0e3;
    const std::vector<float> out = Linear(y, x, start, stop, points);
    for (int k = 0; k < points; ++k) {
      const double g = start + k * (stop - start) / (points - 1);
      EXPECT_NEAR(out[k], ReferenceLinear(y, x, g), 2e-5) << points << " points, k=" << k;
    }
  }

  // 9 GHz is not a float: the stored stimulus ends 512 Hz short of the grid stop.
  const std::vector<float> out = Linear({1, 2, 3}, {8.0e9f, 8.5e9f, 9.0e9f}, 8.0e9, 9.0e9, 201);
  EXPECT_NEAR(out.back(), 3.0f, 1e-5);
  EXPECT_NEAR(out[100], 2.0f, 1e-5);

  // A descending stimulus or grid mirrors the ascending one.
  const std::vector<float> x{0, 1, 2, 3}, y{1, 4, 2, 8};
  const std::vector<float> ascending = Linear(y, x, -0.5, 3.25, 16);
  std::vector<float> rx(x.rbegin(), x.rend()), ry(y.rbegin(), y.rend());
  EXPECT_EQ(Linear(ry, rx, -0.5, 3.25, 16), ascending);
  std::vector<float> reversed = Linear(y, x, 3.25, -0.5, 16);
  std::reverse(reversed.begin(), reversed.end());
  for (int k = 0; k < 16; ++k) EXPECT_NEAR(reversed[k], ascending[k], 1e-5) << k;
}

TEST(TarnInterpolation, LinearDegenerateCallsAndNaNSamplesHaveFixedOutcomes) {
  const std::vector<float> x{0, 1, 2}, y{0, 10, 20};
  EXPECT_EQ(Linear(y, x, 0.5, 99, 1), std::vector<float>{5});     // one point: start
  EXPECT_EQ(Linear(y, x, 3.5, 99, 1), std::vector<float>{-999});  // beyond the data
  EXPECT_EQ(Linear(y, x, 1.5, 1.5, 3), (std::vector<float>{15, 15, 15}));
  EXPECT_EQ(Linear({7}, {3}, 0, 10, 3), (std::vector<float>{7, 7, 7}));
  EXPECT_EQ(Linear({}, {}, 0, 10, 2), (std::vector<float>{-999, -999}));
  EXPECT_EQ(Linear(y, x, kNaN, 2, 2), (std::vector<float>{-999, -999}));
  EXPECT_EQ(Linear(y, x, 0, std::numeric_limits<double>::infinity(), 2),
            (std::vector<float>{-999, -999}));
  // Repeated stimulus values: the empty interval holds, nothing divides by its zero width.
  EXPECT_EQ(Linear({0, 5, 9, 10}, {0, 1, 1, 2}, 0, 2, 5),
            (std::vector<float>{0, 2.5f, 5, 9.5f, 10}));

  // No grid points: nothing written. Products stop at the grid length.
  std::vector<TsComplex> data{{1, 1}, {2, 2}}, factor(4, TsComplex(1.0));
  std::vector<TsComplex> resampled(4, TsComplex(-5, -5)), result(4, TsComplex(-5, -5));
  const std::vector<float> stim{0, 1};
  TarnInterpolation(data.data(), stim.data(), 2, resampled.data(), factor.data(), result.data(), 0,
                    1, 0, 4);
  EXPECT_EQ(result[0], TsComplex(-5, -5));
  TarnInterpolation(data.data(), stim.data(), 2, resampled.data(), factor.data(), result.data(), 0,
                    1, 2, 4);
  EXPECT_EQ(result, (std::vector<TsComplex>{{1, 1}, {2, 2}, {-5, -5}, {-5, -5}}));

  // A NaN sample spoils only its own intervals.
  const std::vector<float> out = Linear({0, 1, kNaN, 3, 4, 5}, Range(6, 0, 1), 0, 5, 11);
  for (int k = 0; k < 11; ++k) {
    const bool touches_nan = k >= 3 && k <= 6;  // grid 1.5 .. 3.0 lies in (1, 3]
    EXPECT_EQ(std::isnan(out[k]), touches_nan) << k;
  }
}

TEST(TarnInterpolation, PhaseCodeAndMagnitudesOfComplexData) {
  // pi/2 codes as 16384; the magnitudes replace the first floats of data and are resampled.
  std::vector<TsComplex> data{{0, 2}, {0, 4}};
  const std::vector<float> x{0, 1}, factor{1, 1, 10};
  std::vector<float> resampled(3), result(3);
  std::vector<std::int16_t> code(3, 1);
  TarnInterpolation(data.data(), x.data(), 2, resampled.data(), factor.data(), result.data(), 0, 1,
                    3, 3, code.data());
  EXPECT_EQ(code, (std::vector<std::int16_t>{16384, 16384, 16384}));
  EXPECT_EQ(data[0], TsComplex(2, 4));
  EXPECT_EQ(resampled, (std::vector<float>{2, 3, 4}));
  EXPECT_EQ(result, (std::vector<float>{2, 3, 40}));
}

TEST(TarnInterpolation, PhaseCodesOfALongDelayTraceFollowTheTruePhase) {
  // A 2001-point trace (scratch on the heap) whose phase turns 37 times: every resampled code
  // is the true phase at its grid point within 3 codes (0.02 degrees), wrapped, also where
  // the ramp between two samples crosses +-pi.
  constexpr int kCount = 2001, kPoints = 1601;
  const double turns = 37.3;
  const std::vector<float> x = Range(kCount, 0.0f, 1.0f);
  std::vector<TsComplex> data(kCount);
  auto phase_at = [&](double s) { return -2.0 * kPi * turns * s / (kCount - 1); };
  for (int i = 0; i < kCount; ++i) data[i] = TsComplex::FromMagPhase(0.5, phase_at(i));
  std::vector<float> resampled(kPoints), factor(kPoints, 1.0f), result(kPoints);
  std::vector<std::int16_t> code(kPoints);
  TarnInterpolation(data.data(), x.data(), kCount, resampled.data(), factor.data(), result.data(),
                    0, kCount - 1, kPoints, kPoints, code.data());
  for (int k = 0; k < kPoints; ++k) {
    const double g = k * double{kCount - 1} / (kPoints - 1);
    const double expected = std::remainder(phase_at(g), 2.0 * kPi) * 32768.0 / kPi;
    double diff = std::remainder(code[k] - expected, 65536.0);
    ASSERT_LE(std::abs(diff), 3.0) << k;
    ASSERT_NEAR(resampled[k], 0.5f, 1e-6) << k;
  }
}

TEST(TarnCubicInterpolation, ReproducesLinesPassesThroughSamplesAndFollowsCurves) {
  const std::vector<double> x{0, 0.5, 2, 2.25, 4, 7};  // uneven spacing
  std::vector<float> line(x.size()), wave(x.size());
  for (std::size_t i = 0; i < x.size(); ++i) {
    line[i] = static_cast<float>(3.0 - 0.75 * x[i]);
    wave[i] = static_cast<float>(std::sin(1.3 * x[i]) + 0.2 * x[i] * x[i]);
  }
  const std::vector<float> out_line = Cubic(line, x, 0, 7, 29);
  for (int k = 0; k < 29; ++k) EXPECT_NEAR(out_line[k], 3.0 - 0.75 * k * 0.25, 2e-6) << k;
  // Grid 0, 0.25, ... 7 contains every stimulus point.
  const std::vector<float> out_wave = Cubic(wave, x, 0, 7, 29);
  for (std::size_t i = 0; i < x.size(); ++i) {
    EXPECT_FLOAT_EQ(out_wave[static_cast<int>(x[i] * 4)], wave[i]) << x[i];
  }

  // A smooth curve on a finer grid is followed closely.
  std::vector<double> fx(41);
  std::vector<float> fy(41);
  for (int i = 0; i < 41; ++i) {
    fx[i] = 1e9 + 2.5e7 * i;
    fy[i] = static_cast<float>(std::cos((fx[i] - 1e9) / 1.5e8));
  }
  const std::vector<float> out = Cubic(fy, fx, 1e9, 2e9, 1001);
  for (int k = 0; k < 1001; ++k) EXPECT_NEAR(out[k], std::cos(k * 1e6 / 1.5e8), 2e-3) << k;
}

TEST(TarnCubicInterpolation, HoldsEndSamplesOutsideTheStimulusAndDegenerateCallsHaveFixedOutcomes) {
  const std::vector<double> x{1, 2, 3};
  EXPECT_EQ(Cubic({5, 6, 9}, x, -1, 5, 7), (std::vector<float>{5, 5, 5, 6, 9, 9, 9}));
  // Descending stimulus and descending grid mirror the ascending case.
  EXPECT_EQ(Cubic({9, 6, 5}, {3, 2, 1}, -1, 5, 7), (std::vector<float>{5, 5, 5, 6, 9, 9, 9}));
  EXPECT_EQ(Cubic({5, 6, 9}, x, 5, -1, 7), (std::vector<float>{9, 9, 9, 6, 5, 5, 5}));

  const std::vector<float> out = Cubic({0, 1, 1, 2}, {0, 1, 1, 2}, 0, 2, 9);  // a repeat
  for (int k = 0; k < 9; ++k) EXPECT_TRUE(std::isfinite(out[k])) << k;
  EXPECT_EQ(Cubic({4}, {1}, 0, 2, 3), (std::vector<float>{4, 4, 4}));
  EXPECT_EQ(Cubic({1, 3}, {0, 1}, 0.25, 99, 1), std::vector<float>{1.5f});
  for (const float v : Cubic({}, {}, 0, 1, 2)) EXPECT_TRUE(std::isnan(v));
  for (const float v : Cubic({1, 2}, {0, 1}, 0, kNaN, 2)) EXPECT_TRUE(std::isnan(v));
  EXPECT_EQ(Cubic({1, 2}, {0, 1}, 0, 1, 0), std::vector<float>{});
}

TEST(TarnCubicInterpolation, UnwrapsPhaseAndDividesTheOperand) {
  // Magnitude 2 and a phase stepping 3.0 -> -3.0 rad (0.28 rad the short way): the resampled
  // values stay on the circle of radius 2 and pass pi, not 0.
  const std::vector<double> x{0, 1, 2};
  const std::vector<float> mag{2, 2, 2};
  std::vector<float> phase{2.8f, 3.0f, -3.0f};
  std::vector<float> rmag(5), rphase(5);
  std::vector<TsComplex> resampled(5), operand(5, TsComplex(0, 4)), result(5);
  TarnCubicInterpolation(mag.data(), phase.data(), x.data(), 3, rmag.data(), rphase.data(),
                         resampled.data(), operand.data(), result.data(), 0, 2, 5, true);
  EXPECT_FLOAT_EQ(phase[2], -3.0f + 6.2831855f);
  for (int k = 0; k < 5; ++k) {
    EXPECT_NEAR(resampled[k].Mag(), 2.0, 1e-6) << k;
    EXPECT_GT(rphase[k], 2.7f) << k;
    EXPECT_LT((result[k] * resampled[k] - TsComplex(0, 4)).Mag(), 1e-5) << k;
  }

  // Without phase the trace is real; a zero magnitude divides to 0, not infinity.
  const std::vector<float> flat{0, 0, 4};
  TarnCubicInterpolation(flat.data(), nullptr, x.data(), 3, rmag.data(), nullptr, resampled.data(),
                         operand.data(), result.data(), 0, 2, 3, false);
  EXPECT_EQ(resampled[2], TsComplex(4, 0));
  EXPECT_EQ(result[0], TsComplex(0, 0));
  EXPECT_EQ(result[2], TsComplex(0, 1));
}

}  // namespace
}  // namespace LumenUtility
