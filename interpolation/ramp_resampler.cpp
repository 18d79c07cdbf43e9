#include "interpolation/ramp_resampler.h"

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "interpolation/stimulus_view.h"
#include "interpolation/vector_kernels.h"

namespace LumenUtility {

namespace {

// Grid indices are formed in double and clamped before conversion; 2^40 is far above any
// grid length an int can state.
constexpr double kIndexCeiling = 1099511627776.0;

std::int64_t ToIndex(double v) {
  if (!(v >= -1.0)) return -1;  // also NaN: the run is empty
  return static_cast<std::int64_t>(std::min(v, kIndexCeiling));
}
std::int64_t FloorIndex(double v) {
  return ToIndex(std::floor(v));
}
std::int64_t CeilIndex(double v) {
  return ToIndex(std::ceil(v));
}

void FillUnreached(float* out, std::size_t n) {
  VectorKernels::Fill(out, n, kTarnFillValue);
}
void FillUnreached(TsComplex* out, std::size_t n) {
  VectorKernels::Fill(VectorKernels::Floats(out), 2 * n, kTarnFillValue);
}

// Difference to the next sample, taken the short way round for a wrapped quantity.
double Difference(float from, float to, float period) {
  double d = double{to} - from;
  if (period > 0.0f) {
    if (d > 0.5 * period) {
      d -= period;
    } else if (d < -0.5 * period) {
      d += period;
    }
  }
  return d;
}

// First value and per-grid-step slope of the ramp through sample y0 rising by `diff` over
// the interval. `scale` is grid step / interval width; `offset` is the run's first grid index
// minus the position of y0 in grid steps.
float RampStart(float y0, double diff, double scale, double offset, float& slope) {
  const double s = diff * scale;
  slope = static_cast<float>(s);
  return static_cast<float>(y0 + s * offset);
}

void EmitRun(const float* values, int i, int next, double scale, double offset, float period,
             float* out, std::size_t n) {
  float slope;
  const float first =
      RampStart(values[i], Difference(values[i], values[next], period), scale, offset, slope);
  VectorKernels::Ramp(out, n, first, slope);
}

void EmitRun(const TsComplex* values, int i, int next, double scale, double offset, float,
             TsComplex* out, std::size_t n) {
  TsComplex first, slope;
  first.re = RampStart(values[i].re, Difference(values[i].re, values[next].re, 0.0f), scale, offset,
                       slope.re);
  first.im = RampStart(values[i].im, Difference(values[i].im, values[next].im, 0.0f), scale, offset,
                       slope.im);
  VectorKernels::Ramp(out, n, first, slope);
}

template <typename T>
void Resample(const T* values, const float* stimulus, int count, KernelGrid grid, T* out,
              float period) {
  if (grid.points <= 0) return;
  const auto points = static_cast<std::size_t>(grid.points);
  if (count <= 0 || !std::isfinite(grid.start) || !std::isfinite(grid.stop)) {
    FillUnreached(out, points);
    return;
  }
  if (count == 1) {
    std::fill(out, out + points, values[0]);
    return;
  }
  if (grid.points == 1) grid.stop = grid.start;
  if (grid.stop < grid.start) {
    Resample(values, stimulus, count, KernelGrid{grid.stop, grid.start, grid.points}, out, period);
    VectorKernels::Reverse(out, points);
    return;
  }
  if (grid.points > 1 && grid.stop == grid.start) {
    Resample(values, stimulus, count, KernelGrid{grid.start, grid.start, 1}, out, period);
    std::fill(out + 1, out + points, out[0]);
    return;
  }

  const StimulusView<float> x(stimulus, count);
  const double step = grid.points > 1 ? (grid.stop - grid.start) / (grid.points - 1)
                                      : (x[count - 1] - x[0]) / (count - 1);
  if (!(step > 0.0) || !std::isfinite(step)) {
    FillUnreached(out, points);
    return;
  }

  const int last = count - 2;  // last interval
  const int i0 = std::clamp(x.LastAtOrBelow(grid.start), 0, last);
  const int i1 = std::clamp(x.FirstAtOrAbove(grid.stop) - 1, i0, last);
  const auto final_index = static_cast<std::int64_t>(points) - 1;
  std::int64_t k0 = 0;
  for (int i = i0; i <= i1 && k0 <= final_index; ++i) {
    const double xa = x[i], xb = x[i + 1];
    // Interior intervals end at the last grid point not beyond their upper stimulus point, so
    // every grid point is interpolated in the interval it lies in; the last one used reaches
    // up to one grid step further.
    const double end = (xb - grid.start) / step;
    const std::int64_t k1 = std::min(i == i1 ? CeilIndex(end) : FloorIndex(end), final_index);
    if (k1 < k0) continue;
    const double width = xb - xa;
    const double scale = width > 0.0 ? step / width : 0.0;
    const double offset = static_cast<double>(k0) - (xa - grid.start) / step;
    EmitRun(values, x.Physical(i), x.Physical(i + 1), scale, offset, period, out + k0,
            static_cast<std::size_t>(k1 - k0 + 1));
    k0 = k1 + 1;
  }
  if (k0 <= final_index) FillUnreached(out + k0, points - static_cast<std::size_t>(k0));
}

}  // namespace

void RampResample(const float* values, const float* stimulus, int count, const KernelGrid& grid,
                  float* out, float period) {
  Resample(values, stimulus, count, grid, out, period);
}

void RampResample(const TsComplex* values, const float* stimulus, int count, const KernelGrid& grid,
                  TsComplex* out) {
  Resample(values, stimulus, count, grid, out, 0.0f);
}

}  // namespace LumenUtility
