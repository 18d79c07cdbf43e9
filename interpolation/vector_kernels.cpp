#include "interpolation/vector_kernels.h"

#include <math.h>  // sincosf (GNU)

#include <algorithm>
#include <cmath>

namespace LumenUtility::VectorKernels {

namespace {

// Smallest normal float: stands in for the squared magnitude of a zero divisor.
constexpr double kZeroDivisorGuard = 1.175494351e-38;

// Rounded angle codes below 2^31 in magnitude convert through int32 directly; anything larger
// (only reachable by extrapolating far outside the data) is reduced modulo 65536 first.
constexpr double kDirectConversionLimit = 2147483520.0;

}  // namespace

void Fill(float* dst, std::size_t n, float value) {
  std::fill(dst, dst + n, value);
}

// Ramps index with int32: grid lengths are ints, and int32-to-float converts four lanes at a
// time where a 64-bit unsigned index has no vector conversion.
void Ramp(float* dst, std::size_t n, float first, float slope) {
  const auto count = static_cast<std::int32_t>(n);
  for (std::int32_t k = 0; k < count; ++k) dst[k] = first + slope * static_cast<float>(k);
}

void Ramp(TsComplex* dst, std::size_t n, TsComplex first, TsComplex slope) {
  float* out = Floats(dst);
  const auto count = static_cast<std::int32_t>(n);
  for (std::int32_t k = 0; k < count; ++k) {
    const float step = static_cast<float>(k);
    out[2 * k] = first.re + slope.re * step;
    out[2 * k + 1] = first.im + slope.im * step;
  }
}

void Scale(float* v, std::size_t n, float factor) {
  for (std::size_t k = 0; k < n; ++k) v[k] *= factor;
}

void Multiply(const float* a, const float* b, float* dst, std::size_t n) {
  for (std::size_t k = 0; k < n; ++k) dst[k] = a[k] * b[k];
}

void Multiply(const TsComplex* a, const TsComplex* b, TsComplex* dst, std::size_t n) {
  for (std::size_t k = 0; k < n; ++k) {
    const double ar = a[k].re, ai = a[k].im, br = b[k].re, bi = b[k].im;
    dst[k].re = static_cast<float>(ar * br - ai * bi);
    dst[k].im = static_cast<float>(ar * bi + ai * br);
  }
}

void Divide(const TsComplex* a, const TsComplex* b, TsComplex* dst, std::size_t n) {
  for (std::size_t k = 0; k < n; ++k) {
    const double ar = a[k].re, ai = a[k].im, br = b[k].re, bi = b[k].im;
    const double d = br * br + bi * bi;
    const double inv = 1.0 / (d == 0.0 ? kZeroDivisorGuard : d);
    dst[k].re = static_cast<float>((ar * br + ai * bi) * inv);
    dst[k].im = static_cast<float>((ai * br - ar * bi) * inv);
  }
}

void CartToPolar(const TsComplex* src, float* magnitude, float* phase, std::size_t n) {
  for (std::size_t k = 0; k < n; ++k) {
    const float re = src[k].re, im = src[k].im;
    phase[k] = std::atan2(im, re);
    magnitude[k] = static_cast<float>(std::sqrt(double{re} * re + double{im} * im));
  }
}

void PolarToCart(const float* magnitude, const float* phase, TsComplex* dst, std::size_t n) {
  for (std::size_t k = 0; k < n; ++k) {
    // One joint call: g++ does not merge cos and sin itself while they may set errno.
    float s, c;
    ::sincosf(phase[k], &s, &c);
    dst[k].re = magnitude[k] * c;
    dst[k].im = magnitude[k] * s;
  }
}

void ToAngleCode(const float* src, std::int16_t* dst, std::size_t n) {
  for (std::size_t k = 0; k < n; ++k) {
    double r = std::round(double{src[k]});
    if (!std::isfinite(r)) {
      dst[k] = 0;
      continue;
    }
    if (std::abs(r) > kDirectConversionLimit) r = std::fmod(r, 65536.0);
    // Conversion to a narrower signed type keeps the value modulo 2^16.
    dst[k] = static_cast<std::int16_t>(static_cast<std::int32_t>(r));
  }
}

void Reverse(float* v, std::size_t n) {
  std::reverse(v, v + n);
}

void Reverse(TsComplex* v, std::size_t n) {
  std::reverse(v, v + n);
}

}  // namespace LumenUtility::VectorKernels
