#include "lumen/stimulus/archive.h"

#include <unistd.h>

#include <algorithm>
#include <bit>
#include <cerrno>
#include <cstring>

#include "lumen/platform/lumen_exception.h"

static_assert(std::endian::native == std::endian::little,
              "archives are little-endian; a big-endian host needs byte swapping here");

namespace LumenUtility {
namespace {

// A refill reads at least this much, so that a record of many small fields costs a few
// system calls instead of one per field.
constexpr std::size_t kRefillBytes = 64 * 1024;

[[noreturn]] void Fail(const wchar_t* message) {
  throw LumenException(LUMEN_E_BOUNDS, message);
}

}  // namespace

Archive::Archive(std::vector<unsigned char>& buffer, bool loading, int fileDescriptor)
    : m_buffer(buffer),
      m_loading(loading),
      m_file(fileDescriptor < 0 ? kInvalidHandle : fileDescriptor) {}

Archive::~Archive() {
  CloseFile();
}

void Archive::Write(const void* bytes, std::size_t count) {
  if (m_loading) Fail(L"Archive Exception: Writing to read-only archive.");
  const auto* first = static_cast<const unsigned char*>(bytes);
  m_buffer.insert(m_buffer.end(), first, first + count);
}

std::size_t Archive::Read(void* destination, std::size_t count) {
  if (!m_loading) Fail(L"Archive Exception: Reading from write-only archive.");
  if (count == 0) return 0;
  MakeAvailable(count);
  std::memcpy(destination, m_buffer.data() + m_readPosition, count);
  m_readPosition += count;
  return count;
}

void Archive::CheckFile() const {
  if (m_file == kInvalidHandle) Fail(L"Archive Exception: Invalid file handle");
}

void Archive::MakeAvailable(std::size_t count) {
  if (m_file != kInvalidHandle && Remaining() < count) Refill(count);
  if (Remaining() < count) Fail(L"Archive Exception: Attempt to read beyond end of buffer.");
}

void Archive::Refill(std::size_t count) {
  const std::size_t wanted = std::max(count, kRefillBytes);
  m_buffer.erase(m_buffer.begin(), m_buffer.begin() + static_cast<std::ptrdiff_t>(m_readPosition));
  m_readPosition = 0;
  const std::size_t kept = m_buffer.size();
  m_buffer.resize(kept + wanted);
  std::size_t got = 0;
  while (got < wanted) {
    const ssize_t n = ::read(m_file, m_buffer.data() + kept + got, wanted - got);
    if (n < 0 && errno == EINTR) continue;
    if (n < 0) {
      m_buffer.resize(kept + got);
      Fail(L"Archive exception: ReadFile failed");
    }
    if (n == 0) break;
    got += static_cast<std::size_t>(n);
  }
  m_buffer.resize(kept + got);
  if (got < wanted) CloseFile();
}

void Archive::CloseFile() {
  if (m_file == kInvalidHandle) return;
  ::close(m_file);
  m_file = kInvalidHandle;
}

}  // namespace LumenUtility
