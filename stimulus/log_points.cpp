// Logarithmic point placement shared by segments and the interpolation code.
#include <algorithm>
#include <cmath>
#include <stdexcept>
#include <vector>

#include "lumen/stimulus/segment.h"

namespace LumenUtility {

double ComputeLogPoint(double start, double stop, int numPts, int index) {
  if (numPts == 1) return start;
  if (numPts < 1) throw std::invalid_argument("numPts");
  if (index >= numPts) throw std::invalid_argument("index");
  if (index == 0) return start;
  if (index == numPts - 1) return stop;
  if (start == stop) return start;
  const double lo = std::min(start, stop);
  const double hi = std::max(start, stop);
  // A descending sweep is the exact mirror of the ascending one.
  if (stop < start) index = numPts - 1 - index;
  const double logLo = std::log10(lo);
  const double v = std::pow(10.0, logLo + (std::log10(hi) - logLo) * index / (numPts - 1));
  return std::clamp(v, lo, hi);
}

void ComputeLogPoints(double start, double stop, int numPts, double* out) {
  if (numPts == 0) return;
  if (numPts < 0) throw std::invalid_argument("numPts");
  if (!(start > 0.0) || !(stop > 0.0)) throw std::invalid_argument("start and stop must be > 0");
  out[0] = start;
  if (numPts == 1) return;
  if (start == stop) {
    std::fill(out, out + numPts, start);
    return;
  }
  const double lo = std::log10(start);
  const double step = (std::log10(stop) - lo) / (numPts - 1);
  const double low = std::min(start, stop);
  const double high = std::max(start, stop);
  for (int i = 1; i < numPts - 1; ++i)
    out[i] = std::clamp(std::pow(10.0, lo + i * step), low, high);
  out[numPts - 1] = stop;
}

void ComputeLogPoints(double start, double stop, int numPts, std::vector<double>& out) {
  if (numPts < 0) throw std::invalid_argument("numPts");
  std::vector<double> points(static_cast<std::size_t>(numPts));
  ComputeLogPoints(start, stop, numPts, points.data());
  out.swap(points);
}

}  // namespace LumenUtility
