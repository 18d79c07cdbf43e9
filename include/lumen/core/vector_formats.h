/// @file
/// Whole-trace formats: the TsComplex display formats applied to every point of a trace.
///
/// Free, stateless functions; the log-magnitude forms read the process-wide zero value
/// (TsComplex::GetLogMagZeroValue) for exact zeros. Traces are std::vector<TsComplex> or a
/// pointer plus index range; angles are radians, log magnitudes dB. Nothing here throws on bad
/// values: invalid arithmetic gives IEEE infinities and NaN.
/// Thread-safety: reentrant; callers keep each trace to one thread while it is written.
#pragma once

#include <cstdint>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"

namespace LumenUtility {

class InputArray;

/// In place: each real part, read as dB, becomes the linear magnitude 10^(dB/20) + 0j.
LUMEN_API void FromLogMag(std::vector<TsComplex>& v);

/// In place: each value becomes 10*log10(re^2 + im^2) + 0j (dB); an exact zero becomes the
/// process-wide zero value (-200 dB unless changed).
LUMEN_API void ToLogMag(std::vector<TsComplex>& v);

/// The ToLogMag values as floats, one per point.
LUMEN_API std::vector<float> FormatLogMag(const std::vector<TsComplex>& v);

/// hypot(re, im) of each point.
LUMEN_API std::vector<double> Mag(const std::vector<TsComplex>& v);

/// In place: z*z.
LUMEN_API void Sq(std::vector<TsComplex>& v);

/// In place: 1/z, with 1/0 giving 0 (the zero divisor guard of TsComplex::operator/).
LUMEN_API void Invert(std::vector<TsComplex>& v);

/// In place: square roots on a continuous branch. Point 0 takes the principal root; each
/// later point takes whichever of +root and -root lies closer in angle to the previous result,
/// so a trace whose phase winds past pi keeps a smooth root instead of flipping sign.
LUMEN_API void Sqrt(std::vector<TsComplex>& v);

/// Sqrt, then a sign for the whole trace, for roots whose phase is near a line through
/// `expectedPhase` (radians) at stimulus 0, such as the transmission of a reciprocal path from
/// its squared product. The line's slope is that of the root's unwrapped phase between its end
/// points over `stimulus` (same length as v, usually Hz). Point 0 of Sqrt is the principal
/// root, which lies within pi/2 of the line's value at the first point exactly when the line,
/// run back from there to stimulus 0, lands within pi/2 of expectedPhase; otherwise the trace
/// is negated. An empty trace or stimulus, or a stimulus whose first and last points are equal,
/// leaves the signs as Sqrt chose them.
LUMEN_API void SqrtEx(const InputArray& stimulus, float expectedPhase, std::vector<TsComplex>& v);

/// Element-wise a[i]*b[i], a.size() points. Throws LumenException(E_INVALIDARG) when b holds
/// fewer points than a.
LUMEN_API std::vector<TsComplex> Mult(const std::vector<TsComplex>& a,
                                      const std::vector<TsComplex>& b);

/// Writes the unwrapped phase (radians) of data[begin, end) into phase[begin, end), continuing
/// the unwrapping already held in phase[0, begin): consecutive results never differ by more
/// than pi, and each result is the point's TsComplex::Phase plus whole turns. Calling it
/// over [0, n) at once or in consecutive pieces gives the same values.
/// Returns S_OK (0), or E_INVALIDARG (writing nothing) when begin < 0, end < begin, or a
/// pointer is null for a non-empty range.
LUMEN_API std::int32_t FormatUnwrappedPhase(const TsComplex* data, float* phase, int begin,
                                            int end);

}  // namespace LumenUtility
