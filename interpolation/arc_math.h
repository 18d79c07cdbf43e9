// Geometry of circular interpolation between two old points: the circle through three
// neighbouring points, and the magnitude/phase line used where the circle does not apply.
// Both are built once per old interval and then evaluated per new point, so a sweep that
// puts many new points into one interval pays the setup (an arc tangent, one complex
// division) once.
#pragma once

#include <cmath>

#include "interpolation/trig_table.h"
#include "lumen/core/ts_complex.h"

namespace LumenUtility {

// |v| from the float parts in double: squares of floats cannot overflow a double, so this
// needs no scaling as hypot does.
inline double Magnitude(TsComplex v) {
  return std::sqrt(double{v.re} * v.re + double{v.im} * v.im);
}

// Angle steps at or below this (radians, 0.05 degrees) are too small to define an arc.
inline constexpr double kMinimumArcStep = 0.00087266;
// sin(kMinimumArcStep)^2, the square of the smallest sine an arc's turns may have.
inline constexpr double kMinimumSineSquared = 0x1.98d89cbb1531p-21;

// The circle through three complex points P0, P1, P2 and the angle steps between them seen
// from its centre. Nearly equal imaginary parts and nearly parallel bisectors are nudged by
// FLT_EPSILON, so collinear or repeated points give a far-away centre and tiny steps (which
// the caller then rejects) rather than a division by zero.
struct Arc {
  double cx = 0.0;
  double cy = 0.0;
  TsComplex w0;  // P0 - centre, rounded to float
  TsComplex w1;  // P1 - centre, rounded to float
  // Cross and dot products w0 x w1, w1 x w2, w0 . w1 and w1 . w2 (w2 = P2 - centre) and the
  // squared lengths of w0, w1 and w2: the sine of a turn is its cross product over the product
  // of the lengths, its tangent the cross over the dot product.
  double cross01 = 0.0;
  double cross12 = 0.0;
  double dot01 = 0.0;
  double dot12 = 0.0;
  double norm0 = 0.0;
  double norm1 = 0.0;
  double norm2 = 0.0;

