#include "lumen/platform/com_variant.h"

#include <new>
#include <utility>

#include "lumen/platform/ole_exception.h"

using LumenUtility::DISP_E_TYPEMISMATCH;
using LumenUtility::E_INVALIDARG;
using LumenUtility::E_OUTOFMEMORY;
using LumenUtility::S_OK;

HRESULT VariantCopyInd(CComVariant* dest, const CComVariant* src) {
  if (!dest || !src) return E_INVALIDARG;
  if (!(src->m_vt & VT_BYREF)) {
    if (dest == src) return S_OK;
    try {
      *dest = *src;
    } catch (const std::bad_alloc&) {
      return E_OUTOFMEMORY;
    }
    return S_OK;
  }
  const void* target = src->m_value.pRef;
  if (!target) return E_INVALIDARG;
  try {
    CComVariant copy;
    switch (src->m_vt & ~VT_BYREF) {
      case VT_I4:
        copy = CComVariant(*static_cast<const std::int32_t*>(target));
        break;
      case VT_R8:
        copy = CComVariant(*static_cast<const double*>(target));
        break;
      case VT_BOOL:
        copy.m_vt = VT_BOOL;
        copy.m_value.boolVal = *static_cast<const VARIANT_BOOL*>(target);
        break;
      default:  // VT_BSTR: the only other kind a reference is made with
        copy = CComVariant(*static_cast<const std::wstring*>(target));
        break;
    }
    *dest = std::move(copy);
  } catch (const std::bad_alloc&) {
    return E_OUTOFMEMORY;
  }
  return S_OK;
}

CComVariant CComVariant::Dereferenced(VARTYPE kind) const {
  if ((m_vt & ~VT_BYREF) != kind) throw COleException(DISP_E_TYPEMISMATCH);
  CComVariant value;
  AfxCheckError(VariantCopyInd(&value, this));
  return value;
}

std::int32_t CComVariant::GetLong() const {
  return Dereferenced(VT_I4).m_value.lVal;
}

double CComVariant::GetDouble() const {
  return Dereferenced(VT_R8).m_value.dblVal;
}

bool CComVariant::GetBool() const {
  return Dereferenced(VT_BOOL).m_value.boolVal != VARIANT_FALSE;
}

std::wstring CComVariant::GetString() const {
  return std::move(Dereferenced(VT_BSTR).m_bstrVal);
}

bool CComVariant::operator==(const CComVariant& other) const noexcept {
  if (m_vt != other.m_vt) return false;
  if (m_vt & VT_BYREF) return m_value.pRef == other.m_value.pRef;
  switch (m_vt) {
    case VT_I4:
      return m_value.lVal == other.m_value.lVal;
    case VT_R8:
      return m_value.dblVal == other.m_value.dblVal;
    case VT_BOOL:
      return m_value.boolVal == other.m_value.boolVal;
    case VT_BSTR:
      return m_bstrVal == other.m_bstrVal;
    default:  // VT_EMPTY
      return true;
  }
}
