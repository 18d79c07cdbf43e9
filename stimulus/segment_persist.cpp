// The archive and packed forms of a Segment.
#include <algorithm>
#include <climits>
#include <cstdint>
#include <string>

#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/archive.h"
#include "lumen/stimulus/segment.h"
#include "stimulus/record_checks.h"

namespace LumenUtility {
namespace {

constexpr const wchar_t* kArchiveRecord = L"InputArray::Segment archive record";
constexpr const wchar_t* kPackedRecord = L"InputArray Segment packed record";
constexpr std::size_t kPackedHeaderBytes = 32;
// Points are copied out of an archive in pieces of this many, so that a count the archive
// cannot back fails at its end instead of sizing a vector first.
constexpr std::uint32_t kPointsPerPiece = 8192;

std::uint64_t PointBytes(std::uint32_t count) {
  return std::uint64_t{8} * count;
}

std::vector<double> ReadPoints(Archive& ar, std::uint32_t count) {
  std::vector<double> points;
  while (points.size() < count) {
    const std::size_t at = points.size();
    const std::size_t piece = std::min<std::size_t>(count - at, kPointsPerPiece);
    points.resize(at + piece);
    ar.Read(points.data() + at, piece * sizeof(double));
  }
  return points;
}

}  // namespace

void Segment::Serialize(Archive& ar) {
  if (ar.IsStoring()) {
    ar << std::uint16_t{1} << m_start << m_stop << std::uint32_t{m_numPoints}
       << static_cast<std::uint8_t>(m_type);
    if (m_type == Arbitrary) {
      if (PointBytes(m_numPoints) > UINT32_MAX)
        packed::Reject(kArchiveRecord, L"too many points for a 32-bit byte count");
      ar << static_cast<std::uint32_t>(PointBytes(m_numPoints));
      ar.Write(CachedPoints(), PointBytes(m_numPoints));
    }
    return;
  }
  try {
    std::uint16_t version;
    ar >> version;
    if (version != 1)
      throw LumenException(LUMEN_E_BOUNDS, L"InputArray::Segment serialization failed.");
    Segment loaded;
    std::uint32_t count;
    std::uint8_t type;
    ar >> loaded.m_start >> loaded.m_stop >> count >> type;
    if (type > packed::kMaxSegmentType)
      packed::Reject(kArchiveRecord, L"segment type " + std::to_wstring(type) + L" is not 0 to 3");
    loaded.m_numPoints = count;
    loaded.m_type = static_cast<SegmentType>(type);
    if (loaded.m_type == Arbitrary) {
      std::uint32_t byteCount;
      ar >> byteCount;
      if (byteCount != PointBytes(count)) {
        packed::Reject(kArchiveRecord, L"byte count " + std::to_wstring(byteCount) +
                                           L" is not 8 x " + std::to_wstring(count) + L" points");
      }
      loaded.m_pCache.reset(new std::vector<double>(ReadPoints(ar, count)));
    }
    *this = loaded;
  } catch (LumenException& e) {
    packed::NameRecordInArchiveError(e, kArchiveRecord);
    throw;
  }
}

int Segment::SaveData(unsigned char* buffer, int bufferSize) const {
  const int size = packed::RecordSize(
      kPackedHeaderBytes + (m_type == Arbitrary ? PointBytes(m_numPoints) : 0), kPackedRecord);
  if (!buffer) return size;
  if (bufferSize < size) return 0;
  packed::StoreAt<std::int32_t>(buffer, 0, size);
  packed::StoreAt<std::int32_t>(buffer, 4, 1);
  packed::StoreAt<double>(buffer, 8, m_start);
  packed::StoreAt<double>(buffer, 16, m_stop);
  packed::StoreAt<std::uint32_t>(buffer, 24, m_numPoints);
  packed::StoreAt<std::int32_t>(buffer, 28, m_type);
  if (m_type == Arbitrary && m_numPoints > 0)
    std::memcpy(buffer + kPackedHeaderBytes, CachedPoints(), PointBytes(m_numPoints));
  return size;
}

int Segment::RecallData(const unsigned char* buffer, int bufferSize) {
  if (!buffer || bufferSize < static_cast<int>(kPackedHeaderBytes)) {
    packed::Reject(kPackedRecord, std::to_wstring(buffer ? bufferSize : 0) +
                                      L" bytes are fewer than its 32-byte header");
  }
  const std::int32_t recordSize = packed::LoadAt<std::int32_t>(buffer, 0);
  const std::int32_t version = packed::LoadAt<std::int32_t>(buffer, 4);
  if (version < 1)
    throw LumenException(LUMEN_E_BOUNDS, L"Unhandled recall version in InputArray Segment");
  const std::uint32_t count = packed::LoadAt<std::uint32_t>(buffer, 24);
  const std::int32_t type = packed::LoadAt<std::int32_t>(buffer, 28);
  if (type < 0 || type > packed::kMaxSegmentType)
    packed::Reject(kPackedRecord, L"segment type " + std::to_wstring(type) + L" is not 0 to 3");
  const std::uint64_t needed = kPackedHeaderBytes + (type == Arbitrary ? PointBytes(count) : 0);
  // A newer writer may append fields, so only version 1 must be exactly this long.
  const bool sizeFits = version == 1 && type == Arbitrary
                            ? static_cast<std::uint64_t>(recordSize) == needed
                            : recordSize >= 0 && static_cast<std::uint64_t>(recordSize) >= needed;
  if (!sizeFits) {
    packed::Reject(kPackedRecord, L"record size " + std::to_wstring(recordSize) +
                                      L" does not hold " + std::to_wstring(needed) + L" bytes");
  }
  if (recordSize > bufferSize) {
    packed::Reject(kPackedRecord, L"record size " + std::to_wstring(recordSize) + L" exceeds the " +
                                      std::to_wstring(bufferSize) + L" bytes there are");
  }
  Segment recalled;
  recalled.m_start = packed::LoadAt<double>(buffer, 8);
  recalled.m_stop = packed::LoadAt<double>(buffer, 16);
  recalled.m_numPoints = count;
  recalled.m_type = static_cast<SegmentType>(type);
  if (recalled.m_type == Arbitrary) {
    recalled.m_pCache.reset(new std::vector<double>(count));
    if (count)
      std::memcpy(recalled.m_pCache->data(), buffer + kPackedHeaderBytes, PointBytes(count));
  }
  *this = recalled;
  return recordSize;
}

}  // namespace LumenUtility
