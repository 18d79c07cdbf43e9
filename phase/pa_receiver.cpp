#include "lumen/phase/pa_receiver.h"

#include "phase/phase_host.h"

namespace {

// Reference ports the test set reports for receivers without a port of their own; they all
// stand for port 1.
bool MeansPortOne(int refPort) {
  return refPort == -1 || (refPort > 99999 && refPort <= 100001);
}

}  // namespace

PAReceiver::PAReceiver(int receiverNumber, bool flag) : reference(false), index(-1) {
  if (receiverNumber < 0) return;
  int testIndex = -1;
  int refPort = -1;
  LumenUtility::RequireTestSet().ClassifyReceiver(receiverNumber, testIndex, refPort, flag);
  if (testIndex != -1) {
    index = testIndex;
    return;
  }
  reference = true;
  index = MeansPortOne(refPort) ? 1 : refPort;
}

int PAReceiver::ToSlot(bool mappingFlag) const {
  return LumenUtility::RequireTestSet().ReceiverToSlot(index, reference, mappingFlag);
}
