// ZipExtractor: reads a ZIP archive from front to back and extracts each entry below a
// destination directory, stored (method 0) or deflated (method 8).
//
// Records are taken in file order by their signatures: local headers with their data are
// extracted, central directory records and the end record are skipped, anything else ends
// the extraction with a failure. Each file is written under a temporary name and renamed into
// place only when its size and CRC-32 match the archive's, so a failure never leaves a partial
// or changed file behind. Entries whose sizes and CRC follow the data in a data descriptor
// (flag bit 3, as streaming writers produce) are read by inflating to the end of the stream.
// Entry names that are absolute, carry a drive prefix or climb out of the destination with
// ".." are refused, as are paths through symbolic links inside the destination.
// Thread-safety: confine to one thread. Ownership: owns the archive file and the decompressor.
#pragma once

#include <zlib.h>

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "lumen/platform/cfile.h"
#include "util/extraction_root.h"

namespace LumenUtility {

class ExtractedFile;

class ZipExtractor {
 public:
  ZipExtractor();
  ~ZipExtractor();
  ZipExtractor(const ZipExtractor&) = delete;
  ZipExtractor& operator=(const ZipExtractor&) = delete;

  // Extracts every entry of the archive at `zipPath` below `destDir` (created when missing;
  // empty: the current directory), appending each extracted entry's path (relative, with '/'
  // separators; directories end in '/') to `extracted` when it is not null. Returns true when
  // the archive was read to its end and every entry extracted; false at the first entry or
  // record that fails, the entries before it staying extracted. Throws CFileException when
  // reading the archive fails.
  bool Extract(const std::wstring& zipPath, const std::wstring& destDir,
               std::vector<std::wstring>* extracted);

 private:
  // What an entry's data gave: CRC-32 and length of the output, archive bytes consumed.
  struct DataCheck {
    std::uint32_t crc = 0;
    std::uint64_t size = 0;
    std::uint64_t consumed = 0;
  };

  bool ExtractEntry(std::vector<std::wstring>* extracted);
  // Reads the `rest` bytes of a record after its signature, then skips the variable parts
  // whose 16-bit lengths stand at `lengthOffsets` within those bytes.
  bool SkipRecord(std::size_t rest, std::initializer_list<std::size_t> lengthOffsets);
  bool ReadExactly(void* buffer, std::size_t count);
  bool SkipBytes(std::uint64_t count);
  // Copies `count` stored bytes to `out` (null: discards them).
  bool CopyStored(std::uint64_t count, ExtractedFile* out, std::uint64_t sizeLimit,
                  DataCheck& data);
  // Inflates one raw deflate stream to `out`; with `bounded` it must end within `count` bytes,
  // which are all consumed; otherwise input is read until the stream ends.
  bool Inflate(bool bounded, std::uint64_t count, ExtractedFile* out, std::uint64_t sizeLimit,
               DataCheck& data);
  // Passes output bytes on, keeping the CRC and refusing output past `sizeLimit`.
  bool Emit(const unsigned char* bytes, std::size_t count, ExtractedFile* out,
            std::uint64_t sizeLimit, DataCheck& data);
  // Reads the data descriptor after an entry's data, with or without its signature; true
  // when it states the CRC and sizes found.
  bool ConfirmDescriptor(const DataCheck& data);

  CFile m_archive;
  std::string m_destination;
  ExtractionRoot m_root;
  z_stream m_stream{};
  bool m_streamReady = false;
  std::unique_ptr<unsigned char[]> m_in;
  std::unique_ptr<unsigned char[]> m_out;
};

}  // namespace LumenUtility
