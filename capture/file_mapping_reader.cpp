#include "lumen/capture/file_mapping_reader.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

#include "capture/shared_memory_registry.h"

using LumenUtility::HResultFromOsError;

FileMappingReader::FileMappingReader(const std::wstring& name) : m_pView(nullptr), m_byteSize(0) {
  const std::string objectName = LumenUtility::SharedMemoryRegistry::ObjectName(name);
  int fd;
  do {
    fd = shm_open(objectName.c_str(), O_RDONLY, 0);
  } while (fd < 0 && errno == EINTR);
  if (fd < 0) throw HResultFromOsError(errno);

  struct stat status {};
  int error = fstat(fd, &status) == 0 ? 0 : errno;
  if (error == 0 && status.st_size > 0) {
    void* view =
        mmap(nullptr, static_cast<std::size_t>(status.st_size), PROT_READ, MAP_SHARED, fd, 0);
    if (view == MAP_FAILED) {
      error = errno;
    } else {
      m_pView = static_cast<const float*>(view);
      m_byteSize = status.st_size;
    }
  }
  close(fd);  // the view keeps the memory
  if (error != 0) throw HResultFromOsError(error);
}

FileMappingReader::~FileMappingReader() {
  if (m_pView != nullptr) munmap(const_cast<float*>(m_pView), static_cast<std::size_t>(m_byteSize));
}
