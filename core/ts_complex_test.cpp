#include "lumen/core/ts_complex.h"

#include <gtest/gtest.h>

#include "core/test_util.h"

#include <cmath>
#include <cstring>
#include <limits>
#include <vector>

namespace LumenUtility {
namespace {

using testutil::ZeroValueGuard;

constexpr double kPi = 3.14159265358979323846;

TEST(TsComplex, LayoutIsTwoFloatsRealFirst) {
  const TsComplex values[2] = {TsComplex(1.5, -2.5), TsComplex(3.0, 4.0)};
  float raw[4];
  std::memcpy(raw, values, sizeof raw);
  EXPECT_EQ(std::vector<float>(raw, raw + 4), (std::vector<float>{1.5f, -2.5f, 3.0f, 4.0f}));
}

TEST(TsComplex, ArithmeticRoundsOnceGuardsComplexDivisionAndNanIsUnequal) {
  const TsComplex a(1, 2), b(3, -4);
  EXPECT_EQ(a + b, TsComplex(4, -2));
  EXPECT_EQ(a - b, TsComplex(-2, 6));
  EXPECT_EQ(a * b, TsComplex(11, 2));
  EXPECT_EQ(a / b, TsComplex(-5.0 / 25, 10.0 / 25));
  EXPECT_EQ(-a, TsComplex(-1, -2));
  EXPECT_EQ(a + 3.0, TsComplex(4, 2));  // only the real part moves
  EXPECT_EQ(a - 3.0, TsComplex(-2, 2));
  EXPECT_EQ(a * 2.0, TsComplex(2, 4));
  TsComplex c = a;
  c *= b;
  c /= b;
  EXPECT_EQ(c, a);
  // 0.1f * 3 in double then rounded once, not three float additions.
  EXPECT_EQ((TsComplex(0.1) * 3.0).re, static_cast<float>(double{0.1f} * 3.0));

  EXPECT_EQ(TsComplex(1, 2) / TsComplex(), TsComplex());
  const float inf = std::numeric_limits<float>::infinity();
  EXPECT_EQ(TsComplex(1, -1) / 0.0, TsComplex(inf, -inf));
  EXPECT_TRUE(std::isnan((TsComplex() / 0.0).re));
  // Equality is exact and false for NaN.
  const float nan = std::numeric_limits<float>::quiet_NaN();
  EXPECT_FALSE(TsComplex(1, nan) == TsComplex(1, nan));
  EXPECT_NE(TsComplex(1, 0), TsComplex(std::nextafter(1.0f, 2.0f), 0));
}

TEST(TsComplex, LogMagOfZeroUsesTheProcessWideZeroValue) {
  ZeroValueGuard guard;
  EXPECT_EQ(TsComplex().LogMag(), -200.0);
  EXPECT_EQ(TsComplex().LogMag(-300.0), -300.0);
  EXPECT_NEAR(TsComplex(1e-30).LogMag(), -600.0, 1e-6);  // tiny (as float), not zero
  EXPECT_EQ(TsComplex(0, 1).LogMag(), 0.0);
  EXPECT_DOUBLE_EQ(TsComplex(10).LogMag(), 20.0);
  EXPECT_EQ(TsComplex::SetLogMagZeroValue(-150), -200.0);
  EXPECT_EQ(TsComplex::SetLogMagZeroValue(-150), -150.0);
  EXPECT_EQ(TsComplex().LogMag(), -150.0);
  EXPECT_EQ(TsComplex().LogDBM(), -150.0);
  EXPECT_EQ(TsComplex::m_minus200dB, TsComplex(7.0710678e-11f, 7.0710678e-11f));
  EXPECT_NEAR(TsComplex::m_minus200dB.LogMag(), -200.0, 1e-5);
}

TEST(TsComplex, PhaseMagnitudeSwrAndPowerFormats) {
  EXPECT_EQ(TsComplex().Phase(), 1.570796326794896);
  EXPECT_EQ(TsComplex(0, -1).Phase(), -1.570796326794896);
  EXPECT_DOUBLE_EQ(TsComplex(-1, 0).Phase(), kPi);
  EXPECT_DOUBLE_EQ(TsComplex(1, 1).Phase(), kPi / 4);

  EXPECT_EQ(TsComplex(3, 4).LinearMag(), 5.0);
  EXPECT_EQ(TsComplex(3e30f, 4e30f).Mag(), std::hypot(double{3e30f}, double{4e30f}));
  EXPECT_EQ(TsComplex().SWR(), 1.0);
  EXPECT_DOUBLE_EQ(TsComplex(0, 0.5).SWR(), 3.0);
  EXPECT_TRUE(std::isinf(TsComplex(1).SWR()));
  EXPECT_NEAR(TsComplex(10).LinearWatt(), 0.1, 1e-8);  // 0.001 is a float constant
  EXPECT_DOUBLE_EQ(TsComplex(-10).LinearVolt(), -std::sqrt(5.0));
  EXPECT_NEAR(TsComplex(10).LinearAmpere(), std::sqrt(100 * 0.00002), 1e-8);
  EXPECT_EQ(TsComplex().LinearVolt(), 0.0);
  EXPECT_TRUE(std::signbit(TsComplex().LinearVolt()));
  EXPECT_DOUBLE_EQ(TsComplex(10).LogDBM(), 20.0);
  EXPECT_TRUE(std::isnan(TsComplex(-1).LogDBM()));
}

TEST(TsComplex, ImpedanceAdmittanceAndEquivalentElements) {
  EXPECT_EQ(TsComplex().Impedance(TsComplex(50)), TsComplex(50, 0));
  EXPECT_EQ(TsComplex(-1).Impedance(TsComplex(50)), TsComplex(0, 0));
  EXPECT_EQ(TsComplex(1).Impedance(TsComplex(50)), TsComplex(0, 0));  // division guard
  EXPECT_EQ(TsComplex().Impedance(TsComplex(50, 10)), TsComplex(50, -10));
  EXPECT_EQ(TsComplex().Admittance(TsComplex(50)), TsComplex(0.02f, 0));
  // Gamma = 1/3 is 100 ohms.
  EXPECT_FLOAT_EQ(TsComplex(1.0 / 3).Impedance(TsComplex(50)).re, 100.0f);

  bool isCapacitance = true;
  EXPECT_EQ(TsComplex(0, 0.5).Z_Inductance(50, 0, isCapacitance), 0.0);
  EXPECT_FALSE(isCapacitance);

  // Gamma of 50 + j50 ohms against 50 ohms: reactance +50 ohm at 1 GHz is 7.96 nH.
  const TsComplex gammaL = (TsComplex(50, 50) - 50.0) / (TsComplex(50, 50) + 50.0);
  EXPECT_NEAR(gammaL.Z_Inductance(50, 1e9, isCapacitance), 50 / (2 * kPi * 1e9), 1e-14);
  EXPECT_FALSE(isCapacitance);

  const TsComplex gammaC = gammaL.Conjugate();  // 50 - j50 ohms
  EXPECT_NEAR(gammaC.Z_Inductance(50, 1e9, isCapacitance), 1 / (50 * 2 * kPi * 1e9), 1e-17);
  EXPECT_TRUE(isCapacitance);

  // The shunt view of 50 - j50 ohms: susceptance +0.01 S is a capacitance.
  EXPECT_NEAR(gammaC.Y_Inductance(50, 1e9, isCapacitance), 0.01 / (2 * kPi * 1e9), 1e-16);
  EXPECT_TRUE(isCapacitance);
  EXPECT_EQ(gammaC.Y_Inductance(50, 0, isCapacitance), 0.0);
  EXPECT_FALSE(isCapacitance);
}

TEST(TsComplex, FactoriesAndSqrt) {
  EXPECT_EQ(TsComplex::FromLogMag(-200), TsComplex(1e-10, 0));
  EXPECT_LT((TsComplex::FromMagPhase(2, kPi / 2) - TsComplex(0, 2)).Mag(), 1e-7);
  EXPECT_FLOAT_EQ(TsComplex::FromLogMagPhase(20, kPi).re, -10.0f);
  EXPECT_LT((TsComplex(-4, 0).Sqrt() - TsComplex(0, 2)).Mag(), 1e-7);
  EXPECT_EQ(TsComplex(0, -1).Conjugate(), TsComplex(0, 1));
}

}  // namespace
}  // namespace LumenUtility
