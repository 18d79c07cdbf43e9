#include "lumen/interpolation/tarn_interpolation.h"

#include <algorithm>
#include <cstddef>
#include <memory>
#include <new>

#include "interpolation/cubic_resampler.h"
#include "interpolation/ramp_resampler.h"
#include "interpolation/vector_kernels.h"
#include "lumen/platform/error_codes.h"

namespace LumenUtility {

namespace {

// Phase codes span 2^16 per turn; ramps between codes take the short way round that circle.
constexpr float kPhaseCodePeriod = 65536.0f;

// Traces of up to 1024 points (the common 201- and 401-point sweeps among them) keep their
// phase scratch on the stack (4 KB); longer ones take it from the heap once per call.
constexpr int kStackScratchFloats = 1024;

// Steps of an unwrapped phase trace are judged and corrected with these float constants, so
// the unwrapped values match a single-precision unwrap exactly.
constexpr float kPi = 3.1415927f;
constexpr float kTwoPi = 6.2831855f;

std::size_t ProductCount(int resultCount, int points) {
  return static_cast<std::size_t>(std::max(0, std::min(resultCount, points)));
}

// Adds to each phase the multiple of 2 pi that removes the jumps larger than pi between
// neighbours (judged on the values as given), in place.
void UnwrapPhase(float* phase, int count) {
  float offset = 0.0f;
  float previous = count > 0 ? phase[0] : 0.0f;
  for (int k = 1; k < count; ++k) {
    const float step = phase[k] - previous;
    previous = phase[k];
    if (step > kPi) {
      offset -= kTwoPi;
    } else if (step < -kPi) {
      offset += kTwoPi;
    }
    phase[k] += offset;
  }
}

// Writes phase codes of the count samples in data to phaseCode and the magnitudes over the
// first count floats of data.
void CodePhase(TsComplex* data, const float* stimulus, int count, const KernelGrid& grid,
               float* resampled, std::int16_t* phaseCode, std::size_t codes) {
  float stack_scratch[kStackScratchFloats];
  std::unique_ptr<float[]> heap_scratch;
  float* phase = stack_scratch;
  if (count > kStackScratchFloats) {
    heap_scratch.reset(new (std::nothrow) float[static_cast<std::size_t>(count)]);
    if (!heap_scratch) throw LUMEN_E_KERNEL_BUFFER;
    phase = heap_scratch.get();
  }
  const auto n = static_cast<std::size_t>(std::max(count, 0));
  VectorKernels::CartToPolar(data, VectorKernels::Floats(data), phase, n);
  VectorKernels::Scale(phase, n, kTarnPhaseCodePerRadian);
  RampResample(phase, stimulus, count, grid, resampled, kPhaseCodePeriod);
  VectorKernels::ToAngleCode(resampled, phaseCode, codes);
}

}  // namespace

void TarnInterpolation(const TsComplex* data, const float* stimulus, int count,
                       TsComplex* resampled, const TsComplex* factor, TsComplex* result,
                       double start, double stop, int points, int resultCount) {
  RampResample(data, stimulus, count, KernelGrid{start, stop, points}, resampled);
  VectorKernels::Multiply(resampled, factor, result, ProductCount(resultCount, points));
}

void TarnInterpolation(TsComplex* data, const float* stimulus, int count, float* resampled,
                       const float* factor, float* result, double start, double stop, int points,
                       int resultCount, std::int16_t* phaseCode) {
  const KernelGrid grid{start, stop, points};
  const std::size_t products = ProductCount(resultCount, points);
  if (phaseCode != nullptr) CodePhase(data, stimulus, count, grid, resampled, phaseCode, products);
  RampResample(VectorKernels::Floats(data), stimulus, count, grid, resampled);
  VectorKernels::Multiply(resampled, factor, result, products);
}

void TarnCubicInterpolation(const float* magnitude, float* phase, const double* stimulus, int count,
                            float* resampledMagnitude, float* resampledPhase, TsComplex* resampled,
                            const TsComplex* operand, TsComplex* result, double start, double stop,
                            int points, bool withPhase) {
  if (points <= 0) return;
  const KernelGrid grid{start, stop, points};
  const auto n = static_cast<std::size_t>(points);
  CubicResample(magnitude, stimulus, count, grid, resampledMagnitude);
  if (withPhase) {
    UnwrapPhase(phase, count);
    CubicResample(phase, stimulus, count, grid, resampledPhase);
    VectorKernels::PolarToCart(resampledMagnitude, resampledPhase, resampled, n);
  } else {
    for (std::size_t k = 0; k < n; ++k) resampled[k] = TsComplex(resampledMagnitude[k], 0.0);
  }
  VectorKernels::Divide(operand, resampled, result, n);
}

}  // namespace LumenUtility
