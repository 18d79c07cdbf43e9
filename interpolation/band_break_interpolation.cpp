#include <algorithm>
#include <cmath>
#include <cstddef>
#include <vector>

#include "interpolation/circular_core.h"
#include "lumen/interpolation/circular_interpolation.h"

namespace LumenUtility {
namespace {

// The breaks in ascending order, NaN last (a NaN break lies below no value).
std::vector<double> SortedBreaks(const std::vector<double>& breaks) {
  std::vector<double> sorted(breaks);
  std::sort(sorted.begin(), sorted.end(),
            [](double a, double b) { return a < b || (!std::isnan(a) && std::isnan(b)); });
  return sorted;
}

// Number of breaks strictly below `value`: a value on a break belongs to the band below it.
int BandOf(const std::vector<double>& sortedBreaks, double value) {
  return static_cast<int>(std::partition_point(sortedBreaks.begin(), sortedBreaks.end(),
                                               [value](double b) { return b < value; }) -
                          sortedBreaks.begin());
}

// First index in `bands` (ascending) whose band is above `band` (orAbove: not below it).
int FirstBand(const std::vector<int>& bands, int band, bool orAbove) {
  const auto it = std::partition_point(bands.begin(), bands.end(),
                                       [&](int b) { return orAbove ? b < band : b <= band; });
  return static_cast<int>(it - bands.begin());
}

}  // namespace

tagInterpStatus CircularInterpolationUsingBandBreaks(
    const InputArray& oldStimulus, const TsComplex* oldData, const InputArray& newStimulus,
    TsComplex* newData, const std::vector<double>& bandBreaks, bool* interpolated) {
  const int newCount = newData ? static_cast<int>(newStimulus.size()) : 0;
  if (newCount == 0) {
    if (interpolated) *interpolated = false;
    return INTERP_UNCHANGED;
  }
  const int n = oldData ? static_cast<int>(oldStimulus.size()) : 0;
  if (n == 0) return INTERP_OUT_OF_RANGE;

  const double* newX = newStimulus.GetRawArray();
  const bool overlap = Overlap(newData, newCount, oldData, n);
  const AscendingTrace old(n, oldStimulus.GetRawArray(), oldData, overlap);
  const std::vector<double> breaks = SortedBreaks(bandBreaks);
  std::vector<int> oldBands(n);
  for (int j = 0; j < n; ++j) oldBands[j] = BandOf(breaks, old.X()[j]);

  tagInterpStatus status = INTERP_UNCHANGED;
  for (int runStart = 0; runStart < newCount;) {
    const int band = BandOf(breaks, newX[runStart]);
    int runEnd = runStart + 1;
    while (runEnd < newCount && BandOf(breaks, newX[runEnd]) == band) ++runEnd;

    int start = 0, count = 1;
    if (n > 1) {
      start = FirstBand(oldBands, band, true);
      const int end = FirstBand(oldBands, band, false);
      count = end - start;
      if (count < 2) {
        // Too few old points in the band: take two, reaching into the next band (or the one
        // below at the top end).
        start = std::min(start, n - 2);
        count = 2;
      }
    }
    LeadPoint lead{};
    CoreRequest request;
    if (start > 0) {
      lead = {old.X()[start - 1], old.D()[start - 1]};
      request.lead = &lead;
    }
    request.oldCount = count;
    request.oldStimulus = old.X() + start;
    request.oldData = old.D() + start;
    request.newCount = runEnd - runStart;
    request.newStimulus = newX + runStart;
    request.newData = newData + runStart;
    request.extrapolate = true;
    request.type = INTERP_CIRCULAR;
    status = CircularCore(request, interpolated);
    runStart = runEnd;
  }
  return status;
}

}  // namespace LumenUtility
