/** @file */
/// @class LumenUtility::TsComplex
/// TsComplex: the library's complex measurement value.
///
/// Exactly two IEEE-754 single-precision floats, real part first (8 bytes, no padding), so
/// arrays of TsComplex are interleaved single-precision complex data that vector routines
/// take directly. Arithmetic runs in double precision on the stored floats and is rounded
/// to float when stored. Angles are radians, logarithms base 10, impedances ohms, frequencies
/// hertz.
/// Thread-safety: a plain value, usable from any thread. The process-wide LogMag zero value is
/// an unguarded double: callers that change it while other threads format data order that.
#pragma once

#include "lumen/export.h"

namespace LumenUtility {

class LUMEN_API TsComplex {
 public:
  /// Real part.
  float re;
  /// Imaginary part.
  float im;

  constexpr TsComplex() : re(0.0f), im(0.0f) {}
  /// The real number `real` (rounded to float), imaginary part 0.
  constexpr TsComplex(double real) : re(static_cast<float>(real)), im(0.0f) {}  // NOLINT
  /// `real` + j `imag`, each rounded to float.
  constexpr TsComplex(double real, double imag)
      : re(static_cast<float>(real)), im(static_cast<float>(imag)) {}

  ///@{
  /// Complex sum, difference, product.
  TsComplex operator+(const TsComplex& b) const;
  TsComplex operator-(const TsComplex& b) const;
  TsComplex operator*(const TsComplex& b) const;
  ///@}
  /// A divisor of exactly 0 + 0j is treated as having squared magnitude 1.175494351e-38, so
  /// a finite dividend gives 0 + 0j instead of NaN.
  TsComplex operator/(const TsComplex& b) const;
  /// Both parts negated.
  TsComplex operator-() const;
  ///@{
  /// Compound forms of +, -, * and / (the same zero-divisor rule).
  TsComplex& operator+=(const TsComplex& b);
  TsComplex& operator-=(const TsComplex& b);
  TsComplex& operator*=(const TsComplex& b);
  TsComplex& operator/=(const TsComplex& b);
  ///@}

  ///@{
  /// Adding or subtracting a real number changes only the real part.
  TsComplex operator+(double x) const;
  TsComplex operator-(double x) const;
  TsComplex operator*(double x) const;
  TsComplex operator/(double x) const;  ///< no guard: x = 0 gives IEEE infinities or NaN
  TsComplex& operator+=(double x);
  TsComplex& operator-=(double x);
  TsComplex& operator*=(double x);
  TsComplex& operator/=(double x);
  ///@}

  ///@{
  /// Exact comparison of both parts; false when either comparison is unordered (NaN).
  bool operator==(const TsComplex& b) const { return re == b.re && im == b.im; }
  bool operator!=(const TsComplex& b) const { return !(*this == b); }
  ///@}

  double Mag() const;        ///< overflow-safe hypot(re, im)
  double LinearMag() const;  ///< sqrt(re^2 + im^2)
  ///@{
  /// 10*log10(re^2 + im^2) in dB; an exact zero gives the process-wide zero value
  /// (GetLogMagZeroValue) or, in the second form, `zeroValue`.
  double LogMag() const;
  double LogMag(double zeroValue) const;
  ///@}
  /// 20*log10(re) in dBm, the real part holding sqrt(power in mW); re = 0 gives the zero
  /// value, a negative real part NaN.
  double LogDBM() const;
  double LinearWatt() const;    ///< re^2 mW in watts
  double LinearVolt() const;    ///< signed voltage of that power in 50 ohms
  double LinearAmpere() const;  ///< signed current of that power in 50 ohms
  /// atan2(im, re) in (-pi, pi]; re exactly 0 gives +pi/2 when im >= 0, else -pi/2.
  double Phase() const;
  double SWR() const;  ///< (1 + |x|) / |1 - |x||; +infinity at |x| = 1
  /// re - j im.
  TsComplex Conjugate() const;
  TsComplex Sqrt() const;  ///< principal root: sqrt(|x|) at half of Phase()
  /// Treats *this as a reflection coefficient G against z0 = R + jX (ohms):
  /// R (1 + G)/(1 - G) - jX.
  TsComplex Impedance(TsComplex z0) const;
  /// ((1 - G)/(1 + G)) / z0, in siemens.
  TsComplex Admittance(TsComplex z0) const;
  /// Equivalent series element of the impedance against a real z0 (ohms) at `freq` (Hz):
  /// inductance in henries (isCapacitance false) or capacitance in farads (true). freq = 0
  /// gives 0 with the flag false.
  double Z_Inductance(double z0, double freq, bool& isCapacitance) const;
  /// Equivalent shunt element of the admittance: capacitance (flag true) when the
  /// susceptance is >= 0, else inductance (flag false).
  double Y_Inductance(double z0, double freq, bool& isCapacitance) const;

  /// The real value of magnitude 10^(dB/20).
  static TsComplex FromLogMag(double dB);
  /// Magnitude 10^(dB/20) at `phase` radians.
  static TsComplex FromLogMagPhase(double dB, double phase);
  /// Linear magnitude `mag` at `phase` radians.
  static TsComplex FromMagPhase(double mag, double phase);

  /// The value LogMag() and LogDBM() report for an exact zero; -200 dB until changed.
  static double GetLogMagZeroValue();
  /// Stores `v` and returns the previous zero value.
  static double SetLogMagZeroValue(double v);

  /// Magnitude 1e-10 (-200 dB): both parts 7.0710678e-11.
  static const TsComplex m_minus200dB;

 private:
  static double m_logMagZeroValue;
};

static_assert(sizeof(TsComplex) == 8, "TsComplex is two packed floats");
static_assert(alignof(TsComplex) == 4, "TsComplex aligns like float");

}  // namespace LumenUtility
