/** @file */
/// @class CMemFile
/// CMemFile: a file held in memory, for archives that go into a byte block instead of a disk.
///
/// `CMemFile()` starts empty and grows as it is written; `CMemFile(bytes)` starts with a copy
/// of existing bytes (for loading) at position 0. The bytes are read with GetData() or taken
/// out with Detach(), which leaves the file empty. Seeking past the end is allowed; a write
/// there fills the gap with zero bytes.
/// Thread-safety: confine each object to one thread. Ownership: the object owns its bytes.
#pragma once

#include <cstdint>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/cfile.h"

class LUMEN_API CMemFile : public CFile {
 public:
  CMemFile() = default;
  /// A file holding `bytes`, at position 0.
  explicit CMemFile(std::vector<std::uint8_t> bytes) : m_data(std::move(bytes)) {}
  /// A file holding a copy of `count` bytes at `bytes`, at position 0.
  CMemFile(const void* bytes, std::size_t count);

  /// A memory file has no path to open: always 0, with genericException in `error`.
  int Open(const wchar_t* path, unsigned flags, CFileException* error = nullptr) override;
  /// Reads min(count, bytes left) bytes; 0 at or past the end.
  unsigned Read(void* buffer, unsigned count) override;
  /// Throws CFileException diskFull when the file would pass 4 GiB (the width of a 32-bit
  /// length), std::bad_alloc when memory runs out.
  void Write(const void* buffer, unsigned count) override;
  /// Throws CFileException badSeek for a position before the start or an unknown origin.
  std::uint64_t Seek(std::int64_t offset, unsigned from) override;
  std::uint64_t GetLength() const override { return m_data.size(); }
  std::uint64_t GetPosition() const override { return m_position; }
  void Flush() override {}
  /// Empties the file and returns to position 0 (the framework frees a memory file's bytes
  /// on Close; take them with Detach first).
  void Close() override;
  void Abort() override { Close(); }

  /// The file's bytes.
  const std::vector<std::uint8_t>& GetData() const { return m_data; }
  /// The bytes written so far; the file is left empty at position 0.
  std::vector<std::uint8_t> Detach();

 private:
  std::vector<std::uint8_t> m_data;
  std::uint64_t m_position = 0;
};
