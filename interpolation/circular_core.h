// The resampling core behind every circular interpolation entry point.
#pragma once

#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/interpolation/circular_interpolation.h"
#include "lumen/interpolation/interp_status.h"

namespace LumenUtility {

// Old points in ascending stimulus order, each value staying with its stimulus: the caller's
// arrays when they already ascend (judged over all points), else reversed or sorted copies.
// Sorting is stable and puts NaN stimulus values last.
class AscendingTrace {
 public:
  // `alwaysCopy` forces copies, for callers whose output overlaps the old data.
  AscendingTrace(int n, const double* stimulus, const TsComplex* data, bool alwaysCopy);
  AscendingTrace(const AscendingTrace&) = delete;
  AscendingTrace& operator=(const AscendingTrace&) = delete;

  int size() const { return m_n; }
  const double* X() const { return m_x; }
  const TsComplex* D() const { return m_d; }

 private:
  int m_n;
  const double* m_x;
  const TsComplex* m_d;
  std::vector<double> m_xCopy;
  std::vector<TsComplex> m_dCopy;
};

// An old point just before the first point of the trace handed to the core (band resampling
// hands over one band of a longer trace).
struct LeadPoint {
  double x;
  TsComplex value;
};

struct CoreRequest {
  int oldCount = 0;
  const double* oldStimulus = nullptr;
  const TsComplex* oldData = nullptr;
  int newCount = 0;
  const double* newStimulus = nullptr;
  TsComplex* newData = nullptr;
  bool extrapolate = false;
  InterpolateType type = INTERP_CIRCULAR;
  // With exactly two old points, the lead (when given) is the first point of the circle.
  const LeadPoint* lead = nullptr;
};

// Index i of the old interval [x[i-1], x[i]] holding `value`, as a bisection of the ascending
// x[lo .. n - 1] finds it: 1 below the range, n - 1 above it; `found` set, with i the point
// probed first, when some x[i] equals the value. Precondition: n >= 2, 0 <= lo <= n - 1 (a lo
// with x[lo] above the value is taken as 0). Returns an index in [0, n - 1] (1 or more unless
// found) whatever the data, NaN and disorder included.
int LocateInterval(const double* x, int n, double value, int lo, bool& found);

// Whether the arrays a[0 .. aCount - 1] and b[0 .. bCount - 1] share memory.
bool Overlap(const TsComplex* a, int aCount, const TsComplex* b, int bCount);

// Resamples as documented for CircularInterpolation / CircularInterpolationEx. `interpolated`
// may be null.
tagInterpStatus CircularCore(const CoreRequest& request, bool* interpolated);

}  // namespace LumenUtility
