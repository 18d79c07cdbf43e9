#include "lumen/core/ts_complex.h"

#include <cmath>
#include <type_traits>

namespace LumenUtility {

static_assert(std::is_standard_layout_v<TsComplex> && std::is_trivially_copyable_v<TsComplex>,
              "TsComplex arrays are handed to vector routines as raw floats");

namespace {

constexpr double kHalfPi = 1.570796326794896;
constexpr double kTwoPi = 6.283185307179586;
// Smallest normal float: stands in for the squared magnitude of a zero divisor.
constexpr double kZeroDivisorGuard = 1.175494351e-38;

TsComplex Divide(double are, double aim, double bre, double bim) {
  double d = bre * bre + bim * bim;
  if (d == 0.0) d = kZeroDivisorGuard;
  return TsComplex((are * bre + aim * bim) / d, (aim * bre - are * bim) / d);
}

}  // namespace

double TsComplex::m_logMagZeroValue = -200.0;
const TsComplex TsComplex::m_minus200dB(7.0710678e-11, 7.0710678e-11);

TsComplex TsComplex::operator+(const TsComplex& b) const {
  return TsComplex(double{re} + b.re, double{im} + b.im);
}
TsComplex TsComplex::operator-(const TsComplex& b) const {
  return TsComplex(double{re} - b.re, double{im} - b.im);
}
TsComplex TsComplex::operator*(const TsComplex& b) const {
  return TsComplex(double{re} * b.re - double{im} * b.im, double{re} * b.im + double{im} * b.re);
}
TsComplex TsComplex::operator/(const TsComplex& b) const {
  return Divide(re, im, b.re, b.im);
}
TsComplex TsComplex::operator-() const {
  return TsComplex(-re, -im);
}
TsComplex& TsComplex::operator+=(const TsComplex& b) {
  return *this = *this + b;
}
TsComplex& TsComplex::operator-=(const TsComplex& b) {
  return *this = *this - b;
}
TsComplex& TsComplex::operator*=(const TsComplex& b) {
  return *this = *this * b;
}
TsComplex& TsComplex::operator/=(const TsComplex& b) {
  return *this = *this / b;
}

TsComplex TsComplex::operator+(double x) const {
  return TsComplex(re + x, im);
}
TsComplex TsComplex::operator-(double x) const {
  return TsComplex(re - x, im);
}
TsComplex TsComplex::operator*(double x) const {
  return TsComplex(re * x, im * x);
}
TsComplex TsComplex::operator/(double x) const {
  return TsComplex(re / x, im / x);
}
TsComplex& TsComplex::operator+=(double x) {
  return *this = *this + x;
}
TsComplex& TsComplex::operator-=(double x) {
  return *this = *this - x;
}
TsComplex& TsComplex::operator*=(double x) {
  return *this = *this * x;
}
TsComplex& TsComplex::operator/=(double x) {
  return *this = *this / x;
}

double TsComplex::Mag() const {
  return std::hypot(double{re}, double{im});
}

double TsComplex::LinearMag() const {
  return std::sqrt(double{re} * re + double{im} * im);
}

double TsComplex::LogMag() const {
  return LogMag(m_logMagZeroValue);
}

double TsComplex::LogMag(double zeroValue) const {
  const double power = double{re} * re + double{im} * im;
  return power == 0.0 ? zeroValue : 10.0 * std::log10(power);
}

double TsComplex::LogDBM() const {
  return re == 0.0f ? m_logMagZeroValue : 20.0 * std::log10(double{re});
}

double TsComplex::LinearWatt() const {
  constexpr float kMilliToUnit = 0.001f;
  return double{re} * re * kMilliToUnit;
}

double TsComplex::LinearVolt() const {
  const double sign = re > 0.0f ? 1.0 : -1.0;
  return sign * std::sqrt(double{re} * re * 50.0 * 0.001);
}

double TsComplex::LinearAmpere() const {
  constexpr float kMilliWattPerOhm = 0.00002f;  // 0.001 / 50
  const double sign = re > 0.0f ? 1.0 : -1.0;
  return sign * std::sqrt(double{re} * re * kMilliWattPerOhm);
}

double TsComplex::Phase() const {
  if (re == 0.0f) return im >= 0.0f ? kHalfPi : -kHalfPi;
  return std::atan2(double{im}, double{re});
}

double TsComplex::SWR() const {
  const double m = LinearMag();
  return (1.0 + m) / std::abs(1.0 - m);
}

TsComplex TsComplex::Conjugate() const {
  return TsComplex(re, -im);
}

TsComplex TsComplex::Sqrt() const {
  const double r = std::sqrt(Mag());
  const double theta = 0.5 * Phase();
  return TsComplex(r * std::cos(theta), r * std::sin(theta));
}

TsComplex TsComplex::Impedance(TsComplex z0) const {
  const TsComplex one(1.0);
  const TsComplex ratio = (one + *this) / (one - *this);
  return TsComplex(double{z0.re} * ratio.re, double{z0.re} * ratio.im - z0.im);
}

TsComplex TsComplex::Admittance(TsComplex z0) const {
  const TsComplex one(1.0);
  return ((one - *this) / (one + *this)) / z0;
}

double TsComplex::Z_Inductance(double z0, double freq, bool& isCapacitance) const {
  const double reactance = Impedance(TsComplex(z0, 0.0)).im;
  isCapacitance = false;
  if (freq == 0.0) return 0.0;
  const double omega = freq * kTwoPi;
  if (reactance >= 0.0) return reactance / omega;
  isCapacitance = true;
  return -1.0 / (reactance * omega);
}

double TsComplex::Y_Inductance(double z0, double freq, bool& isCapacitance) const {
  isCapacitance = false;
  const double susceptance = Admittance(TsComplex(z0, 0.0)).im;
  if (freq == 0.0) return 0.0;
  const double omega = freq * kTwoPi;
  if (susceptance >= 0.0) {
    isCapacitance = true;
    return susceptance / omega;
  }
  return -1.0 / (susceptance * omega);
}

TsComplex TsComplex::FromLogMag(double dB) {
  return TsComplex(std::pow(10.0, dB * 0.05), 0.0);
}

TsComplex TsComplex::FromLogMagPhase(double dB, double phase) {
  return FromMagPhase(std::pow(10.0, dB * 0.05), phase);
}

TsComplex TsComplex::FromMagPhase(double mag, double phase) {
  return TsComplex(mag * std::cos(phase), mag * std::sin(phase));
}

double TsComplex::GetLogMagZeroValue() {
  return m_logMagZeroValue;
}

double TsComplex::SetLogMagZeroValue(double v) {
  const double previous = m_logMagZeroValue;
  m_logMagZeroValue = v;
  return previous;
}

}  // namespace LumenUtility
