#include "util/zip_extractor.h"

#include <linux/limits.h>
#include <unistd.h>

#include <algorithm>

#include "lumen/platform/text_conversion.h"
#include "util/dos_time.h"
#include "util/extracted_file.h"
#include "util/zip_format.h"
#include "util/zip_path.h"

namespace LumenUtility {
namespace {

// The daylight saving flag of the extra field's 0x0100 block; -1 when there is none.
int DaylightFlag(const std::string& extra) {
  const auto* bytes = reinterpret_cast<const unsigned char*>(extra.data());
  for (std::size_t at = 0; at + 4 <= extra.size();) {
    const std::uint16_t id = zip::Get16(bytes + at);
    const std::uint16_t size = zip::Get16(bytes + at + 2);
    if (id == zip::kDaylightBlockId && size >= 4 && at + 8 <= extra.size())
      return zip::Get32(bytes + at + 4) != 0 ? 1 : 0;
    at += 4 + std::size_t{size};
  }
  return -1;
}

}  // namespace

ZipExtractor::ZipExtractor()
    : m_in(std::make_unique_for_overwrite<unsigned char[]>(zip::kPieceBytes)),
      m_out(std::make_unique_for_overwrite<unsigned char[]>(zip::kPieceBytes)) {}

ZipExtractor::~ZipExtractor() {
  if (m_streamReady) inflateEnd(&m_stream);
}

bool ZipExtractor::Extract(const std::wstring& zipPath, const std::wstring& destDir,
                           std::vector<std::wstring>* extracted) {
  m_destination = WideToUtf8(destDir);
  if (!m_destination.empty() && m_destination.back() != '/') m_destination += '/';
  CFileException error;
  if (!m_archive.Open(zipPath.c_str(), CFile::modeRead | CFile::typeBinary, &error)) return false;
  for (;;) {
    unsigned char signature[4];
    const unsigned got = m_archive.Read(signature, 4);
    if (got == 0) return true;
    if (got < 4) return false;
    bool ok;
    switch (zip::Get32(signature)) {
      case zip::kLocalHeaderSignature:
        ok = ExtractEntry(extracted);
        break;
      case zip::kCentralHeaderSignature:
        ok = SkipRecord(zip::kCentralHeaderBytes - 4, {24, 26, 28});
        break;
      case zip::kEndRecordSignature:
        ok = SkipRecord(zip::kEndRecordBytes - 4, {16});
        break;
      default:
        ok = false;
    }
    if (!ok) return false;
  }
}

bool ZipExtractor::ExtractEntry(std::vector<std::wstring>* extracted) {
  unsigned char header[zip::kLocalHeaderBytes - 4];
  if (!ReadExactly(header, sizeof header)) return false;
  const std::uint16_t flags = zip::Get16(header + 2);
  const std::uint16_t method = zip::Get16(header + 4);
  const std::uint16_t time = zip::Get16(header + 6);
  const std::uint16_t date = zip::Get16(header + 8);
  std::uint32_t crc = zip::Get32(header + 10);
  std::uint32_t compressedSize = zip::Get32(header + 14);
  std::uint32_t size = zip::Get32(header + 18);
  std::string name(zip::Get16(header + 22), '\0');
  std::string extra(zip::Get16(header + 24), '\0');
  if (!ReadExactly(name.data(), name.size()) || !ReadExactly(extra.data(), extra.size()))
    return false;
  if ((flags & zip::kFlagEncrypted) ||
      (method != zip::kMethodStored && method != zip::kMethodDeflated))
    return false;
  bool isDirectory = false;
  // Bytes that are not UTF-8 become U+FFFD on disk too, so that the reported names find the
  // files.
  const std::optional<std::string> path = ExtractionPath(WideToUtf8(Utf8ToWide(name)), isDirectory);
  if (!path || m_destination.size() + path->size() >= PATH_MAX) return false;
  if (!m_root.IsOpen() && !m_root.Open(m_destination)) return false;

  ExtractedFile file;
  if (isDirectory) {
    const int fd = m_root.OpenDirectory(*path);
    if (fd < 0) return false;
    ::close(fd);
  } else {
    const std::size_t slash = path->rfind('/');
    const std::string parent = slash == std::string::npos ? std::string() : path->substr(0, slash);
    const int fd = m_root.OpenDirectory(parent);
    if (fd < 0 || !file.Create(fd, path->substr(slash + 1))) return false;
  }
  ExtractedFile* out = isDirectory ? nullptr : &file;
  const bool descriptor = flags & zip::kFlagDataDescriptor;
  // Output past the size the header states cannot pass the checks below: stop it at once, so
  // that a crafted entry cannot fill the disk.
  const std::uint64_t sizeLimit = descriptor ? zip::kMaxSize : size;
  DataCheck data;
  const bool copied = method == zip::kMethodStored
                          ? CopyStored(compressedSize, out, sizeLimit, data)
                          : Inflate(!descriptor, compressedSize, out, sizeLimit, data);
  if (!copied) return false;
  if (descriptor) {
    if (!ConfirmDescriptor(data)) return false;
    crc = data.crc;
    compressedSize = static_cast<std::uint32_t>(data.consumed);
    size = static_cast<std::uint32_t>(data.size);
  }
  if (data.size != size || data.crc != crc) return false;
  if (out) {
    const std::time_t modified = FromDosTimestamp(time, date, DaylightFlag(extra));
    if (modified == -1 || !file.SetModificationTime(modified) || !file.Commit()) return false;
  }
  if (extracted) extracted->push_back(Utf8ToWide(*path + (isDirectory ? "/" : "")));
  return true;
}

bool ZipExtractor::SkipRecord(std::size_t rest, std::initializer_list<std::size_t> lengthOffsets) {
  unsigned char record[zip::kCentralHeaderBytes];
  if (!ReadExactly(record, rest)) return false;
  std::uint64_t variable = 0;
  for (const std::size_t at : lengthOffsets) variable += zip::Get16(record + at);
  return SkipBytes(variable);
}

bool ZipExtractor::ReadExactly(void* buffer, std::size_t count) {
  return count == 0 || m_archive.Read(buffer, static_cast<unsigned>(count)) == count;
}

bool ZipExtractor::SkipBytes(std::uint64_t count) {
  const std::uint64_t target = m_archive.GetPosition() + count;
  if (target > m_archive.GetLength()) return false;
  m_archive.Seek(static_cast<std::int64_t>(target), CFile::begin);
  return true;
}

bool ZipExtractor::CopyStored(std::uint64_t count, ExtractedFile* out, std::uint64_t sizeLimit,
                              DataCheck& data) {
  for (std::uint64_t left = count; left > 0;) {
    const unsigned want = static_cast<unsigned>(std::min<std::uint64_t>(left, zip::kPieceBytes));
    if (!ReadExactly(m_in.get(), want) || !Emit(m_in.get(), want, out, sizeLimit, data))
      return false;
    left -= want;
  }
  data.consumed = count;
  return true;
}

bool ZipExtractor::Inflate(bool bounded, std::uint64_t count, ExtractedFile* out,
                           std::uint64_t sizeLimit, DataCheck& data) {
  if (!m_streamReady) {
    if (inflateInit2(&m_stream, -15) != Z_OK) return false;  // raw deflate, any window size
    m_streamReady = true;
  } else if (inflateReset(&m_stream) != Z_OK) {
    return false;
  }
  const std::uint64_t start = m_archive.GetPosition();
  std::uint64_t left = count;
  std::uint64_t read = 0;
  m_stream.avail_in = 0;
  for (;;) {
    if (m_stream.avail_in == 0) {
      const std::size_t want =
          bounded ? static_cast<std::size_t>(std::min<std::uint64_t>(left, zip::kPieceBytes))
                  : zip::kPieceBytes;
      const unsigned got = want ? m_archive.Read(m_in.get(), static_cast<unsigned>(want)) : 0;
      if (got == 0) return false;  // the data ended inside the stream
      left -= bounded ? got : 0;
      read += got;
      m_stream.next_in = m_in.get();
      m_stream.avail_in = got;
    }
    m_stream.next_out = m_out.get();
    m_stream.avail_out = static_cast<uInt>(zip::kPieceBytes);
    const int status = inflate(&m_stream, Z_NO_FLUSH);
    const std::size_t produced = zip::kPieceBytes - m_stream.avail_out;
    if (produced && !Emit(m_out.get(), produced, out, sizeLimit, data)) return false;
    if (status == Z_STREAM_END) break;
    if (status != Z_OK && status != Z_BUF_ERROR) return false;
  }
  data.consumed = read - m_stream.avail_in;
  // A bounded stream owns all `count` bytes; otherwise what follows it is the descriptor.
  m_archive.Seek(static_cast<std::int64_t>(start + (bounded ? count : data.consumed)),
                 CFile::begin);
  return true;
}

bool ZipExtractor::Emit(const unsigned char* bytes, std::size_t count, ExtractedFile* out,
                        std::uint64_t sizeLimit, DataCheck& data) {
  data.size += count;
  if (data.size > sizeLimit) return false;
  data.crc = static_cast<std::uint32_t>(crc32(data.crc, bytes, static_cast<uInt>(count)));
  return !out || out->Write(bytes, count);
}

bool ZipExtractor::ConfirmDescriptor(const DataCheck& data) {
  const auto states = [&data](const unsigned char* fields) {
    return zip::Get32(fields) == data.crc && zip::Get32(fields + 4) == data.consumed &&
           zip::Get32(fields + 8) == data.size;
  };
  unsigned char descriptor[16];
  const std::uint64_t at = m_archive.GetPosition();
  const unsigned got = m_archive.Read(descriptor, sizeof descriptor);
  if (got == 16 && zip::Get32(descriptor) == zip::kDataDescriptorSignature &&
      states(descriptor + 4))
    return true;
  if (got < 12 || !states(descriptor)) return false;
  m_archive.Seek(static_cast<std::int64_t>(at + 12), CFile::begin);
  return true;
}

}  // namespace LumenUtility
