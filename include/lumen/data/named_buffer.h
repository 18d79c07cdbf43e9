/** @file */
/// @class LumenUtility::NamedBuffer
/// NamedBuffer: one named run of complex samples, the element a DataMatrix stores.
///
/// Besides its name (the key under which the matrix keeps it) a buffer may carry a second,
/// caller-assigned auxiliary name. GetPointer() designates the first sample of the buffer's own
/// sample vector (null while it is empty); every copy and move keeps it pointing into the
/// object's own samples.
///
/// Thread-safety: a plain value; confine each object to one thread. Ownership: the buffer owns
/// its samples.
#pragma once

#include <string>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"

namespace LumenUtility {

class DataMatrix;

class LUMEN_API NamedBuffer {
 public:
  /// A buffer of that name with no samples and no aux name.
  NamedBuffer() = default;
  ///@{
  /// A buffer named `name` (null counts as empty) with no samples and no aux name.
  explicit NamedBuffer(const wchar_t* name);
  explicit NamedBuffer(std::wstring name);
  ///@}

  /// A copy of the name, aux name and samples; the pointer points into the copy.
  NamedBuffer(const NamedBuffer& other);
  /// Replaces name, aux name and samples by copies of `other`'s.
  NamedBuffer& operator=(const NamedBuffer& other);
  /// The moved-from buffer is left with no samples and a null pointer.
  NamedBuffer(NamedBuffer&& other) noexcept;
  /// Takes `other`'s contents; `other` is left with no samples and a null pointer.
  NamedBuffer& operator=(NamedBuffer&& other) noexcept;
  ~NamedBuffer() = default;

  /// The samples.
  const std::vector<TsComplex>& GetData() const { return m_data; }
  /// The first sample, or null when the buffer has none.
  TsComplex* GetPointer() const { return m_pData; }
  /// The name.
  const std::wstring& GetName() const { return m_name; }
  /// The aux name; empty when none was stored.
  const std::wstring& GetAuxName() const { return m_auxName; }
  /// True when the last aux name stored was not empty.
  bool HasAuxName() const { return m_hasAuxName; }
  /// Number of samples.
  int Size() const { return static_cast<int>(m_data.size()); }

  /// Replaces the samples (any length).
  void SetData(std::vector<TsComplex> samples);

 private:
  friend class DataMatrix;

  void RefreshPointer() { m_pData = m_data.empty() ? nullptr : m_data.data(); }

  std::vector<TsComplex> m_data;
  TsComplex* m_pData = nullptr;
  std::wstring m_name;
  std::wstring m_auxName;
  bool m_hasAuxName = false;
};

}  // namespace LumenUtility
