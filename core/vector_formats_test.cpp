#include "lumen/core/vector_formats.h"

#include <gtest/gtest.h>

#include "core/test_util.h"

#include <cmath>
#include <limits>
#include <random>
#include <vector>

#include "lumen/platform/error_codes.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/input_array.h"

namespace LumenUtility {
namespace {

using testutil::ZeroValueGuard;

constexpr double kPi = 3.14159265358979323846;

TsComplex Unit(double angle) {
  return TsComplex::FromMagPhase(1.0, angle);
}

// Phases of a unit-circle trace that winds in steps of up to 0.95 pi in either direction,
// starting inside (-pi, pi] so its unwrapped phase is the angle itself.
std::vector<double> RandomWalk(std::mt19937& rng, int n) {
  std::uniform_real_distribution<double> step(-0.95 * kPi, 0.95 * kPi);
  std::vector<double> angles(n);
  angles[0] = std::uniform_real_distribution<double>(-3.0, 3.0)(rng);
  for (int i = 1; i < n; ++i) angles[i] = angles[i - 1] + step(rng);
  return angles;
}

TEST(VectorFormats, LogMagGivesDecibelsAndTheZeroValueForExactZero) {
  ZeroValueGuard guard;
  std::vector<TsComplex> v = {TsComplex(0, 0), TsComplex(1, 0), TsComplex(10, 0),
                              TsComplex(0, -0.1), TsComplex(1e-30, 0)};
  const std::vector<float> formatted = FormatLogMag(v);
  ToLogMag(v);
  const float expected[] = {-200.0f, 0.0f, 20.0f, -20.0f, -600.0f};
  for (size_t i = 0; i < v.size(); ++i) {
    EXPECT_FLOAT_EQ(v[i].re, expected[i]) << i;
    EXPECT_EQ(v[i].im, 0.0f);
    EXPECT_EQ(formatted[i], v[i].re) << i;
  }
  FromLogMag(v);
  EXPECT_NEAR(v[3].re, 0.1, 1e-8);

  TsComplex::SetLogMagZeroValue(-300.0);
  EXPECT_EQ(FormatLogMag({TsComplex()})[0], -300.0f);
}

TEST(VectorFormats, SquareInvertAndProductAgree) {
  const std::vector<TsComplex> v = {TsComplex(1, 2), TsComplex(-0.5, 0.25), TsComplex(0, 0)};
  std::vector<TsComplex> squared = v;
  Sq(squared);
  EXPECT_EQ(squared, Mult(v, v));
  std::vector<TsComplex> inverted = v;
  Invert(inverted);
  EXPECT_EQ(inverted[2], TsComplex(0, 0));  // 1/0 is 0, not NaN
  const std::vector<TsComplex> product = Mult(v, inverted);
  for (int i = 0; i < 2; ++i) EXPECT_LT(std::abs((product[i] - TsComplex(1)).Mag()), 1e-6);

  // The product takes the first trace's length; a shorter second trace is refused.
  EXPECT_EQ(Mult({TsComplex(2)}, v), std::vector<TsComplex>{TsComplex(2, 4)});
  try {
    Mult(v, {TsComplex(2)});
    FAIL() << "no exception";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetCode(), E_INVALIDARG);
  }
}

TEST(VectorFormats, UnwrappedPhaseCrossesMinusPiAndFollowsARandomWalkWholeOrInPieces) {
  // With the TsComplex::Phase rule for a zero real part.
  std::vector<float> phase(3);
  const std::vector<TsComplex> down = {TsComplex(0, -1), TsComplex(-1, 0.01), TsComplex(0, 0)};
  ASSERT_EQ(FormatUnwrappedPhase(down.data(), phase.data(), 0, 3), S_OK);
  EXPECT_FLOAT_EQ(phase[0], -kPi / 2);
  EXPECT_NEAR(phase[1], -kPi - 0.01, 1e-5);
  EXPECT_NEAR(phase[2], -1.5 * kPi, 1e-5);  // 0 + 0j counts as +pi/2

  std::mt19937 rng(7);
  for (int trial = 0; trial < 50; ++trial) {
    const int n = 200;
    const std::vector<double> angles = RandomWalk(rng, n);
    std::vector<TsComplex> data(n);
    for (int i = 0; i < n; ++i) data[i] = Unit(angles[i]);

    std::vector<float> whole(n);
    ASSERT_EQ(FormatUnwrappedPhase(data.data(), whole.data(), 0, n), S_OK);
    for (int i = 0; i < n; ++i) ASSERT_NEAR(whole[i], angles[i], 1e-5 * (1 + i)) << i;

    // Pieces of 1 to 7 points; their starting turn count comes from a truncated quotient that
    // is often a turn off when the walk has doubled back.
    std::vector<float> pieces(n);
    std::uniform_int_distribution<int> length(1, 7);
    for (int begin = 0; begin < n;) {
      const int end = std::min(n, begin + length(rng));
      ASSERT_EQ(FormatUnwrappedPhase(data.data(), pieces.data(), begin, end), S_OK);
      begin = end;
    }
    for (int i = 0; i < n; ++i) ASSERT_EQ(pieces[i], whole[i]) << "trial " << trial << " at " << i;
  }
}

TEST(VectorFormats, UnwrappedPhaseRejectsBadRangesWithoutWriting) {
  const TsComplex data[2] = {TsComplex(1, 0), TsComplex(-1, 0)};
  float phase[2] = {7.0f, 7.0f};
  EXPECT_EQ(FormatUnwrappedPhase(data, phase, -1, 1), E_INVALIDARG);
  EXPECT_EQ(FormatUnwrappedPhase(data, phase, 2, 1), E_INVALIDARG);
  EXPECT_EQ(FormatUnwrappedPhase(nullptr, phase, 0, 2), E_INVALIDARG);
  EXPECT_EQ(FormatUnwrappedPhase(nullptr, nullptr, 1, 1), S_OK);  // empty range
  EXPECT_EQ(phase[0] + phase[1], 14.0f);

  // A garbage earlier result does not poison the continuation.
  const TsComplex three[3] = {TsComplex(1, 0), TsComplex(1, 0), TsComplex(0, 1)};
  float out[3] = {std::numeric_limits<float>::quiet_NaN(), std::numeric_limits<float>::infinity(),
                  0.0f};
  EXPECT_EQ(FormatUnwrappedPhase(three, out, 2, 3), S_OK);
  EXPECT_TRUE(std::isfinite(out[2]));
}

TEST(VectorFormats, SqrtKeepsTheBranchContinuous) {
  std::vector<TsComplex> v = {Unit(0), Unit(0.9 * kPi), Unit(1.8 * kPi)};
  EXPECT_NEAR(v[2].Sqrt().Phase(), -0.1 * kPi, 1e-6);  // the principal root jumps
  Sqrt(v);
  const double expected[] = {0.0, 0.45 * kPi, 0.9 * kPi};
  for (int i = 0; i < 3; ++i) EXPECT_LT((v[i] - Unit(expected[i])).Mag(), 1e-6) << i;

  // Property: over a winding trace the roots square back to the data, and neighbours stay
  // within a quarter turn (half of the data's step of at most 0.95 pi, plus rounding).
  std::mt19937 rng(11);
  const std::vector<double> angles = RandomWalk(rng, 500);
  std::vector<TsComplex> data(angles.size());
  for (size_t i = 0; i < angles.size(); ++i)
    data[i] = TsComplex::FromMagPhase(1 + i % 3, angles[i]);
  std::vector<TsComplex> roots = data;
  Sqrt(roots);
  for (size_t i = 0; i < roots.size(); ++i) {
    ASSERT_LT((roots[i] * roots[i] - data[i]).Mag(), 1.5e-5) << i;
    if (i > 0) ASSERT_LE(std::abs((roots[i] / roots[i - 1]).Phase()), 0.4876 * kPi) << i;
  }

  std::vector<TsComplex> empty, negative = {TsComplex(-4, 0)};
  Sqrt(empty);
  Sqrt(negative);
  EXPECT_LT((negative[0] - TsComplex(0, 2)).Mag(), 1e-6);
}

TEST(VectorFormats, SqrtExRecoversADelayLineRootAndLeavesDegenerateInputsAsSqrtDoes) {
  // Root r(f) = a(f) e^{j(phase0 - 2 pi f tau)}; the data is r^2. Whatever the first point's
  // principal root, the sign decision must give back r itself.
  const double tau = 1e-9;  // s
  for (double phase0 : {0.0, 0.3, -2.0, 3.0}) {
    for (double start : {0.0, 0.1e9, 0.3e9, 0.6e9, 1.9e9, 7.77e9}) {
      const int n = 201;
      const InputArray stimulus(start, start + 2e9, n, Linear);
      std::vector<TsComplex> root(n), data(n);
      for (int i = 0; i < n; ++i) {
        const double f = stimulus[i];
        root[i] = TsComplex::FromMagPhase(0.9 - 1e-11 * f, phase0 - 2 * kPi * f * tau);
        data[i] = root[i] * root[i];
      }
      SqrtEx(stimulus, static_cast<float>(phase0), data);
      for (int i = 0; i < n; i += 50) {
        EXPECT_LT((data[i] - root[i]).Mag(), 1.5e-5) << phase0 << " " << start << " " << i;
      }
    }
  }

  // Degenerate inputs are left as Sqrt leaves them.
  const std::vector<TsComplex> data = {TsComplex(-1, 0.1), TsComplex(-1, -0.1)};
  std::vector<TsComplex> plain = data;
  Sqrt(plain);

  std::vector<TsComplex> flat = data;  // equal end points: slope 0/0
  SqrtEx(InputArray(5.0, 2), 3.0f, flat);
  EXPECT_EQ(flat, plain);
  std::vector<TsComplex> noStimulus = data, empty;
  SqrtEx(InputArray(), 3.0f, noStimulus);
  EXPECT_EQ(noStimulus, plain);
  SqrtEx(InputArray(1.0, 2.0, 2, Linear), 0.0f, empty);
}

}  // namespace
}  // namespace LumenUtility
