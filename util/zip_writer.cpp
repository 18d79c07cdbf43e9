#include "util/zip_writer.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

// An input file opened for reading, closed on every path out.
class InputFile {
 public:
  explicit InputFile(const std::string& path) {
    do {
      m_fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK);
    } while (m_fd < 0 && errno == EINTR);
  }
  ~InputFile() {
    if (m_fd >= 0) ::close(m_fd);
  }
  InputFile(const InputFile&) = delete;
  InputFile& operator=(const InputFile&) = delete;
  int Fd() const { return m_fd; }

 private:
  int m_fd;
};

// Names are UTF-8: readers that see the flag decode them so, where they would otherwise take
// the bytes for the old DOS code page. Plain ASCII names carry no flag, as ever.
std::uint16_t NameFlags(const std::string& name) {
  for (const char c : name) {
    if (static_cast<unsigned char>(c) >= 0x80) return zip::kFlagUtf8Name;
  }
  return 0;
}

// Bytes read into `buffer`, 0 at the end, -1 on an error.
ssize_t ReadSome(int fd, unsigned char* buffer, std::size_t count) {
  for (;;) {
    const ssize_t got = ::read(fd, buffer, count);
    if (got >= 0 || errno != EINTR) return got;
  }
}

}  // namespace

ZipWriter::ZipWriter() : ZipWriter(Limits{}) {}

ZipWriter::ZipWriter(Limits limits) : m_limits(limits) {}

ZipWriter::~ZipWriter() {
  if (m_streamReady) deflateEnd(&m_stream);
}

bool ZipWriter::Open(const std::wstring& zipPath) {
  CFileException error;
  if (!m_archive.Open(zipPath.c_str(), CFile::modeCreate | CFile::modeWrite | CFile::typeBinary,
                      &error))
    return false;
  m_archivePath = WideToUtf8(zipPath);
  struct stat info;
  if (::stat(m_archivePath.c_str(), &info) == 0) {
    m_archiveDevice = info.st_dev;
    m_archiveInode = info.st_ino;
  }
  // Raw deflate (negative window bits: no zlib header or trailer), 2^15-byte window.
  if (deflateInit2(&m_stream, Z_DEFAULT_COMPRESSION, Z_DEFLATED, -15, 8, Z_DEFAULT_STRATEGY) !=
      Z_OK) {
    m_archive.Abort();
    return false;
  }
  m_streamReady = true;
  m_in = std::make_unique_for_overwrite<unsigned char[]>(zip::kPieceBytes);
  m_out = std::make_unique_for_overwrite<unsigned char[]>(zip::kPieceBytes);
  return true;
}

bool ZipWriter::Add(const std::string& path, const std::string& entryName) {
  if (m_entries.size() >= m_limits.maxEntries || entryName.size() > 0xFFFF) return false;
  const InputFile input(path);
  struct stat info;
  if (input.Fd() < 0 || ::fstat(input.Fd(), &info) != 0 || !S_ISREG(info.st_mode)) return false;
  if (info.st_dev == m_archiveDevice && info.st_ino == m_archiveInode) return false;
  const std::uint64_t headerOffset = m_archive.GetPosition();
  if (static_cast<std::uint64_t>(info.st_size) > m_limits.maxSize ||
      headerOffset > m_limits.maxSize)
    return false;

  Entry entry{entryName,
              ToDosTimestamp(info.st_mtime),
              0,
              0,
              static_cast<std::uint32_t>(info.st_size),
              static_cast<std::uint32_t>(headerOffset)};
  const std::string header = LocalHeader(entry);
  m_archive.Write(header.data(), static_cast<unsigned>(header.size()));
  std::uint64_t size = 0;
  if (!Compress(input.Fd(), entry.crc, size)) {
    WindBack(headerOffset);
    return false;
  }
  const std::uint64_t end = m_archive.GetPosition();
  const std::uint64_t compressedSize = end - headerOffset - header.size();
  if (end > m_limits.maxSize) {
    WindBack(headerOffset);
    return false;
  }
  entry.compressedSize = static_cast<std::uint32_t>(compressedSize);
  entry.size = static_cast<std::uint32_t>(size);  // what was read, should the file have changed
  std::string sizes;
  zip::Put32(sizes, entry.crc);
  zip::Put32(sizes, entry.compressedSize);
  zip::Put32(sizes, entry.size);
  m_archive.Seek(static_cast<std::int64_t>(headerOffset + zip::kLocalCrcOffset), CFile::begin);
  m_archive.Write(sizes.data(), static_cast<unsigned>(sizes.size()));
  m_archive.Seek(static_cast<std::int64_t>(end), CFile::begin);
  m_entries.push_back(std::move(entry));
  return true;
}

