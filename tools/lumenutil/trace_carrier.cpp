#include "lumenutil/trace_carrier.h"

#include <cmath>
#include <limits>
#include <vector>

namespace lumenutil {
namespace {

double SmallestStep(const std::vector<double>& values, double smallest) {
  for (std::size_t i = 1; i < values.size(); ++i) {
    const double step = std::fabs(values[i] - values[i - 1]);
    if (step > 0 && step < smallest) smallest = step;
  }
  return smallest;
}

LumenUtility::InputArray Scaled(std::vector<double> values, double scale) {
  for (double& v : values) v *= scale;
  return LumenUtility::InputArray(values);
}

}  // namespace

double CarryScale(double smallestStep) {
  constexpr double kWantedStep = 1000;
  if (!(smallestStep > 0) || smallestStep >= kWantedStep || !std::isfinite(smallestStep)) {
    return 1;
  }
  // Steps below 1e-300 would need a scale beyond the range of a double: such a sweep has
  // no meaningful interpolation anyway, and is carried unscaled.
  const double power = std::ceil(std::log10(kWantedStep / smallestStep) - 1e-12);
  const double scale = std::pow(10.0, power);
  return std::isfinite(scale) ? scale : 1;
}

void CarryOnto(CSnPFileBase& file, const LumenUtility::InputArray& target, bool holdEnds) {
  const std::vector<double> fileStimulus = file.GetParam(SNP_S11).GetStimulus().GetArray();
  const std::vector<double> targetStimulus = target.GetArray();
  const double smallest = SmallestStep(
      targetStimulus, SmallestStep(fileStimulus, std::numeric_limits<double>::infinity()));
  const double scale = CarryScale(smallest);
  if (scale == 1) {
    if (holdEnds) file.ExtroplateReadSNPFile(target);
    file.InterpolateReadSNPFile(target, true);
    return;
  }
  const int traces = file.GetSNPType() * file.GetSNPType();
  for (int k = 0; k < traces; ++k) {
    CSNParameter& trace = file.GetParam(static_cast<ESNParam>(k));
    trace.SetStimulus(Scaled(trace.GetStimulus().GetArray(), scale));
  }
  const LumenUtility::InputArray scaledTarget = Scaled(targetStimulus, scale);
  if (holdEnds) file.ExtroplateReadSNPFile(scaledTarget);
  file.InterpolateReadSNPFile(scaledTarget, true);
  for (int k = 0; k < traces; ++k) file.GetParam(static_cast<ESNParam>(k)).SetStimulus(target);
}

}  // namespace lumenutil
