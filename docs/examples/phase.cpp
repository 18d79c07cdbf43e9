// Phase-coherent acquisition: a ratio parameter collected and averaged over a sweep, with the
// host's test set supplied as a host object.
// guide:begin
#include <cstdio>
#include <string>
#include <vector>

#include "lumen/phase.h"
#include "lumen/platform.h"
#include "lumen/util.h"

using LumenUtility::TsComplex;

// The host's test set: two ports; slot 0..1 the reference receivers, 2..3 the test receivers.
class TwoPortTestSet final : public ITestSet {
 public:
  int GetPortCount() override { return 2; }
  int ReceiverToSlot(int index, bool reference, bool) override {
    return reference ? index - 1 : index + 1;
  }
  void ClassifyReceiver(int, int& testIndex, int& refPort, bool) override {
    testIndex = refPort = -1;
  }
  int GetReceiverPosition(const std::wstring&) override { return 0; }
};

int main() {
  PAComponent component;
  const PAParameter b2OverA1(2, false, 1, true, 0, true);  // test receiver 2 / port 1 reference
  component.AddParameter(b2OverA1);
  component.SetSweepParameters(3, false, 2);  // 3 points, 2 samples averaged per point
  std::vector<TsComplex> buffer(4 + StitchPhase::kRotatedValues);
  try {
    component.PutData(buffer.data(), 1, static_cast<int>(buffer.size()), false, false);
  } catch (const LumenException& e) {
    std::printf("without a test set: 0x%08X\n", static_cast<unsigned>(e.GetCode()));
  }

  TwoPortTestSet testSet;
  LumenUtility::RegisterHostObject<ITestSet>(LumenUtility::kHostCategoryApplication, 0, &testSet);
  for (int sample = 0; sample < 6; ++sample) {  // two samples for each of the 3 points
    buffer[0] = TsComplex(2.0, 0.0);                                  // a1
    buffer[3] = TsComplex::FromMagPhase(1.0 + 0.1 * sample, -0.5);  // b2
    component.PutData(buffer.data(), 1, static_cast<int>(buffer.size()), false, false);
  }
  const int available = component.GetAvailableDataCount(b2OverA1);
  for (int k = 0; k < available; ++k) {
    const TsComplex v = component.GetDataByRef(b2OverA1)[k];
    std::printf("point %d: |b2/a1| %.3f at %.3f rad\n", k, v.Mag(), v.Phase());
  }
}
// guide:end
