#include "lumen/interpolation/linear_interpolation.h"

#include <cmath>

#include "interpolation/monotonic_locator.h"
#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {
namespace {

bool AllFinite(const double* values, unsigned int count) {
  for (unsigned int k = 0; k < count; ++k) {
    if (!std::isfinite(values[k])) return false;
  }
  return true;
}

template <typename T>
tagInterpStatus Resample(const InputArray& oldStimulus, const InputArray& newStimulus,
                         const std::vector<T>& in, std::vector<T>& out) {
  if (oldStimulus == newStimulus) {
    out = in;
    return INTERP_UNCHANGED;
  }
  const unsigned int oldCount = oldStimulus.size();
  const double* oldPoints = oldStimulus.GetRawArray();
  // A NaN compares neither above nor below its neighbours, so Direction alone would let it
  // through; such a stimulus has no order to search.
  if (Direction(static_cast<std::int32_t>(oldCount), oldPoints) == SLOPE_MIXED ||
      !AllFinite(oldPoints, oldCount)) {
    return INTERP_NOT_MONOTONIC;
  }
  if (in.size() < oldCount) {
    throw LumenException(LUMEN_E_BOUNDS,
                         L"LinearInterpolation: fewer data values than old stimulus points.");
  }

  MonotonicLocator locator(oldStimulus);
  const unsigned int newCount = newStimulus.size();
  const double* newPoints = newStimulus.GetRawArray();
  // Resampling a trace in place: read from a copy of the old values.
  std::vector<T> copy;
  const std::vector<T>* source = &in;
  if (&in == &out) {
    copy = in;
    source = &copy;
  }
  out.resize(newCount);
  for (unsigned int k = 0; k < newCount; ++k) {
    out[k] = LinearInterpolate(*source, locator.Find(newPoints[k]));
  }
  return INTERP_DONE;
}

}  // namespace

tagInterpStatus LinearInterpolation(const InputArray& oldStimulus, const InputArray& newStimulus,
                                    const std::vector<float>& in, std::vector<float>& out) {
  return Resample(oldStimulus, newStimulus, in, out);
}

tagInterpStatus LinearInterpolation(const InputArray& oldStimulus, const InputArray& newStimulus,
                                    const std::vector<double>& in, std::vector<double>& out) {
  return Resample(oldStimulus, newStimulus, in, out);
}

tagInterpStatus LinearInterpolation(const InputArray& oldStimulus, const InputArray& newStimulus,
                                    const std::vector<TsComplex>& in, std::vector<TsComplex>& out) {
  return Resample(oldStimulus, newStimulus, in, out);
}

}  // namespace LumenUtility
