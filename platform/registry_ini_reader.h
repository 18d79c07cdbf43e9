// RegistryIniReader: reads the configuration file that stands in for the system registry.
//
// The file is UTF-8 text (a leading byte-order mark is skipped), lines ending in LF or CR LF:
//
//   ; the second test set
//   [HKEY_LOCAL_MACHINE\SOFTWARE\Corvane\Network Analyzer]
//   T2Mode = dword:00000001
//   T2Name = "Test set 2"
//   T2Path = expand:%ProgramData%\T2
//
// A line in brackets names the key that the value lines after it belong to. A value line is a
// name, "=", and a value: "dword:" and 1 to 8 hexadecimal digits make a REG_DWORD; "expand:"
// and a text make a REG_EXPAND_SZ; any other text is a REG_SZ. Blanks and tabs around names,
// values and key paths do not count; a text in double quotes keeps its blanks (the quotes are
// not part of it, and nothing inside is an escape). Lines that are empty or start with ";" or
// "#" are comments. A later value of the same name replaces an earlier one.
// Stateless; reentrant.
#pragma once

#include <string>
#include <string_view>

#include "lumen/platform/registry_store.h"

namespace LumenUtility {

class RegistryIniReader {
 public:
  // The largest file read, 1 MiB: a configuration of a few values is far smaller, and a
  // larger file is the wrong file.
  static constexpr std::size_t kMaxFileBytes = 1 << 20;

  // The values of `text`. Throws LumenException LUMEN_E_BOUNDS with the message
  // "registry configuration line N: <what is wrong>" at the first line that fits none of the
  // forms above.
  static RegistryStore Parse(std::string_view text);

  // The values of the file at `path`. Throws CFileException when it cannot be read,
  // LumenException LUMEN_E_BOUNDS when it is larger than kMaxFileBytes or as Parse (the
  // message then ends with " in " and the path).
  static RegistryStore ReadFile(const std::wstring& path);
};

}  // namespace LumenUtility
