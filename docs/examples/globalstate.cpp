// Global instrument state: settings changed, saved with the instrument state, preset and
// recalled; a value that cannot be stored.
// guide:begin
#include <cmath>
#include <cstdio>
#include <string>

#include "lumen/globalstate.h"
#include "lumen/platform.h"

int main() {
  GlobalState::SetPowerKnobResolution(0.25);  // dB
  const int handle = GlobalState::ForcePathElementValue(L"Port1Bypass", L"Thru");

  CMemFile saved;
  {
    CArchive ar(&saved, CArchive::store);
    GlobalState::SerializeGlobalState(ar);
  }
  GlobalState::PresetGlobalState();
  std::printf("after preset: %.2f dB\n", GlobalState::GetPowerKnobResolution());
  saved.SeekToBegin();
  CArchive ar(&saved, CArchive::load);
  GlobalState::SerializeGlobalState(ar);
  std::printf("recalled: %.2f dB\n", GlobalState::GetPowerKnobResolution());

  std::wstring value;
  if (GlobalState::IsPathForceElementValue(L"Port1Bypass", value))
    std::printf("Port1Bypass forced to %ls\n", value.c_str());
  GlobalState::UnforcePathElementValue(handle);
  try {
    GlobalState::SetPowerKnobResolution(std::nan(""));
  } catch (HRESULT hr) {
    std::printf("NaN refused: 0x%08X\n", static_cast<unsigned>(hr));
  }
}
// guide:end
