#include "interpolation/arc_math.h"

#include <cmath>

#include "interpolation/trig_table.h"

namespace LumenUtility {
MagnitudeLine::MagnitudeLine(double x0, double x1, TsComplex y0, TsComplex y1) {
  const double m0 = Magnitude(y0);
  const double m1 = Magnitude(y1);
  m_slope = (m1 - m0) / (x1 - x0);
  m_intercept = m1 - m_slope * x1;
}

MagPhaseLine::MagPhaseLine(double x0, double x1, TsComplex y0, TsComplex y1)
    : m_x0(x0), m_x1(x1), m_y0(y0), m_magnitude(x0, x1, y0, y1), m_turn((y1 / y0).Phase()) {}

TsComplex MagPhaseLine::At(double x) const {
  const double m = m_magnitude.At(x);
  if (m == 0.0) return TsComplex();
  const double theta = ((x - m_x0) / (m_x1 - m_x0)) * m_turn;
  const TsComplex turned = Rotate(m_y0, theta, TrigTable::Get());
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
