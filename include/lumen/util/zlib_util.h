/// @file
/// ZlibUtil: packing files into ZIP archives and unpacking them in process, with zlib's raw
/// deflate for the data.
///
/// Archives hold one deflated entry per file, named by its path relative to a base directory
/// with '/' separators, with DOS modification times in local time and an extra block that
/// records whether daylight saving time was in effect. Sizes are 32-bit (no ZIP64): files of
/// 4 GiB or more, archives that would pass 4 GiB and more than 65535 entries are not written.
/// Paths are UTF-8 on disk; entry names are UTF-8, flagged as such when they are not plain
/// ASCII, and bytes of an entry name that are not UTF-8 are extracted as U+FFFD. Every function
/// reports success as its result and throws nothing but std::bad_alloc. Thread-safety: the
/// functions share no state; calls on different files may run in parallel.
#pragma once

#include <string>
#include <vector>

#include "lumen/export.h"

namespace LumenUtility::ZlibUtil {

/// Writes a new archive at `zipPath` (created or replaced) holding the listed files, each
/// named by its path relative to `baseDir` (dot segments resolved). An empty name, an absolute
/// one, one that climbs out of `baseDir` (../x), a file that cannot be read or is not a regular
/// file, and a file that does not fit the format are left out, and the result is false; the
/// other files are still packed. Also false when the archive cannot be written (it may then be
/// incomplete).
LUMEN_API bool DoZip(const std::wstring& baseDir, const std::vector<std::wstring>& files,
                     const std::wstring& zipPath);
/// Packs the one file `filePath` under its own name (the part after the last '/').
LUMEN_API bool DoZip(const std::wstring& filePath, const std::wstring& zipPath);

/// Extracts every entry of `zipPath` below `destDir` (created when missing; empty: the current
/// directory), replacing files of the same names, and appends each entry's relative path
/// ('/'-separated; a directory entry ends in '/') to `extracted` when it is not null (the
/// vector is not cleared). Stored and deflated entries are read, with their sizes and CRC-32
/// in the header or in a data descriptor after the data. Each file gets the entry's
/// modification time and appears only once its size and CRC-32 have been checked.
/// Returns false, at the first failing entry (the ones before it stay extracted), when the
/// archive cannot be read or holds another kind of record, an entry uses another method or
/// encryption, its data are corrupt or fail the checks, or its name is absolute or climbs out of
/// `destDir`; nothing is ever written outside `destDir`, not even through links inside it.
LUMEN_API bool DoUnzip(const std::wstring& zipPath, const std::wstring& destDir,
                       std::vector<std::wstring>* extracted);

}  // namespace LumenUtility::ZlibUtil
