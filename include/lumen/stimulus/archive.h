/** @file */
/// @class LumenUtility::Archive
/// Archive: the library's byte archive for the archive form of stimulus arrays.
///
/// A storing archive appends to the caller's byte vector; a loading archive reads it from the
/// start and, when given an open file descriptor, refills it from the file whenever a read
/// needs more bytes than remain: the bytes already consumed are dropped and at least 64 KiB
/// (or the read's size, if larger) are appended, so a loading archive holds at most the
/// unread bytes plus one refill. A refill that comes back short has reached the end of the
/// file: the descriptor is closed and later reads are served from the buffer alone.
/// Values are little-endian at their own width; doubles are IEEE-754 64-bit.
/// Every failure throws LumenException with code 0xE8080882 (LUMEN_E_BOUNDS).
/// Thread-safety: confine to one thread. Ownership: the byte vector is the caller's and must
/// outlive the archive; the descriptor passes to the archive, which closes it at the end of
/// the file or when destroyed. Writing the stored bytes anywhere is the caller's business.
#pragma once

#include <cstddef>
#include <cstdint>
#include <type_traits>
#include <vector>

#include "lumen/export.h"

namespace LumenUtility {

class LUMEN_API Archive {
 public:
  /// The descriptor value that stands for no file (all bits set).
  static constexpr int kInvalidHandle = -1;

  /// `loading` false: the archive appends to `buffer`. `loading` true: it reads `buffer` from
  /// the start, then `fileDescriptor` (an open, readable descriptor, or kInvalidHandle).
  Archive(std::vector<unsigned char>& buffer, bool loading, int fileDescriptor = kInvalidHandle);
  Archive(const Archive&) = delete;
  Archive& operator=(const Archive&) = delete;
  ~Archive();

  /// True for an archive that reads.
  bool IsLoading() const { return m_loading; }
  /// True for an archive that writes.
  bool IsStoring() const { return !m_loading; }
  /// The file descriptor, or kInvalidHandle once there is none.
  int GetFile() const { return m_file; }

  /// Storing only ("Archive Exception: Writing to read-only archive." otherwise): appends the
  /// `count` bytes at `bytes`.
  void Write(const void* bytes, std::size_t count);
  /// Loading only ("Archive Exception: Reading from write-only archive." otherwise): copies
  /// the next `count` bytes to `destination` and returns `count`; 0 reads nothing. Throws
  /// "Archive exception: ReadFile failed" when the file cannot be read and "Archive
  /// Exception: Attempt to read beyond end of buffer." when fewer bytes exist; nothing is
  /// consumed then.
  std::size_t Read(void* destination, std::size_t count);
  /// Throws "Archive Exception: Invalid file handle" unless the archive has a file.
  void CheckFile() const;

  ///@{
  /// Typed writes and reads of 1-, 2-, 4- and 8-byte integers, float and double, in the
  /// machine's (little-endian) byte order; the errors are those of Write and Read.
  template <typename T>
  requires(std::is_arithmetic_v<T> && !std::is_same_v<T, bool> &&
           (sizeof(T) == 1 || sizeof(T) == 2 || sizeof(T) == 4 || sizeof(T) == 8)) Archive&
  operator<<(T value) {
    Write(&value, sizeof value);
    return *this;
  }
  template <typename T>
  requires(std::is_arithmetic_v<T> && !std::is_same_v<T, bool> &&
           (sizeof(T) == 1 || sizeof(T) == 2 || sizeof(T) == 4 || sizeof(T) == 8)) Archive&
  operator>>(T& value) {
    T read;
    Read(&read, sizeof read);
    value = read;
    return *this;
  }
  ///@}

 private:
  /// Brings at least `count` unread bytes into the buffer or throws.
  void MakeAvailable(std::size_t count);
  void Refill(std::size_t count);
  void CloseFile();
  std::size_t Remaining() const { return m_buffer.size() - m_readPosition; }

  std::vector<unsigned char>& m_buffer;
  std::size_t m_readPosition = 0;
  bool m_loading;
  int m_file;
};

}  // namespace LumenUtility
