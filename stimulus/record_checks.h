// Shared by the readers and writers of the persisted stimulus forms: little-endian fields at
// byte offsets of the packed forms, and the errors that name the record at fault.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>

#include <vector>

#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/segment.h"

namespace LumenUtility::packed {

// The host is little-endian (checked where the archive is built), so a field is its bytes.
template <typename T>
T LoadAt(const unsigned char* record, std::size_t offset) {
  T value;
  std::memcpy(&value, record + offset, sizeof value);
  return value;
}

template <typename T>
void StoreAt(unsigned char* record, std::size_t offset, T value) {
  std::memcpy(record + offset, &value, sizeof value);
}

// Highest SegmentType value.
inline constexpr std::int64_t kMaxSegmentType = 3;

// Throws LumenException 0xE8080882 with "<record>: <problem>".
[[noreturn]] void Reject(const wchar_t* record, const std::wstring& problem);

// `bytes` as a packed record size; throws (naming `record`) past 2^31 - 1.
int RecordSize(std::uint64_t bytes, const wchar_t* record);

// Throws (naming `record`) unless the segments hold `total` points together.
void CheckTotalPoints(const wchar_t* record, std::uint64_t total,
                      const std::vector<Segment>& segments);

// Adds `record` as a second message to an archive's own error (end of buffer, failed read),
// which cannot know what it was reading.
void NameRecordInArchiveError(LumenException& e, const wchar_t* record);

}  // namespace LumenUtility::packed
