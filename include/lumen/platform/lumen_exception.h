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
  explicit LumenException(HRESULT code);
  LumenException(HRESULT code, std::wstring message);
  explicit LumenException(std::wstring message);

  HRESULT GetCode() const noexcept { return m_code; }
  const std::vector<std::wstring>& GetMessages() const noexcept { return m_messages; }
  /// The first message, or an empty string when there is none.
  std::wstring GetMessage() const;
  void AddMessage(std::wstring message);

  /// "0x80004005: index" in UTF-8; the code alone when there is no message.
  const char* what() const noexcept override;

 private:
  void RebuildWhat();

  HRESULT m_code;
  std::vector<std::wstring> m_messages;
  std::string m_what;
};
