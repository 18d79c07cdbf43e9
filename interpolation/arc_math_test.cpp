#include "interpolation/arc_math.h"

#include <gtest/gtest.h>

#include <cmath>

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
  EXPECT_NEAR(arc.Turn01(), 0.4, 1e-6);
  EXPECT_NEAR(arc.Turn12(), -0.7, 1e-6);
  EXPECT_NEAR(std::hypot(arc.w0.re, arc.w0.im), 0.5, 1e-6);

  // P0 and P1 share their imaginary part, P1 and P2 their real part.
  const Arc square = ArcThrough(OnCircle(0, 0, 1, 0.25 * kPi), OnCircle(0, 0, 1, 0.75 * kPi),
                                OnCircle(0, 0, 1, 1.25 * kPi));
  EXPECT_NEAR(square.cx, 0.0, 1e-5);
  EXPECT_NEAR(square.cy, 0.0, 1e-5);
  EXPECT_NEAR(square.Turn01(), 0.5 * kPi, 1e-5);
}

TEST(ArcThrough, FoldsLargeTurnsAndFindsNoneForDegenerateTriples) {
  // 120 degrees per point reads as 60: the arcsine of the sine of the turn.
  const Arc arc = ArcThrough(OnCircle(0, 0, 1, 0), OnCircle(0, 0, 1, 2 * kPi / 3),
                             OnCircle(0, 0, 1, 4 * kPi / 3));
  EXPECT_NEAR(arc.Turn01(), kPi / 3, 1e-6);
  EXPECT_NEAR(arc.Turn12(), kPi / 3, 1e-6);
  const Arc back = ArcThrough(OnCircle(0, 0, 1, 0), OnCircle(0, 0, 1, -2 * kPi / 3),
                              OnCircle(0, 0, 1, -4 * kPi / 3));
  EXPECT_NEAR(back.Turn01(), -kPi / 3, 1e-6);

  // Collinear or repeated points give no usable turn.
  for (const Arc& flat : {ArcThrough({0, 0}, {1, 1}, {2, 2}), ArcThrough({1, 1}, {1, 1}, {1, 1}),
                          ArcThrough({0.5f, 0}, {0.5f, 0}, {0.5f, 1})}) {
    EXPECT_TRUE(std::isfinite(flat.cx) && std::isfinite(flat.cy));
    EXPECT_FALSE(flat.TurnsAboveMinimum());
  }
}

}  // namespace
}  // namespace LumenUtility
