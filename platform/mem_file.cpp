#include "lumen/platform/mem_file.h"

#include <algorithm>
#include <cerrno>
#include <cstring>

namespace {

// The largest memory file: lengths of persisted blocks are 32-bit.
constexpr std::uint64_t kMaxBytes = 0xFFFFFFFFu;

}  // namespace

CMemFile::CMemFile(const void* bytes, std::size_t count)
    : m_data(static_cast<const std::uint8_t*>(bytes),
             static_cast<const std::uint8_t*>(bytes) + count) {}

int CMemFile::Open(const wchar_t* path, unsigned, CFileException* error) {
  if (error) *error = CFileException(CFileException::genericException, -1, path);
  return 0;
}

unsigned CMemFile::Read(void* buffer, unsigned count) {
  if (m_position >= m_data.size()) return 0;
  const std::size_t n = std::min<std::uint64_t>(count, m_data.size() - m_position);
  if (n) std::memcpy(buffer, m_data.data() + m_position, n);
  m_position += n;
  return static_cast<unsigned>(n);
}

void CMemFile::Write(const void* buffer, unsigned count) {
  if (count == 0) return;
  const std::uint64_t end = m_position + count;
  if (end > kMaxBytes) throw CFileException(CFileException::diskFull, ENOSPC);
  if (end > m_data.size()) m_data.resize(end);
  std::memcpy(m_data.data() + m_position, buffer, count);
  m_position = end;
}

std::uint64_t CMemFile::Seek(std::int64_t offset, unsigned from) {
  m_position = SeekTarget(offset, from, m_position, m_data.size(), GetFilePath());
  return m_position;
}

void CMemFile::Close() {
  m_data = {};
  m_position = 0;
}

std::vector<std::uint8_t> CMemFile::Detach() {
  std::vector<std::uint8_t> bytes = std::move(m_data);
  Close();
  return bytes;
}
