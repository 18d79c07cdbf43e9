/** @file */
/// @class CArchive
/// CArchive: the framework's binary archive over a CFile, storing or loading for its life.
///
/// Values are written little-endian at their own width (integers of 1, 2, 4 and 8 bytes, IEEE
/// float and double) and wide strings in the framework's tagged form: 0xFF, the 16-bit tag
/// 0xFFFE, the UTF-16 unit count (1 byte below 0xFF; else 0xFF and 16 bits below 0xFFFE; else
/// 0xFF, 0xFFFF and 32 bits), then the UTF-16 units. Loading a string also accepts the
/// untagged 8-bit form (read as UTF-8) and the 64-bit count form.
/// The archive adds no buffer of its own: every value goes straight to the (buffered) file, so
/// the file's position always matches what the archive has read or written.
/// Thread-safety: confine to one thread. Ownership: the file is the caller's; it must outlive
/// the archive, and Close does not close it.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/archive_exception.h"
#include "lumen/platform/cfile.h"

class LUMEN_API CArchive {
 public:
  /// Direction of an archive: writing (store) or reading (load).
  enum Mode : unsigned { store = 0, load = 1 };

  /// `file` must not be null; `mode` is store or load (other bits are ignored).
  CArchive(CFile* file, unsigned mode);
  CArchive(const CArchive&) = delete;
  CArchive& operator=(const CArchive&) = delete;
  /// Flushes a storing archive, discarding file errors (call Close to see them).
  ~CArchive();

  /// True for an archive that writes.
  bool IsStoring() const { return !m_loading; }
  /// True for an archive that reads.
  bool IsLoading() const { return m_loading; }
  /// The file, or null after Close.
  CFile* GetFile() const { return m_file; }
  /// Storing: hands the written bytes to the file's system (CFile::Flush). Loading: nothing.
  void Flush();
  /// Flushes and detaches from the file; later reads and writes throw genericException.
  void Close();

  /// Reads up to `count` bytes; returns how many were read (fewer only at the end of the
  /// file). Throws CArchiveException writeOnly on a storing archive.
  unsigned Read(void* buffer, unsigned count);
  /// Writes `count` bytes. Throws CArchiveException readOnly on a loading archive.
  void Write(const void* buffer, unsigned count);

  ///@{
  /// Writes the value in little-endian byte order (1, 2, 4 or 8 bytes; floats as IEEE-754).
  /// Throws CArchiveException readOnly on a loading archive.
  CArchive& operator<<(std::uint8_t v);
  CArchive& operator<<(std::int8_t v);
  CArchive& operator<<(std::uint16_t v);
  CArchive& operator<<(std::int16_t v);
  CArchive& operator<<(std::uint32_t v);
  CArchive& operator<<(std::int32_t v);
  CArchive& operator<<(std::uint64_t v);
  CArchive& operator<<(std::int64_t v);
  CArchive& operator<<(float v);
  CArchive& operator<<(double v);
  ///@}
  /// Throws CArchiveException genericException for a string of 2^32 - 1 or more UTF-16
  /// units (the widest count the tagged form has room for).
  CArchive& operator<<(const std::wstring& text);

  ///@{
  /// Reads a value written by the matching operator<<. Each read throws CArchiveException
  /// endOfFile (naming the file) when fewer bytes remain than the value needs; the value is
  /// then unchanged.
  CArchive& operator>>(std::uint8_t& v);
  CArchive& operator>>(std::int8_t& v);
  CArchive& operator>>(std::uint16_t& v);
  CArchive& operator>>(std::int16_t& v);
  CArchive& operator>>(std::uint32_t& v);
  CArchive& operator>>(std::int32_t& v);
  CArchive& operator>>(std::uint64_t& v);
  CArchive& operator>>(std::int64_t& v);
  CArchive& operator>>(float& v);
  CArchive& operator>>(double& v);
  ///@}
  /// A count larger than the bytes left throws endOfFile once they are used up; the string is
  /// read in pieces, so no allocation exceeds the bytes actually present by more than 64 KiB.
  /// `text` is unchanged on failure.
  CArchive& operator>>(std::wstring& text);

 private:
  template <typename T>
  CArchive& WriteValue(T v);
  template <typename T>
  CArchive& ReadValue(T& v);
  /// Reads exactly `count` bytes or throws endOfFile.
  void ReadExactly(void* buffer, std::size_t count);
  void CheckAttached() const;
  [[noreturn]] void Throw(int cause) const;
  std::uint64_t ReadStringLength(bool& wide);

  CFile* m_file;
  bool m_loading;
};
