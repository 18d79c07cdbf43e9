#include "phase/phase_host.h"

#include "lumen/platform/lumen_exception.h"
#include "lumen/util/host_object.h"

namespace LumenUtility {

ITestSet* FindTestSet() {
  return FindHostObject<ITestSet>(kHostCategoryApplication, 0);
}

ITestSet& RequireTestSet() {
  ITestSet* testSet = FindTestSet();
  if (testSet == nullptr) throw LumenException(E_POINTER, L"no test set is registered");
  return *testSet;
}

AI_IFIFO* FindFifo() {
  return FindHostObject<AI_IFIFO>(kHostCategoryApplication, 0);
}

AI_IFIFO& RequireFifo() {
  AI_IFIFO* fifo = FindFifo();
  if (fifo == nullptr) throw LumenException(E_POINTER, L"no FIFO is registered");
  return *fifo;
}

}  // namespace LumenUtility
