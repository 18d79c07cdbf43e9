/** @file */
/// @class LumenUtility::FileSearch
/// FileSearch: the file-system entries that match a wildcard path such as /data/*.csv,
/// optionally in every subdirectory too.
///
/// The last path component is the pattern, matched against each entry name with the wildcard
/// rules of the analyzer's original platform: `*` stands for any run of characters (none
/// included), `?` for exactly one, every other character for itself with ASCII letters
/// compared without case (*.CSV finds a.csv), and the pattern `*.*` for every name, with or
/// without a dot. Directories that match are listed like files; with `*.*` that includes the
/// entries `.` and `..` of each directory searched.
/// Results are full paths: the directory part of the pattern, as given, followed by the entry
/// name. A search lists, depth first, the matches inside each subdirectory before the matches of
/// the directory itself; within one directory, entries come in the order the system returns
/// them. Symbolic links to directories are followed, except back into a directory the search
/// is already inside, so a link cycle cannot make it run forever.
/// Missing directories and unmatched patterns simply give no results; only std::bad_alloc is
/// thrown. Names on disk are UTF-8.
/// Thread-safety: confine to one thread. Ownership: a value; it holds only the result strings.
#pragma once

#include <string>
#include <vector>

#include "lumen/export.h"

namespace LumenUtility {

class LUMEN_API FileSearch {
 public:
  /// Any value other than Recurse searches the directory alone, as the original flag does.
  enum RecurseSubDirs : int { Recurse = 0, NoRecurse = 1 };

  /// Runs Search(path, recurse).
  FileSearch(const wchar_t* path, RecurseSubDirs recurse);

  /// Replaces the results by those of a new search of `path` (null counts as empty): the
  /// directory part up to and including the last `/` (none: the current directory, and the
  /// results have no directory prefix) and the pattern after it. `Recurse` searches every
  /// subdirectory below the directory part as well; any other value only the directory itself.
  void Search(const wchar_t* path, RecurseSubDirs recurse);
  /// A copy of the paths found by the last search.
  std::vector<std::wstring> GetResults() const { return m_results; }

  /// `directory`, a `/` unless `directory` is empty or already ends with one, then `pattern`
  /// (null pointers count as empty strings).
  static std::wstring CreateSearchPattern(const wchar_t* directory, const wchar_t* pattern);

 private:
  std::vector<std::wstring> m_results;
};

}  // namespace LumenUtility
