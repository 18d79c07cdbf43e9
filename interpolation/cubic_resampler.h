// Piecewise-cubic resampling of a double stimulus onto a KernelGrid.
//
// Between stimulus points x[j] < g <= x[j+1] the value is a cubic through both samples whose
// slopes are the central differences of the neighbouring samples; the first and last
// intervals, which lack an outer neighbour, bend only at their inner end. The cubic
// reproduces a straight line exactly and passes through every sample. Grid points at or below
// the first stimulus point hold the first sample, grid points beyond the last stimulus point
// hold the last sample. A descending stimulus (last point below the first) gives the values
// of its ascending mirror; a descending grid gives the ascending grid's values reversed.
//
// Outcomes of degenerate input, all without reading beyond the stated counts:
//  - grid.points <= 0: nothing written;
//  - count <= 0, or a start or stop that is not finite: every output is NaN (no value);
//  - count == 1: every output holds values[0];
//  - grid.points == 1: the single point `start`.
// Repeated stimulus values are fine (no zero divisor arises in a non-decreasing stimulus); in
// an unordered stimulus a central difference over a zero span counts as slope 0.
#pragma once

#include "interpolation/kernel_grid.h"

namespace LumenUtility {

// Resamples count samples at stimulus (any unit) into out, which holds grid.points floats.
// The cubic is evaluated in double and rounded to float once.
void CubicResample(const float* values, const double* stimulus, int count, const KernelGrid& grid,
                   float* out);

}  // namespace LumenUtility
