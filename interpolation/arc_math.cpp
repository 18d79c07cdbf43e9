#include "interpolation/arc_math.h"

#include <algorithm>
#include <cfloat>
#include <cmath>

namespace LumenUtility {
namespace {

// |v|. Squares of floats cannot overflow a double, so this needs no scaling as hypot does.
double Magnitude(TsComplex v) {
  return std::sqrt(double{v.re} * v.re + double{v.im} * v.im);
}

// v * (cos theta + j sin theta), with cos and sin rounded to float as TsComplex holds them and
// the product rounded to float.
TsComplex Rotate(TsComplex v, double theta) {
  const float c = static_cast<float>(std::cos(theta));
  const float s = static_cast<float>(std::sin(theta));
  return TsComplex(double{v.re} * c - double{v.im} * s, double{v.re} * s + double{v.im} * c);
}

double Cross(TsComplex u, TsComplex v) {
  return double{u.re} * v.im - double{u.im} * v.re;
}
double Norm(TsComplex v) {
  return double{v.re} * v.re + double{v.im} * v.im;
}

double FoldedTurn(double cross, double normU, double normV) {
  return std::asin(std::clamp(cross / std::sqrt(normU * normV), -1.0, 1.0));
}

// Squared sine of the smallest turn the arc is used for.
const double kMinimumSineSquared = std::sin(kMinimumArcStep) * std::sin(kMinimumArcStep);

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

  // Where the bisectors cross. The reciprocals are taken side by side rather than one after
  // the other: the divisions are most of this function's time.
  const double inverseM1 = 1.0 / m1;
  const double inverseSpread = 1.0 / (m1 - m2);
  Arc arc;
  arc.cy = (c2 * m1 - c1 * m2) * inverseSpread;
  arc.cx = std::fabs(m1) >= FLT_EPSILON ? (arc.cy - c1) * inverseM1 : (c1 - c2) / m2;
  arc.w0 = TsComplex(a0 - arc.cx, b0 - arc.cy);
  arc.w1 = TsComplex(a1 - arc.cx, b1 - arc.cy);
  const TsComplex w2(a2 - arc.cx, b2 - arc.cy);
  arc.cross01 = Cross(arc.w0, arc.w1);
  arc.cross12 = Cross(arc.w1, w2);
  arc.norm0 = Norm(arc.w0);
  arc.norm1 = Norm(arc.w1);
  arc.norm2 = Norm(w2);
  return arc;
}

bool Arc::TurnsAboveMinimum() const {
  // sin^2 > sin^2(minimum) for both turns, multiplied out; NaN fails the comparison.
  return cross01 * cross01 > kMinimumSineSquared * (norm0 * norm1) &&
         cross12 * cross12 > kMinimumSineSquared * (norm1 * norm2);
}

double Arc::Turn01() const {
  return FoldedTurn(cross01, norm0, norm1);
}
double Arc::Turn12() const {
  return FoldedTurn(cross12, norm1, norm2);
}

TsComplex RotateOnArc(const Arc& arc, TsComplex start, double theta) {
  const TsComplex turned = Rotate(start, theta);
  return TsComplex(turned.re + arc.cx, turned.im + arc.cy);
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
  const TsComplex turned = Rotate(m_y0, theta);
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
