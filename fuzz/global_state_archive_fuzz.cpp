// Loads the input as a saved global state. What loads must read through every setting, and
// save and load again to the same bytes; what is refused must leave the settings as they were.
#include <cstddef>
#include <cstdint>
#include <vector>

#include "globalstate/global_state_table.h"
#include "lumen/globalstate.h"
#include "lumen/platform.h"

namespace {

std::vector<std::uint8_t> Saved() {
  CMemFile file;
  CArchive ar(&file, CArchive::store);
  GlobalState::SerializeGlobalState(ar);
  ar.Close();
  return file.Detach();
}

void Load(const std::uint8_t* data, std::size_t size) {
  CMemFile file(data, size);
  CArchive ar(&file, CArchive::load);
  GlobalState::SerializeGlobalState(ar);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  LumenUtility::GlobalStateTable& table = LumenUtility::GlobalStateTable::Instance();
  table.ReplaceSettings({{L"PowerKnobResolution", L"7.000000"}});
  const LumenUtility::GlobalStateTable::Settings before = table.GetSettings();
  try {
    Load(data, size);
  } catch (const LumenException&) {
    if (table.GetSettings() != before) __builtin_trap();
    return 0;
  } catch (const CArchiveException&) {
    if (table.GetSettings() != before) __builtin_trap();
    return 0;
  }
  try {
    GlobalState::GetIndexLinePolarity();
  } catch (HRESULT) {
    __builtin_trap();  // a loaded polarity must be one the reader takes
  }
  GlobalState::GetEquationEditorFastProcessingMode();
  GlobalState::GetPowerKnobResolution();
  const std::vector<std::uint8_t> first = Saved();
  Load(first.data(), first.size());
  if (Saved() != first) __builtin_trap();
  return 0;
}
