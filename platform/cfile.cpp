#include "lumen/platform/cfile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <limits>

#include "lumen/platform/text_conversion.h"

CFile::CFile() = default;

CFile::CFile(const wchar_t* path, unsigned flags) {
  CFileException error;
  if (!Open(path, flags, &error)) throw error;
}

CFile::~CFile() {
  Abort();
}

int CFile::Open(const wchar_t* path, unsigned flags, CFileException* error) {
  const std::wstring name = path ? path : L"";
  auto fail = [&](int cause, int osError) {
    if (error) *error = CFileException(cause, osError, name.c_str());
    return 0;
  };
  if (IsOpen()) return fail(CFileException::genericException, -1);
  int access;
  switch (flags & 3) {
    case modeRead:
      access = O_RDONLY;
      break;
    case modeWrite:
      access = O_WRONLY;
      break;
    case modeReadWrite:
      access = O_RDWR;
      break;
    default:
      return fail(CFileException::badPath, EINVAL);
  }
  int systemFlags = access | O_CLOEXEC;
  if (flags & modeCreate) systemFlags |= O_CREAT | ((flags & modeNoTruncate) ? 0 : O_TRUNC);
  const std::string utf8 = LumenUtility::WideToUtf8(name);
  int fd;
  do {
    fd = ::open(utf8.c_str(), systemFlags, 0666);
  } while (fd < 0 && errno == EINTR);
  if (fd < 0) {
    const int osError = errno;
    return fail(CFileException::OsErrorToException(osError), osError);
  }
  struct stat info;
  if (::fstat(fd, &info) != 0 || S_ISDIR(info.st_mode)) {
    ::close(fd);
    return fail(CFileException::accessDenied, EISDIR);
  }
  m_fd = fd;
  m_canRead = access != O_WRONLY;
  m_canWrite = access != O_RDONLY;
  m_strFileName = name;
  m_readPos = m_readEnd = m_writeEnd = 0;
  m_systemPos = 0;
  return 1;
}

unsigned CFile::Read(void* buffer, unsigned count) {
  CheckAccess(m_canRead);
  if (count == 0) return 0;
  FlushWrites();
  auto* out = static_cast<std::uint8_t*>(buffer);
  const std::size_t buffered = std::min<std::size_t>(count, m_readEnd - m_readPos);
  if (buffered) std::memcpy(out, Buffer() + m_readPos, buffered);
  m_readPos += buffered;
  std::size_t done = buffered;
  if (done == count) return count;
  m_readPos = m_readEnd = 0;
  if (count - done >= kBufferBytes) {
    while (done < count) {
      const std::size_t got = ReadFromSystem(out + done, count - done);
      if (got == 0) break;
      done += got;
    }
    return static_cast<unsigned>(done);
  }
  while (m_readEnd < count - done) {
    const std::size_t got = ReadFromSystem(Buffer() + m_readEnd, kBufferBytes - m_readEnd);
    if (got == 0) break;
    m_readEnd += got;
  }
  const std::size_t more = std::min(count - done, m_readEnd);
  std::memcpy(out + done, Buffer(), more);
  m_readPos = more;
  return static_cast<unsigned>(done + more);
}

void CFile::Write(const void* buffer, unsigned count) {
  CheckAccess(m_canWrite);
  if (count == 0) return;
  DropReadAhead();
  const auto* bytes = static_cast<const std::uint8_t*>(buffer);
  if (m_writeEnd + count > kBufferBytes) FlushWrites();
  if (count >= kBufferBytes) {
    WriteToSystem(bytes, count);
    return;
  }
  std::memcpy(Buffer() + m_writeEnd, bytes, count);
  m_writeEnd += count;
}

std::uint64_t CFile::SeekTarget(std::int64_t offset, unsigned from, std::uint64_t position,
                                std::uint64_t length, const std::wstring& fileName) {
  std::int64_t origin;
  switch (from) {
    case begin:
      origin = 0;
      break;
    case current:
      origin = static_cast<std::int64_t>(position);
      break;
    case end:
      origin = static_cast<std::int64_t>(length);
      break;
    default:
      throw CFileException(CFileException::badSeek, EINVAL, fileName.c_str());
  }
  std::int64_t target;
  if (__builtin_add_overflow(origin, offset, &target) || target < 0)
    throw CFileException(CFileException::badSeek, EINVAL, fileName.c_str());
  return static_cast<std::uint64_t>(target);
}

