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
  const double t = target;

  if (std::floor(low) == std::floor(high)) {
    const double a = ValueAt(data, low);
    const double b = ValueAt(data, high);
    switch (Classify(a, b, t)) {
      case Crossing::kStrict:
        position = Interpolate(low, a, high, b, t);
        return true;
      case Crossing::kFlat:
        position = searchRight ? high : low;
        return true;
      case Crossing::kNone:
        return false;
    }
  }

  // low and high lie in different intervals, so there is at least one whole point between.
  const int firstWhole = static_cast<int>(std::ceil(low));
  const int lastWhole = static_cast<int>(std::floor(high));
  bool haveFallback = false;
  double fallback = 0.0;

  if (searchRight) {
    if (low != firstWhole) {
      const double a = ValueAt(data, low);
      const double b = data[firstWhole];
      const Crossing c = Classify(a, b, t);
      if (c == Crossing::kStrict) {
        position = Interpolate(low, a, firstWhole, b, t);
        return true;
      }
      if (c == Crossing::kFlat) {
        haveFallback = true;
        fallback = firstWhole;
      }
    }
    for (int i = firstWhole; i < lastWhole; ++i) {
      const Crossing c = Classify(data[i], data[i + 1], t);
      if (c == Crossing::kStrict) {
        position = WholeIntervalCrossing(data, i, target);
        return true;
      }
      if (c == Crossing::kFlat) {
        haveFallback = true;
        fallback = i + 1;
      }
    }
    const double a = data[lastWhole];
    const double b = ValueAt(data, high);
    const Crossing c = Classify(a, b, t);
    if (c == Crossing::kStrict) {
      position = Interpolate(lastWhole, a, high, b, t);
      return true;
    }
    if (c == Crossing::kFlat) {
      position = high;
      return true;
    }
  } else {
    if (high != lastWhole) {
      const double a = data[lastWhole];
      const double b = ValueAt(data, high);
      const Crossing c = Classify(a, b, t);
      if (c == Crossing::kStrict) {
        position = Interpolate(lastWhole, a, high, b, t);
        return true;
      }
      if (c == Crossing::kFlat) {
        haveFallback = true;
        fallback = lastWhole;
      }
    }
    for (int i = lastWhole; i > firstWhole; --i) {
      const Crossing c = Classify(data[i - 1], data[i], t);
      if (c == Crossing::kStrict) {
        position = WholeIntervalCrossing(data, i - 1, target);
        return true;
      }
      if (c == Crossing::kFlat) {
        haveFallback = true;
        fallback = i - 1;
      }
    }
    const double a = ValueAt(data, low);
    const double b = data[firstWhole];
    const Crossing c = Classify(a, b, t);
    if (c == Crossing::kStrict) {
      position = Interpolate(low, a, firstWhole, b, t);
      return true;
    }
    if (c == Crossing::kFlat) {
      position = low;
      return true;
    }
  }

  if (!haveFallback) return false;
  position = fallback;
  return true;
}

}  // namespace LumenUtility
