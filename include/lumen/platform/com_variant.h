/** @file */
/// @class CComVariant
/// CComVariant: the framework's self-managing variant, here the value of a changed setting that a
/// property bag hands to its subscribers.
///
/// It holds nothing (VT_EMPTY), a 32-bit integer (VT_I4), a double (VT_R8), a boolean (VT_BOOL,
/// stored as VARIANT_BOOL: -1 true, 0 false) or a wide string (VT_BSTR), or a reference to a
/// value of one of those four kinds owned by someone else (VT_BYREF combined with the kind).
/// Copies of a by-value variant are independent; copies of a reference share its target.
/// VariantCopyInd makes a copy in which a reference is replaced by the value it points at.
/// Thread-safety: confine each object to one thread; the target of a reference must not change
/// while another thread reads through it. Ownership: by-value contents are owned; reference
/// targets are the caller's and must outlive every read through the reference.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/error_codes.h"

/// The kind of value a variant holds (a VARENUM, possibly with VT_BYREF).
using VARTYPE = std::uint16_t;
/// A variant's boolean: VARIANT_TRUE (-1) or VARIANT_FALSE (0).
using VARIANT_BOOL = std::int16_t;

///@{
/// The two boolean values.
inline constexpr VARIANT_BOOL VARIANT_TRUE = -1;
inline constexpr VARIANT_BOOL VARIANT_FALSE = 0;
///@}

/// The kinds a CComVariant holds: empty, 32-bit integer, double, string, boolean; VT_BYREF
/// marks a reference to a caller's value of that kind.
enum VARENUM : VARTYPE {
  VT_EMPTY = 0,
  VT_I4 = 3,
  VT_R8 = 5,
  VT_BSTR = 8,
  VT_BOOL = 11,
  VT_BYREF = 0x4000
};

namespace LumenUtility {
/// A variant read as a kind it does not hold.
inline constexpr HRESULT DISP_E_TYPEMISMATCH = MakeHResult(0x80020005);
}  // namespace LumenUtility

class LUMEN_API CComVariant {
 public:
  /// An empty variant (VT_EMPTY).
  CComVariant() noexcept {}
  /// A VT_I4 variant holding `value`.
  CComVariant(int value) : m_vt(VT_I4) { m_value.lVal = value; }
  /// A VT_R8 variant holding `value`.
  CComVariant(double value) : m_vt(VT_R8) { m_value.dblVal = value; }
  /// A VT_BOOL variant holding VARIANT_TRUE or VARIANT_FALSE.
  CComVariant(bool value) : m_vt(VT_BOOL) {
    m_value.boolVal = value ? VARIANT_TRUE : VARIANT_FALSE;
  }
  /// A null `text` gives an empty string.
  CComVariant(const wchar_t* text) : m_vt(VT_BSTR), m_bstrVal(text ? text : L"") {}
  /// A VT_BSTR variant holding `text`.
  CComVariant(std::wstring text) : m_vt(VT_BSTR), m_bstrVal(std::move(text)) {}
  /// 8-bit text would otherwise turn silently into VT_BOOL.
  CComVariant(const char*) = delete;

  ///@{
  /// References to a caller's value. A null target makes a reference that every read and
  /// VariantCopyInd refuse with E_INVALIDARG.
  static CComVariant Reference(std::int32_t* target) { return CComVariant(VT_I4, target); }
  static CComVariant Reference(double* target) { return CComVariant(VT_R8, target); }
  static CComVariant Reference(VARIANT_BOOL* target) { return CComVariant(VT_BOOL, target); }
  static CComVariant Reference(std::wstring* target) { return CComVariant(VT_BSTR, target); }
  ///@}

  /// The kind, with VT_BYREF set for a reference.
  VARTYPE GetType() const noexcept { return m_vt; }

  ///@{
  /// The value of a variant of that kind, read through a reference when it is one. Throw
  /// COleException with DISP_E_TYPEMISMATCH for a variant of another kind, and with
  /// E_INVALIDARG for a null reference.
  std::int32_t GetLong() const;
  double GetDouble() const;
  bool GetBool() const;
  std::wstring GetString() const;
  ///@}

  /// True when both hold the same kind and the same value; references are equal when they
  /// point at the same target.
  bool operator==(const CComVariant& other) const noexcept;

 private:
  CComVariant(VARTYPE kind, void* target) : m_vt(kind | VT_BYREF) { m_value.pRef = target; }
  /// The variant's value with a reference followed, or throws as the getters do.
  CComVariant Dereferenced(VARTYPE kind) const;

  friend LUMEN_API HRESULT VariantCopyInd(CComVariant* dest, const CComVariant* src);

  VARTYPE m_vt = VT_EMPTY;
  union {
    std::int32_t lVal;
    double dblVal;
    VARIANT_BOOL boolVal;
    void* pRef;
  } m_value{};
  std::wstring m_bstrVal;
};

/// Copies `src` into `dest`, replacing a reference by a by-value copy of what it points at
/// (`dest` and `src` may be the same variant). Returns S_OK; E_INVALIDARG when either pointer
/// is null or `src` is a null reference; E_OUTOFMEMORY when the string cannot be copied.
/// `dest` is unchanged on failure.
LUMEN_API HRESULT VariantCopyInd(CComVariant* dest, const CComVariant* src);
