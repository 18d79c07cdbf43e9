#include "lumen/core/value_search.h"

#include <algorithm>
#include <cmath>

namespace LumenUtility {

namespace {

enum class Crossing { kNone, kStrict, kFlat };

// Whether the segment from a to b reaches t (inclusive at both ends). NaN never crosses.
Crossing Classify(double a, double b, double t) {
  if (!((a <= t && t <= b) || (b <= t && t <= a))) return Crossing::kNone;
  return a == b ? Crossing::kFlat : Crossing::kStrict;
}

// Where the straight line from (p, a) to (q, b) takes the value t.
double Interpolate(double p, double a, double q, double b, double t) {
  return p + (t - a) / (b - a) * (q - p);
}

// The trace at a fractional index x in [0, count - 1].
double ValueAt(const float* data, double x) {
  const double whole = std::floor(x);
  const int i = static_cast<int>(whole);
  const double f = x - whole;
  if (f == 0.0) return data[i];
  return data[i] + (double{data[i + 1]} - data[i]) * f;
}

// Crossing inside the whole interval (i, i + 1), in single precision.
double WholeIntervalCrossing(const float* data, int i, float t) {
  const float offset = (t - data[i]) / (data[i + 1] - data[i]);
  return static_cast<double>(static_cast<float>(i) + offset);
}

// The walk over consecutive intervals in the search direction. Each step looks at one
// interval: a strict crossing ends the search there; a flat run on the target is remembered
// by its end farther along the walk, so that a later crossing still wins and, failing one,
// the walk ends at the last flat run it passed.
class Walk {
 public:
  Walk(const float* data, float target, bool searchRight)
      : m_data(data), m_target(target), m_searchRight(searchRight) {}

  // Looks at the interval between fractional indices p <= q, its end values interpolated in
  // double precision. Returns true with `position` set when the target is crossed in it.
  bool Partial(double p, double q, double& position) {
    const double a = ValueAt(m_data, p);
    const double b = ValueAt(m_data, q);
    if (!Crosses(Classify(a, b, m_target), p, q)) return false;
    position = Interpolate(p, a, q, b, m_target);
    return true;
  }

  // Looks at the whole interval (i, i + 1); a crossing in it is computed in single precision.
  bool Whole(int i, double& position) {
    if (!Crosses(Classify(m_data[i], m_data[i + 1], m_target), i, i + 1)) return false;
    position = WholeIntervalCrossing(m_data, i, m_target);
    return true;
  }

  // At the end of the walk: the remembered flat run's far end, if any.
  bool Finish(double& position) const {
    if (!m_haveFlat) return false;
    position = m_flatEnd;
    return true;
  }

 private:
  // Whether the interval [p, q] crosses the target strictly; remembers it when it is flat.
  bool Crosses(Crossing c, double p, double q) {
    if (c == Crossing::kFlat) {
      m_haveFlat = true;
      m_flatEnd = m_searchRight ? q : p;
    }
    return c == Crossing::kStrict;
  }

  const float* m_data;
  float m_target;
  bool m_searchRight;
  bool m_haveFlat = false;
  double m_flatEnd = 0.0;
};

}  // namespace

bool ValueSearch(double start, const float* data, int count, double rangeLow, double rangeHigh,
                 bool searchRight, float target, double& position) {
  if (data == nullptr || count < 1) return false;
  if (std::isnan(start) || std::isnan(rangeLow) || std::isnan(rangeHigh)) return false;
  if (rangeHigh < rangeLow) return false;
  const double last = count - 1;
  rangeLow = std::max(rangeLow, 0.0);
  rangeHigh = std::min(rangeHigh, last);

  double low, high;  // the part of the range on the search side of start
  if (searchRight) {
    if (start > rangeHigh) return false;
    low = std::max(rangeLow, start);
    high = rangeHigh;
  } else {
    if (start < rangeLow) return false;
    low = rangeLow;
    high = std::min(rangeHigh, start);
  }
  if (high < low) return false;  // also catches a range lying wholly outside the data

  Walk walk(data, target, searchRight);
  if (std::floor(low) == std::floor(high)) {
    return walk.Partial(low, high, position) || walk.Finish(position);
  }

  // low and high lie in different intervals, so there is at least one whole point between.
  // The partial interval at the far end is looked at even when it is a single point: a point
  // on the target there still ends the walk when the interval before it holds a NaN.
  const int firstWhole = static_cast<int>(std::ceil(low));
  const int lastWhole = static_cast<int>(std::floor(high));
  if (searchRight) {
    if (low != firstWhole && walk.Partial(low, firstWhole, position)) return true;
    for (int i = firstWhole; i < lastWhole; ++i) {
      if (walk.Whole(i, position)) return true;
    }
    if (walk.Partial(lastWhole, high, position)) return true;
  } else {
    if (high != lastWhole && walk.Partial(lastWhole, high, position)) return true;
    for (int i = lastWhole - 1; i >= firstWhole; --i) {
      if (walk.Whole(i, position)) return true;
    }
    if (walk.Partial(low, firstWhole, position)) return true;
  }
  return walk.Finish(position);
}

}  // namespace LumenUtility
