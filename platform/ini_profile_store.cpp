#include "lumen/platform/ini_profile_store.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <limits>
#include <string>

#include "lumen/platform/cfile.h"
#include "lumen/platform/text_conversion.h"
#include "platform/ini_document.h"

namespace LumenUtility {
namespace {

// Reads the whole file at `path` into `bytes`; a missing file reads as empty. False when the
// file exists but cannot be read.
bool ReadWholeFile(const std::wstring& path, std::string& bytes) {
  bytes.clear();
  CFile file;
  CFileException error;
  if (!file.Open(path.c_str(), CFile::modeRead, &error)) return error.m_lOsError == ENOENT;
  try {
    char chunk[16 * 1024];
    while (const unsigned n = file.Read(chunk, sizeof chunk)) bytes.append(chunk, n);
  } catch (const CFileException&) {
    return false;
  }
  return true;
}

// Replaces the file at `path` by `bytes`: written to a temporary file beside it, which takes
// over the old file's permissions and is renamed over it only once complete.
bool ReplaceWholeFile(const std::wstring& path, const std::string& bytes) {
  const std::wstring temporary = path + L"." + std::to_wstring(getpid()) + L".tmp";
  const std::string narrowPath = WideToUtf8(path);
  const std::string narrowTemporary = WideToUtf8(temporary);
  try {
    CFile file(temporary.c_str(), CFile::modeCreate | CFile::modeWrite);
    file.Write(bytes.data(), static_cast<unsigned>(bytes.size()));
    file.Close();
  } catch (const CFileException&) {
    std::remove(narrowTemporary.c_str());
    return false;
  }
  struct stat old;
  if (stat(narrowPath.c_str(), &old) == 0) chmod(narrowTemporary.c_str(), old.st_mode & 07777);
  if (std::rename(narrowTemporary.c_str(), narrowPath.c_str()) != 0) {
    std::remove(narrowTemporary.c_str());
    return false;
  }
  return true;
}

// The leading decimal integer of `text`, if there is one within the 32-bit range.
bool ParseLeadingInt(const std::wstring& text, std::int32_t& value) {
  std::size_t pos = 0;
  while (pos < text.size() && (text[pos] == L' ' || text[pos] == L'\t')) ++pos;
  const bool negative = pos < text.size() && text[pos] == L'-';
  if (pos < text.size() && (text[pos] == L'-' || text[pos] == L'+')) ++pos;
  const std::size_t firstDigit = pos;
  std::int64_t magnitude = 0;
  constexpr std::int64_t kLimit = std::int64_t{std::numeric_limits<std::int32_t>::max()} + 1;
  for (; pos < text.size() && text[pos] >= L'0' && text[pos] <= L'9'; ++pos) {
    magnitude = magnitude * 10 + (text[pos] - L'0');
    if (magnitude > kLimit) return false;
  }
  if (pos == firstDigit) return false;
  const std::int64_t signedValue = negative ? -magnitude : magnitude;
  if (signedValue > std::numeric_limits<std::int32_t>::max()) return false;
  value = static_cast<std::int32_t>(signedValue);
  return true;
}

}  // namespace

void IniProfileStore::SetPath(const std::wstring& path) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  m_path = path;
  m_memoryText.clear();
}

std::wstring IniProfileStore::GetPath() const {
  const std::lock_guard<std::mutex> lock(m_mutex);
  return m_path;
}

bool IniProfileStore::LoadText(std::wstring& text) const {
  if (m_path.empty()) {
    text = m_memoryText;
    return true;
  }
  std::string bytes;
  if (!ReadWholeFile(m_path, bytes)) return false;
  text = Utf8ToWide(bytes);
  return true;
}

bool IniProfileStore::StoreText(const std::wstring& text) {
  if (m_path.empty()) {
    m_memoryText = text;
    return true;
  }
  return ReplaceWholeFile(m_path, WideToUtf8(text));
}

std::wstring IniProfileStore::GetProfileString(const std::wstring& section,
                                               const std::wstring& entry,
                                               const std::wstring& defaultValue) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  std::wstring text;
  if (!LoadText(text)) return defaultValue;
  return IniDocument::Parse(text).Find(section, entry).value_or(defaultValue);
}

int IniProfileStore::WriteProfileString(const std::wstring& section, const std::wstring& entry,
                                        const std::wstring& value) {
  const std::lock_guard<std::mutex> lock(m_mutex);
  if (!IniDocument::CanStore(section, entry, value)) return 0;
  std::wstring text;
  if (!LoadText(text)) return 0;
  IniDocument document = IniDocument::Parse(text);
  document.Set(section, entry, value);
  return StoreText(document.Text()) ? 1 : 0;
}

std::int32_t IniProfileStore::GetProfileInt(const std::wstring& section,
                                            const std::wstring& entry,
                                            std::int32_t defaultValue) {
  const std::wstring text = GetProfileString(section, entry, std::wstring());
  std::int32_t value;
  return ParseLeadingInt(text, value) ? value : defaultValue;
}

int IniProfileStore::WriteProfileInt(const std::wstring& section, const std::wstring& entry,
                                     std::int32_t value) {
  return WriteProfileString(section, entry, std::to_wstring(value));
}

}  // namespace LumenUtility
