#include "lumen/util/file_search.h"

#include <dirent.h>
#include <sys/stat.h>

#include <algorithm>
#include <cstring>
#include <utility>

#include "lumen/platform/text_conversion.h"
#include "util/wildcard_match.h"

namespace LumenUtility {
namespace {

// A directory's identity, to recognise it again when a link leads back into it.
using DirectoryId = std::pair<dev_t, ino_t>;

// Entry names of one directory, in the system's order; empty for a directory that cannot be
// opened. An error while reading ends the list, as the end does.
class DirectoryEntries {
 public:
  explicit DirectoryEntries(const std::string& directory)
      : m_directory(directory.empty() ? std::string(".") : directory),
        m_dir(opendir(m_directory.c_str())) {}
  ~DirectoryEntries() {
    if (m_dir) closedir(m_dir);
  }
  DirectoryEntries(const DirectoryEntries&) = delete;
  DirectoryEntries& operator=(const DirectoryEntries&) = delete;

  // The next entry, or null at the end. `isDirectory` tells whether it is a directory or a
  // link to one.
  const dirent* Next(bool& isDirectory) {
    const dirent* entry = m_dir ? readdir(m_dir) : nullptr;
    if (!entry) return nullptr;
    isDirectory = entry->d_type == DT_DIR;
    if (entry->d_type == DT_LNK || entry->d_type == DT_UNKNOWN) {
      struct stat info;
      isDirectory =
          stat((m_directory + '/' + entry->d_name).c_str(), &info) == 0 && S_ISDIR(info.st_mode);
    }
    return entry;
  }

 private:
  std::string m_directory;
  DIR* m_dir;
};

bool IdOf(const std::string& directory, DirectoryId& id) {
  struct stat info;
  if (stat(directory.empty() ? "." : directory.c_str(), &info) != 0) return false;
  id = {info.st_dev, info.st_ino};
  return true;
}

// Appends the matches of `pattern` in `directory` (empty or ending in '/') and, when
// `recurse`, first those of every subdirectory not in `inside` (the directories of the
// current descent).
void SearchDirectory(const std::string& directory, const std::wstring& pattern, bool recurse,
                     std::vector<DirectoryId>& inside, std::vector<std::wstring>& results) {
  if (recurse) {
    // Names first, then the descent: a deep tree keeps one directory open, not one per level.
    std::vector<std::string> subdirectories;
    {
      DirectoryEntries entries(directory);
      bool isDirectory = false;
      while (const dirent* entry = entries.Next(isDirectory)) {
        if (isDirectory && std::strcmp(entry->d_name, ".") != 0 &&
            std::strcmp(entry->d_name, "..") != 0)
          subdirectories.push_back(directory + entry->d_name + '/');
      }
    }
    for (const std::string& subdirectory : subdirectories) {
      DirectoryId id;
      if (!IdOf(subdirectory, id) || std::find(inside.begin(), inside.end(), id) != inside.end())
        continue;
      inside.push_back(id);
      SearchDirectory(subdirectory, pattern, recurse, inside, results);
      inside.pop_back();
    }
  }
  DirectoryEntries entries(directory);
  bool isDirectory = false;
  while (const dirent* entry = entries.Next(isDirectory)) {
    if (MatchesWildcard(Utf8ToWide(entry->d_name), pattern))
      results.push_back(Utf8ToWide(directory + entry->d_name));
  }
}

}  // namespace

FileSearch::FileSearch(const wchar_t* path, RecurseSubDirs recurse) {
  Search(path, recurse);
}

void FileSearch::Search(const wchar_t* path, RecurseSubDirs recurse) {
  const std::wstring text = path ? path : L"";
  const std::size_t slash = text.rfind(L'/');
  const std::size_t patternAt = slash == std::wstring::npos ? 0 : slash + 1;
  const std::string directory = WideToUtf8(std::wstring_view(text).substr(0, patternAt));
  std::vector<std::wstring> results;
  std::vector<DirectoryId> inside;
  DirectoryId id;
  if (IdOf(directory, id)) inside.push_back(id);
  SearchDirectory(directory, text.substr(patternAt), recurse == Recurse, inside, results);
  m_results = std::move(results);
}

std::wstring FileSearch::CreateSearchPattern(const wchar_t* directory, const wchar_t* pattern) {
  std::wstring result = directory ? directory : L"";
  if (!result.empty() && result.back() != L'/') result += L'/';
  if (pattern) result += pattern;
  return result;
}

}  // namespace LumenUtility
