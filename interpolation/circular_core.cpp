#include "interpolation/circular_core.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <numeric>
#include <optional>

#include "interpolation/arc_math.h"
#include "interpolation/gallop_search.h"
#include "interpolation/phase_fit.h"
#include "lumen/interpolation/linear_interpolation.h"

namespace LumenUtility {
namespace {

// A new point this close to an old one (stimulus units) takes the old value.
constexpr double kMatchTolerance = 0.1;

// Value of one old interval [X[i-1], X[i]] at new stimulus points, with the circle and the
// magnitude/phase line of the current interval kept until the interval changes.
class IntervalInterpolator {
 public:
  IntervalInterpolator(int n, const double* x, const TsComplex* d, InterpolateType type,
                       const LeadPoint* lead)
      : m_n(n), m_x(x), m_d(d), m_type(type), m_lead(lead) {}

  // Precondition: 1 <= i <= n - 1.
  TsComplex At(int i, double x) {
    if (i != m_i) Enter(i);
    if (m_arcUsable) {
      const double t = (x - m_x[i - 1]) / (m_x[i] - m_x[i - 1]);
      const double theta = t * m_step;
      if (std::fabs(theta) > kMinimumArcStep) return RotateOnArc(m_arc, m_start, theta);
    }
    if (!m_line) m_line.emplace(m_x[i - 1], m_x[i], m_d[i - 1], m_d[i]);
    return m_line->At(x);
  }

 private:
  void Enter(int i) {
    m_i = i;
    m_line.reset();
    m_arcUsable = false;
    if (m_type == INTERP_MAG_PHASE) return;
    // Three consecutive old points; the last interval looks back one point further. Two old
    // points borrow the lead point before them, if there is one.
    double x0, x1, x2;
    TsComplex p0, p1, p2;
    if (m_n >= 3) {
      const int first = i == m_n - 1 ? i - 2 : i - 1;
      x0 = m_x[first], x1 = m_x[first + 1], x2 = m_x[first + 2];
      p0 = m_d[first], p1 = m_d[first + 1], p2 = m_d[first + 2];
    } else if (m_lead != nullptr) {
      x0 = m_lead->x, x1 = m_x[0], x2 = m_x[1];
      p0 = m_lead->value, p1 = m_d[0], p2 = m_d[1];
    } else {
      return;
    }
    // Only exactly even steps: the arc assumes the data turns by equal angles per equal step.
    if (x1 - x0 != x2 - x1) return;
    m_arc = ArcThrough(p0, p1, p2);
    if (!m_arc.TurnsAboveMinimum()) return;
    const bool lastInterval = i == m_n - 1;
    m_step = lastInterval ? m_arc.Turn12() : m_arc.Turn01();
    m_start = lastInterval ? m_arc.w1 : m_arc.w0;
    m_arcUsable = true;
  }

  const int m_n;
  const double* const m_x;
  const TsComplex* const m_d;
  const InterpolateType m_type;
  const LeadPoint* const m_lead;

