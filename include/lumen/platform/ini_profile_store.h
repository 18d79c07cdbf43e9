/** @file */
/// @class LumenUtility::IniProfileStore
/// IniProfileStore: the default profile, kept in memory or in an INI file.
///
/// The file is UTF-8 text of "[Section]" header lines and "entry=value" lines; blanks around
/// names and values are not part of them, a value with blanks at either end or wrapped in
/// double quotes is written inside one more pair of double quotes, and lines starting with ';'
/// are comments. When a name occurs twice, the first occurrence counts. Every access reads
/// the file anew and every write replaces it whole through a temporary file renamed over it,
/// so several processes sharing one profile see each other's settings and a failed write
/// leaves the old file as it was. Rewriting keeps comments, other entries and their order.
/// Without a path (the start) the entries are kept in memory only.
/// Thread-safety: all operations may be called from any thread at once (one lock per store).
/// Ownership: owns its memory entries; the file belongs to whoever set the path.
#pragma once

#include <cstdint>
#include <mutex>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/profile_store.h"

namespace LumenUtility {

class LUMEN_API IniProfileStore : public IProfileStore {
 public:
  IniProfileStore() = default;

  /// Keeps the profile in the INI file at `path` from now on (a missing file is created by
  /// the first write); an empty path returns to memory. The entries held so far are not
  /// carried over either way. No file is touched by this call.
  void SetPath(const std::wstring& path);
  /// The INI file path; empty while the profile is kept in memory.
  std::wstring GetPath() const;

  /// As IProfileStore. Reads give the default when the file cannot be read. Writes return 0,
  /// leaving the file untouched, when it exists but cannot be read (it is not overwritten),
  /// when it cannot be replaced, and when a name or value cannot be written as a line: an
  /// empty or blank-edged section or entry, a ']' in a section, a '=' in an entry or one
  /// starting with '[' or ';', or a line end or zero character in any of them.
  std::wstring GetProfileString(const std::wstring& section, const std::wstring& entry,
                                const std::wstring& defaultValue) override;
  int WriteProfileString(const std::wstring& section, const std::wstring& entry,
                         const std::wstring& value) override;
  /// Reads the leading decimal integer of the value (blanks and a sign before it allowed,
  /// text after it ignored); a value without one, or outside the 32-bit range, gives the
  /// default. Writes the value in decimal.
  std::int32_t GetProfileInt(const std::wstring& section, const std::wstring& entry,
                             std::int32_t defaultValue) override;
  int WriteProfileInt(const std::wstring& section, const std::wstring& entry,
                      std::int32_t value) override;

 private:
  /// The stored text: the file's, or the memory copy. False when the file cannot be read.
  bool LoadText(std::wstring& text) const;
  /// Replaces the stored text; false on failure.
  bool StoreText(const std::wstring& text);

  mutable std::mutex m_mutex;
  std::wstring m_path;
  std::wstring m_memoryText;
};

/// The store ProfileStore() gives when the host has installed none.
LUMEN_API IniProfileStore& DefaultProfileStore();

}  // namespace LumenUtility
