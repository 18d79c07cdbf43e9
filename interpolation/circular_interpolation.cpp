#include "lumen/interpolation/circular_interpolation.h"

#include "interpolation/arc_math.h"
#include "interpolation/circular_core.h"

namespace LumenUtility {
namespace {

// Interleaved (re, im) float pairs have the layout of TsComplex.
const TsComplex* AsComplex(const float* pairs) {
  return reinterpret_cast<const TsComplex*>(pairs);
}
TsComplex* AsComplex(float* pairs) {
  return reinterpret_cast<TsComplex*>(pairs);
}

tagInterpStatus Run(const InputArray& oldStimulus, const TsComplex* oldData,
                    const InputArray& newStimulus, TsComplex* newData, bool* interpolated,
                    bool extrapolate, InterpolateType type) {
  CoreRequest request;
  request.newCount = static_cast<int>(newStimulus.size());
  // An empty new stimulus is answered without looking at anything else.
  if (request.newCount > 0) {
    request.oldCount = static_cast<int>(oldStimulus.size());
    request.oldStimulus = oldStimulus.GetRawArray();
    request.newStimulus = newStimulus.GetRawArray();
  }
  request.oldData = oldData;
  request.newData = newData;
  request.extrapolate = extrapolate;
  request.type = type;
  return CircularCore(request, interpolated);
}

tagInterpStatus Run(std::int32_t oldCount, const double* oldStimulus, const float* oldData,
                    std::int32_t newCount, const double* newStimulus, float* newData,
                    bool* interpolated, bool extrapolate, InterpolateType type) {
  CoreRequest request;
  request.oldCount = oldCount;
  request.oldStimulus = oldStimulus;
  request.oldData = AsComplex(oldData);
  request.newCount = newCount;
  request.newStimulus = newStimulus;
  request.newData = AsComplex(newData);
  request.extrapolate = extrapolate;
  request.type = type;
  return CircularCore(request, interpolated);
}

}  // namespace

tagInterpStatus CircularInterpolation(const InputArray& oldStimulus, const TsComplex* oldData,
                                      const InputArray& newStimulus, TsComplex* newData,
                                      bool* interpolated, InterpolateType type) {
  return Run(oldStimulus, oldData, newStimulus, newData, interpolated, false, type);
}

tagInterpStatus CircularInterpolation(std::int32_t oldCount, const double* oldStimulus,
                                      const float* oldData, std::int32_t newCount,
                                      const double* newStimulus, float* newData, bool* interpolated,
                                      InterpolateType type) {
  return Run(oldCount, oldStimulus, oldData, newCount, newStimulus, newData, interpolated, false,
             type);
}

tagInterpStatus CircularInterpolationEx(const InputArray& oldStimulus, const TsComplex* oldData,
                                        const InputArray& newStimulus, TsComplex* newData,
                                        bool* interpolated) {
  return Run(oldStimulus, oldData, newStimulus, newData, interpolated, true, INTERP_CIRCULAR);
}

tagInterpStatus CircularInterpolationEx(std::int32_t oldCount, const double* oldStimulus,
                                        const float* oldData, std::int32_t newCount,
                                        const double* newStimulus, float* newData,
                                        bool* interpolated) {
  return Run(oldCount, oldStimulus, oldData, newCount, newStimulus, newData, interpolated, true,
             INTERP_CIRCULAR);
}

TsComplex LinearInterpolateUsingMagPhase(double x0, double x1, TsComplex y0, TsComplex y1,
                                         double x) {
  return MagPhaseLine(x0, x1, y0, y1).At(x);
}

}  // namespace LumenUtility
