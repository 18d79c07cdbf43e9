// Recalls a packed segment or array (first byte's low bit) from the rest of the input, then
// saves and recalls what was accepted: the second save must give the same bytes.
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <exception>
#include <memory>
#include <vector>

#include "lumen/platform.h"
#include "lumen/stimulus.h"

namespace {

// Larger arrays are valid but only slow the fuzzer down.
constexpr unsigned int kMaxPointsToExpand = 100000;

template <typename T>
std::vector<unsigned char> Saved(const T& value) {
  std::vector<unsigned char> bytes(value.SaveData(nullptr, 0));
  value.SaveData(bytes.data(), static_cast<int>(bytes.size()));
  return bytes;
}

template <typename T>
void RecallAndResave(const unsigned char* record, int size) {
  T value;
  try {
    value.RecallData(record, size);
  } catch (const LumenException&) {
    return;  // a documented rejection
  }
  const std::vector<unsigned char> first = Saved(value);
  T again;
  again.RecallData(first.data(), static_cast<int>(first.size()));
  if (Saved(again) != first) __builtin_trap();
  if (value.size() <= kMaxPointsToExpand) {
    try {
      value.GetArray();
    } catch (const std::exception&) {
      // A logarithmic sweep through zero is stored faithfully but has no points.
    }
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  // An exact-size copy, so a read past the record is a sanitizer finding.
  const std::size_t length = size - 1;
  std::unique_ptr<unsigned char[]> record(new unsigned char[length ? length : 1]);
  std::memcpy(record.get(), data + 1, length);
  if (data[0] & 1) {
    RecallAndResave<LumenUtility::InputArray>(record.get(), static_cast<int>(length));
  } else {
    RecallAndResave<LumenUtility::Segment>(record.get(), static_cast<int>(length));
  }
  return 0;
}
