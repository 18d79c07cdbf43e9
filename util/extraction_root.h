// ExtractionRoot: the destination directory of an extraction, through which every directory
// below it is reached one component at a time, so that nothing lands outside it.
//
// Components are opened relative to their parent's descriptor without following symbolic
// links: a link inside the destination (left there by an earlier extraction, or planted) can
// never lead a write elsewhere. Missing directories are created (mode 0777 less the umask).
// Thread-safety: confine to one thread. Ownership: owns the descriptor of the destination.
#pragma once

#include <string>

namespace LumenUtility {

class ExtractionRoot {
 public:
  ExtractionRoot() = default;
  ~ExtractionRoot();
  ExtractionRoot(const ExtractionRoot&) = delete;
  ExtractionRoot& operator=(const ExtractionRoot&) = delete;

  // Creates `directory` (UTF-8; empty: the current directory) with its missing parents and
  // opens it. The destination itself may be reached through links. False when it cannot be
  // created or opened.
  bool Open(const std::string& directory);
  bool IsOpen() const { return m_fd >= 0; }

  // A new descriptor (the caller closes it) of the directory `relative` below the root: a
  // normalised '/'-separated path, empty for the root itself. Missing components are created.
  // -1 when a component is a symbolic link, a file or cannot be created or opened.
  int OpenDirectory(const std::string& relative) const;

 private:
  int m_fd = -1;
};

}  // namespace LumenUtility
