/** @file */
/// @class CStdioFile
/// CStdioFile: a text file read line by line and written as text, over the buffered CFile.
///
/// Text is UTF-8 on disk (the 8-bit code page of this system). In text mode (the default,
/// typeText) a line read drops a CR before its LF, so files written on either platform read
/// alike; with typeBinary the CR stays. WriteString writes "\n" as is in both modes.
/// Thread-safety: confine each object to one thread. Ownership: as CFile.
#pragma once

#include <string>

#include "lumen/export.h"
#include "lumen/platform/cfile.h"

class LUMEN_API CStdioFile : public CFile {
 public:
  CStdioFile() = default;
  /// Opens as Open does; throws the CFileException that Open would report.
  CStdioFile(const wchar_t* path, unsigned flags);

  int Open(const wchar_t* path, unsigned flags, CFileException* error = nullptr) override;

  /// Reads the next line without its line end into `line`. Returns nonzero when a line was
  /// read (a last line without LF included); 0 at the end of the file, with `line` empty.
  /// Malformed UTF-8 becomes U+FFFD. Throws CFileException on a read error.
  int ReadString(std::wstring& line);
  /// Writes `text` as UTF-8 (null writes nothing). Throws CFileException on a write error.
  void WriteString(const wchar_t* text);

 private:
  bool m_textMode = true;
};
