#include "lumen/capture/file_mapping.h"

#include <unistd.h>

#include <cerrno>

#include "capture/shared_memory_registry.h"

using LumenUtility::SharedMemoryRegistry;

FileMapping::FileMapping(const std::wstring& name, std::int64_t size)
    : m_handle(-1), m_objectName(SharedMemoryRegistry::ObjectName(name)), m_holdsName(false) {
  // A section of no size cannot exist, as on the platform this class was first written for.
  if (size < 1) throw LumenUtility::E_INVALIDARG;
  m_handle = SharedMemoryRegistry::Open(m_objectName, size, m_holdsName);
}

FileMapping::FileMapping(const FileMapping& other)
    : m_handle(-1), m_objectName(other.m_objectName), m_holdsName(false) {
  m_handle = dup(other.m_handle);
  if (m_handle < 0) throw LumenUtility::HResultFromOsError(errno);
  if (other.m_holdsName) {
    SharedMemoryRegistry::AddHolder(m_objectName);
    m_holdsName = true;
  }
}

FileMapping& FileMapping::operator=(const FileMapping& other) {
  if (this != &other) {
    FileMapping copy(other);  // may throw; *this is untouched then
    Close();
    m_handle = copy.m_handle;
    m_objectName = copy.m_objectName;
    m_holdsName = copy.m_holdsName;
    copy.m_handle = -1;
    copy.m_holdsName = false;
  }
  return *this;
}

FileMapping::~FileMapping() {
  Close();
}

void FileMapping::Close() noexcept {
  if (m_handle >= 0) close(m_handle);
  m_handle = -1;
  if (m_holdsName) SharedMemoryRegistry::Release(m_objectName);
  m_holdsName = false;
}