std::uint64_t CFile::Seek(std::int64_t offset, unsigned from) {
  CheckOpen();
  const std::uint64_t length = from == end ? GetLength() : 0;
  const std::uint64_t target = SeekTarget(offset, from, GetPosition(), length, m_strFileName);
  FlushWrites();
  m_readPos = m_readEnd = 0;
  if (::lseek(m_fd, static_cast<off_t>(target), SEEK_SET) < 0) ThrowErrno(errno);
  m_systemPos = target;
  return target;
}

std::uint64_t CFile::GetLength() const {
  CheckOpen();
  struct stat info;
  if (::fstat(m_fd, &info) != 0) ThrowErrno(errno);
  return std::max<std::uint64_t>(static_cast<std::uint64_t>(info.st_size), GetPosition());
}

std::uint64_t CFile::GetPosition() const {
  return m_systemPos - (m_readEnd - m_readPos) + m_writeEnd;
}

void CFile::Flush() {
  if (IsOpen()) FlushWrites();
}

void CFile::Close() {
  if (!IsOpen()) return;
  int osError = 0;
  try {
    FlushWrites();
  } catch (const CFileException& e) {
    osError = e.m_lOsError;
  }
  if (::close(m_fd) != 0 && osError == 0 && errno != EINTR) osError = errno;
  m_fd = -1;
  m_readPos = m_readEnd = m_writeEnd = 0;
  if (osError != 0) ThrowErrno(osError);
}

void CFile::Abort() {
  try {
    Close();
  } catch (const CFileException&) {
    // Abort reports nothing; the descriptor is closed either way.
  }
}

void CFile::ThrowErrno(int osError) const {
  CFileException::ThrowOsError(osError, m_strFileName.c_str());
}

void CFile::CheckOpen() const {
  if (!IsOpen()) throw CFileException(CFileException::invalidFile, EBADF, m_strFileName.c_str());
}

void CFile::CheckAccess(bool allowed) const {
  CheckOpen();
  if (!allowed) throw CFileException(CFileException::accessDenied, EBADF, m_strFileName.c_str());
}

void CFile::FlushWrites() {
  if (m_writeEnd == 0) return;
  const std::size_t count = m_writeEnd;
  m_writeEnd = 0;
  WriteToSystem(Buffer(), count);
}

void CFile::DropReadAhead() {
  if (m_readEnd == 0) return;
  const std::uint64_t logical = GetPosition();
  m_readPos = m_readEnd = 0;
  if (logical != m_systemPos) {
    if (::lseek(m_fd, static_cast<off_t>(logical), SEEK_SET) < 0) ThrowErrno(errno);
    m_systemPos = logical;
  }
}

void CFile::WriteToSystem(const std::uint8_t* bytes, std::size_t count) {
  while (count > 0) {
    const ssize_t written = ::write(m_fd, bytes, count);
    if (written < 0) {
      if (errno == EINTR) continue;
      ThrowErrno(errno);
    }
    if (written == 0) ThrowErrno(ENOSPC);
    bytes += written;
    count -= static_cast<std::size_t>(written);
    m_systemPos += static_cast<std::uint64_t>(written);
  }
}

std::size_t CFile::ReadFromSystem(std::uint8_t* bytes, std::size_t count) {
  for (;;) {
    const ssize_t got = ::read(m_fd, bytes, count);
    if (got >= 0) {
      m_systemPos += static_cast<std::uint64_t>(got);
      return static_cast<std::size_t>(got);
    }
    if (errno != EINTR) ThrowErrno(errno);
  }
}

std::uint8_t* CFile::Buffer() {
  if (!m_buffer) m_buffer = std::make_unique_for_overwrite<std::uint8_t[]>(kBufferBytes);
  return m_buffer.get();
}