bool ZipWriter::Compress(int fd, std::uint32_t& crc, std::uint64_t& size) {
  deflateReset(&m_stream);
  crc = static_cast<std::uint32_t>(crc32(0, Z_NULL, 0));
  size = 0;
  int flush = Z_NO_FLUSH;
  while (flush != Z_FINISH) {
    const ssize_t got = ReadSome(fd, m_in.get(), zip::kPieceBytes);
    if (got < 0) return false;
    size += static_cast<std::uint64_t>(got);
    if (size > m_limits.maxSize) return false;
    crc = static_cast<std::uint32_t>(crc32(crc, m_in.get(), static_cast<uInt>(got)));
    flush = got == 0 ? Z_FINISH : Z_NO_FLUSH;
    m_stream.next_in = m_in.get();
    m_stream.avail_in = static_cast<uInt>(got);
    do {
      m_stream.next_out = m_out.get();
      m_stream.avail_out = static_cast<uInt>(zip::kPieceBytes);
      deflate(&m_stream, flush);  // cannot fail here: the stream is set up and never misused
      const std::size_t produced = zip::kPieceBytes - m_stream.avail_out;
      if (produced) m_archive.Write(m_out.get(), static_cast<unsigned>(produced));
    } while (m_stream.avail_out == 0);
  }
  return true;
}

void ZipWriter::WindBack(std::uint64_t offset) {
  m_archive.Seek(static_cast<std::int64_t>(offset), CFile::begin);
  m_woundBack = true;
}

bool ZipWriter::Finish() {
  const std::uint64_t directoryOffset = m_archive.GetPosition();
  std::string directory;
  for (const Entry& entry : m_entries) directory += CentralHeader(entry);
  std::string end;
  zip::Put32(end, zip::kEndRecordSignature);
  zip::Put16(end, 0);  // this disk
  zip::Put16(end, 0);  // disk of the central directory
  zip::Put16(end, static_cast<std::uint32_t>(m_entries.size()));
  zip::Put16(end, static_cast<std::uint32_t>(m_entries.size()));
  zip::Put32(end, static_cast<std::uint32_t>(directory.size()));
  zip::Put32(end, static_cast<std::uint32_t>(directoryOffset));
  zip::Put16(end, 0);  // comment length
  directory += end;
  m_archive.Write(directory.data(), static_cast<unsigned>(directory.size()));
  const std::uint64_t length = m_archive.GetPosition();
  m_archive.Close();
  // Bytes of a wound-back entry may still lie past the end record.
  return !m_woundBack || ::truncate(m_archivePath.c_str(), static_cast<off_t>(length)) == 0;
}

std::string ZipWriter::LocalHeader(const Entry& entry) const {
  std::string header;
  header.reserve(zip::kLocalHeaderBytes + entry.name.size() + zip::kDaylightBlockBytes);
  zip::Put32(header, zip::kLocalHeaderSignature);
  zip::Put16(header, zip::kVersionNeeded);
  PutDescription(header, entry);
  PutNameAndExtra(header, entry);
  return header;
}

std::string ZipWriter::CentralHeader(const Entry& entry) const {
  std::string header;
  header.reserve(zip::kCentralHeaderBytes + entry.name.size() + zip::kDaylightBlockBytes);
  zip::Put32(header, zip::kCentralHeaderSignature);
  zip::Put16(header, zip::kVersionNeeded);  // made by
  zip::Put16(header, zip::kVersionNeeded);
  PutDescription(header, entry);
  zip::Put16(header, 0);  // comment length
  zip::Put16(header, 0);  // disk number start
  zip::Put16(header, 0);  // internal attributes
  zip::Put32(header, 0);  // external attributes
  zip::Put32(header, entry.headerOffset);
  PutNameAndExtra(header, entry);
  return header;
}

void ZipWriter::PutDescription(std::string& header, const Entry& entry) {
  zip::Put16(header, NameFlags(entry.name));
  zip::Put16(header, zip::kMethodDeflated);
  zip::Put16(header, entry.modified.time);
  zip::Put16(header, entry.modified.date);
  zip::Put32(header, entry.crc);
  zip::Put32(header, entry.compressedSize);
  zip::Put32(header, entry.size);
  zip::Put16(header, static_cast<std::uint32_t>(entry.name.size()));
  zip::Put16(header, zip::kDaylightBlockBytes);
}

void ZipWriter::PutNameAndExtra(std::string& header, const Entry& entry) {
  header += entry.name;
  zip::Put16(header, zip::kDaylightBlockId);
  zip::Put16(header, 4);
  zip::Put32(header, static_cast<std::uint32_t>(entry.modified.daylight));
}

}  // namespace LumenUtility
