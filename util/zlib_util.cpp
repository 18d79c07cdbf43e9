#include "lumen/util/zlib_util.h"

#include <filesystem>

#include "lumen/platform/text_conversion.h"
#include "util/zip_extractor.h"
#include "util/zip_path.h"
#include "util/zip_writer.h"

namespace LumenUtility::ZlibUtil {
namespace {

// `baseDir` with its dot segments resolved and a trailing '/', or empty for the current
// directory.
std::string BaseDirectory(const std::wstring& baseDir) {
  std::string base = std::filesystem::path(WideToUtf8(baseDir)).lexically_normal().string();
  if (!base.empty() && base.back() != '/') base += '/';
  return base;
}

}  // namespace

bool DoZip(const std::wstring& baseDir, const std::vector<std::wstring>& files,
           const std::wstring& zipPath) {
  try {
    ZipWriter writer;
    if (!writer.Open(zipPath)) return false;
    const std::string base = BaseDirectory(baseDir);
    bool result = true;
    for (const std::wstring& file : files) {
      const std::optional<std::string> entry = NormalizeRelativePath(WideToUtf8(file));
      if (!entry || !writer.Add(base + *entry, *entry)) result = false;
    }
    return writer.Finish() && result;
  } catch (const CFileException&) {
    return false;
  }
}

bool DoZip(const std::wstring& filePath, const std::wstring& zipPath) {
  const std::size_t slash = filePath.rfind(L'/');
  if (slash == std::wstring::npos) return DoZip(std::wstring(), {filePath}, zipPath);
  return DoZip(filePath.substr(0, slash + 1), {filePath.substr(slash + 1)}, zipPath);
}

bool DoUnzip(const std::wstring& zipPath, const std::wstring& destDir,
             std::vector<std::wstring>* extracted) {
  try {
    ZipExtractor extractor;
    return extractor.Extract(zipPath, destDir, extracted);
  } catch (const CFileException&) {
    return false;
  }
}

}  // namespace LumenUtility::ZlibUtil
