// ZipWriter: writes a ZIP archive entry by entry, each file's data compressed as one raw
// deflate stream, with CRC-32 and sizes patched into the local header after the data.
//
// Every entry carries the 8-byte extra block with the daylight saving flag of its modification
// time. An entry that cannot be written whole (unreadable input, or sizes and offsets past the
// format's 32-bit fields or its 65535 entries) is left out: the archive is wound back to where
// the entry began, so what is written is always a valid archive of the other entries.
// Thread-safety: confine to one thread. Ownership: owns the archive file and the compressor.
#pragma once

#include <sys/types.h>
#include <zlib.h>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "lumen/platform/cfile.h"
#include "util/dos_time.h"
#include "util/zip_format.h"

namespace LumenUtility {

class ZipWriter {
 public:
  // The format's limits; tests lower them to reach the limits with small files.
  struct Limits {
    std::uint64_t maxSize = zip::kMaxSize;  // largest size or offset, in bytes
    std::size_t maxEntries = zip::kMaxEntries;
  };

  ZipWriter();
  explicit ZipWriter(Limits limits);
  ~ZipWriter();
  ZipWriter(const ZipWriter&) = delete;
  ZipWriter& operator=(const ZipWriter&) = delete;

  // Creates (or replaces) the archive at `zipPath` and sets up the compressor (level 6 raw
  // deflate, 32 KiB window). False when either fails.
  bool Open(const std::wstring& zipPath);
  // Packs the regular file at `path` (UTF-8) as the entry `entryName`. False, with the entry
  // left out, when the file cannot be opened or read, is not a regular file, is the archive
  // itself, or would take a size, an offset or the entry count past the limits. Throws
  // CFileException when writing the archive fails.
  bool Add(const std::string& path, const std::string& entryName);
  // Writes the central directory and the end record and closes the archive. Returns false when
  // the archive could not be cut to its length after an entry was wound back; throws
  // CFileException when writing or closing fails.
  bool Finish();

 private:
  struct Entry {
    std::string name;
    DosTimestamp modified;
    std::uint32_t crc;
    std::uint32_t compressedSize;
    std::uint32_t size;
    std::uint32_t headerOffset;
  };

  // Compresses the open file `fd` into the archive; false on a read error or when `size`
  // passes the limit while reading (the file grew).
  bool Compress(int fd, std::uint32_t& crc, std::uint64_t& size);
  void WindBack(std::uint64_t offset);
  std::string LocalHeader(const Entry& entry) const;
  std::string CentralHeader(const Entry& entry) const;
  // The fields local and central headers share: flags to extra field length.
  static void PutDescription(std::string& header, const Entry& entry);
  static void PutNameAndExtra(std::string& header, const Entry& entry);

  Limits m_limits;
  CFile m_archive;
  std::string m_archivePath;
  dev_t m_archiveDevice = 0;
  ino_t m_archiveInode = 0;
  z_stream m_stream{};
  bool m_streamReady = false;
  bool m_woundBack = false;
  std::unique_ptr<unsigned char[]> m_in;
  std::unique_ptr<unsigned char[]> m_out;
  std::vector<Entry> m_entries;
};

}  // namespace LumenUtility
