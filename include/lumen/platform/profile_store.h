/// @file
/// The host application's profile: named string and integer entries grouped in sections,
/// where components keep their settings between runs.
///
/// The library reads and writes the profile through the store the host installs. Until one is
/// installed, the default IniProfileStore (see "lumen/platform/ini_profile_store.h") serves:
/// in memory until the host gives it a file. Section and entry names compare without regard
/// to ASCII case, as profile names do on the original platform.
/// Thread-safety: the installed pointer may be read and replaced from any thread; each store
/// states its own. Ownership: an installed store is not owned; the host keeps it alive until
/// another store replaces it and no call into it is in progress.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/export.h"

namespace LumenUtility {

/// A profile; implemented by the host or by IniProfileStore.
class LUMEN_API IProfileStore {
 public:
  virtual ~IProfileStore() = default;

  /// The string stored under `section`/`entry`, or `defaultValue` when there is none.
  virtual std::wstring GetProfileString(const std::wstring& section, const std::wstring& entry,
                                        const std::wstring& defaultValue) = 0;
  /// Stores `value` under `section`/`entry`, replacing an earlier value. Nonzero on success,
  /// 0 when the value could not be stored (the profile is then unchanged).
  virtual int WriteProfileString(const std::wstring& section, const std::wstring& entry,
                                 const std::wstring& value) = 0;
  /// The integer stored under `section`/`entry`, or `defaultValue` when there is none or it
  /// is not an integer.
  virtual std::int32_t GetProfileInt(const std::wstring& section, const std::wstring& entry,
                                     std::int32_t defaultValue) = 0;
  /// Stores `value` as an integer entry. Nonzero on success, 0 on failure (profile unchanged).
  virtual int WriteProfileInt(const std::wstring& section, const std::wstring& entry,
                              std::int32_t value) = 0;
};

/// Installs `store` as the profile; null returns to the default IniProfileStore.
LUMEN_API void SetProfileStore(IProfileStore* store);

/// The installed profile, or the default store when none is installed.
LUMEN_API IProfileStore& ProfileStore();

}  // namespace LumenUtility
