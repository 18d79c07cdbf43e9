#include "lumen/platform/lumen_exception.h"

#include <cstdio>

#include "lumen/platform/text_conversion.h"

LumenException::LumenException(HRESULT code) : m_code(code) {
  RebuildWhat();
}

LumenException::LumenException(HRESULT code, std::wstring message) : m_code(code) {
  m_messages.push_back(std::move(message));
  RebuildWhat();
}

LumenException::LumenException(std::wstring message)
    : LumenException(LumenUtility::LUMEN_E_BOUNDS, std::move(message)) {}

std::wstring LumenException::GetMessage() const {
  return m_messages.empty() ? std::wstring() : m_messages.front();
}

void LumenException::AddMessage(std::wstring message) {
  m_messages.push_back(std::move(message));
  RebuildWhat();
}

const char* LumenException::what() const noexcept {
  return m_what.c_str();
}

void LumenException::RebuildWhat() {
  char code[16];
  std::snprintf(code, sizeof code, "0x%08X", static_cast<unsigned>(m_code));
  m_what = code;
  for (const std::wstring& message : m_messages) {
    m_what += m_what.size() == 10 ? ": " : "; ";
    m_what += LumenUtility::WideToUtf8(message);
  }
}
