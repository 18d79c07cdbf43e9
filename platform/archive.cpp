#include "lumen/platform/archive.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <limits>

#include "lumen/platform/text_conversion.h"

static_assert(std::endian::native == std::endian::little,
              "archives are little-endian; a big-endian host needs byte swapping here");

namespace {

// The tagged wide-string form: 0xFF and the 16-bit tag 0xFFFE before the count.
constexpr std::uint8_t kLongCount = 0xFF;
constexpr std::uint16_t kUnicodeTag = 0xFFFE;
constexpr std::uint16_t kWiderCount16 = 0xFFFF;
constexpr std::uint32_t kWiderCount32 = 0xFFFFFFFF;
// Strings are read in pieces of this many bytes, so a count that claims more than the archive
// holds fails at its end instead of allocating the claimed size first.
constexpr std::size_t kStringPieceBytes = 64 * 1024;

template <typename T>
void Append(std::string& out, T value) {
  char bytes[sizeof(T)];
  std::memcpy(bytes, &value, sizeof(T));
  out.append(bytes, sizeof(T));
}

}  // namespace

CArchive::CArchive(CFile* file, unsigned mode) : m_file(file), m_loading((mode & load) != 0) {}

CArchive::~CArchive() {
  try {
    Flush();
  } catch (const CFileException&) {
    // A destructor reports nothing; Close reports the failure.
  }
}

void CArchive::Flush() {
  if (m_file && !m_loading) m_file->Flush();
}

void CArchive::Close() {
  Flush();
  m_file = nullptr;
}

unsigned CArchive::Read(void* buffer, unsigned count) {
  CheckAttached();
  if (!m_loading) Throw(CArchiveException::writeOnly);
  auto* out = static_cast<std::uint8_t*>(buffer);
  unsigned done = 0;
  while (done < count) {
    const unsigned got = m_file->Read(out + done, count - done);
    if (got == 0) break;
    done += got;
  }
  return done;
}

void CArchive::Write(const void* buffer, unsigned count) {
  CheckAttached();
  if (m_loading) Throw(CArchiveException::readOnly);
  m_file->Write(buffer, count);
}

template <typename T>
CArchive& CArchive::WriteValue(T v) {
  Write(&v, sizeof v);
  return *this;
}

template <typename T>
CArchive& CArchive::ReadValue(T& v) {
  T value;
  ReadExactly(&value, sizeof value);
  v = value;
  return *this;
}

void CArchive::ReadExactly(void* buffer, std::size_t count) {
  if (Read(buffer, static_cast<unsigned>(count)) != count) Throw(CArchiveException::endOfFile);
}

CArchive& CArchive::operator<<(std::uint8_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(std::int8_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(std::uint16_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(std::int16_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(std::uint32_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(std::int32_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(std::uint64_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(std::int64_t v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(float v) {
  return WriteValue(v);
}
CArchive& CArchive::operator<<(double v) {
  return WriteValue(v);
}
CArchive& CArchive::operator>>(std::uint8_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(std::int8_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(std::uint16_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(std::int16_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(std::uint32_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(std::int32_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(std::uint64_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(std::int64_t& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(float& v) {
  return ReadValue(v);
}
CArchive& CArchive::operator>>(double& v) {
  return ReadValue(v);
}

CArchive& CArchive::operator<<(const std::wstring& text) {
  const std::string units = LumenUtility::WideToUtf16LeBytes(text);
  const std::uint64_t count = units.size() / 2;
  if (count >= kWiderCount32) Throw(CArchiveException::genericException);
  std::string record;
  record.reserve(units.size() + 10);
  Append(record, kLongCount);
  Append(record, kUnicodeTag);
  if (count < kLongCount) {
    Append(record, static_cast<std::uint8_t>(count));
  } else if (count < kUnicodeTag) {
    Append(record, kLongCount);
    Append(record, static_cast<std::uint16_t>(count));
  } else {
    Append(record, kLongCount);
    Append(record, kWiderCount16);
    Append(record, static_cast<std::uint32_t>(count));
  }
  record += units;
  Write(record.data(), static_cast<unsigned>(record.size()));
  return *this;
}

std::uint64_t CArchive::ReadStringLength(bool& wide) {
  wide = false;
  std::uint8_t count8;
  *this >> count8;
  if (count8 < kLongCount) return count8;
  std::uint16_t count16;
  *this >> count16;
  if (count16 == kUnicodeTag) {
    wide = true;
    *this >> count8;
    if (count8 < kLongCount) return count8;
    *this >> count16;
  }
  if (count16 < kWiderCount16) return count16;
  std::uint32_t count32;
  *this >> count32;
  if (count32 < kWiderCount32) return count32;
  std::uint64_t count64;
  *this >> count64;
  return count64;
}

CArchive& CArchive::operator>>(std::wstring& text) {
  bool wide;
  const std::uint64_t count = ReadStringLength(wide);
  if (wide && count > std::numeric_limits<std::uint64_t>::max() / 2)
    Throw(CArchiveException::endOfFile);
  std::uint64_t left = wide ? 2 * count : count;
  std::string bytes;
  while (left > 0) {
    const std::size_t piece =
        static_cast<std::size_t>(std::min<std::uint64_t>(left, kStringPieceBytes));
    const std::size_t at = bytes.size();
    bytes.resize(at + piece);
    ReadExactly(bytes.data() + at, piece);
    left -= piece;
  }
  text = wide ? LumenUtility::Utf16LeBytesToWide(
                    reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size())
              : LumenUtility::Utf8ToWide(bytes);
  return *this;
}

void CArchive::CheckAttached() const {
  if (!m_file) throw CArchiveException(CArchiveException::genericException);
}

void CArchive::Throw(int cause) const {
  throw CArchiveException(cause, m_file ? m_file->GetFilePath().c_str() : nullptr);
}
