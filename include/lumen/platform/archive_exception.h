/** @file */
/// @class CArchiveException
/// CArchiveException: a failed archive operation (wrong direction, end of data, bad content),
/// thrown by value by CArchive and by the code that reads archives.
///
/// `m_cause` holds the framework's cause numbers; `m_lOsError` is -1 (archive failures do not
/// come from the system; file failures arrive as CFileException); `m_strFileName` names the
/// archive's file when it has one.
/// Thread-safety: a plain value; confine each object to one thread.
#pragma once

#include <cstdint>
#include <exception>
#include <string>

#include "lumen/export.h"

class LUMEN_API CArchiveException : public std::exception {
 public:
  /// Causes, with the numbers of the original platform.
  enum {
    none = 0,
    genericException = 1,
    readOnly = 2,
    endOfFile = 3,
    writeOnly = 4,
    badIndex = 5,
    badClass = 6,
    badSchema = 7
  };

  /// An exception of `cause` about the file `fileName` (null: none named).
  explicit CArchiveException(int cause = none, const wchar_t* fileName = nullptr);

  /// As CFileException::GetErrorMessage: the message for the cause into `buffer` (at most
  /// `maxChars` characters with the terminator); nonzero when something was written.
  int GetErrorMessage(wchar_t* buffer, unsigned maxChars, unsigned* helpContext = nullptr) const;
  /// The message for the cause, naming the file when there is one.
  std::wstring GetErrorMessage() const;
  /// GetErrorMessage() in UTF-8.
  const char* what() const noexcept override;

  /// One of the causes above.
  int m_cause;
  /// The system error number; -1 when none.
  std::int32_t m_lOsError = -1;
  /// The file concerned; empty when none.
  std::wstring m_strFileName;

 private:
  std::string m_what;
};
