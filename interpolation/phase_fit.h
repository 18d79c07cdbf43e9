// Phase smoothing for circular interpolation: the phase of every resampled point is replaced
// by a blend of quadratic fits of the old trace's unwrapped phase, one fit through each old
// point and its two neighbours.
#pragma once

#include "lumen/core/ts_complex.h"

namespace LumenUtility {

// Solves the 3x3 system m * v = rhs by inverting m (Gauss-Jordan elimination with partial
// pivoting) and multiplying. Returns false, leaving v unwritten, when the largest pivot
// available at some step is below 10000 * DBL_EPSILON in magnitude.
bool SolveByInverse3x3(const double m[3][3], const double rhs[3], double v[3]);

// Rewrites the phase of newData[0 .. newCount - 1] (magnitudes kept). Old stimulus `x`
// ascends (NaN tolerated: it only spoils nearby fits), `data` holds its n values. A new point
// equal to an old stimulus value, or with no valid fit on either side, keeps its value. Fits
// are made only where the two neighbouring steps are within a factor of 5 of each other and
// the system is not singular. Does nothing for n < 3.
void ApplyPhaseFit(int n, const double* x, const TsComplex* data, int newCount,
                   const double* newStimulus, TsComplex* newData);

}  // namespace LumenUtility
