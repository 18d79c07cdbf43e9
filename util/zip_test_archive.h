// Test support: ZIP archives built byte by byte, so that tests can craft the records other
// writers produce (stored entries, data descriptors, directory entries) and corrupt them
// (wrong CRC or sizes, unknown methods, hostile names).
#pragma once

#include <zlib.h>

#include <cstdint>
#include <fstream>
#include <string>
#include <vector>

#include "util/zip_format.h"

namespace LumenUtility::testutil {

// `data` as a raw deflate stream.
inline std::string RawDeflate(const std::string& data, int level = Z_DEFAULT_COMPRESSION) {
  z_stream stream{};
  deflateInit2(&stream, level, Z_DEFLATED, -15, 8, Z_DEFAULT_STRATEGY);
  std::string out(deflateBound(&stream, data.size()), '\0');
  stream.next_in = reinterpret_cast<Bytef*>(const_cast<char*>(data.data()));
  stream.avail_in = static_cast<uInt>(data.size());
  stream.next_out = reinterpret_cast<Bytef*>(out.data());
  stream.avail_out = static_cast<uInt>(out.size());
  deflate(&stream, Z_FINISH);
  out.resize(stream.total_out);
  deflateEnd(&stream);
  return out;
}

inline std::uint32_t Crc32(const std::string& data) {
  return static_cast<std::uint32_t>(
      crc32(0, reinterpret_cast<const Bytef*>(data.data()), static_cast<uInt>(data.size())));
}

// One entry as it is to be written; as constructed, a valid deflated entry. The setters
// change what is written, for entries of other writers and for corrupt ones.
struct TestEntry {
  TestEntry(std::string entryName, std::string entryData)
      : name(std::move(entryName)), data(std::move(entryData)) {}
  TestEntry& Method(std::uint16_t value) { return Set(method, value); }
  TestEntry& Flags(std::uint16_t value) { return Set(flags, value); }
  TestEntry& Time(std::uint16_t dosTime, std::uint16_t dosDate) {
    time = dosTime;
    return Set(date, dosDate);
  }
  TestEntry& Extra(std::string value) { return Set(extra, std::move(value)); }
  // What the local header (with kFlagDataDescriptor: the descriptor) states, the data staying
  // as they are.
  TestEntry& Crc(std::int64_t value) { return Set(crc, value); }
  TestEntry& CompressedSize(std::int64_t value) { return Set(compressedSize, value); }
  TestEntry& Size(std::int64_t value) { return Set(size, value); }
  // With kFlagDataDescriptor: a descriptor without its optional signature. The header then
  // states only the length of stored data, as streaming writers do.
  TestEntry& NoDescriptorSignature() { return Set(descriptorSignature, false); }

  std::string name;
  std::string data;
  std::uint16_t method = zip::kMethodDeflated;
  std::uint16_t flags = 0;
  std::uint16_t time = 0x6000;  // 12:00:00
  std::uint16_t date = 0x52A1;  // 2021-05-01
  std::string extra;
  std::int64_t crc = -1;  // -1: the true value
  std::int64_t compressedSize = -1;
  std::int64_t size = -1;
  bool descriptorSignature = true;

 private:
  template <typename T, typename V>
  TestEntry& Set(T& field, V value) {
    field = std::move(value);
    return *this;
  }
};

// Local headers with data, the central directory and the end record.
class TestArchive {
 public:
  TestArchive& Add(TestEntry entry) {
    const std::string stored =
        entry.method == zip::kMethodDeflated ? RawDeflate(entry.data) : entry.data;
    const std::uint32_t crc =
        entry.crc >= 0 ? static_cast<std::uint32_t>(entry.crc) : Crc32(entry.data);
    const auto compressed = static_cast<std::uint32_t>(
        entry.compressedSize >= 0 ? entry.compressedSize : std::int64_t(stored.size()));
    const auto size =
        static_cast<std::uint32_t>(entry.size >= 0 ? entry.size : std::int64_t(entry.data.size()));
    const bool descriptor = entry.flags & zip::kFlagDataDescriptor;
    std::string sizes;  // as stated: in the header, or in the descriptor after the data
    zip::Put32(sizes, crc);
    zip::Put32(sizes, compressed);
    zip::Put32(sizes, size);
    std::string headerSizes = sizes;
    if (descriptor) {
      // A streaming writer knows the length of stored data only.
      headerSizes.assign(12, '\0');
      if (entry.method == zip::kMethodStored) {
        headerSizes.resize(4);
        zip::Put32(headerSizes, static_cast<std::uint32_t>(stored.size()));
        zip::Put32(headerSizes, 0);
      }
    }
    std::string fields;
    zip::Put16(fields, 20);  // version needed
    zip::Put16(fields, entry.flags);
    zip::Put16(fields, entry.method);
    zip::Put16(fields, entry.time);
    zip::Put16(fields, entry.date);
    std::string lengths;
    zip::Put16(lengths, static_cast<std::uint32_t>(entry.name.size()));
    zip::Put16(lengths, static_cast<std::uint32_t>(entry.extra.size()));
    std::string local;
    zip::Put32(local, zip::kLocalHeaderSignature);
    local += fields + headerSizes + lengths + entry.name + entry.extra;
    const std::uint32_t offset = static_cast<std::uint32_t>(m_bytes.size());
    m_bytes += local + stored;
    if (descriptor) {
      if (entry.descriptorSignature) zip::Put32(m_bytes, zip::kDataDescriptorSignature);
      m_bytes += sizes;
    }
    std::string central;
    zip::Put32(central, zip::kCentralHeaderSignature);
    zip::Put16(central, 20);  // made by
    central += fields + sizes + lengths;
    zip::Put16(central, 0);  // comment
    zip::Put16(central, 0);
    zip::Put16(central, 0);
    zip::Put32(central, 0);
    zip::Put32(central, offset);
    central += entry.name + entry.extra;
    m_central += central;
    ++m_count;
    return *this;
  }
  std::string Bytes() const {
    std::string end;
    zip::Put32(end, zip::kEndRecordSignature);
    zip::Put32(end, 0);
    zip::Put16(end, m_count);
    zip::Put16(end, m_count);
    zip::Put32(end, static_cast<std::uint32_t>(m_central.size()));
    zip::Put32(end, static_cast<std::uint32_t>(m_bytes.size()));
    zip::Put16(end, 0);
    return m_bytes + m_central + end;
  }
  void WriteTo(const std::string& path) const { std::ofstream(path, std::ios::binary) << Bytes(); }

 private:
  std::string m_bytes;
  std::string m_central;
  std::uint32_t m_count = 0;
};

}  // namespace LumenUtility::testutil
