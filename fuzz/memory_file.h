// A fuzzer's input as a file the library's file classes can open by path: an anonymous
// in-memory file, named through /proc/self/fd, that goes away with the object.
#pragma once

#include <sys/mman.h>
#include <unistd.h>

#include <cstddef>
#include <cstdio>
#include <string>

namespace lumen_fuzz {

class MemoryFile {
 public:
  MemoryFile(const void* data, std::size_t size) : m_fd(memfd_create("fuzz", MFD_CLOEXEC)) {
    if (m_fd < 0 || write(m_fd, data, size) != static_cast<ssize_t>(size)) __builtin_trap();
    std::snprintf(m_path, sizeof m_path, "/proc/self/fd/%d", m_fd);
  }
  explicit MemoryFile(const std::string& text) : MemoryFile(text.data(), text.size()) {}
  ~MemoryFile() { close(m_fd); }
  MemoryFile(const MemoryFile&) = delete;
  MemoryFile& operator=(const MemoryFile&) = delete;

  // The path as the wide text the file classes take.
  std::wstring Path() const {
    return std::wstring(m_path, m_path + std::char_traits<char>::length(m_path));
  }

 private:
  int m_fd;
  char m_path[64];
};

}  // namespace lumen_fuzz
