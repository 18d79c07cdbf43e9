#include "globalstate/global_state_host.h"

#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

namespace LumenUtility::GlobalStateHost {

namespace {

template <class Interface>
Interface* Find() {
  return FindHostObject<Interface>(kHostCategoryApplication, 0);
}

}  // namespace

bool CanStoreReference() {
  INAHardwareCaps* caps = Find<INAHardwareCaps>();
  return caps == nullptr || caps->CanStoreReference();
}

bool HasIndexLine() {
  INAHardwareCaps* caps = Find<INAHardwareCaps>();
  return caps != nullptr && caps->HasIndexLine();
}

HWControl* Hardware() {
  return Find<HWControl>();
}

void NotifyCore() {
  if (LumenApp::ILumenCore* core = Find<LumenApp::ILumenCore>()) core->OnGlobalStateChanged();
}

std::vector<std::wstring> SelectedDevices(int kind) {
  Interface::ISelectedExternalDevices* devices = Find<Interface::ISelectedExternalDevices>();
  return devices ? devices->GetSelectedDevices(kind) : std::vector<std::wstring>();
}

}  // namespace LumenUtility::GlobalStateHost
