/// @file
/// Vector-kernel interpolation: measured traces carried from their stimulus list onto an evenly
/// spaced grid in single precision, with a per-point factor or divisor applied in the same call.
///
/// The grid has `points` values start + k * (stop - start) / (points - 1), in the stimulus unit
/// (usually Hz). All three functions keep no state, allocate only where stated and write only
/// into the caller's arrays, which must hold the stated numbers of values. Thread-safety: safe
/// to call from several threads on separate arrays.
///
/// Linear resampling (TarnInterpolation) expects an evenly spaced stimulus. Grid points between
/// stimulus points are interpolated, grid points below the first are extrapolated from the
/// first interval, grid points beyond the last get the fill value -999.0 (both parts of a
/// complex value) except the one grid point lying less than a grid step past it, which is
/// still extrapolated. Cubic resampling (TarnCubicInterpolation) holds the first sample below
/// the stimulus and the last sample beyond it. Both accept a descending stimulus (giving the
/// values of its ascending mirror) and a descending grid (stop < start).
///
/// Degenerate calls have fixed outcomes and never read beyond the stated counts:
///  - points <= 0: nothing is written;
///  - points == 1: the single grid point is `start`;
///  - count == 1: every grid point holds the one sample;
///  - count <= 0, or start or stop not finite: every resampled value is -999.0 (linear) or
///    NaN (cubic);
///  - resultCount is capped at points.
#pragma once

#include <cstdint>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"

namespace LumenUtility {

/// Value the linear resampler leaves at grid points beyond the data.
inline constexpr float kTarnFillValue = -999.0f;

/// Phase codes are 16-bit angles: code = phase (radians) * 32768 / pi, so pi/2 is 16384.
inline constexpr float kTarnPhaseCodePerRadian = 10430.3779296875f;

/// Resamples count complex samples `data` at the evenly spaced `stimulus` onto the grid into
/// `resampled` (points values), then writes result[k] = resampled[k] * factor[k] (complex
/// product) for k < min(resultCount, points). factor and result hold that many values.
LUMEN_API void TarnInterpolation(const TsComplex* data, const float* stimulus, int count,
                                 TsComplex* resampled, const TsComplex* factor, TsComplex* result,
                                 double start, double stop, int points, int resultCount);

/// Real resampling with an optional 16-bit phase code.
/// With phaseCode: data holds count complex samples. Their magnitudes are written over the
/// first count floats of data (data is changed), and their phases (radians) are coded,
/// resampled onto the grid and stored as codes in phaseCode[0 .. min(resultCount, points)).
/// Phase is interpolated the short way round: a trace stepping from +179 to -179 degrees passes
/// through 180, never through 0. A code is the rounded phase (halves away from zero) wrapped
/// into -32768 .. 32767, so exactly pi codes as -32768; grid points the resampler did not
/// reach code as -999 (the fill value).
/// In every case the first count floats of data are then resampled as real values into
/// `resampled` (points values) and result[k] = resampled[k] * factor[k] for
/// k < min(resultCount, points). Without phaseCode the caller puts real values (for example
/// magnitudes) in the first count floats of data.
/// Throws HRESULT LUMEN_E_KERNEL_BUFFER when the temporary phase array (count floats, taken
/// from the heap above 1024 points) cannot be allocated; nothing has been written then.
LUMEN_API void TarnInterpolation(TsComplex* data, const float* stimulus, int count,
                                 float* resampled, const float* factor, float* result, double start,
                                 double stop, int points, int resultCount, std::int16_t* phaseCode);

/// Cubic resampling of a trace given as magnitude and phase (radians) at an ascending (or
/// descending) double stimulus, then division of an operand by it:
///  1. resampledMagnitude (points floats) = cubic resampling of magnitude;
///  2. without withPhase: resampled[k] = (resampledMagnitude[k], 0); phase and
///     resampledPhase are not touched;
///  3. with withPhase: phase is unwrapped in place (each step larger than pi shifts the rest of
///     the trace by 2 pi), resampledPhase (points floats) = cubic resampling of it, and
///     resampled[k] = resampledMagnitude[k] * (cos, sin)(resampledPhase[k]);
///  4. result[k] = operand[k] / resampled[k] (complex division) for k < points; a resampled
///     value of exactly 0 gives 0 for a finite operand, as TsComplex division does.
/// resampled, operand and result hold points values.
LUMEN_API void TarnCubicInterpolation(const float* magnitude, float* phase, const double* stimulus,
                                      int count, float* resampledMagnitude, float* resampledPhase,
                                      TsComplex* resampled, const TsComplex* operand,
                                      TsComplex* result, double start, double stop, int points,
                                      bool withPhase);

}  // namespace LumenUtility
