// Entry names of ZIP archives: which relative paths may become entries, and which entries may
// be written below a destination directory.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace LumenUtility {

// The '/'-separated relative path `path` with empty and "." components dropped and each ".."
// taking back the component before it. std::nullopt for an absolute path (leading '/'), a ".."
// with nothing to take back (the path climbs out), a NUL character or an empty result.
std::optional<std::string> NormalizeRelativePath(std::string_view path);

// The entry named `name` as a path below the destination: `\` counts as `/` (archives of the
// Windows build use it), and a trailing separator marks a directory (`isDirectory`). Refused
// (std::nullopt) as NormalizeRelativePath refuses, and for a drive prefix such as "C:".
std::optional<std::string> ExtractionPath(std::string_view name, bool& isDirectory);

}  // namespace LumenUtility
