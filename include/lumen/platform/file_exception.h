/** @file */
/// @class CFileException
/// CFileException: a failed file operation, thrown by value by CFile and its derivations.
///
/// `m_cause` holds the framework's cause numbers (kept because stored status texts and callers
/// compare against them), `m_lOsError` the operating system's error number (errno; -1 when the
/// failure did not come from the system) and `m_strFileName` the file's path as given to Open.
/// Thread-safety: a plain value; confine each object to one thread.
#pragma once

#include <cstdint>
#include <exception>
#include <string>

#include "lumen/export.h"

class LUMEN_API CFileException : public std::exception {
 public:
  enum {
    none = 0,
    genericException = 1,
    fileNotFound = 2,
    badPath = 3,
    tooManyOpenFiles = 4,
    accessDenied = 5,
    invalidFile = 6,
    removeCurrentDir = 7,
    directoryFull = 8,
    badSeek = 9,
    hardIO = 10,
    sharingViolation = 11,
    lockViolation = 12,
    diskFull = 13,
    endOfFile = 14
  };

  /// An exception of `cause` with the system error `osError` (errno; -1 for none) about the
  /// file `fileName` (null: none named).
  explicit CFileException(int cause = none, std::int32_t osError = -1,
                          const wchar_t* fileName = nullptr);

  /// The cause that best describes the errno value `osError`; genericException for values
  /// without a closer cause.
  static int OsErrorToException(std::int32_t osError);
  /// Throws CFileException(OsErrorToException(osError), osError, fileName).
  [[noreturn]] static void ThrowOsError(std::int32_t osError, const wchar_t* fileName = nullptr);

  /// Writes the message for the cause, naming the file, into `buffer` (at most `maxChars`
  /// characters with the terminating zero; a longer message is cut). Returns nonzero when
  /// something was written, 0 when `buffer` is null or `maxChars` is 0. `helpContext`, when
  /// given, receives 0 (there is no help system).
  int GetErrorMessage(wchar_t* buffer, unsigned maxChars, unsigned* helpContext = nullptr) const;
  /// The same message as a string.
  std::wstring GetErrorMessage() const;
  /// The message in UTF-8.
  const char* what() const noexcept override;

  /// One of the causes above.
  int m_cause;
  /// The system error number (errno); -1 when none.
  std::int32_t m_lOsError;
  /// The file concerned; empty when none.
  std::wstring m_strFileName;

 private:
  std::string m_what;
};