  int m_i = -1;
  bool m_arcUsable = false;
  Arc m_arc;
  double m_step = 0.0;  // turn across the interval, radians
  TsComplex m_start;    // interval start relative to the centre
  std::optional<MagPhaseLine> m_line;
};

// Writes every new point; returns how many took an old value.
int FirstPass(int n, const double* x, const TsComplex* d, const CoreRequest& request) {
  const tagSlope newOrder = Direction(request.newCount, request.newStimulus);
  IntervalInterpolator interval(n, x, d, request.type, request.lead);
  int copied = 0;
  int previous = 1;
  for (int k = 0; k < request.newCount; ++k) {
    const double value = request.newStimulus[k];
    if (n == 1) {
      // Nothing to interpolate between: every point takes the one value.
      request.newData[k] = d[0];
      if (std::fabs(value - x[0]) < kMatchTolerance) ++copied;
      continue;
    }
    const int lo = newOrder == SLOPE_ASCENDING ? std::max(previous - 1, 0) : 0;
    bool found = false;
    int i = LocateInterval(x, n, value, lo, found);
    if (std::fabs(value - x[i]) < kMatchTolerance) found = true;
    // The lower neighbour wins, also over an exact match above it.
    if (i > 0 && std::fabs(value - x[i - 1]) < kMatchTolerance) {
      --i;
      found = true;
    }
    if (found) {
      request.newData[k] = d[i];
      ++copied;
    } else {
      request.newData[k] = interval.At(i, value);
    }
    previous = i;
  }
  return copied;
}

}  // namespace

AscendingTrace::AscendingTrace(int n, const double* stimulus, const TsComplex* data,
                               bool alwaysCopy)
    : m_n(std::max(n, 0)), m_x(stimulus), m_d(data) {
  if (m_n == 0) return;
  const tagSlope order = Direction(m_n, stimulus);
  if (order == SLOPE_ASCENDING && !alwaysCopy) return;
  std::vector<int> index(m_n);
  std::iota(index.begin(), index.end(), 0);
  if (order == SLOPE_DESCENDING) {
    std::reverse(index.begin(), index.end());
  } else if (order == SLOPE_MIXED) {
    std::stable_sort(index.begin(), index.end(), [stimulus](int a, int b) {
      return stimulus[a] < stimulus[b] || (!std::isnan(stimulus[a]) && std::isnan(stimulus[b]));
    });
  }
  m_xCopy.resize(m_n);
  m_dCopy.resize(m_n);
  for (int k = 0; k < m_n; ++k) {
    m_xCopy[k] = stimulus[index[k]];
    m_dCopy[k] = data[index[k]];
  }
  m_x = m_xCopy.data();
  m_d = m_dCopy.data();
}

int LocateInterval(const double* x, int n, double value, int lo, bool& found) {
  found = false;
  if (value < x[0]) return 1;
  if (value > x[n - 1]) return n - 1;
  // The hint holds for an ascending sweep of new values; anything else starts from 0.
  if (!(x[lo] <= value)) lo = 0;
  // Unless the value equals two neighbouring old points, every bisection ends at the first
  // point not below the value. Galloping from lo finds it in a few probes for a sweep instead
  // of log n; for a run of equal points the bisection below picks which one is reported, as
  // its probe order decides.
  const int first = lo + static_cast<int>(GallopBoundary(
                             n - lo, 0, [&](std::ptrdiff_t k) { return x[lo + k] >= value; }));
  if (first < n && x[first] > value) return first;
  if (first < n && x[first] == value && !(first + 1 < n && x[first + 1] == value)) {
    found = true;
    return first;
  }
  int hi = n - 1;
  while (lo < hi) {
    const int mid = lo + (hi - lo) / 2;
    if (x[mid] == value) {
      found = true;
      return mid;
    }
    if (x[mid] > value) {
      hi = mid;
      continue;
    }
    if (x[mid + 1] == value) {
      found = true;
      return mid + 1;
    }
    if (x[mid + 1] > value) return mid + 1;
    lo = mid + 1;
  }
  return std::max(lo, 1);
}

bool Overlap(const TsComplex* a, int aCount, const TsComplex* b, int bCount) {
  return std::less<>()(a, b + bCount) && std::less<>()(b, a + aCount);
}

tagInterpStatus CircularCore(const CoreRequest& request, bool* interpolated) {
  const int newCount = request.newStimulus && request.newData ? request.newCount : 0;
  if (newCount <= 0) {
    if (interpolated) *interpolated = false;
    return INTERP_UNCHANGED;
  }
  const int n = request.oldStimulus && request.oldData ? request.oldCount : 0;
  if (n <= 0) return INTERP_OUT_OF_RANGE;

  const bool overlap = Overlap(request.newData, newCount, request.oldData, n);
  const AscendingTrace old(n, request.oldStimulus, request.oldData, overlap);
  const double* x = old.X();
  if (!request.extrapolate) {
    const double first = request.newStimulus[0], last = request.newStimulus[newCount - 1];
    if (first < x[0] || first > x[n - 1] || last < x[0] || last > x[n - 1]) {
      return INTERP_OUT_OF_RANGE;
    }
  }

  CoreRequest checked = request;
  checked.newCount = newCount;
  const int copied = FirstPass(n, x, old.D(), checked);
  const bool computed = copied != newCount;
  if (interpolated) *interpolated = computed;
  if (!computed) return INTERP_UNCHANGED;
  if (request.type != INTERP_CIRCULAR_NO_PHASE_FIT) {
    ApplyPhaseFit(n, x, old.D(), newCount, request.newStimulus, request.newData);
  }
  return INTERP_DONE;
}

}  // namespace LumenUtility
