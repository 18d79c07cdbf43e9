#include "interpolation/arc_math.h"

#include <cfloat>
#include <cmath>

namespace LumenUtility {
namespace {

constexpr double kPi = 3.141592653589793;
constexpr double kHalfPi = 1.570796326794896;

// |v|. Squares of floats cannot overflow a double, so this needs no scaling as hypot does.
double Magnitude(TsComplex v) {
  return std::sqrt(double{v.re} * v.re + double{v.im} * v.im);
}

// The turn from u to v, folded as asin(sin(turn)) would fold it: turns beyond a quarter are
// mirrored back (0.6 pi becomes 0.4 pi).
double FoldedTurn(TsComplex u, TsComplex v) {
  const double cross = double{u.re} * v.im - double{u.im} * v.re;
  const double dot = double{u.re} * v.re + double{u.im} * v.im;
  const double turn = std::atan2(cross, dot);
  if (turn > kHalfPi) return kPi - turn;
  if (turn < -kHalfPi) return -kPi - turn;
  return turn;
}

}  // namespace

Arc ArcThrough(TsComplex p0, TsComplex p1, TsComplex p2) {
  const double a0 = p0.re, b0 = p0.im, a1 = p1.re, a2 = p2.re;
  double b1 = p1.im, b2 = p2.im;
  // Midpoints of the chords P0P1 and P1P2, from the points as given.
  const double s01 = (b1 + b0) / 2, u01 = (a1 + a0) / 2;
  const double s12 = (b2 + b1) / 2, u12 = (a2 + a1) / 2;
  // The perpendicular bisectors y = m x + c of both chords; a horizontal chord would make its
  // bisector vertical, so its end is lifted by FLT_EPSILON.
  if (std::fabs(b1 - b0) < FLT_EPSILON) b1 = b0 + FLT_EPSILON;
  const double m1 = (a0 - a1) / (b1 - b0);
  if (std::fabs(b2 - b1) < FLT_EPSILON) b2 = b1 + FLT_EPSILON;
  double m2 = (a1 - a2) / (b2 - b1);
  const double c1 = s01 - m1 * u01;
  const double c2 = s12 - m2 * u12;
  if (std::fabs(m2 - m1) < FLT_EPSILON) m2 = m1 + FLT_EPSILON;

  Arc arc;
  arc.cy = (c2 * m1 - c1 * m2) / (m1 - m2);
  arc.cx = std::fabs(m1) >= FLT_EPSILON ? (arc.cy - c1) / m1 : (c1 - c2) / m2;
  arc.w0 = TsComplex(a0 - arc.cx, b0 - arc.cy);
  arc.w1 = TsComplex(a1 - arc.cx, b1 - arc.cy);
  const TsComplex w2(a2 - arc.cx, b2 - arc.cy);
  arc.step01 = FoldedTurn(arc.w0, arc.w1);
  arc.step12 = FoldedTurn(arc.w1, w2);
  return arc;
}

TsComplex RotateOnArc(const Arc& arc, TsComplex start, double theta) {
  const float c = static_cast<float>(std::cos(theta));
  const float s = static_cast<float>(std::sin(theta));
  const float re = static_cast<float>(double{start.re} * c - double{start.im} * s);
  const float im = static_cast<float>(double{start.re} * s + double{start.im} * c);
  return TsComplex(re + arc.cx, im + arc.cy);
}

MagPhaseLine::MagPhaseLine(double x0, double x1, TsComplex y0, TsComplex y1)
    : m_x0(x0), m_x1(x1), m_y0(y0) {
  const double m0 = Magnitude(y0);
  const double m1 = Magnitude(y1);
  m_slope = (m1 - m0) / (x1 - x0);
  m_intercept = m1 - m_slope * x1;
  m_turn = (y1 / y0).Phase();
}

TsComplex MagPhaseLine::At(double x) const {
  const double m = m_slope * x + m_intercept;
  if (m == 0.0) return TsComplex();
  const double theta = ((x - m_x0) / (m_x1 - m_x0)) * m_turn;
  const TsComplex turned = m_y0 * TsComplex(std::cos(theta), std::sin(theta));
  // m (cos phi, sin phi) with phi the angle of `turned`, without the arc tangent round trip;
  // a zero real part takes the +-pi/2 convention of TsComplex::Phase.
  if (turned.re == 0.0f) {
    const double phi = turned.Phase();
    return TsComplex(m * std::cos(phi), m * std::sin(phi));
  }
  const double scale = m / Magnitude(turned);
  return TsComplex(scale * turned.re, scale * turned.im);
}

}  // namespace LumenUtility
