#include "lumen/capture/file_mapping_with_view.h"

#include <sys/mman.h>

#include <cerrno>
#include <limits>

#include "capture/shared_memory_registry.h"

namespace {

// The byte size of `count` elements, or 0 when count is below 1 or the bytes would not fit
// a signed 64-bit size.
template <class T>
std::int64_t ByteSize(std::int64_t count) {
  if (count < 1 || count > std::numeric_limits<std::int64_t>::max() / std::int64_t{sizeof(T)}) {
    return 0;
  }
  return count * std::int64_t{sizeof(T)};
}

}  // namespace

template <class T>
FileMappingWithView<T>::FileMappingWithView(const std::wstring& name, std::int64_t count)
    : m_pView(nullptr), m_mapping(name, ByteSize<T>(count)), m_count(count) {
  void* view = mmap(nullptr, static_cast<std::size_t>(ByteSize<T>(count)), PROT_READ | PROT_WRITE,
                    MAP_SHARED, m_mapping.GetHandle(), 0);
  if (view == MAP_FAILED) throw LumenUtility::HResultFromOsError(errno);
  m_pView = static_cast<T*>(view);
}

template <class T>
FileMappingWithView<T>::~FileMappingWithView() {
  munmap(m_pView, static_cast<std::size_t>(ByteSize<T>(m_count)));
}

template class FileMappingWithView<float>;