  // Whether both turns exceed kMinimumArcStep; false when a point sits on the centre or the
  // circle is not finite. Compares squares, so it needs neither a root nor an arcsine.
  bool TurnsAboveMinimum() const {
    // sin^2 > sin^2(minimum) for both turns, multiplied out; NaN fails the comparison.
    return cross01 * cross01 > kMinimumSineSquared * (norm0 * norm1) &&
           cross12 * cross12 > kMinimumSineSquared * (norm1 * norm2);
  }
  // The turns from P0 to P1 and from P1 to P2 in radians, positive anticlockwise, folded into
  // [-pi/2, pi/2] as the arcsine of their sine folds them (a turn of 0.6 pi reads as 0.4 pi):
  // a turn whose cosine is negative is reflected about pi/2, which atan(cross / |dot|) does.
  double Turn01(const TrigTable& trig) const { return trig.Atan(cross01 / std::fabs(dot01)); }
  double Turn12(const TrigTable& trig) const { return trig.Atan(cross12 / std::fabs(dot12)); }
};

// The perpendicular bisector y = m x + c of the chord from P = (ap, bp) to Q = (aq, bq), and
// 1 / m. Neighbouring circles of a sweep share a chord, and so its bisector; one whose
// imaginary parts lie within FLT_EPSILON (`nudged`) is not shared, as each circle lifts its
// end differently.
struct Bisector {
  double m = 0.0;
  double c = 0.0;
  double inverse = 0.0;
  bool nudged = true;
};

inline constexpr double kArcNudge = 1.1920928955078125e-07;  // FLT_EPSILON

inline Bisector BisectorOf(TsComplex p, TsComplex q) {
  const double ap = p.re, bp = p.im, aq = q.re, bq = q.im;
  Bisector bisector;
  bisector.m = (ap - aq) / (bq - bp);
  bisector.c = (bq + bp) / 2 - bisector.m * ((aq + ap) / 2);
  bisector.inverse = 1.0 / bisector.m;
  bisector.nudged = !(std::fabs(bq - bp) >= kArcNudge);
  return bisector;
}

// The arc through P0, P1, P2 (imaginary parts b1 and b2 as lifted) from the bisectors of its
// chords P0P1 (m1, c1, inverseM1 = 1 / m1) and P1P2 (m2, c2).
inline Arc ArcFromBisectors(double m1, double c1, double inverseM1, double m2, double c2, double a0,
                            double b0, double a1, double b1, double a2, double b2) {
  if (std::fabs(m2 - m1) < kArcNudge) m2 = m1 + kArcNudge;
  // Where the bisectors cross.
  const double inverseSpread = 1.0 / (m1 - m2);
  Arc arc;
  arc.cy = (c2 * m1 - c1 * m2) * inverseSpread;
  arc.cx = std::fabs(m1) >= kArcNudge ? (arc.cy - c1) * inverseM1 : (c1 - c2) / m2;
  arc.w0 = TsComplex(a0 - arc.cx, b0 - arc.cy);
  arc.w1 = TsComplex(a1 - arc.cx, b1 - arc.cy);
  const TsComplex w2(a2 - arc.cx, b2 - arc.cy);
  auto cross = [](TsComplex u, TsComplex v) { return double{u.re} * v.im - double{u.im} * v.re; };
  auto dot = [](TsComplex u, TsComplex v) { return double{u.re} * v.re + double{u.im} * v.im; };
  arc.cross01 = cross(arc.w0, arc.w1);
  arc.cross12 = cross(arc.w1, w2);
  arc.norm0 = dot(arc.w0, arc.w0);
  arc.norm1 = dot(arc.w1, arc.w1);
  arc.norm2 = dot(w2, w2);
  arc.dot01 = dot(arc.w0, arc.w1);
  arc.dot12 = dot(arc.w1, w2);
  return arc;
}

// Defined here rather than out of line: the resampling builds arcs for a block of intervals
// in one loop, which the processor overlaps only when nothing in it is a call.
inline Arc ArcThrough(TsComplex p0, TsComplex p1, TsComplex p2) {
  const double a0 = p0.re, b0 = p0.im, a1 = p1.re, a2 = p2.re;
  double b1 = p1.im, b2 = p2.im;
  // Midpoints of the chords P0P1 and P1P2, from the points as given.
  const double s01 = (b1 + b0) / 2, u01 = (a1 + a0) / 2;
  const double s12 = (b2 + b1) / 2, u12 = (a2 + a1) / 2;
  // The perpendicular bisectors y = m x + c of both chords; a horizontal chord would make its
  // bisector vertical, so its end is lifted by FLT_EPSILON.
  if (std::fabs(b1 - b0) < kArcNudge) b1 = b0 + kArcNudge;
  const double m1 = (a0 - a1) / (b1 - b0);
  if (std::fabs(b2 - b1) < kArcNudge) b2 = b1 + kArcNudge;
  const double m2 = (a1 - a2) / (b2 - b1);
  const double c1 = s01 - m1 * u01;
  const double c2 = s12 - m2 * u12;
  return ArcFromBisectors(m1, c1, 1.0 / m1, m2, c2, a0, b0, a1, b1, a2, b2);
}

// v * (cos theta + j sin theta), with cos and sin rounded to float as TsComplex holds them and
// the product rounded to float.
inline TsComplex Rotate(TsComplex v, double theta, const TrigTable& trig) {
  double sine, cosine;
  trig.SinCos(theta, sine, cosine);
  const float c = static_cast<float>(cosine);
  const float s = static_cast<float>(sine);
  return TsComplex(double{v.re} * c - double{v.im} * s, double{v.re} * s + double{v.im} * c);
}

// start rotated by theta (radians) about the arc's centre; cos and sin of theta and the sums
// rounded to float.
inline TsComplex RotateOnArc(const Arc& arc, TsComplex start, double theta, const TrigTable& trig) {
  const TsComplex turned = Rotate(start, theta, trig);
  return TsComplex(turned.re + arc.cx, turned.im + arc.cy);
}

// The straight line of magnitude through (x0, |y0|) and (x1, |y1|); stimulus in the caller's
// unit, x0 != x1.
class MagnitudeLine {
 public:
  MagnitudeLine(double x0, double x1, TsComplex y0, TsComplex y1);
  // The magnitude line at x, also beyond [x0, x1] (where it may turn negative).
  double At(double x) const { return m_slope * x + m_intercept; }

 private:
  double m_slope;      // magnitude per stimulus unit
  double m_intercept;  // magnitude at stimulus 0
};

// Magnitude linear and phase turned along the shorter way between (x0, y0) and (x1, y1);
// stimulus in the caller's unit, x0 != x1.
class MagPhaseLine {
 public:
  MagPhaseLine(double x0, double x1, TsComplex y0, TsComplex y1);
  // The value at x, also beyond [x0, x1]; (0, 0) where the magnitude line is exactly 0.
  TsComplex At(double x) const;

 private:
  double m_x0;
  double m_x1;
  TsComplex m_y0;
  MagnitudeLine m_magnitude;
  double m_turn;  // phase of y1 / y0 in (-pi, pi]
};

}  // namespace LumenUtility
