// Boundary search that starts from a hint: suits callers that look up a sweep of values in
// order, where each answer lies next to the previous one.
#pragma once

#include <algorithm>
#include <cstddef>

namespace LumenUtility {

// The first i in [0, count) with above(i) true, or count when there is none, for a predicate
// that is false up to some index and true from there on. Probes outward from `hint` in
// doubling steps and then bisects the bracket: O(log d) probes for an answer d away from the
// hint. For a predicate that is not ordered so (NaN in the data) it still returns some index
// in [0, count] after at most about 2 log2(count) probes.
template <typename Above>
std::ptrdiff_t GallopBoundary(std::ptrdiff_t count, std::ptrdiff_t hint, Above above) {
  if (count <= 0) return 0;
  std::ptrdiff_t low = -1, high = count;  // -1 and count stand for the ends
  hint = std::clamp<std::ptrdiff_t>(hint, 0, count - 1);
  if (!above(hint)) {
    low = hint;
    for (std::ptrdiff_t step = 1; low + step < count; step *= 2) {
      if (above(low + step)) {
        high = low + step;
        break;
      }
      low += step;
    }
  } else {
    high = hint;
    for (std::ptrdiff_t step = 1; high - step >= 0; step *= 2) {
      if (!above(high - step)) {
        low = high - step;
        break;
      }
      high -= step;
    }
  }
  while (high - low > 1) {
    const std::ptrdiff_t mid = low + (high - low) / 2;
    (above(mid) ? high : low) = mid;
  }
  return high;
}

}  // namespace LumenUtility
