/** @file */
/// @class FileMappingWithView
/// FileMappingWithView<T>: a named shared-memory object with a read/write view of all of it,
/// seen as an array of T (the library uses float).
///
/// Creation, sharing and naming are those of FileMapping ("lumen/capture/file_mapping.h"):
/// two objects of the same name, in one process or in two, see the same memory, and a new
/// object's memory reads as zero. The layout and synchronisation of the contents are the
/// user's concern.
///
/// Thread-safety: each object belongs to one thread at a time. Ownership: the object owns its
/// view and its FileMapping; it cannot be copied.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

#include "lumen/capture/file_mapping.h"
#include "lumen/capture/no_copy.h"
#include "lumen/export.h"

template <class T>
class LUMEN_API FileMappingWithView : private NoCopy {
 public:
  /// Creates or opens the object `name` with room for `count` elements (count >= 1) and maps
  /// all of it. Throws as FileMapping does, and the errno-built code when mapping fails.
  FileMappingWithView(const std::wstring& name, std::int64_t count);
  ~FileMappingWithView();

  /// Address of element `index` of the view; no bounds check (index < GetCount()).
  T* GetPtr(std::uint32_t index) { return m_pView + index; }
  /// Number of elements the view holds.
  std::int64_t GetCount() const { return m_count; }

 private:
  T* m_pView;
  FileMapping m_mapping;
  std::int64_t m_count;
};

extern template class FileMappingWithView<float>;
