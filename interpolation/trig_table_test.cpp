#include "interpolation/trig_table.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace LumenUtility {
namespace {

// The table functions against the library's, over arguments from every table step and the
// whole reduced range; the bounds are those the header states.
TEST(TrigTable, SineAndCosineStayWithin2p5e12OfTheLibrarys) {
  const TrigTable& trig = TrigTable::Get();
  std::mt19937_64 rng(5);
  std::uniform_real_distribution<double> turn(-4.0, 4.0), wide(-1e6, 1e6);
  double worst = 0.0;
  for (int k = 0; k < 200000; ++k) {
    const double x = k % 2 == 0 ? turn(rng) : wide(rng);
    double s = 0.0, c = 0.0;
    trig.SinCos(x, s, c);
    worst = std::max({worst, std::fabs(s - std::sin(x)), std::fabs(c - std::cos(x))});
  }
  EXPECT_LT(worst, 2.5e-12);
}

TEST(TrigTable, AnglesStayWithin2p5e13RadiansOfAtan2InEveryQuadrant) {
  const TrigTable& trig = TrigTable::Get();
  std::mt19937_64 rng(6);
  std::uniform_real_distribution<float> part(-2.0f, 2.0f);
  std::uniform_real_distribution<double> ratio(-50.0, 50.0);
  double worst = 0.0;
  for (int k = 0; k < 200000; ++k) {
    const TsComplex v(part(rng), part(rng));
    worst = std::max(worst, std::fabs(trig.Angle(v) - std::atan2(double{v.im}, double{v.re})));
    const double u = ratio(rng);
    worst = std::max(worst, std::fabs(trig.Atan(u) - std::atan(u)));
  }
  EXPECT_LT(worst, 2.5e-13);
  EXPECT_EQ(trig.Angle(TsComplex(0.0f, -1.0f)), TsComplex(0.0f, -1.0f).Phase());
  EXPECT_TRUE(std::isnan(trig.Atan(std::nan(""))));
}

}  // namespace
}  // namespace LumenUtility
