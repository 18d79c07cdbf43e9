// The archive and packed forms of an InputArray.
#include <climits>
#include <cstdint>
#include <string>

#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/archive.h"
#include "lumen/stimulus/input_array.h"
#include "stimulus/record_checks.h"

namespace LumenUtility {
namespace {

constexpr const wchar_t* kArchiveRecord = L"InputArray archive record";
constexpr const wchar_t* kPackedRecord = L"InputArray packed record";
constexpr int kPackedHeaderBytes = 20;
// The smallest packed segment record: its header.
constexpr std::uint64_t kPackedSegmentHeaderBytes = 32;

}  // namespace

void InputArray::Serialize(Archive& ar) {
  if (ar.IsStoring()) {
    ar << std::uint16_t{1} << std::uint32_t{NumSegments()};
    for (const Segment& s : GetSegments()) Segment(s).Serialize(ar);
    return;
  }
  try {
    std::uint16_t version;
    ar >> version;
    if (version != 1) throw LumenException(LUMEN_E_BOUNDS, L"InputArray version not recognized");
    std::uint32_t count;
    ar >> count;
    std::vector<Segment> segments;
    std::uint64_t total = 0;
    for (std::uint32_t k = 0; k < count; ++k) {
      Segment s;
      s.Serialize(ar);
      total += s.size();
      if (total > UINT_MAX) packed::Reject(kArchiveRecord, L"more than 2^32 - 1 points");
      segments.push_back(s);
    }
    AdoptSegments(std::move(segments), static_cast<unsigned int>(total));
  } catch (LumenException& e) {
    packed::NameRecordInArchiveError(e, kArchiveRecord);
    throw;
  }
}

int InputArray::SaveData(unsigned char* buffer, int bufferSize) const {
  std::uint64_t recordSize = kPackedHeaderBytes;
  for (const Segment& s : GetSegments()) recordSize += s.SaveData(nullptr, 0);
  const int size = packed::RecordSize(recordSize, kPackedRecord);
  if (!buffer) return size;
  if (bufferSize < size) return 0;
  packed::StoreAt<std::int32_t>(buffer, 0, size);
  packed::StoreAt<std::int32_t>(buffer, 4, 1);
  packed::StoreAt<std::uint32_t>(buffer, 8, m_size);
  packed::StoreAt<std::uint32_t>(buffer, 12, NumSegments());
  packed::StoreAt<std::int32_t>(buffer, 16, size - kPackedHeaderBytes);
  int offset = kPackedHeaderBytes;
  for (const Segment& s : GetSegments()) offset += s.SaveData(buffer + offset, bufferSize - offset);
  return size;
}

int InputArray::RecallData(const unsigned char* buffer, int bufferSize) {
  if (!buffer || bufferSize < kPackedHeaderBytes) {
    packed::Reject(kPackedRecord, std::to_wstring(buffer ? bufferSize : 0) +
                                      L" bytes are fewer than its 20-byte header");
  }
  const std::int32_t recordSize = packed::LoadAt<std::int32_t>(buffer, 0);
  const std::int32_t version = packed::LoadAt<std::int32_t>(buffer, 4);
  if (version < 1) return recordSize;
  const std::uint32_t total = packed::LoadAt<std::uint32_t>(buffer, 8);
  const std::uint32_t count = packed::LoadAt<std::uint32_t>(buffer, 12);
  const std::int32_t segmentBytes = packed::LoadAt<std::int32_t>(buffer, 16);
  if (recordSize < kPackedHeaderBytes || recordSize > bufferSize) {
    packed::Reject(kPackedRecord, L"record size " + std::to_wstring(recordSize) +
                                      L" is not between 20 and the " + std::to_wstring(bufferSize) +
                                      L" bytes there are");
  }
  // A newer writer may append fields after the segments; version 1 has none.
  const std::int32_t room = recordSize - kPackedHeaderBytes;
  if (segmentBytes < 0 || segmentBytes > room || (version == 1 && segmentBytes != room)) {
    packed::Reject(kPackedRecord, L"segment byte count " + std::to_wstring(segmentBytes) +
                                      L" does not fit record size " + std::to_wstring(recordSize));
  }
  if (total == 0) {
    clear();
    return recordSize;
  }
  if (count * kPackedSegmentHeaderBytes > static_cast<std::uint64_t>(segmentBytes)) {
    packed::Reject(kPackedRecord, std::to_wstring(count) + L" segments cannot fit in " +
                                      std::to_wstring(segmentBytes) + L" bytes");
  }
  std::vector<Segment> segments(count);
  const int end = kPackedHeaderBytes + segmentBytes;
  int offset = kPackedHeaderBytes;
  for (std::uint32_t k = 0; k < count; ++k) {
    try {
      offset += segments[k].RecallData(buffer + offset, end - offset);
    } catch (LumenException& e) {
      e.AddMessage(std::wstring(kPackedRecord) + L": segment " + std::to_wstring(k));
      throw;
    }
  }
  packed::CheckTotalPoints(kPackedRecord, total, segments);
  AdoptSegments(std::move(segments), total);
  return recordSize;
}

void InputArray::AdoptSegments(std::vector<Segment>&& segments, unsigned int total) {
  m_pSegments.reset(new std::vector<Segment>(std::move(segments)));
  m_size = total;
  m_pArray.reset();
}

}  // namespace LumenUtility
