// Phase smoothing for circular interpolation: the phase of every resampled point is replaced
// by a blend of quadratic fits of the old trace's unwrapped phase, one fit through each old
// point and its two neighbours.
#pragma once

#include <cstddef>
#include <vector>

#include "lumen/core/ts_complex.h"

namespace LumenUtility {

// Solves the 3x3 system m * v = rhs by Gauss-Jordan elimination with partial pivoting.
// Returns false, leaving v unwritten, when the largest pivot available at some step is below
// 10000 * DBL_EPSILON in magnitude.
bool Solve3x3(const double m[3][3], const double rhs[3], double v[3]);

// The fitted phase of an old trace at new stimulus points. Fits are made only where the two
// neighbouring steps are within a factor of 5 of each other and the system is not singular;
// each is made when first needed and kept for the 255 old points after it, so a sweep of new
// points costs one fit per old point it passes.
// Thread-safety: confine to one thread. Ownership: borrows the old stimulus, which must outlive
// it and stay unchanged; holds the unwrapped phase (n floats) and 10 KB of fits.
class PhaseFit {
 public:
  // n old values `data` at the ascending stimulus `x` (NaN tolerated: it only spoils nearby
  // fits). With n < 3 no point has a fit.
  PhaseFit(int n, const double* x, const TsComplex* data);
  PhaseFit(const PhaseFit&) = delete;
  PhaseFit& operator=(const PhaseFit&) = delete;

  // The phase (radians, unwrapped) that replaces the phase of a resampled point at stimulus
  // `value`, written to `psi`. Returns false, leaving psi unwritten, where the point keeps its
  // value: it equals an old stimulus value, or neither neighbouring old point has a fit.
  bool PhaseAt(double value, double& psi);

  // PhaseAt for a value known to lie strictly between x[upper - 1] and x[upper], or below x[0]
  // with upper = 1, or above x[n - 1] with upper = n - 1, whose share of that interval
  // (value - x[upper - 1]) / (x[upper] - x[upper - 1]) is `share`; saves the search and the
  // division. Precondition n >= 3.
  bool PhaseBetween(std::ptrdiff_t upper, double value, double share, double& psi);

  // Makes, in one run, the fits of old points first .. last that are not made yet (at most
  // 256, else nothing): fits made one after the other overlap in the processor, where fits
  // made on demand wait for the work around them. Only a matter of speed.
  void Prepare(std::ptrdiff_t first, std::ptrdiff_t last);

 private:
  // Phase(x) = a x^2 + b x + c near one old point; `valid` false where no fit was made.
  struct Quadratic {
    double a = 0.0;
    double b = 0.0;
    double c = 0.0;
    bool valid = false;

    double At(double x) const { return a * x * x + b * x + c; }
  };
  // The fit through old points i - 1, i and i + 1, made or from the ring.
  // Precondition: 0 <= i <= n - 1.
  const Quadratic& FitAt(std::ptrdiff_t i);
  Quadratic MakeFit(std::ptrdiff_t i) const;

  const int m_n;
  const double* const m_x;
  std::vector<float> m_phase;
  std::ptrdiff_t m_hint = 0;  // where the previous lower-bound search ended
  // The fit of old point i sits in slot i % kRing, tagged with i.
  static constexpr int kRing = 256;
  std::ptrdiff_t m_tag[kRing];
  Quadratic m_ring[kRing];
};

}  // namespace LumenUtility
