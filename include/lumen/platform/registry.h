/// @file
/// The registry as the library reads it: one process-wide RegistryStore, read only.
///
/// The host chooses where the values come from: a configuration file (see
/// SetRegistryConfigurationFile) or a store it fills itself. Until it does, the registry is
/// empty and every reader takes its default. No environment variable is consulted.
/// Thread-safety: none; the host sets the store during start-up, and library code reads it on
/// the threads its callers use one at a time.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/registry_store.h"

namespace LumenUtility {

/// Reads the configuration file at `path` and makes it the registry. The file is UTF-8 text:
/// a "[key path]" line, then its "name = value" lines, a value being "dword:" and 1 to 8
/// hexadecimal digits, "expand:" and a text, or a text (in double quotes to keep blanks);
/// lines starting with ";" or "#" are comments. On failure throws CFileException (unreadable
/// file) or LumenException LUMEN_E_BOUNDS (a malformed line, with its number, or a file over
/// 1 MiB), and the registry stays as it was. Later changes to the file are read by calling again.
LUMEN_API void SetRegistryConfigurationFile(const std::wstring& path);

/// Makes `store` the registry (an empty store empties it).
LUMEN_API void SetRegistryStore(RegistryStore store);

/// The registry as it stands; valid until the next Set call.
LUMEN_API const RegistryStore& GetRegistryStore();

}  // namespace LumenUtility
