/** @file */
/// @class COleException
/// COleException: a failed OLE operation (a variant copy, for one), thrown by value with the
/// operation's HRESULT; and AfxCheckError, which raises a failed HRESULT the way the framework
/// does.
/// Thread-safety: a plain value; confine each object to one thread.
#pragma once

#include <exception>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/error_codes.h"

class LUMEN_API COleException : public std::exception {
 public:
  /// An exception of status code `sc`.
  explicit COleException(HRESULT sc);

  /// "OLE error 0x80070057" in UTF-8.
  const char* what() const noexcept override;

  /// The status code.
  HRESULT m_sc;

 private:
  std::string m_what;
};

/// Does nothing for a success code. Throws std::bad_alloc (the framework's memory exception)
/// for E_OUTOFMEMORY, and COleException carrying `sc` for every other failure code.
LUMEN_API void AfxCheckError(HRESULT sc);
