/** @file */
/// @class FileMappingReader
/// FileMappingReader: the client side of a data capture block, a read-only view of an existing
/// named shared-memory object as 32-bit floats.
///
/// It opens the object a FileMapping of the same block name made ("lumen/capture/file_mapping.h"),
/// in this process or another, and never creates, resizes or removes one. The view stays valid
/// when the writer removes the name.
///
/// Thread-safety: each object belongs to one thread at a time; what the floats hold while the
/// writer fills them is the writer's concern. Ownership: the object owns its view.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/capture/no_copy.h"
#include "lumen/export.h"

class LUMEN_API FileMappingReader : private NoCopy {
 public:
  /// Opens block `name`. Throws an HRESULT by value: 0x80070002 (ENOENT) when there is no such
  /// block, 0x80070016 for a name that is empty or holds "/" or a NUL character, 0x8007000D when
  /// access is denied, and the errno-built code of any other failing call.
  explicit FileMappingReader(const std::wstring& name);
  ~FileMappingReader();

  /// Size of the block in bytes.
  std::int64_t GetByteSize() const { return m_byteSize; }
  /// Number of whole floats the block holds (a trailing partial float is not counted).
  std::int64_t GetCount() const { return m_byteSize / static_cast<std::int64_t>(sizeof(float)); }
  /// Address of float `index`; no bounds check (index < GetCount()).
  const float* GetPtr(std::int64_t index) const { return m_pView + index; }

 private:
  const float* m_pView;
  std::int64_t m_byteSize;
};
