// Piecewise-linear resampling of an evenly spaced float stimulus onto a KernelGrid.
//
// Each stimulus interval fills the run of grid points it covers with one linear ramp, so the
// cost is one ramp per interval plus one store per grid point. Grid points:
//  - between two stimulus points are interpolated in the interval they lie in (a point exactly
//    on a stimulus value belongs to the interval below it);
//  - below the first stimulus point are extrapolated from the first interval the grid meets;
//  - beyond the last stimulus point get kTarnFillValue, except that the grid point at or just
//    past the end of the last interval used (less than one grid step beyond it) is still
//    extrapolated, so a float-rounded stimulus end still reaches a grid stop given in double.
// A descending stimulus (last point below the first) is read from its far end and gives the
// values of its ascending mirror; a descending grid gives the ascending grid's values reversed.
//
// Outcomes of degenerate input, all without reading beyond the stated counts:
//  - grid.points <= 0: nothing written;
//  - count <= 0, or a start or stop that is not finite: every grid point is kTarnFillValue;
//  - count == 1: every grid point holds values[0];
//  - grid.points == 1: the single point `start`, placed as on a grid with the stimulus' mean
//    spacing; kTarnFillValue when the stimulus has no positive, finite spread;
//  - start == stop with several points: every point holds the value at start;
//  - a grid spacing that is not finite (start and stop too far apart): every grid point is
//    kTarnFillValue.
// An interval of zero width holds its first value. NaN samples or stimulus values give NaN
// outputs where they are used; they never move a write outside the grid.
#pragma once

#include "interpolation/kernel_grid.h"
#include "lumen/core/ts_complex.h"
#include "lumen/interpolation/tarn_interpolation.h"

namespace LumenUtility {

// Resamples count real samples at stimulus (in any unit, evenly spaced) into out, which must
// hold grid.points floats. period > 0 treats the samples as a wrapped quantity with that
// period (65536 for 16-bit angle codes): each interval ramps the short way round from its
// first sample, so outputs may leave the principal range by up to half a period and the
// caller reduces them. period = 0 for ordinary values.
void RampResample(const float* values, const float* stimulus, int count, const KernelGrid& grid,
                  float* out, float period = 0.0f);

// The same for complex samples, real and imaginary parts ramped independently; out holds
// grid.points values.
void RampResample(const TsComplex* values, const float* stimulus, int count, const KernelGrid& grid,
                  TsComplex* out);

}  // namespace LumenUtility
