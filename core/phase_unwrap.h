// The unwrapping behind FormatUnwrappedPhase, with the principal phase of each point supplied
// by the caller: resampling code with a faster arc tangent unwraps exactly as the library
// does.
#pragma once

#include <cmath>

namespace LumenUtility {

// FormatUnwrappedPhase over the valid range begin <= end (phase non-null when the range is not
// empty), with phaseOf(i) as the principal phase (radians, (-pi, pi]) of point i, asked for in
// ascending order.
template <typename PhaseOf>
void UnwrapPhase(float* phase, int begin, int end, PhaseOf phaseOf) {
  constexpr double kPi = 3.141592653589793;
  constexpr double kTwoPi = 6.283185307179586;
  constexpr double kInvTwoPi = 0.15915494309189535;
  // Whole turns already added by the earlier pieces. Truncating their net phase change can
  // come out one turn short or long; the first new point absorbs that below.
  double turns = 0.0;
  if (begin > 1) {
    turns = std::trunc((double{phase[begin - 1]} - phase[0]) * kInvTwoPi);
    if (!std::isfinite(turns)) turns = 0.0;
  }

  for (int i = begin; i < end; ++i) {
    const double principal = phaseOf(i);
    const double phi = principal + turns * kTwoPi;
    if (i > 0) {
      const double d = phi - phase[i - 1];
      if (d < -kPi) {
        turns += 1.0;
      } else if (d > kPi) {
        turns -= 1.0;
      }
      // Past the first point neighbouring principal phases differ by less than 2 pi, so one
      // turn always suffices; only a misestimated starting turn count needs more.
      if (i == begin && std::isfinite(d)) {
        const double rest = principal + turns * kTwoPi - phase[i - 1];
        if (std::abs(rest) > kPi) turns += std::round(-rest * kInvTwoPi);
      }
    }
    // Rounded once from the principal phase, so equal turn counts give equal bits however
    // the trace was split into calls.
    phase[i] = static_cast<float>(principal + turns * kTwoPi);
  }
}

}  // namespace LumenUtility
