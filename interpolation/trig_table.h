// Sine, cosine and arc tangent for the resampling loops, from small tables and short
// polynomials: inline, branch-light, without divisions (but for arguments beyond 1 of the
// arc tangent) and several times cheaper than the library calls. The polynomials stop where
// the data cannot tell: errors are below 2.5e-12 (sine, cosine) and 2.5e-13 (radians, arc
// tangent), 20,000 times below the float precision (6e-8) of the values they turn.
#pragma once

#include <cfloat>
#include <cmath>
#include <cstdint>

#include "lumen/core/ts_complex.h"

namespace LumenUtility {

// Tables of sin and cos at 256 steps around the circle and of atan with its first derivatives
// at 129 points of [0, 1] (9 KB).
// Thread-safety: immutable once built; Get() builds the one instance on first use (thread-safe)
// and callers on any thread share it.
class TrigTable {
 public:
  static const TrigTable& Get();

  // sin(x) and cos(x), x in radians. |x| beyond 1e6 (and NaN or infinity) goes to std::sin and
  // std::cos.
  void SinCos(double x, double& s, double& c) const {
    if (!(std::fabs(x) <= kReducedRange)) {
      s = std::sin(x);
      c = std::cos(x);
      return;
    }
    // x = k * step + r with |r| <= step / 2 (plus rounding). k * kStepHigh is exact for |k| below
    // 2^26, and so is the subtraction from x, which lies within one step of it.
    const double k = RoundToInteger(x * kStepsPerRadian);
    const double r = (x - k * kStepHigh) - k * kStepLow;
    const Entry& e = m_sinCos[static_cast<std::int64_t>(k) & (kSteps - 1)];
    const double r2 = r * r;
    // sin r and 1 - cos r as Taylor series: with |r| <= 0.0123 the first terms left out,
    // r^5 / 120 and r^6 / 720, are below 2.4e-12 and 5e-15.
    const double sinR = r - r * r2 * (1.0 / 6);
    const double oneMinusCosR = r2 * (0.5 - r2 * (1.0 / 24));
    // The table value plus a small correction, which keeps the rounding error near half a unit.
    s = e.sin + (e.cos * sinR - e.sin * oneMinusCosR);
    c = e.cos - (e.sin * sinR + e.cos * oneMinusCosR);
  }

  // The angle of v in (-pi, pi] as TsComplex::Phase gives it (atan2(im, re), with +-pi/2 by
  // the sign test im >= 0 where re is 0).
  double Angle(TsComplex v) const {
    if (v.re == 0.0f) return v.Phase();
    const double y = v.im, x = v.re;
    // One division either way: the smaller part over the larger.
    const bool steep = std::fabs(y) > std::fabs(x);
    const double u = steep ? x / y : y / x;
    // Finite for finite parts; infinities and NaN go to the library.
    if (!(std::fabs(u) <= 1.0)) return std::atan2(y, x);
    const double a = AtanInUnit(u);
    if (steep) {
      // atan2 = +-pi/2 - atan(x / y), the sign that of y.
      return std::signbit(y) ? (-kHalfPiHigh - a) - kHalfPiLow : (kHalfPiHigh - a) + kHalfPiLow;
    }
    if (x > 0.0) return a;
    // Left half-plane: half a turn towards the side y is on (a -0 imaginary part is below).
    return std::signbit(y) ? (a - kPiHigh) - kPiLow : (a + kPiHigh) + kPiLow;
  }

  // atan(u) in [-pi/2, pi/2]; atan(+-infinity) = +-pi/2, NaN stays NaN.
  double Atan(double u) const {
    const double a = std::fabs(u);
    // Beyond 1, atan(a) = pi/2 - atan(1/a); pi/2 in two parts keeps the difference exact.
    if (a > 1.0) {
      const double result = (kHalfPiHigh - AtanInUnit(1.0 / a)) + kHalfPiLow;
      return std::signbit(u) ? -result : result;
    }
    return AtanInUnit(u);
  }

 private:
  TrigTable();

  // atan(u) for |u| <= 1 (NaN stays NaN).
  double AtanInUnit(double u) const {
    const double v = std::fabs(u);
    // atan(v) = atan(c + e) with c = j / 128 the nearest table point, as the Taylor series
    // about c: with |e| <= 1/256 the terms beyond e^4, whose coefficients are below 1, add
    // less than 2e-13. e is exact.
    const double j = RoundToInteger(v * kAtanSteps);
    const double e = v - j * (1.0 / kAtanSteps);
    // A NaN index reads entry 0; the NaN still reaches the result through e.
    const AtanEntry& t = m_atan[j >= 0.0 && j <= kAtanSteps ? static_cast<int>(j) : 0];
    const double series =
        e * (t.d[0] + e * (t.d[1] + e * (t.d[2] + e * t.d[3])));
    const double result = t.atan + series;
    return std::signbit(u) ? -result : result;
  }

  // The integer nearest to x (ties to even), for |x| below 2^51, in the default rounding mode.
  static double RoundToInteger(double x) {
    constexpr double kShift = 0x1.8p52;
    return (x + kShift) - kShift;
  }

  static constexpr int kSteps = 256;
  static constexpr double kReducedRange = 1e6;
  static constexpr double kStepsPerRadian = 0x1.45f306dc9c883p+5;  // 256 / (2 pi)
  // 2 pi / 256 = kStepHigh + kStepLow; kStepHigh has 27 significant bits.
  static constexpr double kStepHigh = 0x1.921fb54p-6;
  static constexpr double kStepLow = 0x1.10b4611a62633p-36;
  static constexpr int kAtanSteps = 128;
  // pi/2 = kHalfPiHigh + kHalfPiLow.
  static constexpr double kHalfPiHigh = 0x1.921fb54442d18p+0;
  static constexpr double kHalfPiLow = 0x1.1a62633145c07p-54;
  // pi = kPiHigh + kPiLow.
  static constexpr double kPiHigh = 0x1.921fb54442d18p+1;
  static constexpr double kPiLow = 0x1.1a62633145c07p-53;

  struct Entry {
    double sin;
    double cos;
  };
  // atan and its Taylor coefficients d[k - 1] = atan^(k)(c) / k!, k = 1 .. 4, at c.
  struct AtanEntry {
    double atan;
    double d[4];
  };
  Entry m_sinCos[kSteps];            // at k * 2 pi / 256
  AtanEntry m_atan[kAtanSteps + 1];  // at c = j / 128
};

}  // namespace LumenUtility
