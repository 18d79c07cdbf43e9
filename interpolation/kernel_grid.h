// The evenly spaced output grid of the vector-kernel resamplers.
#pragma once

namespace LumenUtility {

// Grid values start + k * (stop - start) / (points - 1) for k = 0 .. points - 1, in the
// stimulus unit (Hz, s, dBm...). stop may lie below start (a descending grid). With one point
// the grid is `start` alone and stop is ignored; with none nothing is written.
struct KernelGrid {
  double start;
  double stop;
  int points;
};

}  // namespace LumenUtility
