// ExtractedFile: a file being extracted, written under a temporary name in its directory and
// renamed to its own name only once its contents have been checked, so that a failed
// extraction leaves neither a partial file nor a changed old one.
// Thread-safety: confine to one thread. Ownership: owns the directory descriptor it is given
// and the temporary file, which it removes unless committed.
#pragma once

#include <cstddef>
#include <ctime>
#include <string>

namespace LumenUtility {

class ExtractedFile {
 public:
  ExtractedFile() = default;
  ~ExtractedFile();
  ExtractedFile(const ExtractedFile&) = delete;
  ExtractedFile& operator=(const ExtractedFile&) = delete;

  // Takes over `directoryFd` and creates a new temporary file in it (mode 0666 less the umask)
  // to become `name` (one path component). False when the file cannot be created.
  bool Create(int directoryFd, const std::string& name);
  // Appends `count` bytes; false on a write error (a full disk).
  bool Write(const unsigned char* bytes, std::size_t count);
  // Sets the access time to now and the modification time to `modified`; false on failure.
  bool SetModificationTime(std::time_t modified);
  // Renames the file to its name, replacing a file (or link) of that name; false when that
  // fails (a directory of that name) or a write went wrong before.
  bool Commit();

 private:
  int m_directoryFd = -1;
  int m_fd = -1;
  std::string m_name;
  std::string m_temporaryName;
  bool m_committed = false;
};

}  // namespace LumenUtility
