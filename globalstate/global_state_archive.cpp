// SerializeGlobalState: the saved form of the settings.
#include <cstdint>

#include "globalstate/global_state_names.h"
#include "globalstate/global_state_table.h"
#include "globalstate/resolution_text.h"
#include "lumen/globalstate/global_state.h"
#include "lumen/platform/lumen_exception.h"

namespace GlobalState {

namespace {

using LumenUtility::GlobalStateTable;
namespace names = LumenUtility::GlobalStateNames;

constexpr std::uint32_t kVersion = 1;

[[noreturn]] void ThrowInvalidSetting(const std::wstring& key, const std::wstring& value) {
  throw LumenException(LumenUtility::LUMEN_E_BOUNDS, L"global state setting \"" + key +
                                                         L"\" cannot be \"" + value + L"\"");
}

// Throws for a value that the setting's reader would refuse or misread; other keys (settings
// of other versions) are kept as they are.
void CheckSetting(const std::wstring& key, const std::wstring& value) {
  if (key == names::kIndexPolarity) {
    if (value != names::kNegative) ThrowInvalidSetting(key, value);
  } else if (key == names::kEquationEditorFastProcessing) {
    if (value != names::kTrue && value != names::kFalse) ThrowInvalidSetting(key, value);
  } else if (key == names::kPowerKnobResolution) {
    if (!LumenUtility::ParseResolution(value)) ThrowInvalidSetting(key, value);
  }
}

void Store(CArchive& ar, const GlobalStateTable::Settings& settings) {
  ar << kVersion << static_cast<std::uint32_t>(settings.size());
  for (const auto& [key, value] : settings) ar << key << value;
}

// Reads a whole record into new settings, so that a failure part way leaves the table alone.
GlobalStateTable::Settings Load(CArchive& ar) {
  std::uint32_t version = 0;
  ar >> version;
  if (version > kVersion) throw LumenException(LumenUtility::LUMEN_E_UNKNOWN_VERSION);
  std::uint32_t count = 0;
  ar >> count;
  GlobalStateTable::Settings settings;
  // Each entry takes at least two bytes, so a count beyond the data ends at the archive's end.
  for (std::uint32_t i = 0; i < count; ++i) {
    std::wstring key;
    std::wstring value;
    ar >> key >> value;
    // The reference is never saved; one found here is not applied to the hardware later.
    if (key == names::kReferenceState) continue;
    CheckSetting(key, value);
    settings[key] = std::move(value);
  }
  return settings;
}

}  // namespace

void SerializeGlobalState(CArchive& ar) {
  GlobalStateTable& table = GlobalStateTable::Instance();
  if (ar.IsStoring()) {
    Store(ar, table.GetSettings());
  } else {
    table.ReplaceSettings(Load(ar));
  }
}

}  // namespace GlobalState
