/// @file
/// Circular interpolation: resampling complex traces (reflection and transmission
/// coefficients) from one stimulus onto another along circles in the complex plane.
///
/// Such data moves on circles as the stimulus changes (a delay turns the phase, a resonance
/// traces an arc), so interpolating real and imaginary parts separately would cut the chord
/// and shrink the magnitude. A new point within 0.1 stimulus units of an old point takes that
/// point's value; otherwise it is rotated along the circle through three neighbouring old points
/// when they are evenly spaced and the circle is well defined, else interpolated in magnitude
/// (linearly) and phase (along the shorter turn). A second pass can replace the phase of every
/// point by a blend of local quadratic fits of the unwrapped phase.
///
/// The 0.1 tolerance is in stimulus units and suits frequencies in Hz; a caller whose steps are
/// near or below one unit (time in seconds, power in dBm) must scale both stimuli into a
/// smaller unit (ps, millidecibels) first, or neighbouring points are copied, not
/// interpolated. Stimulus values are in the caller's unit (Hz, dBm, s) and may come in any
/// order; output point k always belongs to new stimulus point k. All functions are stateless
/// and reentrant; the arrays must not change during a call. `interpolated` may be null;
/// otherwise it receives true when at least one output point was computed rather than copied
/// from an old point.
#pragma once

#include <cstdint>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"
#include "lumen/interpolation/interp_status.h"
#include "lumen/stimulus/input_array.h"

namespace LumenUtility {

/// How CircularInterpolation carries complex data between points.
enum InterpolateType : std::int32_t {
  /// Magnitude/phase interpolation everywhere, then the phase fit.
  INTERP_MAG_PHASE = 0,
  /// Arc rotation where it applies, else magnitude/phase; then the phase fit.
  INTERP_CIRCULAR = 1,
  /// As INTERP_CIRCULAR without the phase fit.
  INTERP_CIRCULAR_NO_PHASE_FIT = 2,
};

/// Resamples oldData (oldStimulus.size() values) onto newStimulus, writing newStimulus.size()
/// values to newData. Returns:
///   INTERP_OUT_OF_RANGE when the first or last new value lies outside the old range, or the
///     old stimulus is empty while new points are asked for; nothing is written, not even the
///     flag;
///   INTERP_UNCHANGED when every new point took an old value (also for an empty new stimulus,
///     which is not read); the flag is false;
///   INTERP_DONE otherwise; the flag is true.
/// With one old point every new point takes its value; with two, the interval between them is
/// interpolated in magnitude and phase.
LUMEN_API tagInterpStatus CircularInterpolation(const InputArray& oldStimulus,
                                                const TsComplex* oldData,
                                                const InputArray& newStimulus, TsComplex* newData,
                                                bool* interpolated, InterpolateType type);
/// As above on raw arrays; the data are interleaved (re, im) float pairs.
LUMEN_API tagInterpStatus CircularInterpolation(std::int32_t oldCount, const double* oldStimulus,
                                                const float* oldData, std::int32_t newCount,
                                                const double* newStimulus, float* newData,
                                                bool* interpolated, InterpolateType type);

///@{
/// As CircularInterpolation with INTERP_CIRCULAR, but new points outside the old range are
/// extrapolated from the outermost interval instead of failing the call. INTERP_OUT_OF_RANGE
/// is returned only for an empty old stimulus with new points asked for.
LUMEN_API tagInterpStatus CircularInterpolationEx(const InputArray& oldStimulus,
                                                  const TsComplex* oldData,
                                                  const InputArray& newStimulus, TsComplex* newData,
                                                  bool* interpolated);
LUMEN_API tagInterpStatus CircularInterpolationEx(std::int32_t oldCount, const double* oldStimulus,
                                                  const float* oldData, std::int32_t newCount,
                                                  const double* newStimulus, float* newData,
                                                  bool* interpolated);
///@}

/// As CircularInterpolationEx, but no interpolation crosses a band edge. The band of a value is
/// the number of `bandBreaks` strictly below it (a value equal to a break belongs to the band
/// below). Consecutive new points of one band are resampled from the old points of that band
/// only; a band with fewer than two old points borrows its neighbours to make two, and a
/// two-point band also takes the old point just before it as the third point of its circle
/// (at the very start, where there is none, it interpolates magnitude and phase). Old stimuli
/// in any order and unsorted breaks are accepted. The status and flag are those of the last
/// band resampled.
LUMEN_API tagInterpStatus CircularInterpolationUsingBandBreaks(
    const InputArray& oldStimulus, const TsComplex* oldData, const InputArray& newStimulus,
    TsComplex* newData, const std::vector<double>& bandBreaks, bool* interpolated);

/// Value at stimulus x on the line from (x0, y0) to (x1, y1): magnitude linear in x (extended
/// beyond the ends), phase turned from y0 towards y1 along the shorter way in proportion to
/// (x - x0) / (x1 - x0). A magnitude of exactly 0 gives (0, 0). x0 != x1.
LUMEN_API TsComplex LinearInterpolateUsingMagPhase(double x0, double x1, TsComplex y0, TsComplex y1,
                                                   double x);

}  // namespace LumenUtility
