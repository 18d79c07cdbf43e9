// The averaging rules of phase-coherent values: how the samples of one averaging block fold
// into one stored value. Sample i (0-based) of a block of n folds into the target t; the
// sample with i + 1 == n completes it. For n == 1 the target is the sample itself. All
// stored components are single precision.
#pragma once

#include "lumen/core/ts_complex.h"

namespace LumenUtility {

// Complex mean: t = the sum of the samples over n. n >= 1, 0 <= i < n.
void FoldComplexMean(TsComplex& t, TsComplex sample, int i, int n);

// Magnitude as root-mean-square power, phase as the angle of the summed unit phasors: while
// the block runs, t.re sums the powers |s|^2 and q sums s/|s| over the samples that are not
// zero; completed, t = sqrt(mean power) at the angle of q (the angle rule of
// TsComplex::Phase). n >= 1, 0 <= i < n.
void FoldPowerAndPhase(TsComplex& t, TsComplex& q, TsComplex sample, int i, int n);

}  // namespace LumenUtility
