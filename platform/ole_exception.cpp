#include "lumen/platform/ole_exception.h"

#include <cstdio>
#include <new>

COleException::COleException(HRESULT sc) : m_sc(sc) {
  char text[32];
  std::snprintf(text, sizeof text, "OLE error 0x%08X", static_cast<unsigned>(sc));
  m_what = text;
}

const char* COleException::what() const noexcept {
  return m_what.c_str();
}

void AfxCheckError(HRESULT sc) {
  if (LumenUtility::Succeeded(sc)) return;
  if (sc == LumenUtility::E_OUTOFMEMORY) throw std::bad_alloc();
  throw COleException(sc);
}
