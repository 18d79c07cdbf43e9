// Record layouts of the ZIP container (PKWARE application note), little-endian throughout,
// as ZlibUtil writes and reads them.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace LumenUtility::zip {

inline constexpr std::uint32_t kLocalHeaderSignature = 0x04034B50;
inline constexpr std::uint32_t kCentralHeaderSignature = 0x02014B50;
inline constexpr std::uint32_t kEndRecordSignature = 0x06054B50;
inline constexpr std::uint32_t kDataDescriptorSignature = 0x08074B50;

// Fixed parts, signature included.
inline constexpr std::size_t kLocalHeaderBytes = 30;
inline constexpr std::size_t kCentralHeaderBytes = 46;
inline constexpr std::size_t kEndRecordBytes = 22;

// Offsets in the local header of the fields written after the data.
inline constexpr std::size_t kLocalCrcOffset = 14;

inline constexpr std::uint16_t kVersionNeeded = 20;  // 2.0: deflate
inline constexpr std::uint16_t kMethodStored = 0;
inline constexpr std::uint16_t kMethodDeflated = 8;
inline constexpr std::uint16_t kFlagEncrypted = 1;
// CRC-32 and sizes follow the data in a data descriptor; the header holds zeros.
inline constexpr std::uint16_t kFlagDataDescriptor = 8;
// The entry name is UTF-8 (else the DOS code page 437, by the application note).
inline constexpr std::uint16_t kFlagUtf8Name = 0x0800;

// The extra block that carries whether daylight saving time was in effect at the entry's
// modification time: id, then 4 data bytes holding 1 or 0.
inline constexpr std::uint16_t kDaylightBlockId = 0x0100;
inline constexpr std::size_t kDaylightBlockBytes = 8;

// The widest value of the format's 32-bit sizes and offsets (no ZIP64), and the most entries
// its 16-bit counts hold.
inline constexpr std::uint64_t kMaxSize = 0xFFFFFFFF;
inline constexpr std::size_t kMaxEntries = 0xFFFF;

// Data moves through buffers of this size.
inline constexpr std::size_t kPieceBytes = 64 * 1024;

inline void Put16(std::string& out, std::uint32_t v) {
  out += static_cast<char>(v & 0xFF);
  out += static_cast<char>((v >> 8) & 0xFF);
}
inline void Put32(std::string& out, std::uint32_t v) {
  Put16(out, v & 0xFFFF);
  Put16(out, v >> 16);
}
inline std::uint16_t Get16(const unsigned char* p) {
  return static_cast<std::uint16_t>(p[0] | (p[1] << 8));
}
inline std::uint32_t Get32(const unsigned char* p) {
  return Get16(p) | (static_cast<std::uint32_t>(Get16(p + 2)) << 16);
}

}  // namespace LumenUtility::zip
