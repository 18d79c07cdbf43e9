// The external phase reference: its calibration (PRN) file read and carried onto a sweep, and
// the device itself simulated through the host's diagnostic feature switch.
// guide:begin
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <string>
#include <vector>

#include "lumen/phase.h"
#include "lumen/platform.h"
#include "lumen/util.h"

using LumenUtility::InputArray;

// The host's feature switches: only the phase reference simulation is on.
class Features final : public IDiagFeaturesInterface {
 public:
  bool IsFeatureOn(const std::wstring& name) override { return name == L"SimulatePhaseRef"; }
};

int main() {
  const char* path = "guide_phase_reference.prn";
  std::ofstream(path) << "Frequency (Hz), Phase (deg)\n1e9, 10\n2e9, 50\n3e9, 90\n";
  PrnReader prn;
  if (!prn.LoadFile(L"guide_phase_reference.prn")) return 1;
  const InputArray sweep(std::vector<double>{1.5e9, 2.5e9});
  const std::vector<LumenUtility::TsComplex> phase = prn.GetPhase(sweep);
  for (unsigned k = 0; k < sweep.size(); ++k) {
    std::printf("%.2f GHz: %.1f deg\n", sweep[k] / 1e9, phase[k].Phase() * 180 / M_PI);
  }
  try {
    prn.GetPhase(InputArray(std::vector<double>{0.5e9, 1.5e9}));
  } catch (std::int32_t code) {
    std::printf("below the file's first point: 0x%08X\n", static_cast<unsigned>(code));
  }
  std::remove(path);

  Features features;
  LumenUtility::RegisterHostObject<IDiagFeaturesInterface>(
      LumenUtility::kHostCategoryApplication, 0, &features);
  PhaseReference reference;  // simulated: no driver is loaded
  reference.SetupReference(0, 4);
  std::printf("device 0: %s\n", LumenUtility::WideToUtf8(reference.GetModel(0)).c_str());
}
// guide:end
