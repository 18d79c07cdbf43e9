/// @file
/// Result codes and stimulus directions shared by every resampling routine.
#pragma once

#include <cstdint>

namespace LumenUtility {

/// Outcome of a resampling call.
enum tagInterpStatus : std::int32_t {
  /// The first or last new stimulus value lies outside the old range (resamplers that do not
  /// extrapolate). Nothing was written.
  INTERP_OUT_OF_RANGE = -2,
  /// The old stimulus neither ascends nor descends. Nothing was written.
  INTERP_NOT_MONOTONIC = -1,
  /// At least one output point was computed rather than copied.
  INTERP_DONE = 0,
  /// Every output point was copied from an input point.
  INTERP_UNCHANGED = 1,
};

/// Direction of a sequence of stimulus values.
enum tagSlope : std::int32_t {
  /// Every change between neighbours is an increase; also one value or all values equal.
  SLOPE_ASCENDING = 0,
  /// Every change between neighbours is a decrease.
  SLOPE_DESCENDING = 1,
  /// Empty, or rising in one place and falling in another.
  SLOPE_MIXED = 2,
};

}  // namespace LumenUtility
