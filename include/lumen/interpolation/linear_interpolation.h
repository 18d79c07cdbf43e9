/// @file
/// Linear and logarithmic interpolation: data at a fractional point index, the fractional
/// index at which a stimulus reaches a value, and whole traces carried from one stimulus
/// array onto another.
///
/// A fractional index is a double whose integer part is a point index and whose fraction is
/// the share of the way to the next point (2.25: a quarter of the way from point 2 to 3).
/// All functions are stateless and reentrant; the arrays passed in must not change during a
/// call. Nothing here keeps pointers or references past the call.
#pragma once

#include <cstdint>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"
#include "lumen/interpolation/interp_status.h"
#include "lumen/stimulus/input_array.h"

namespace LumenUtility {

///@{
/// Value of `data` at `index`, computed in double precision: data[i] when the fraction is 0
/// (data[i + 1] is then not read), else data[i] + f * (data[i + 1] - data[i]). A null array
/// gives 0. NaN gives NaN without reading. The caller keeps 0 <= index and, when the fraction
/// is not 0, index + 1 inside the array.
LUMEN_API double LinearInterpolate(const double* data, double index);
LUMEN_API float LinearInterpolate(const float* data, double index);
///@}

///@{
/// As the pointer forms; an empty vector gives 0. These forms never read outside the vector:
/// an index below 0 gives the first element, an index past the last element the last one, NaN
/// gives NaN.
LUMEN_API double LinearInterpolate(const std::vector<double>& data, double index);
LUMEN_API float LinearInterpolate(const std::vector<float>& data, double index);
///@}
/// Real and imaginary parts interpolated separately in double precision; an empty vector
/// gives (0, 0). Out-of-range indices as for the real vector forms (NaN gives NaN parts).
LUMEN_API TsComplex LinearInterpolate(const std::vector<TsComplex>& data, double index);

/// Stimulus value at `index`. An index at most 0.001 points past the last point is pulled back
/// onto it. Throws LumenException(LUMEN_E_BOUNDS, "Bounds checking failure for
/// LinearInterpolate.") for an index below 0, NaN, more than 0.001 past the last point, or an
/// empty stimulus.
LUMEN_API double LinearInterpolate(const InputArray& stimulus, double index);

/// Stimulus value at `index` interpolated on a logarithmic scale:
/// 10^(log10 a + f * (log10 b - log10 a)) between neighbours a and b, which must be positive
/// (else NaN). Throws LumenException(LUMEN_E_BOUNDS, "Bounds checking failure for
/// LogInterpolate.") for an index below 0, NaN or past the last point.
LUMEN_API double LogInterpolate(const InputArray& stimulus, double index);

/// Fractional index at which `stimulus` reaches `value`: each segment answers through
/// Segment::Find, and the gap between two segments is crossed linearly. Among several
/// crossings the one nearest `nearIndex` wins (the earlier on a tie). A value no segment and no
/// gap reaches gives the nearer end index (the last on a tie, also 0 for NaN). An empty
/// stimulus gives 0.
LUMEN_API double FindNearestIndex(const InputArray& stimulus, double nearIndex, double value);

/// Direction of values[0 .. count - 1]: equal neighbours are ignored; the overall direction
/// is descending when the last value is below the first. count <= 0 gives SLOPE_MIXED.
LUMEN_API tagSlope Direction(std::int32_t count, const double* values);

///@{
/// Carries a trace from `oldStimulus` onto `newStimulus`. Each new point takes the linear
/// interpolation of `in` at FindNearestIndex(oldStimulus, 0.0, new value): points outside the
/// old range take the nearer end value; where the old stimulus repeats a value, the first
/// segment or gap reaching it answers, an explicit-point segment with its Segment::Find choice
/// (for 1, 2, 2, 3 and the value 2: index 2).
/// Returns INTERP_UNCHANGED with out = in when both stimuli are equal; INTERP_NOT_MONOTONIC with
/// `out` untouched when the old stimulus neither ascends nor descends, or holds a NaN or an
/// infinity; else INTERP_DONE with out.size() == newStimulus.size().
/// Throws LumenException(LUMEN_E_BOUNDS) without touching `out` when `in` holds fewer than
/// oldStimulus.size() values. Costs at most O(log N) per new point, about constant for new
/// points in order. `in` and `out` may be one vector.
LUMEN_API tagInterpStatus LinearInterpolation(const InputArray& oldStimulus,
                                              const InputArray& newStimulus,
                                              const std::vector<float>& in,
                                              std::vector<float>& out);
LUMEN_API tagInterpStatus LinearInterpolation(const InputArray& oldStimulus,
                                              const InputArray& newStimulus,
                                              const std::vector<double>& in,
                                              std::vector<double>& out);
LUMEN_API tagInterpStatus LinearInterpolation(const InputArray& oldStimulus,
                                              const InputArray& newStimulus,
                                              const std::vector<TsComplex>& in,
                                              std::vector<TsComplex>& out);
///@}

}  // namespace LumenUtility
