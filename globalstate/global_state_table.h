// GlobalStateTable: the values behind the GlobalState functions: the settings as text by key,
// the frequency reference apart from them, and the forced path element values by handle.
//
// Every lookup, store and removal by key goes to the reference map for the exact key
// "ReferenceState" and to the settings map for any other key. The process-wide table is
// created on first use and kept until the process ends.
// Thread-safety: none; one thread at a time. Ownership: the table owns its strings.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <utility>

namespace LumenUtility {

class GlobalStateTable {
 public:
  using Settings = std::map<std::wstring, std::wstring>;

  // The table as at start-up: no settings, no forced elements, and "ReferenceState" =
  // "Internal" when the library keeps the reference (the host's hardware capabilities).
  GlobalStateTable();

  // The process-wide table, built on the first call.
  static GlobalStateTable& Instance();
  // Builds the process-wide table again as at start-up, for a host that starts over (and for
  // tests, which change the hardware between cases).
  static void Restart();

  // The value stored under `key`, or null; valid until the table changes.
  const std::wstring* Find(const std::wstring& key) const;
  void Store(const std::wstring& key, std::wstring value);
  void Remove(const std::wstring& key);

  // Every setting except the reference, in key order.
  const Settings& GetSettings() const { return m_settings; }
  // Replaces every setting except the reference.
  void ReplaceSettings(Settings settings) { m_settings = std::move(settings); }

  // See GlobalState::ForcePathElementValue and its neighbours.
  int ForcePathElementValue(const std::wstring& path, const std::wstring& value);
  bool IsPathForceElementValue(const std::wstring& path, std::wstring& value) const;
  void UnforcePathElementValue(int handle);

 private:
  Settings& MapFor(const std::wstring& key);
  const Settings& MapFor(const std::wstring& key) const;

  static std::unique_ptr<GlobalStateTable> s_pTable;

  int m_lastHandle = -1;
  std::map<int, std::pair<std::wstring, std::wstring>> m_forcedElements;
  Settings m_settings;
  Settings m_referenceSetting;
};

}  // namespace LumenUtility
