// The host objects the global state calls, looked up in the capabilities table (category 3,
// index 0) at each use. A missing object is taken as the least the settings can work
// with, never dereferenced: without hardware capabilities the library keeps the reference and
// there is no index line; without hardware control nothing is switched and the reference
// reads "Internal"; without a core nobody is notified; without the device list nothing is
// selected.
#pragma once

#include <string>
#include <vector>

class HWControl;

namespace LumenUtility::GlobalStateHost {

// INAHardwareCaps::CanStoreReference; true without the object.
bool CanStoreReference();
// INAHardwareCaps::HasIndexLine; false without the object.
bool HasIndexLine();
// The hardware control object, or null.
HWControl* Hardware();
// ILumenCore::OnGlobalStateChanged, when there is a core.
void NotifyCore();
// ISelectedExternalDevices::GetSelectedDevices(kind); empty without the object.
std::vector<std::wstring> SelectedDevices(int kind);

}  // namespace LumenUtility::GlobalStateHost
