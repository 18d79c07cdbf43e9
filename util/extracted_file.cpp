#include "util/extracted_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <chrono>
#include <cstdio>

namespace LumenUtility {
namespace {

// A name no archive entry of ours is expected to have; the counter and the clock make it
// unlikely to exist, and O_EXCL makes sure.
std::string TemporaryName() {
  static std::atomic<unsigned> counter{0};
  const auto ticks = std::chrono::steady_clock::now().time_since_epoch().count();
  char name[64];
  std::snprintf(name, sizeof name, ".lumen-unzip-%d-%u-%llx", static_cast<int>(::getpid()),
                counter.fetch_add(1), static_cast<unsigned long long>(ticks) & 0xFFFFFF);
  return name;
}

}  // namespace

ExtractedFile::~ExtractedFile() {
  if (m_fd >= 0) ::close(m_fd);
  if (!m_committed && !m_temporaryName.empty())
    ::unlinkat(m_directoryFd, m_temporaryName.c_str(), 0);
  if (m_directoryFd >= 0) ::close(m_directoryFd);
}

bool ExtractedFile::Create(int directoryFd, const std::string& name) {
  m_directoryFd = directoryFd;
  m_name = name;
  for (int attempt = 0; attempt < 100 && m_fd < 0; ++attempt) {
    const std::string temporary = TemporaryName();
    m_fd = ::openat(directoryFd, temporary.c_str(),
                    O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, 0666);
    if (m_fd >= 0)
      m_temporaryName = temporary;
    else if (errno != EEXIST)
      return false;
  }
  return m_fd >= 0;
}

bool ExtractedFile::Write(const unsigned char* bytes, std::size_t count) {
  while (count > 0) {
    const ssize_t written = ::write(m_fd, bytes, count);
    if (written < 0 && errno == EINTR) continue;
    if (written <= 0) return false;
    bytes += written;
    count -= static_cast<std::size_t>(written);
  }
  return true;
}

bool ExtractedFile::SetModificationTime(std::time_t modified) {
  const timespec times[2] = {{0, UTIME_NOW}, {modified, 0}};
  return ::futimens(m_fd, times) == 0;
}

bool ExtractedFile::Commit() {
  if (m_fd < 0) return false;
  // close() is where some file systems report a write that could not be stored.
  const int closed = ::close(m_fd);
  m_fd = -1;
  if (closed != 0) return false;
  if (::renameat(m_directoryFd, m_temporaryName.c_str(), m_directoryFd, m_name.c_str()) != 0)
    return false;
  m_committed = true;
  return true;
}

}  // namespace LumenUtility
