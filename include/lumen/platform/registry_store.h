/** @file */
/// @class LumenUtility::RegistryStore
/// RegistryStore: typed registry values in memory, found by key path and value name, as the
/// system registry would answer them.
///
/// Key paths and value names compare without regard to ASCII case, and a key path's trailing
/// backslashes do not count (`HKEY_LOCAL_MACHINE\SOFTWARE\X\` is `hkey_local_machine\software\x`).
/// Each value has the registry's type number. A typed query answers only a value of its type:
/// a value of another type counts as absent, as it does for the readers of the registry.
/// The process-wide store that library code reads is set through "lumen/platform/registry.h".
/// Thread-safety: a plain value; confine each object to one thread.
#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <utility>

#include "lumen/export.h"

namespace LumenUtility {

///@{
/// The registry's type numbers of the values the library reads.
inline constexpr std::uint32_t REG_SZ = 1;
inline constexpr std::uint32_t REG_EXPAND_SZ = 2;
inline constexpr std::uint32_t REG_BINARY = 3;
inline constexpr std::uint32_t REG_DWORD = 4;
///@}

/// One value of the store: its type and, by type, its number or text.
struct RegistryValue {
  /// The registry type number.
  std::uint32_t type = REG_SZ;
  std::uint32_t dword = 0;  ///< the value of a REG_DWORD
  std::wstring text;        ///< the value of a REG_SZ or REG_EXPAND_SZ
};

class LUMEN_API RegistryStore {
 public:
  /// Stores a REG_DWORD under (keyPath, name), replacing any value of any type there.
  void SetDword(const std::wstring& keyPath, const std::wstring& name, std::uint32_t value);
  /// Stores a string under (keyPath, name) with `type` REG_SZ or REG_EXPAND_SZ; any other
  /// type throws std::invalid_argument and changes nothing.
  void SetString(const std::wstring& keyPath, const std::wstring& name, const std::wstring& text,
                 std::uint32_t type = REG_SZ);
  /// Stores `value` as it is (a REG_BINARY, for example, to stand for a value of a type the
  /// library does not read).
  void SetValue(const std::wstring& keyPath, const std::wstring& name, RegistryValue value);

  /// The value under (keyPath, name) whatever its type, or null; valid until the store changes.
  const RegistryValue* Find(const std::wstring& keyPath, const std::wstring& name) const;
  /// The value when it is a REG_DWORD; otherwise (absent or of another type) nothing.
  std::optional<std::uint32_t> QueryDword(const std::wstring& keyPath,
                                          const std::wstring& name) const;
  /// The text when the value is a REG_SZ or REG_EXPAND_SZ; otherwise nothing.
  std::optional<std::wstring> QueryString(const std::wstring& keyPath,
                                          const std::wstring& name) const;

  /// Number of values stored.
  std::size_t size() const { return m_values.size(); }
  /// True when no value is stored.
  bool empty() const { return m_values.empty(); }

 private:
  using Key = std::pair<std::wstring, std::wstring>;
  static Key MakeKey(const std::wstring& keyPath, const std::wstring& name);

  std::map<Key, RegistryValue> m_values;
};

}  // namespace LumenUtility
