#include "lumen/core/trace_stats.h"

#include <cmath>
#include <cstddef>

namespace LumenUtility {

namespace {

template <typename T>
void Accumulate(const T* begin, const T* end, T& mean, T& stdDev, T& min, T& max, T& meanSquare) {
  if (begin == nullptr || end == nullptr || end <= begin) return;
  const std::ptrdiff_t n = end - begin;
  double sum = 0.0;
  double sumOfSquares = 0.0;
  // The deviation comes from sums taken about the first value: the same quantity, but a
  // trace such as 1e9 Hz +- 1 no longer loses every digit of its spread to cancellation.
  const double origin = begin[0];
  double shiftedSum = 0.0;
  double shiftedSumOfSquares = 0.0;
  double lowest = origin;
  double highest = origin;
  for (const T* p = begin; p != end; ++p) {
    const double x = *p;
    sum += x;
    sumOfSquares += x * x;
    const double dx = x - origin;
    shiftedSum += dx;
    shiftedSumOfSquares += dx * dx;
    if (x < lowest) lowest = x;
    if (x > highest) highest = x;
  }
  const double count = static_cast<double>(n);
  mean = static_cast<T>(sum / count);
  meanSquare = static_cast<T>(sumOfSquares / count);
  min = static_cast<T>(lowest);
  max = static_cast<T>(highest);
  double deviation = 0.0;
  if (n >= 2) {
    // Rounding can leave the difference slightly negative for nearly constant data.
    double variance = shiftedSumOfSquares - shiftedSum * shiftedSum / count;
    if (variance < 0.0) variance = 0.0;
    deviation = std::sqrt(variance / (count - 1.0));
  }
  stdDev = static_cast<T>(deviation);
}

}  // namespace

void ComputeStats(const float* begin, const float* end, float& mean, float& stdDev, float& min,
                  float& max, float& meanSquare) {
  Accumulate(begin, end, mean, stdDev, min, max, meanSquare);
}

void ComputeStats(const double* begin, const double* end, double& mean, double& stdDev, double& min,
                  double& max, double& meanSquare) {
  Accumulate(begin, end, mean, stdDev, min, max, meanSquare);
}

}  // namespace LumenUtility
