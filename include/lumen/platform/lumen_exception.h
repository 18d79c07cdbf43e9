/** @file */
/// @class LumenException
/// LumenException: the library's exception object, thrown by value.
///
/// It carries an HRESULT-style code and a list of wide messages; throwing code puts in one
/// message or none. Constructed from a message alone its code is LUMEN_E_BOUNDS.
/// Thread-safety: a plain value; confine each object to one thread.
#pragma once

#include <exception>
#include <string>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/error_codes.h"

class LUMEN_API LumenException : public std::exception {
 public:
  /// An exception of `code` without messages.
  explicit LumenException(HRESULT code);
  /// An exception of `code` with one message.
  LumenException(HRESULT code, std::wstring message);
  /// An exception of E_FAIL with one message.
  explicit LumenException(std::wstring message);

  /// The result code.
  HRESULT GetCode() const noexcept { return m_code; }
  /// Every message, the first given first.
  const std::vector<std::wstring>& GetMessages() const noexcept { return m_messages; }
  /// The first message, or an empty string when there is none.
  std::wstring GetMessage() const;
  /// Appends a message (what() then lists it too).
  void AddMessage(std::wstring message);

  /// "0x80004005: index" in UTF-8; the code alone when there is no message.
  const char* what() const noexcept override;

 private:
  void RebuildWhat();

  HRESULT m_code;
  std::vector<std::wstring> m_messages;
  std::string m_what;
};
