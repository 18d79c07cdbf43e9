#include "interpolation/phase_fit.h"

#include <cfloat>
#include <cmath>
#include <utility>
#include <vector>

#include "interpolation/gallop_search.h"
#include "lumen/core/vector_formats.h"

namespace LumenUtility {
namespace {

// Phase(x) = a x^2 + b x + c near one old point; `valid` false where no fit was made.
struct Quadratic {
  double a = 0.0;
  double b = 0.0;
  double c = 0.0;
  bool valid = false;

  double At(double x) const { return a * x * x + b * x + c; }
};

}  // namespace

bool SolveByInverse3x3(const double m[3][3], const double rhs[3], double v[3]) {
  double a[3][3], inverse[3][3] = {{1, 0, 0}, {0, 1, 0}, {0, 0, 1}};
  for (int r = 0; r < 3; ++r) {
    for (int c = 0; c < 3; ++c) a[r][c] = m[r][c];
  }
  for (int col = 0; col < 3; ++col) {
    int pivot = col;
    for (int r = col + 1; r < 3; ++r) {
      if (std::fabs(a[r][col]) > std::fabs(a[pivot][col])) pivot = r;
    }
    // Catches NaN too: the comparison fails.
    if (!(std::fabs(a[pivot][col]) >= 10000 * DBL_EPSILON)) return false;
    std::swap(a[pivot], a[col]);
    std::swap(inverse[pivot], inverse[col]);
    const double scale = 1.0 / a[col][col];
    for (int c = 0; c < 3; ++c) {
      a[col][c] *= scale;
      inverse[col][c] *= scale;
    }
    for (int r = 0; r < 3; ++r) {
      if (r == col) continue;
      const double factor = a[r][col];
      for (int c = 0; c < 3; ++c) {
        a[r][c] -= factor * a[col][c];
        inverse[r][c] -= factor * inverse[col][c];
      }
    }
  }
  for (int r = 0; r < 3; ++r) {
    v[r] = inverse[r][0] * rhs[0] + inverse[r][1] * rhs[1] + inverse[r][2] * rhs[2];
  }
  return true;
}

void ApplyPhaseFit(int n, const double* x, const TsComplex* data, int newCount,
                   const double* newStimulus, TsComplex* newData) {
  if (n < 3) return;
  std::vector<float> phase(n);
  FormatUnwrappedPhase(data, phase.data(), 0, n);

  std::vector<Quadratic> fits(n);
  for (int i = 1; i + 1 < n; ++i) {
    // Only where the two steps are within a factor of 5: a lopsided triple makes the parabola
    // swing wildly over the longer step.
    const double ratio = std::fabs(x[i - 1] - x[i]) / std::fabs(x[i + 1] - x[i]);
    if (!(ratio > 0.2 && ratio < 5.0)) continue;
    double m[3][3], rhs[3], v[3];
    for (int j = 0; j < 3; ++j) {
      const double xj = x[i - 1 + j];
      m[j][0] = xj * xj;
      m[j][1] = xj;
      m[j][2] = 1.0;
      rhs[j] = phase[i - 1 + j];
    }
    if (SolveByInverse3x3(m, rhs, v)) fits[i] = {v[0], v[1], v[2], true};
  }

  std::ptrdiff_t p = 0;
  for (int k = 0; k < newCount; ++k) {
    const double value = newStimulus[k];
    p = GallopBoundary(n, p, [&](std::ptrdiff_t i) { return x[i] >= value; });
    if (p < n && x[p] == value) continue;
    const std::ptrdiff_t hi = p == n ? n - 1 : (p == 0 ? 1 : p);
    const Quadratic& upper = fits[hi];
    const Quadratic& lower = fits[hi - 1];
    double psi;
    if (upper.valid && lower.valid) {
      const double w = (value - x[hi - 1]) / (x[hi] - x[hi - 1]);
      psi = w * upper.At(value) + (1.0 - w) * lower.At(value);
    } else if (upper.valid) {
      psi = upper.At(value);
    } else if (lower.valid) {
      psi = lower.At(value);
    } else {
      continue;
    }
    const TsComplex v = newData[k];
    const double magnitude = std::sqrt(double{v.re} * v.re + double{v.im} * v.im);
    newData[k] = TsComplex(magnitude * std::cos(psi), magnitude * std::sin(psi));
  }
}

}  // namespace LumenUtility
