/** @file */
/// @class CFile
/// CFile: a binary file on disk, with the framework's open flags and seek origins.
///
/// Reads and writes go through one 64 KiB buffer, so the many small reads and writes of the
/// persisted forms (a 2-byte version, a 10-byte read-ahead, one CSV field) cost no system call
/// each; a transfer of at least the buffer's size goes straight to the system. Read, Write and
/// Seek failures throw CFileException by value. Derivations (CMemFile, CStdioFile, the CSV file)
/// override the virtual operations they change.
/// Sharing flags (shareDenyWrite and others) are accepted and ignored: Linux has no mandatory
/// sharing modes.
/// Thread-safety: confine each object to one thread. Ownership: the object owns its file
/// descriptor and closes it when destroyed (discarding errors; call Close to see them).
#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/file_exception.h"

class LUMEN_API CFile {
 public:
  /// Open flags, combinable with |: an access mode (modeRead, modeWrite, modeReadWrite), a
  /// sharing mode (accepted, not enforced), modeCreate and modeNoTruncate; the type flags are
  /// accepted and mean nothing (files are bytes).
  enum OpenFlags : unsigned {
    modeRead = 0,
    modeWrite = 1,
    modeReadWrite = 2,
    shareCompat = 0,
    shareExclusive = 0x10,
    shareDenyWrite = 0x20,
    shareDenyRead = 0x30,
    shareDenyNone = 0x40,
    modeNoInherit = 0x80,
    modeCreate = 0x1000,
    modeNoTruncate = 0x2000,
    typeText = 0x4000,
    typeBinary = 0x8000
  };
  /// Origin of a Seek.
  enum SeekPosition : unsigned { begin = 0, current = 1, end = 2 };

  CFile();
  /// Opens `path` as Open does; throws the CFileException that Open would report.
  CFile(const wchar_t* path, unsigned flags);
  CFile(const CFile&) = delete;
  CFile& operator=(const CFile&) = delete;
  virtual ~CFile();

  /// Opens `path` (UTF-8 on disk) with the access of flags & 3 (modeRead, modeWrite or
  /// modeReadWrite); modeCreate creates the file (mode 0666 before the umask) and truncates
  /// it unless modeNoTruncate is given. Returns nonzero on success. On failure returns 0 and,
  /// when `error` is given, fills it with the cause, errno and path; a directory fails with
  /// accessDenied and an object that is already open with genericException.
  virtual int Open(const wchar_t* path, unsigned flags, CFileException* error = nullptr);

  /// Reads up to `count` bytes into `buffer`; returns how many were read, 0 only at the end of
  /// the file (or for count 0). Throws CFileException on a system error, when not open
  /// (invalidFile) or when opened with modeWrite (accessDenied).
  virtual unsigned Read(void* buffer, unsigned count);
  /// Writes all `count` bytes (buffered). Throws CFileException when not open (invalidFile) or
  /// opened with modeRead (accessDenied), at once; a refusal of the system (diskFull, ...) is
  /// thrown by the Write, Flush, Seek or Close that hands the bytes over.
  virtual void Write(const void* buffer, unsigned count);
  /// Moves to `offset` bytes from `from` (begin, current or end); returns the new position in
  /// bytes from the start. Throws CFileException badSeek for a position before the start or an
  /// unknown origin.
  virtual std::uint64_t Seek(std::int64_t offset, unsigned from);
  /// Seek(0, begin): returns 0.
  std::uint64_t SeekToBegin() { return Seek(0, begin); }
  /// Seek(0, end): returns the length in bytes.
  std::uint64_t SeekToEnd() { return Seek(0, end); }
  /// Length of the file in bytes, buffered writes included.
  virtual std::uint64_t GetLength() const;
  /// Position of the next byte read or written, in bytes from the start; no system call.
  virtual std::uint64_t GetPosition() const;
  /// Hands buffered writes to the system (no fsync: the data survives the process, and a
  /// debug print file flushed after every line stays cheap).
  virtual void Flush();
  /// Flushes and closes. Throws CFileException when the buffered bytes cannot be written; the
  /// descriptor is closed either way. Closing a closed file does nothing.
  virtual void Close();
  /// Closes without flushing errors escaping; buffered bytes are still offered to the system.
  virtual void Abort();

  /// True between a successful Open and Close or Abort.
  bool IsOpen() const { return m_fd >= 0; }
  /// The path given to Open or SetFilePath.
  std::wstring GetFilePath() const { return m_strFileName; }
  /// Names the file for later messages; does not open or rename anything.
  void SetFilePath(const wchar_t* path) { m_strFileName = path ? path : L""; }

 protected:
  /// The position `offset` bytes from `from` for a file at `position` of `length` bytes.
  /// Throws CFileException badSeek (naming `fileName`) for an unknown origin or a position
  /// before the start or past 2^63 - 1.
  static std::uint64_t SeekTarget(std::int64_t offset, unsigned from, std::uint64_t position,
                                  std::uint64_t length, const std::wstring& fileName);

 private:
  [[noreturn]] void ThrowErrno(int osError) const;
  void CheckOpen() const;
  /// CheckOpen, then accessDenied unless the open flags allow the access.
  void CheckAccess(bool allowed) const;
  /// Writes the pending output buffer; throws on failure (the buffer is dropped either way, so
  /// a later Close does not fail twice on the same bytes).
  void FlushWrites();
  /// Forgets read-ahead bytes, moving the descriptor back to the logical position.
  void DropReadAhead();
  void WriteToSystem(const std::uint8_t* bytes, std::size_t count);
  std::size_t ReadFromSystem(std::uint8_t* bytes, std::size_t count);
  std::uint8_t* Buffer();

  static constexpr std::size_t kBufferBytes = 64 * 1024;

  int m_fd = -1;
  bool m_canRead = false;
  bool m_canWrite = false;
  std::wstring m_strFileName;
  std::unique_ptr<std::uint8_t[]> m_buffer;
  /// The buffer holds either read-ahead bytes [m_readPos, m_readEnd) or pending output
  /// [0, m_writeEnd), never both.
  std::size_t m_readPos = 0;
  std::size_t m_readEnd = 0;
  std::size_t m_writeEnd = 0;
  /// The descriptor's offset, kept here so that GetPosition needs no system call.
  std::uint64_t m_systemPos = 0;
};
