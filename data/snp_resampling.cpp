// The resampling members of CSnPFileBase: carrying every matrix trace onto new stimulus
// points, and widening traces to cover them first.
#include <vector>

#include "lumen/data/snp_file_base.h"

using LumenUtility::InputArray;

void CSnPFileBase::InterpolateReadSNPFile(const InputArray& stimulus, bool reset) {
  const int count = GetMaxNumParams();
  for (int k = 0; k < count; ++k) GetLoopParam(k).Interpolate(stimulus, reset);
}

void CSnPFileBase::ExtroplateReadSNPFile(const InputArray& stimulus) {
  if (stimulus.empty()) return;
  // The target's extremes rather than its first and last point, so that a descending target
  // widens the traces as much as the same points ascending.
  const double low = stimulus.min_element();
  const double high = stimulus.max_element();
  const int count = GetMaxNumParams();
  for (int k = 0; k < count; ++k) {
    CSNParameter& trace = GetLoopParam(k);
    std::vector<LumenUtility::TsComplex>& data = trace.GetData();
    if (trace.GetStimulus().empty() || data.empty()) continue;
    std::vector<double> points = trace.GetStimulus().GetArray();
    const bool widenLow = low < points.front();
    const bool widenHigh = points.back() < high;
    if (!widenLow && !widenHigh) continue;
    if (widenLow) {
      points.insert(points.begin(), low);
      data.insert(data.begin(), data.front());
    }
    if (widenHigh) {
      points.push_back(high);
      data.push_back(data.back());
    }
    trace.SetStimulus(InputArray(points));
  }
}
