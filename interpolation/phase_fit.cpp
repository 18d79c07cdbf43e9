#include "interpolation/phase_fit.h"

#include <algorithm>
#include <cfloat>
#include <cmath>
#include <utility>

#include "core/phase_unwrap.h"
#include "interpolation/gallop_search.h"
#include "interpolation/trig_table.h"

namespace LumenUtility {
namespace {

// One row of the augmented system: coefficients of the three unknowns, then the right side.
struct Row {
  double u, v, w, rhs;
};

// Exchanges the rows when `exchange` holds. A branch, not selects: along a sweep the pivot
// choice is the same fit after fit, so the branch is predicted, where selects would cost
// three instructions for each of the eight values moved.
inline void ExchangeIf(bool exchange, Row& p, Row& q) {
  if (exchange) std::swap(p, q);
}

// A pivot below this magnitude (or NaN) makes the system singular.
inline bool Usable(double pivot) {
  return std::fabs(pivot) >= 10000 * DBL_EPSILON;
}

}  // namespace

bool Solve3x3(const double m[3][3], const double rhs[3], double v[3]) {
  // Gauss-Jordan on the augmented rows, written out column by column. Partial pivoting: the
  // row with the largest entry in the column (the first of equals) becomes the pivot row.
  Row r0{m[0][0], m[0][1], m[0][2], rhs[0]};
  Row r1{m[1][0], m[1][1], m[1][2], rhs[1]};
  Row r2{m[2][0], m[2][1], m[2][2], rhs[2]};

  ExchangeIf(std::fabs(r1.u) > std::fabs(r0.u), r0, r1);
  ExchangeIf(std::fabs(r2.u) > std::fabs(r0.u), r0, r2);
  if (!Usable(r0.u)) return false;
  double scale = 1.0 / r0.u;
  r0 = {1.0, r0.v * scale, r0.w * scale, r0.rhs * scale};
  r1 = {0.0, r1.v - r1.u * r0.v, r1.w - r1.u * r0.w, r1.rhs - r1.u * r0.rhs};
  r2 = {0.0, r2.v - r2.u * r0.v, r2.w - r2.u * r0.w, r2.rhs - r2.u * r0.rhs};

  ExchangeIf(std::fabs(r2.v) > std::fabs(r1.v), r1, r2);
  if (!Usable(r1.v)) return false;
  scale = 1.0 / r1.v;
  r1 = {0.0, 1.0, r1.w * scale, r1.rhs * scale};
  r0 = {1.0, 0.0, r0.w - r0.v * r1.w, r0.rhs - r0.v * r1.rhs};
  r2 = {0.0, 0.0, r2.w - r2.v * r1.w, r2.rhs - r2.v * r1.rhs};

  if (!Usable(r2.w)) return false;
  const double last = r2.rhs / r2.w;
  v[0] = r0.rhs - r0.w * last;
  v[1] = r1.rhs - r1.w * last;
  v[2] = last;
  return true;
}

PhaseFit::PhaseFit(int n, const double* x, const TsComplex* data) : m_n(n), m_x(x) {
  std::fill(m_tag, m_tag + kRing, -1);
  if (n < 3) return;
  m_phase.resize(n);
  // As FormatUnwrappedPhase unwraps, with the table arc tangent (the library's atan2 would be
  // a third of the resampling's time). The angles are taken 256 at a time ahead of the
  // unwrapping, whose steps wait on each other while the angles do not.
  const TrigTable& trig = TrigTable::Get();
  constexpr int kChunk = 256;
  double angle[kChunk];
  int chunkStart = -kChunk;
  UnwrapPhase(m_phase.data(), 0, n, [&](int i) {
    if (i >= chunkStart + kChunk) {
      chunkStart = i;
      const int count = std::min(kChunk, n - i);
      for (int k = 0; k < count; ++k) angle[k] = trig.Angle(data[i + k]);
    }
    return angle[i - chunkStart];
  });
}

PhaseFit::Quadratic PhaseFit::MakeFit(std::ptrdiff_t i) const {
  if (i < 1 || i + 1 >= m_n) return {};
  const double* x = m_x;
  // Only where the two steps are within a factor of 5: a lopsided triple makes the parabola
  // swing wildly over the longer step.
  const double before = std::fabs(x[i - 1] - x[i]), after = std::fabs(x[i + 1] - x[i]);
  // Steps within a factor of 4 (the products by powers of 2 are exact) are within 5 without
  // the division.
  const bool near = before > 0.25 * after && before < 4.0 * after;
  if (!near) {
    const double ratio = before / after;
    if (!(ratio > 0.2 && ratio < 5.0)) return {};
  }
  double m[3][3], rhs[3], v[3];
  for (int j = 0; j < 3; ++j) {
    const double xj = x[i - 1 + j];
    m[j][0] = xj * xj;
    m[j][1] = xj;
    m[j][2] = 1.0;
    rhs[j] = m_phase[i - 1 + j];
  }
  if (!Solve3x3(m, rhs, v)) return {};
  return {v[0], v[1], v[2], true};
}

const PhaseFit::Quadratic& PhaseFit::FitAt(std::ptrdiff_t i) {
  const std::ptrdiff_t slot = i % kRing;
  if (m_tag[slot] != i) {
    m_tag[slot] = i;
    m_ring[slot] = MakeFit(i);
  }
  return m_ring[slot];
}

void PhaseFit::Prepare(std::ptrdiff_t first, std::ptrdiff_t last) {
  first = std::max<std::ptrdiff_t>(first, 0);
  last = std::min<std::ptrdiff_t>(last, m_n - 1);
  if (m_n < 3 || last - first >= kRing) return;
  for (std::ptrdiff_t i = first; i <= last; ++i) FitAt(i);
}

bool PhaseFit::PhaseAt(double value, double& psi) {
  const std::ptrdiff_t n = m_n;
  if (n < 3) return false;
  const double* x = m_x;
  const std::ptrdiff_t p =
      GallopBoundary(n, m_hint, [&](std::ptrdiff_t i) { return x[i] >= value; });
  m_hint = p;
  if (p < n && x[p] == value) return false;
  const std::ptrdiff_t upper = p == n ? n - 1 : (p == 0 ? 1 : p);
  const double share = (value - x[upper - 1]) / (x[upper] - x[upper - 1]);
  return PhaseBetween(upper, value, share, psi);
}

bool PhaseFit::PhaseBetween(std::ptrdiff_t upper, double value, double share, double& psi) {
  const Quadratic& high = FitAt(upper);
  const Quadratic& low = FitAt(upper - 1);
  if (high.valid && low.valid) {
    psi = share * high.At(value) + (1.0 - share) * low.At(value);
  } else if (high.valid) {
    psi = high.At(value);
  } else if (low.valid) {
    psi = low.At(value);
  } else {
    return false;
  }
  return true;
}

}  // namespace LumenUtility
