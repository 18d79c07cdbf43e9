// The receiver substitution of a 4-port test set: where the "a1" receiver and the port-1
// reference receiver take different slots of the per-point buffer, the port-1 reference value
// is replaced by the "a1" value before a point is used (when a component's reference receiver
// index is 1).
#pragma once

#include <vector>

#include "lumen/core/ts_complex.h"

namespace LumenUtility {

// One copy within a point buffer: the value at `source` goes over the value at `target`.
struct SlotSubstitution {
  int source;
  int target;
  bool operator==(const SlotSubstitution&) const = default;
};

// Works the substitution out from the registered test set: empty when there is none, when
// it has other than 4 ports, when "a1" already sits in the port-1 reference slot, or when
// either slot it reports is negative (nothing to copy from or to).
std::vector<SlotSubstitution> ComputeReceiverSubstitution();

// The process-wide substitution, worked out on the first call and kept for the process.
const std::vector<SlotSubstitution>& ReceiverSubstitution();

// Applies `substitution` to `count` point buffers, point k at points + k * stride. Every slot
// must lie inside each buffer.
void ApplyReceiverSubstitution(const std::vector<SlotSubstitution>& substitution,
                               TsComplex* points, int count, int stride);

}  // namespace LumenUtility
