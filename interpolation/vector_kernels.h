// Single-precision vector primitives behind the grid resamplers.
//
// Plain loops over contiguous arrays, written so the compiler can vectorise them: no calls
// into other translation units inside the loops, no branches that depend on earlier elements.
// Complex arrays are interleaved floats, real part first (TsComplex). Counts are numbers of
// elements (complex values count once); a count of 0 does nothing. Unless a function says
// otherwise, its arrays must not overlap.
#pragma once

#include <cstddef>
#include <cstdint>

#include "lumen/core/ts_complex.h"

namespace LumenUtility::VectorKernels {

// The interleaved floats of a TsComplex array (TsComplex is standard layout, real part
// first, no padding). Null stays null, so an empty array needs no valid pointer.
inline float* Floats(TsComplex* v) {
  return reinterpret_cast<float*>(v);
}
inline const float* Floats(const TsComplex* v) {
  return reinterpret_cast<const float*>(v);
}

// dst[k] = value for k < n.
void Fill(float* dst, std::size_t n, float value);

// dst[k] = first + slope * k for k < n (real ramp); n < 2^31.
void Ramp(float* dst, std::size_t n, float first, float slope);

// dst[k] = first + slope * k for k < n, with real and imaginary parts ramped independently;
// n < 2^31.
void Ramp(TsComplex* dst, std::size_t n, TsComplex first, TsComplex slope);

// v[k] *= factor for k < n, in place.
void Scale(float* v, std::size_t n, float factor);

// dst[k] = a[k] * b[k]; dst may be a or b.
void Multiply(const float* a, const float* b, float* dst, std::size_t n);

// dst[k] = a[k] * b[k] in complex arithmetic, formed in double and rounded to float once;
// dst may be a or b.
void Multiply(const TsComplex* a, const TsComplex* b, TsComplex* dst, std::size_t n);

// dst[k] = a[k] / b[k] in complex arithmetic, formed in double so |b|^2 neither overflows nor
// underflows for any float divisor. A divisor of exactly 0 + 0j counts as having squared
// magnitude 1.175494351e-38 (the smallest normal float), as TsComplex division does: a finite
// dividend then gives 0 + 0j instead of infinities. dst may be a or b.
void Divide(const TsComplex* a, const TsComplex* b, TsComplex* dst, std::size_t n);

// Magnitude (sqrt(re^2 + im^2), formed in double) and phase (atan2(im, re), radians in
// [-pi, pi]) of src[0 .. n). `magnitude` may overlay the first n floats of src: element k is
// read before float k is written, and float k never lies in a later element.
void CartToPolar(const TsComplex* src, float* magnitude, float* phase, std::size_t n);

// dst[k] = magnitude[k] * (cos, sin)(phase[k]), phase in radians.
void PolarToCart(const float* magnitude, const float* phase, TsComplex* dst, std::size_t n);

// 16-bit angle codes: rounds each value to the nearest integer (halves away from zero) and
// keeps it modulo 65536 in -32768 .. 32767, so a value that ran past +32767 comes back in at
// the bottom the way an angle passes through pi. Non-finite values give 0.
void ToAngleCode(const float* src, std::int16_t* dst, std::size_t n);

// Reverses the order of n elements in place.
void Reverse(float* v, std::size_t n);
void Reverse(TsComplex* v, std::size_t n);

}  // namespace LumenUtility::VectorKernels
