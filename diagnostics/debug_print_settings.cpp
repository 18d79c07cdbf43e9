#include <algorithm>
#include <string>

#include "lumen/diagnostics/debug_print.h"
#include "lumen/platform/profile_store.h"

namespace {

const std::wstring kSection = L"Debug";
const std::wstring kSlotsEntry = L"Debug Print";
const std::wstring kFileNameEntry = L"Debug Print Filename";
const std::wstring kFileDeviceEntry = L"Debug Print File";

}  // namespace

void CDebugPrint::SaveSettings() {
  std::wstring slots(kNumSlots, L'0');
  for (std::int32_t slot = 0; slot < kNumSlots; ++slot) {
    if (IsOn(slot)) slots[slot] = L'1';
  }
  LumenUtility::IProfileStore& profile = LumenUtility::ProfileStore();
  profile.WriteProfileString(kSection, kSlotsEntry, slots);
  profile.WriteProfileString(kSection, kFileNameEntry, GetFileName());
  profile.WriteProfileInt(kSection, kFileDeviceEntry, IsDeviceOn(File) ? 1 : 0);
}

void CDebugPrint::RecallSettings() {
  LumenUtility::IProfileStore& profile = LumenUtility::ProfileStore();
  const std::wstring slots = profile.GetProfileString(kSection, kSlotsEntry, L"");
  const std::size_t count = std::min<std::size_t>(slots.size(), kNumSlots);
  for (std::size_t slot = 0; slot < count; ++slot) {
    SetOn(static_cast<std::int32_t>(slot), slots[slot] == L'1');
  }

  const std::wstring fileName = profile.GetProfileString(kSection, kFileNameEntry, L"");
  const bool fileOn = profile.GetProfileInt(kSection, kFileDeviceEntry, 0) != 0;
  const std::lock_guard<std::mutex> lock(m_fileMutex);
  if (!fileName.empty()) m_fileName = fileName;
  // Switching off first makes switching on open the file anew, under the recalled name.
  // That includes a device left on by an earlier open that failed: the recalled settings
  // ask for a file, so it is tried again rather than left without one.
  SetFileDeviceLocked(false);
  if (fileOn) SetFileDeviceLocked(true);
}
