// Test sweeps for phase stitching: the point buffers an acquisition delivers across band
// breaks whose phase jumps are known, and the kept points as they should come out.
#pragma once

#include <cmath>
#include <vector>

#include "lumen/core/ts_complex.h"

namespace phase_test {

struct StitchSweep {
  std::vector<std::vector<LumenUtility::TsComplex>> acquired;  // in acquisition order
  std::vector<std::vector<LumenUtility::TsComplex>> raw;       // kept points as acquired
  std::vector<std::vector<LumenUtility::TsComplex>> truth;     // kept points without jumps
};

// `kept` points whose values 0..4 are (1 + k) e^(j 0.3 m) at kept position m, turned by
// jumps[i] (radians) after breaks[i]. Leading and settling points hold junk; with reference
// points each break gets a capture point (the last kept point again) before its settling
// points and a realign point (the same point behind the jump) after them. Values 5 and up
// stay 0.
inline StitchSweep MakeStitchSweep(int kept, const std::vector<int>& breaks,
                                   const std::vector<double>& jumps, int pointsPerBreak,
                                   int leadingPoints, bool hasReferencePoints, int pointSize) {
  using LumenUtility::TsComplex;
  const auto point = [&](int m, double jump) {
    std::vector<TsComplex> values(pointSize);
    for (int k = 0; k < 5; ++k) values[k] = TsComplex::FromMagPhase(1.0 + k, 0.3 * m + jump);
    return values;
  };
  const std::vector<TsComplex> junk(pointSize, TsComplex(-7, 13));
  StitchSweep sweep;
  for (int i = 0; i < leadingPoints; ++i) sweep.acquired.push_back(junk);
  double jump = 0.0;
  std::size_t next = 0;
  for (int m = 0; m < kept; ++m) {
    sweep.acquired.push_back(point(m, jump));
    sweep.raw.push_back(sweep.acquired.back());
    sweep.truth.push_back(point(m, 0.0));
    if (next < breaks.size() && breaks[next] == m) {
      if (hasReferencePoints) sweep.acquired.push_back(point(m, jump));
      for (int i = 0; i < pointsPerBreak; ++i) sweep.acquired.push_back(junk);
      jump = jumps[next++];
      if (hasReferencePoints) sweep.acquired.push_back(point(m, jump));
    }
  }
  return sweep;
}

}  // namespace phase_test
