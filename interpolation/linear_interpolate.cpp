#include <cfloat>
#include <cmath>
#include <cstddef>
#include <limits>

#include "lumen/interpolation/linear_interpolation.h"
#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {
namespace {

// Integer part (truncated) and fraction of a fractional index, as modf splits it.
struct SplitIndex {
  std::ptrdiff_t whole;
  double fraction;
};

SplitIndex Split(double index) {
  double whole = 0.0;
  const double fraction = std::modf(index, &whole);
  return {static_cast<std::ptrdiff_t>(whole), fraction};
}

template <typename T>
T InterpolateArray(const T* data, double index) {
  if (data == nullptr) return T(0);
  if (std::isnan(index)) return std::numeric_limits<T>::quiet_NaN();
  const SplitIndex s = Split(index);
  if (s.fraction == 0.0) return data[s.whole];
  const double a = data[s.whole];
  const double b = data[s.whole + 1];
  return static_cast<T>(a + s.fraction * (b - a));
}

// Keeps an index inside [0, size - 1] so that the pointer form reads only elements 0 .. size-1.
// NaN stays NaN. Precondition: size > 0.
double ClampIndex(double index, std::size_t size) {
  const double last = static_cast<double>(size - 1);
  if (index < 0.0) return 0.0;
  if (index > last) return last;
  return index;
}

template <typename T>
T InterpolateVector(const std::vector<T>& data, double index) {
  if (data.empty()) return T(0);
  return InterpolateArray(data.data(), ClampIndex(index, data.size()));
}

[[noreturn]] void ThrowBounds(const wchar_t* message) {
  throw LumenException(LUMEN_E_BOUNDS, message);
}

}  // namespace

double LinearInterpolate(const double* data, double index) {
  return InterpolateArray(data, index);
}

float LinearInterpolate(const float* data, double index) {
  return InterpolateArray(data, index);
}

double LinearInterpolate(const std::vector<double>& data, double index) {
  return InterpolateVector(data, index);
}

float LinearInterpolate(const std::vector<float>& data, double index) {
  return InterpolateVector(data, index);
}

TsComplex LinearInterpolate(const std::vector<TsComplex>& data, double index) {
  if (data.empty()) return TsComplex();
  if (std::isnan(index)) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    return TsComplex(nan, nan);
  }
  if (index <= 0.0) return data.front();
  const SplitIndex s = Split(ClampIndex(index, data.size()));
  const TsComplex& a = data[s.whole];
  if (s.fraction == 0.0) return a;
  const TsComplex& b = data[s.whole + 1];
  const double re = a.re + s.fraction * (static_cast<double>(b.re) - a.re);
  const double im = a.im + s.fraction * (static_cast<double>(b.im) - a.im);
  return TsComplex(re, im);
}

double LinearInterpolate(const InputArray& stimulus, double index) {
  const double last = static_cast<double>(stimulus.size()) - 1.0;
  const double pastEnd = index - last;
  // A thousandth of a point past the end is taken as the end: callers compute end indices
  // from stimulus values and land a few ulps beyond them.
  if (pastEnd > 0.001) ThrowBounds(L"Bounds checking failure for LinearInterpolate.");
  if (pastEnd > DBL_EPSILON) index = last;
  if (!(index >= 0.0)) ThrowBounds(L"Bounds checking failure for LinearInterpolate.");

  const SplitIndex s = Split(index);
  const auto i = static_cast<unsigned int>(s.whole);
  const auto lastIndex = stimulus.size() - 1;
  // An index up to DBL_EPSILON past the end leaves i == last with a tiny fraction; there is no
  // point i + 1 to move towards.
  if (i == lastIndex) return stimulus[lastIndex];
  if (s.fraction < DBL_EPSILON && i == 0) return stimulus[0];
  const double a = stimulus[i];
  return a + (stimulus[i + 1] - a) * s.fraction;
}

double LogInterpolate(const InputArray& stimulus, double index) {
  const double last = static_cast<double>(stimulus.size()) - 1.0;
  if (!(index >= 0.0 && index <= last)) {
    ThrowBounds(L"Bounds checking failure for LogInterpolate.");
  }
  const SplitIndex s = Split(index);
  const auto i = static_cast<unsigned int>(s.whole);
  if (i + 1 == stimulus.size() || (std::fabs(s.fraction) < DBL_EPSILON && i == 0)) {
    return stimulus[i];
  }
  const double la = std::log10(stimulus[i]);
  const double lb = std::log10(stimulus[i + 1]);
  return std::pow(10.0, la + s.fraction * (lb - la));
}

double FindNearestIndex(const InputArray& stimulus, double nearIndex, double value) {
  if (stimulus.empty()) return 0.0;
  double best = DBL_MAX;
  bool found = false;
  auto offer = [&](double candidate) {
    if (std::fabs(candidate - nearIndex) < std::fabs(best - nearIndex)) {
      best = candidate;
      found = true;
    }
  };

  const std::vector<Segment>& segments = stimulus.GetSegments();
  unsigned int base = 0;
  for (std::size_t k = 0; k < segments.size(); ++k) {
    const Segment& segment = segments[k];
    const unsigned int n = segment.size();
    if (n == 0) continue;
    const bool fromEnd = n > 1 && base < nearIndex;
    const double r = segment.Find(value, fromEnd);
    if (r >= 0.0) offer(base + r);
    base += n;

    std::size_t next = k + 1;
    while (next < segments.size() && segments[next].empty()) ++next;
    if (next == segments.size()) break;
    const double low = segment.at(n - 1);
    const double t = (value - low) / (segments[next].at(0) - low);
    if (t >= 0.0 && t <= 1.0) offer((base - 1) + t);
  }
  if (found) return best;

  const double toFirst = std::fabs(value - stimulus[0]);
  const double toLast = std::fabs(value - stimulus[stimulus.size() - 1]);
  return toLast <= toFirst ? stimulus.size() - 1.0 : 0.0;
}

tagSlope Direction(std::int32_t count, const double* values) {
  if (count <= 0) return SLOPE_MIXED;
  const bool descending = values[count - 1] < values[0];
  for (std::int32_t k = 0; k + 1 < count; ++k) {
    if (values[k + 1] == values[k]) continue;
    if ((values[k + 1] < values[k]) != descending) return SLOPE_MIXED;
  }
  return descending ? SLOPE_DESCENDING : SLOPE_ASCENDING;
}

}  // namespace LumenUtility
