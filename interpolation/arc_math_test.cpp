#include "interpolation/arc_math.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace LumenUtility {
namespace {

constexpr double kPi = 3.141592653589793;

TsComplex OnCircle(double cx, double cy, double r, double angle) {
  return TsComplex(cx + r * std::cos(angle), cy + r * std::sin(angle));
}

TEST(ArcThrough, FindsCentreAndSignedTurnsAlsoForAxisParallelChords) {
  const Arc arc = ArcThrough(OnCircle(0.3, -0.2, 0.5, 1.0), OnCircle(0.3, -0.2, 0.5, 1.4),
                             OnCircle(0.3, -0.2, 0.5, 0.7));
  EXPECT_NEAR(arc.cx, 0.3, 1e-6);
  EXPECT_NEAR(arc.cy, -0.2, 1e-6);
  EXPECT_NEAR(arc.Turn01(TrigTable::Get()), 0.4, 1e-6);
  EXPECT_NEAR(arc.Turn12(TrigTable::Get()), -0.7, 1e-6);
  EXPECT_NEAR(std::hypot(arc.w0.re, arc.w0.im), 0.5, 1e-6);

  // P0 and P1 share their imaginary part, P1 and P2 their real part.
  const Arc square = ArcThrough(OnCircle(0, 0, 1, 0.25 * kPi), OnCircle(0, 0, 1, 0.75 * kPi),
                                OnCircle(0, 0, 1, 1.25 * kPi));
  EXPECT_NEAR(square.cx, 0.0, 1e-5);
  EXPECT_NEAR(square.cy, 0.0, 1e-5);
  EXPECT_NEAR(square.Turn01(TrigTable::Get()), 0.5 * kPi, 1e-5);
}

TEST(ArcThrough, FoldsLargeTurnsAndFindsNoneForDegenerateTriples) {
  // 120 degrees per point reads as 60: the arcsine of the sine of the turn.
  const Arc arc = ArcThrough(OnCircle(0, 0, 1, 0), OnCircle(0, 0, 1, 2 * kPi / 3),
                             OnCircle(0, 0, 1, 4 * kPi / 3));
  EXPECT_NEAR(arc.Turn01(TrigTable::Get()), kPi / 3, 1e-6);
  EXPECT_NEAR(arc.Turn12(TrigTable::Get()), kPi / 3, 1e-6);
  const Arc back = ArcThrough(OnCircle(0, 0, 1, 0), OnCircle(0, 0, 1, -2 * kPi / 3),
                              OnCircle(0, 0, 1, -4 * kPi / 3));
  EXPECT_NEAR(back.Turn01(TrigTable::Get()), -kPi / 3, 1e-6);

  // Collinear or repeated points give no usable turn.
  for (const Arc& flat : {ArcThrough({0, 0}, {1, 1}, {2, 2}), ArcThrough({1, 1}, {1, 1}, {1, 1}),
                          ArcThrough({0.5f, 0}, {0.5f, 0}, {0.5f, 1})}) {
    EXPECT_TRUE(std::isfinite(flat.cx) && std::isfinite(flat.cy));
    EXPECT_FALSE(flat.TurnsAboveMinimum());
  }
}

TEST(ArcThrough, ProductsAreThoseOfTheVectorsRoundedToFloat) {
  // Nearly collinear points put the centre far away, where rounding the vectors to float moves
  // them by about 1e-7 of their length: the squared lengths, cross and dot products must be
  // those of the rounded vectors, or the turn and its minimum check disagree with them.
  std::mt19937 rng(3);
  std::uniform_real_distribution<double> unit(-1.0, 1.0);
  for (int trial = 0; trial < 2000; ++trial) {
    const TsComplex p0(unit(rng), unit(rng)), p1(unit(rng), unit(rng));
    const double bend = 1e-3 * unit(rng);
    const TsComplex p2(2.0 * p1.re - p0.re + bend, 2.0 * p1.im - p0.im - bend);
    const Arc arc = ArcThrough(p0, p1, p2);
    const TsComplex w2(double{p2.re} - arc.cx, double{p2.im} - arc.cy);
    auto cross = [](TsComplex u, TsComplex v) { return double{u.re} * v.im - double{u.im} * v.re; };
    auto dot = [](TsComplex u, TsComplex v) { return double{u.re} * v.re + double{u.im} * v.im; };
    ASSERT_EQ(arc.norm0, dot(arc.w0, arc.w0)) << trial;
    ASSERT_EQ(arc.norm1, dot(arc.w1, arc.w1)) << trial;
    ASSERT_EQ(arc.dot01, dot(arc.w0, arc.w1)) << trial;
    ASSERT_EQ(arc.cross01, cross(arc.w0, arc.w1)) << trial;
    // Where no imaginary part was nudged, w2 is P2 - centre as given.
    constexpr double kNudge = 1.1920928955078125e-07;
    if (std::fabs(double{p1.im} - p0.im) >= kNudge && std::fabs(double{p2.im} - p1.im) >= kNudge) {
      ASSERT_EQ(arc.norm2, dot(w2, w2)) << trial;
      ASSERT_EQ(arc.cross12, cross(arc.w1, w2)) << trial;
      ASSERT_EQ(arc.dot12, dot(arc.w1, w2)) << trial;
    }
  }
}

}  // namespace
}  // namespace LumenUtility
