#include "lumen/util/zip7_util.h"

#include <fcntl.h>
#include <stdlib.h>
#include <unistd.h>

#include <filesystem>
#include <system_error>

#include "lumen/platform/stdio_file.h"
#include "lumen/platform/text_conversion.h"
#include "platform/command_line.h"
#include "platform/process.h"
#include "util/zip7_listing.h"

namespace LumenUtility::Zip7Util {
namespace {

std::wstring& ArchiverDirectory() {
  static std::wstring directory = L"/usr/bin/";
  return directory;
}

// Whether `text` can stand between double quotes on the command line: a quote would end the
// quoting, a trailing backslash would escape the closing quote.
bool Quotable(const std::wstring& text) {
  return text.find(L'"') == std::wstring::npos && (text.empty() || text.back() != L'\\');
}

// Whether the archiver takes `path`, quoted, for a path: not for a switch or a list file.
bool QuotablePath(const std::wstring& path) {
  return Quotable(path) && (path.empty() || (path.front() != L'-' && path.front() != L'@'));
}

std::wstring Quoted(const std::wstring& text) {
  return L"\"" + text + L"\"";
}

// Runs the archiver with the command line "7za" + `arguments`; true when it exited with 0.
bool RunArchiver(const std::wstring& arguments, const std::wstring& workDir, int outputFd = -1) {
  const std::optional<int> status =
      RunProcess(ArchiverDirectory() + L"7za", SplitCommandLine(arguments), workDir, outputFd);
  return status == 0;
}

// Runs the listing of `zipPath` into a temporary file and reads the entry names from it.
bool ListEntries(const std::wstring& zipPath, std::vector<std::wstring>& names) {
  std::error_code error;
  const std::filesystem::path directory = std::filesystem::temp_directory_path(error);
  if (error) return false;
  std::string path = (directory / "7ZipXXXXXX").string();
  const int fd = mkostemp(path.data(), O_CLOEXEC);
  if (fd < 0) return false;
  const bool listed = RunArchiver(L" l " + Quoted(zipPath), std::wstring(), fd);
  ::close(fd);
  std::vector<std::wstring> lines;
  if (listed) {
    try {
      CStdioFile listing(Utf8ToWide(path).c_str(), CFile::modeRead);
      for (std::wstring line; listing.ReadString(line);) lines.push_back(line);
    } catch (const CFileException&) {
      ::unlink(path.c_str());
      return false;
    }
  }
  ::unlink(path.c_str());
  AppendListedNames(lines, names);
  return listed;
}

}  // namespace

std::wstring GetArchiverDirectory() {
  return ArchiverDirectory();
}

void SetArchiverDirectory(const std::wstring& directory) {
  ArchiverDirectory() = directory;
}

bool DoZip(const std::wstring& filePath, const std::wstring& zipPath) {
  if (!QuotablePath(filePath) || !QuotablePath(zipPath)) return false;
  return RunArchiver(L" a -tzip -mx=1 " + Quoted(zipPath) + L" " + Quoted(filePath),
                     std::wstring());
}

bool DoZip(const std::wstring& workDir, const std::vector<std::wstring>& files,
           const std::wstring& zipPath) {
  if (!QuotablePath(zipPath)) return false;
  std::wstring arguments = L" a -tzip -mx=1 " + Quoted(zipPath);
  for (const std::wstring& file : files) {
    if (!QuotablePath(file)) return false;
    arguments += L" " + Quoted(file);
  }
  return RunArchiver(arguments, workDir);
}

bool DoUnzip(const std::wstring& zipPath, const std::wstring& destDir,
             std::vector<std::wstring>* files) {
  if (!QuotablePath(zipPath) || !Quotable(destDir)) return false;
  if (files) files->clear();
  if (!RunArchiver(L" x " + Quoted(zipPath) + L" " + Quoted(L"-o" + destDir), std::wstring()))
    return false;
  return !files || ListEntries(zipPath, *files);
}

}  // namespace LumenUtility::Zip7Util
