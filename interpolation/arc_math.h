// Geometry of circular interpolation between two old points: the circle through three
// neighbouring points, and the magnitude/phase line used where the circle does not apply.
// Both are built once per old interval and then evaluated per new point, so a sweep that
// puts many new points into one interval pays the setup (two arc tangents, one complex
// division) once.
#pragma once

#include "lumen/core/ts_complex.h"

namespace LumenUtility {

// Angle steps at or below this (radians, 0.05 degrees) are too small to define an arc.
inline constexpr double kMinimumArcStep = 0.00087266;

// The circle through three complex points P0, P1, P2 and the angle steps between them seen
// from its centre. Nearly equal imaginary parts and nearly parallel bisectors are nudged by
// FLT_EPSILON, so collinear or repeated points give a far-away centre and tiny steps (which
// the caller then rejects) rather than a division by zero.
struct Arc {
  double cx = 0.0;
  double cy = 0.0;
  TsComplex w0;  // P0 - centre, rounded to float
  TsComplex w1;  // P1 - centre, rounded to float
  // Turn from P0 to P1 and from P1 to P2 in radians, folded into [-pi/2, pi/2] (the arcsine
  // of the sine of the turn), positive anticlockwise.
  double step01 = 0.0;
  double step12 = 0.0;
};

Arc ArcThrough(TsComplex p0, TsComplex p1, TsComplex p2);

// start rotated by theta (radians) about the arc's centre; cos and sin of theta and the sums
// rounded to float.
TsComplex RotateOnArc(const Arc& arc, TsComplex start, double theta);

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
  double m_slope;      // magnitude per stimulus unit
  double m_intercept;  // magnitude at stimulus 0
  double m_turn;       // phase of y1 / y0 in (-pi, pi]
};

}  // namespace LumenUtility
