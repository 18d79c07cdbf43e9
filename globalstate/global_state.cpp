// The settings functions of GlobalState: reference, index line, equation editor, power knob,
// forced path elements and preset.
#include "lumen/globalstate/global_state.h"

#include <cmath>

#include "globalstate/channel_manager_link.h"
#include "globalstate/global_state_host.h"
#include "globalstate/global_state_names.h"
#include "globalstate/global_state_table.h"
#include "globalstate/resolution_text.h"
#include "lumen/platform/main_window.h"
#include "lumen/util/host_interfaces.h"
#include "platform/ascii_case.h"

namespace GlobalState {

namespace {

using LumenUtility::GlobalStateTable;
namespace names = LumenUtility::GlobalStateNames;
namespace host = LumenUtility::GlobalStateHost;

constexpr double kDefaultPowerKnobResolution = 0.1;  // dB

[[noreturn]] void ThrowInvalidArgument() {
  throw static_cast<HRESULT>(LumenUtility::E_INVALIDARG);
}

// The spelling of the reference constant that `state` names in any case.
const wchar_t* ReferenceForm(const std::wstring& state) {
  for (const wchar_t* form : {names::kInternal, names::kExternal}) {
    if (LumenUtility::EqualsNoCase<wchar_t>(state, form)) return form;
  }
  ThrowInvalidArgument();
}

// Stores the reference and switches the hardware to it; when the hardware refuses, the
// stored reference returns to `previous` before the error passes on.
void StoreAndSwitch(GlobalStateTable& table, const std::wstring& form,
                    const std::wstring& previous) {
  table.Store(names::kReferenceState, form);
  HWControl* hardware = host::Hardware();
  if (hardware == nullptr) return;
  try {
    hardware->SetExternalReference(form != names::kInternal);
  } catch (...) {
    table.Store(names::kReferenceState, previous);
    throw;
  }
}

}  // namespace

void PresetGlobalState() {
  GlobalStateTable::Instance().ReplaceSettings({});
}

void SetExternalReference(const std::wstring& state) {
  GlobalStateTable& table = GlobalStateTable::Instance();
  const std::wstring form = ReferenceForm(state);
  const std::wstring* stored = table.Find(names::kReferenceState);
  if (stored == nullptr) throw static_cast<HRESULT>(LumenUtility::LUMEN_E_NO_REFERENCE_STATE);
  const std::wstring previous = *stored;

  IChannelManager* manager = LumenUtility::ChannelManagerLink::Instance().Get();
  const int token = manager ? manager->BeginChange() : 0;
  try {
    StoreAndSwitch(table, form, previous);
    host::NotifyCore();
    LumenUtility::SendMainWindowMessage(kReferenceChangedMessage, 0, 0);
  } catch (...) {
    // The change ends whatever failed, or the channels would wait for it for ever. The first
    // error is the one that counts.
    if (manager) {
      try {
        manager->EndChange(token);
      } catch (...) {
      }
    }
    throw;
  }
  if (manager) manager->EndChange(token);
}

std::wstring GetExternalReference() {
  GlobalStateTable& table = GlobalStateTable::Instance();
  if (!host::CanStoreReference()) {
    HWControl* hardware = host::Hardware();
    return hardware && hardware->IsExternalReference() ? names::kExternal : names::kInternal;
  }
  const std::wstring* stored = table.Find(names::kReferenceState);
  if (stored == nullptr) ThrowInvalidArgument();
  return *stored;
}

IndexLinePolarity GetIndexLinePolarity() {
  GlobalStateTable& table = GlobalStateTable::Instance();
  if (!host::HasIndexLine()) return IndexLinePositive;
  const std::wstring* stored = table.Find(names::kIndexPolarity);
  if (stored == nullptr) return IndexLinePositive;
  if (*stored == names::kNegative) return IndexLineNegative;
  ThrowInvalidArgument();
}

void SetIndexLinePolarity(IndexLinePolarity polarity) {
  GlobalStateTable& table = GlobalStateTable::Instance();
  if (polarity == GetIndexLinePolarity()) return;
  if (!host::HasIndexLine()) ThrowInvalidArgument();
  switch (polarity) {
    case IndexLineNegative:
      table.Store(names::kIndexPolarity, names::kNegative);
      break;
    case IndexLinePositive:
      table.Remove(names::kIndexPolarity);
      break;
    default:
      ThrowInvalidArgument();
  }
  host::NotifyCore();
}

void SetEquationEditorFastProcessingMode(bool fast) {
  GlobalStateTable::Instance().Store(names::kEquationEditorFastProcessing,
                                     fast ? names::kTrue : names::kFalse);
  host::NotifyCore();
}

bool GetEquationEditorFastProcessingMode() {
  const std::wstring* stored =
      GlobalStateTable::Instance().Find(names::kEquationEditorFastProcessing);
  return stored != nullptr && *stored == names::kTrue;
}

void SetPowerKnobResolution(double resolution) {
  GlobalStateTable& table = GlobalStateTable::Instance();
  if (!std::isfinite(resolution)) ThrowInvalidArgument();
  table.Store(names::kPowerKnobResolution, LumenUtility::FormatResolution(resolution));
}

double GetPowerKnobResolution() {
  const std::wstring* stored = GlobalStateTable::Instance().Find(names::kPowerKnobResolution);
  if (stored == nullptr) return kDefaultPowerKnobResolution;
  // The table holds only texts that read back (stored here or checked on loading); anything
  // else reads as 0, as a text without a number does.
  return LumenUtility::ParseResolution(*stored).value_or(0.0);
}

int ForcePathElementValue(const std::wstring& path, const std::wstring& value) {
  return GlobalStateTable::Instance().ForcePathElementValue(path, value);
}

bool IsPathForceElementValue(const std::wstring& path, std::wstring& value) {
  return GlobalStateTable::Instance().IsPathForceElementValue(path, value);
}

void UnforcePathElementValue(int handle) {
  GlobalStateTable::Instance().UnforcePathElementValue(handle);
}

}  // namespace GlobalState
