#include "interpolation/cubic_resampler.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>

#include "interpolation/stimulus_view.h"
#include "interpolation/vector_kernels.h"

namespace LumenUtility {

namespace {

// The interval's cubic in the normalised position u = t / h (0 at the lower stimulus point,
// 1 at the upper): y0 + u * (B + u * (C + u * D)), with B = b h, C = c h^2, D = d h^3 of the
// cubic y0 + b t + c t^2 + d t^3. Working in u keeps h^3 out of every divisor, so a very
// close pair of stimulus points cannot underflow it to zero.
struct Cubic {
  double lower, inv_h, y0, B, C, D;
  double operator()(double g) const {
    const double u = (g - lower) * inv_h;
    return y0 + u * (B + u * (C + u * D));
  }
};

// Slope of the chord over `span`; 0 when the span is empty or unordered, which a
// non-decreasing stimulus never produces.
double ChordSlope(double rise, double span) {
  return span > 0.0 ? rise / span : 0.0;
}

// Cubic of interval (i - 1, i) of the ascending view, 1 <= i <= count - 1. The caller has a
// grid point g with x[i - 1] < g <= x[i], so h > 0 unless a stimulus value is NaN.
Cubic IntervalCubic(const float* values, const StimulusView<double>& x, int count, int i) {
  const int j = i - 1, e = i;
  const int jm = std::max(i - 2, 0), jp = std::min(i + 1, count - 1);
  auto y = [&](int k) { return double{values[x.Physical(k)]}; };
  const double h = x[e] - x[j];
  const double y0 = y(j), y1 = y(e), rise = y1 - y0;
  // Central differences scaled to the interval: B at x[j], S1 at x[e].
  double B = ChordSlope(y(e) - y(jm), x[e] - x[jm]) * h;
  const double S1 = ChordSlope(y(jp) - y(j), x[jp] - x[j]) * h;
  double C, D;
  if (jm == j) {
    // First interval: no curvature at the outer end, slope S1 at the inner end.
    B = 1.5 * (rise - S1 / 3.0);
    C = 0.0;
    D = rise - B;
  } else if (e == jp) {
    // Last interval: slope B at the inner end, no curvature at the outer end.
    C = 1.5 * (rise - B);
    D = rise - C - B;
  } else {
    D = B + S1 - 2.0 * rise;
    C = rise - D - B;
  }
  return Cubic{x[j], 1.0 / h, y0, B, C, D};
}

}  // namespace

void CubicResample(const float* values, const double* stimulus, int count, const KernelGrid& grid,
                   float* out) {
  if (grid.points <= 0) return;
  const auto points = static_cast<std::size_t>(grid.points);
  if (count <= 0 || !std::isfinite(grid.start) || !std::isfinite(grid.stop)) {
    VectorKernels::Fill(out, points, std::numeric_limits<float>::quiet_NaN());
    return;
  }
  if (grid.points > 1 && grid.stop < grid.start) {
    CubicResample(values, stimulus, count, KernelGrid{grid.stop, grid.start, grid.points}, out);
    VectorKernels::Reverse(out, points);
    return;
  }

  const StimulusView<double> x(stimulus, count);
  const double step = grid.points > 1 ? (grid.stop - grid.start) / (grid.points - 1) : 0.0;
  auto g = [&](std::size_t k) { return grid.start + static_cast<double>(k) * step; };

  std::size_t k = 0;
  const float head = values[x.Physical(0)];
  while (k < points && g(k) <= x[0]) out[k++] = head;
  // Grid and stimulus both ascend, so one forward pass pairs each grid point with the first
  // stimulus point at or above it; intervals without grid points cost one comparison.
  for (int i = 1; i < count && k < points; ++i) {
    const double upper = x[i];
    if (!(g(k) <= upper)) continue;
    const Cubic cubic = IntervalCubic(values, x, count, i);
    do {
      out[k] = static_cast<float>(cubic(g(k)));
      ++k;
    } while (k < points && g(k) <= upper);
  }
  // Beyond the last stimulus point the last sample holds.
  if (k < points) VectorKernels::Fill(out + k, points - k, values[x.Physical(count - 1)]);
}

}  // namespace LumenUtility
