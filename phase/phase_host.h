// Lookup of the host objects the phase-coherent acquisition calls.
#pragma once

#include "lumen/util/host_interfaces.h"

namespace LumenUtility {

// The test set registered under category 3, index 0, or nullptr.
ITestSet* FindTestSet();
// The test set; throws LumenException(E_POINTER, "no test set is registered") when missing.
ITestSet& RequireTestSet();
// The FIFO registered under category 3, index 0, or nullptr.
AI_IFIFO* FindFifo();
// The FIFO; throws LumenException(E_POINTER, "no FIFO is registered") when missing.
AI_IFIFO& RequireFifo();

}  // namespace LumenUtility
