/// @file
/// Statistics of a trace's values (mean, sample standard deviation, extremes, mean square),
/// as shown by trace statistics markers.
///
/// Free, stateless functions; reentrant.
#pragma once

#include "lumen/export.h"

namespace LumenUtility {

///@{
/// Statistics of [begin, end), accumulated in double precision in one pass: mean, sample
/// standard deviation (0 for fewer than two values), minimum, maximum and the mean of the
/// squares. An empty range (begin == end, or either pointer null) writes nothing. NaN values
/// make the mean, deviation and mean square NaN; the extremes skip them unless the first value
/// is NaN.
LUMEN_API void ComputeStats(const float* begin, const float* end, float& mean, float& stdDev,
                            float& min, float& max, float& meanSquare);
LUMEN_API void ComputeStats(const double* begin, const double* end, double& mean, double& stdDev,
                            double& min, double& max, double& meanSquare);
///@}

}  // namespace LumenUtility
