#include "phase/receiver_substitution.h"

#include <cstddef>

#include "lumen/phase/pa_receiver.h"
#include "phase/phase_host.h"

namespace LumenUtility {

namespace {

constexpr int kSubstitutionPorts = 4;

}  // namespace

std::vector<SlotSubstitution> ComputeReceiverSubstitution() {
  ITestSet* testSet = FindTestSet();
  if (testSet == nullptr || testSet->GetPortCount() != kSubstitutionPorts) return {};
  const int target = PAReceiver(true, 1).ToSlot(false);
  const int source = testSet->GetReceiverPosition(L"a1") - 1;  // the position is 1-based
  if (source == target || source < 0 || target < 0) return {};
  return {SlotSubstitution{source, target}};
}

const std::vector<SlotSubstitution>& ReceiverSubstitution() {
  static const std::vector<SlotSubstitution> substitution = ComputeReceiverSubstitution();
  return substitution;
}

void ApplyReceiverSubstitution(const std::vector<SlotSubstitution>& substitution,
                               TsComplex* points, int count, int stride) {
  for (int k = 0; k < count; ++k) {
    TsComplex* point = points + static_cast<std::ptrdiff_t>(k) * stride;
    for (const SlotSubstitution& pair : substitution) point[pair.target] = point[pair.source];
  }
}

}  // namespace LumenUtility
