/// @file
/// Marker search: where along a trace does the trace reach a target value.
///
/// Free, stateless function; reentrant.
#pragma once

#include "lumen/export.h"

namespace LumenUtility {

/// Searches data[0, count) from the fractional point index `start` towards higher indices
/// (searchRight) or lower ones, within [rangeLow, rangeHigh] (fractional indices, cut to
/// [0, count - 1]), for the first place where the trace, read as straight lines between its
/// points, reaches `target`. On success writes that fractional index to `position` and returns
/// true.
/// - A segment that passes through or touches the target gives the interpolated crossing
///   (computed in single precision between whole points).
/// - A segment lying exactly on the target (flat) does not stop the search; its far end is
///   remembered and returned if no later segment reaches the target. In the last segment of
///   the range a flat run ends the search at the range's end.
/// Returns false, leaving `position` alone, when nothing reaches the target, or for an invalid
/// request: null data, count < 1, rangeHigh < rangeLow, a NaN argument, or a start beyond the
/// range in the search direction.
LUMEN_API bool ValueSearch(double start, const float* data, int count, double rangeLow,
                           double rangeHigh, bool searchRight, float target, double& position);

}  // namespace LumenUtility
