#include "globalstate/global_state_table.h"

#include <limits>

#include "globalstate/global_state_host.h"
#include "globalstate/global_state_names.h"

namespace LumenUtility {

namespace names = GlobalStateNames;

std::unique_ptr<GlobalStateTable> GlobalStateTable::s_pTable;

GlobalStateTable::GlobalStateTable() {
  if (GlobalStateHost::CanStoreReference()) Store(names::kReferenceState, names::kInternal);
}

GlobalStateTable& GlobalStateTable::Instance() {
  // A start-up that fails (a host object throws) leaves no table, so the next call tries again.
  if (!s_pTable) s_pTable = std::make_unique<GlobalStateTable>();
  return *s_pTable;
}

void GlobalStateTable::Restart() {
  s_pTable.reset();
  Instance();
}

GlobalStateTable::Settings& GlobalStateTable::MapFor(const std::wstring& key) {
  return key == names::kReferenceState ? m_referenceSetting : m_settings;
}

const GlobalStateTable::Settings& GlobalStateTable::MapFor(const std::wstring& key) const {
  return key == names::kReferenceState ? m_referenceSetting : m_settings;
}

const std::wstring* GlobalStateTable::Find(const std::wstring& key) const {
  const Settings& map = MapFor(key);
  const auto found = map.find(key);
  return found == map.end() ? nullptr : &found->second;
}

void GlobalStateTable::Store(const std::wstring& key, std::wstring value) {
  MapFor(key)[key] = std::move(value);
}

void GlobalStateTable::Remove(const std::wstring& key) {
  MapFor(key).erase(key);
}

int GlobalStateTable::ForcePathElementValue(const std::wstring& path, const std::wstring& value) {
  // Handles only grow; past the largest int there is none left to give.
  if (m_lastHandle == std::numeric_limits<int>::max()) return -1;
  const int handle = m_lastHandle + 1;
  if (!m_forcedElements.emplace(handle, std::make_pair(path, value)).second) return -1;
  m_lastHandle = handle;
  return handle;
}

bool GlobalStateTable::IsPathForceElementValue(const std::wstring& path,
                                               std::wstring& value) const {
  for (const auto& [handle, element] : m_forcedElements) {
    if (element.first == path) {
      value = element.second;
      return true;
    }
  }
  return false;
}

void GlobalStateTable::UnforcePathElementValue(int handle) {
  m_forcedElements.erase(handle);
}

}  // namespace LumenUtility
