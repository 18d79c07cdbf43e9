#include "util/extraction_root.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <filesystem>
#include <system_error>

namespace LumenUtility {
namespace {

constexpr int kDirectoryFlags = O_RDONLY | O_DIRECTORY | O_CLOEXEC;

// Opens `name` in `parent` as a directory, creating it when missing; never follows a link.
int OpenOrCreate(int parent, const std::string& name) {
  for (int attempt = 0; attempt < 2; ++attempt) {
    const int fd = ::openat(parent, name.c_str(), kDirectoryFlags | O_NOFOLLOW);
    if (fd >= 0 || errno != ENOENT) return fd;
    // Another process may create it meanwhile: EEXIST leads to a second open.
    if (::mkdirat(parent, name.c_str(), 0777) != 0 && errno != EEXIST) return -1;
  }
  return -1;
}

}  // namespace

ExtractionRoot::~ExtractionRoot() {
  if (m_fd >= 0) ::close(m_fd);
}

bool ExtractionRoot::Open(const std::string& directory) {
  const std::string path = directory.empty() ? std::string(".") : directory;
  std::error_code error;
  std::filesystem::create_directories(path, error);  // an existing directory is no error
  m_fd = ::open(path.c_str(), kDirectoryFlags);
  return m_fd >= 0;
}

int ExtractionRoot::OpenDirectory(const std::string& relative) const {
  if (m_fd < 0) return -1;
  int current = ::fcntl(m_fd, F_DUPFD_CLOEXEC, 0);
  std::size_t start = 0;
  while (current >= 0 && start < relative.size()) {
    std::size_t end = relative.find('/', start);
    if (end == std::string::npos) end = relative.size();
    const int next = OpenOrCreate(current, relative.substr(start, end - start));
    ::close(current);
    current = next;
    start = end + 1;
  }
  return current;
}

}  // namespace LumenUtility
