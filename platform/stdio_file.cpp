#include "lumen/platform/stdio_file.h"

#include <cstring>

#include "lumen/platform/text_conversion.h"

CStdioFile::CStdioFile(const wchar_t* path, unsigned flags) {
  CFileException error;
  if (!Open(path, flags, &error)) throw error;
}

int CStdioFile::Open(const wchar_t* path, unsigned flags, CFileException* error) {
  const int opened = CFile::Open(path, flags, error);
  if (opened) m_textMode = (flags & typeBinary) == 0;
  return opened;
}

int CStdioFile::ReadString(std::wstring& line) {
  std::string bytes;
  bool ended = false;
  char c;
  while (CFile::Read(&c, 1) == 1) {
    if (c == '\n') {
      ended = true;
      break;
    }
    bytes.push_back(c);
  }
  if (!ended && bytes.empty()) {
    line.clear();
    return 0;
  }
  if (ended && m_textMode && !bytes.empty() && bytes.back() == '\r') bytes.pop_back();
  line = LumenUtility::Utf8ToWide(bytes);
  return 1;
}

void CStdioFile::WriteString(const wchar_t* text) {
  if (!text) return;
  const std::string utf8 = LumenUtility::WideToUtf8(text);
  CFile::Write(utf8.data(), static_cast<unsigned>(utf8.size()));
}
