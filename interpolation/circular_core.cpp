#include "interpolation/circular_core.h"

#include <algorithm>
#include <cfloat>
#include <cmath>
#include <functional>
#include <numeric>
#include <optional>

#include "interpolation/arc_math.h"
#include "interpolation/block_interpolator.h"
#include "interpolation/gallop_search.h"
#include "interpolation/phase_fit.h"
#include "interpolation/trig_table.h"
#include "lumen/interpolation/linear_interpolation.h"

namespace LumenUtility {
namespace {

// A new point this close to an old one (stimulus units) takes the old value.
constexpr double kMatchTolerance = 0.1;

// Whether x[0 .. n - 1] never decreases (so holds no NaN).
bool NonDecreasing(int n, const double* x) {
  bool ordered = true;
  for (int k = 0; k + 1 < n; ++k) ordered &= x[k] <= x[k + 1];
  return ordered;
}

// The points of one block of the pass.
struct Block {
  static constexpr int kSize = BlockInterpolator::kMaxPoints;
  int interval[kSize];  // old interval (upper index), or the old point a copy takes
  bool copied[kSize];
  bool computed[kSize];
  // Upper index of the old interval that strictly holds the point (or 1 below the old range,
  // n - 1 above it), as the phase fit's search would find it; 0 where that is not known.
  int fitInterval[kSize];
  // Share of the interval at the point: (value - x[i - 1]) / (x[i] - x[i - 1]), for computed
  // points; the circle's rotation and the phase fit's blend both use it.
  double t[kSize];
  bool fitted[kSize];
  double psi[kSize];
  double magnitude[kSize];
};

// Writes every new point; returns how many took an old value. With `fit`, each point the
// phase fit covers gets the fitted phase at its first-pass magnitude. `ordered`: x never
// decreases, which lets a sweep find its intervals by looking next to the previous one.
// The points go through in blocks, each stage over the whole block before the next, so that
// the processor overlaps the work of neighbouring points (see BlockInterpolator).
int ResamplePass(int n, const double* x, const TsComplex* d, bool ordered,
                 const CoreRequest& request, PhaseFit* fit) {
  const tagSlope newOrder = Direction(request.newCount, request.newStimulus);
  if (n == 1) {
    // Nothing to interpolate between: every point takes the one value.
    int copied = 0;
    for (int k = 0; k < request.newCount; ++k) {
      request.newData[k] = d[0];
      if (std::fabs(request.newStimulus[k] - x[0]) < kMatchTolerance) ++copied;
    }
    return copied;
  }
  BlockInterpolator interpolator(n, x, d, request.type, request.lead);
  const TrigTable& trig = TrigTable::Get();
  int copied = 0;
  int previous = 1;
  Block block;
  for (int k0 = 0; k0 < request.newCount; k0 += Block::kSize) {
    const int count = std::min(Block::kSize, request.newCount - k0);
    const double* value = request.newStimulus + k0;
    TsComplex* out = request.newData + k0;
    int lowest = n, highest = 0;
    for (int j = 0; j < count; ++j) {
      const double v = value[j];
      int i = 0;
      bool found = false;
      bool inside = false;
      // A sweep finds most points in the interval of the one before or in one of the next
      // three (new points denser or sparser than the old).
      if (ordered) {
        for (int c = std::max(previous, 1), end = std::min(previous + 3, n - 1); c <= end; ++c) {
          if (x[c - 1] < v && v < x[c]) {
            i = c;
            inside = true;
            break;
          }
        }
      }
      if (!inside) {
        const int lo = newOrder == SLOPE_ASCENDING ? std::max(previous - 1, 0) : 0;
        i = LocateInterval(x, n, v, lo, found);
        inside = ordered && !found && (v < x[0] || v > x[n - 1] || (x[i - 1] < v && v < x[i]));
      }
      if (std::fabs(v - x[i]) < kMatchTolerance) found = true;
      // The lower neighbour wins, also over an exact match above it.
      if (i > 0 && std::fabs(v - x[i - 1]) < kMatchTolerance) {
        --i;
        found = true;
      }
      previous = i;
      block.interval[j] = i;
      block.copied[j] = found;
      block.computed[j] = !found;
      block.fitInterval[j] = found || !inside ? 0 : i;
      if (!found) block.t[j] = (v - x[i - 1]) / (x[i] - x[i - 1]);
      lowest = std::min(lowest, i);
      highest = std::max(highest, i);
      copied += found;
    }
    if (fit != nullptr) {
      fit->Prepare(lowest - 1, highest + 1);
      for (int j = 0; j < count; ++j) {
        const int upper = block.fitInterval[j];
        block.fitted[j] = upper > 0 ? fit->PhaseBetween(upper, value[j], block.t[j], block.psi[j])
                                    : fit->PhaseAt(value[j], block.psi[j]);
      }
    } else {
      std::fill(block.fitted, block.fitted + count, false);
    }
    interpolator.Evaluate(count, block.interval, value, block.t, block.computed, block.fitted, out,
                          block.magnitude);
    for (int j = 0; j < count; ++j) {
      if (!block.copied[j]) continue;
      const TsComplex old = d[block.interval[j]];
      if (block.fitted[j]) {
        block.magnitude[j] = Magnitude(old);
      } else {
        out[j] = old;
      }
    }
    for (int j = 0; j < count; ++j) {
      if (!block.fitted[j]) continue;
      double s, c;
      trig.SinCos(block.psi[j], s, c);
      out[j] = TsComplex(block.magnitude[j] * c, block.magnitude[j] * s);
    }
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
  std::optional<PhaseFit> fit;
  if (request.type != INTERP_CIRCULAR_NO_PHASE_FIT && n >= 3) fit.emplace(n, x, old.D());
  const bool ordered = NonDecreasing(n, x);
  const int copied = ResamplePass(n, x, old.D(), ordered, checked, fit ? &*fit : nullptr);
  const bool computed = copied != newCount;
  if (interpolated) *interpolated = computed;
  if (!computed) {
    // The phase fit runs only where some point was computed: points that took an old value
    // without sitting exactly on it get that value back.
    if (fit) ResamplePass(n, x, old.D(), ordered, checked, nullptr);
    return INTERP_UNCHANGED;
  }
  return INTERP_DONE;
}

}  // namespace LumenUtility
