/// @file
/// Zip7Util: packing and unpacking ZIP archives through the external command-line archiver
/// 7za, for the jobs the in-process ZlibUtil leaves to it.
///
/// Each function runs the archiver from the process-wide archiver directory with a command line
/// of this form (Q a double quote), split into arguments by the Windows runtime's rules and
/// started directly, never through a shell:
///   7za a -tzip -mx=1 Q zip Q Q file Q ...   packing (in the working directory given, if any)
///   7za x Q zip Q Q -o destDir Q             extraction
///   7za l Q zip Q                            listing, its output read back for the names
/// It waits for the archiver without a time limit. The archiver reads no answers: its standard
/// input is empty, so a question (whether to replace an existing file) ends it with an error.
/// A function returns true only when the archiver ran and exited with status 0. Paths holding a
/// double quote or ending in a backslash (either would break the command line's quoting), and
/// paths that start with '-' or '@' (the archiver would take them for a switch or a list file)
/// are refused with false before anything runs. Nothing is thrown but std::bad_alloc.
/// Thread-safety: the archiver directory is process-wide; set it during start-up, before any
/// call. Calls may otherwise run in parallel.
#pragma once

#include <string>
#include <vector>

#include "lumen/export.h"

namespace LumenUtility::Zip7Util {

/// The directory the archiver is started from, with its trailing '/'; "/usr/bin/" until set.
LUMEN_API std::wstring GetArchiverDirectory();
/// Sets the archiver directory; the program name "7za" follows it directly, so it should end
/// in '/' (empty: the archiver is looked up in PATH).
LUMEN_API void SetArchiverDirectory(const std::wstring& directory);

/// Packs `filePath` into the archive `zipPath` (added to, or created), from the caller's
/// working directory.
LUMEN_API bool DoZip(const std::wstring& filePath, const std::wstring& zipPath);
/// Packs `files` into `zipPath`, the archiver running in `workDir` (so relative names are
/// taken from there and keep their directories in the archive).
LUMEN_API bool DoZip(const std::wstring& workDir, const std::vector<std::wstring>& files,
                     const std::wstring& zipPath);
/// Extracts `zipPath` below `destDir`. When `files` is not null it is cleared and, after the
/// extraction, filled with the entry names of the archive's listing (directories included);
/// false when the listing cannot be made.
LUMEN_API bool DoUnzip(const std::wstring& zipPath, const std::wstring& destDir,
                       std::vector<std::wstring>* files);

}  // namespace LumenUtility::Zip7Util
