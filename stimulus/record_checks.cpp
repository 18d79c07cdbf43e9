#include "stimulus/record_checks.h"

#include <climits>

namespace LumenUtility::packed {

void Reject(const wchar_t* record, const std::wstring& problem) {
  throw LumenException(LUMEN_E_BOUNDS, std::wstring(record) + L": " + problem);
}

int RecordSize(std::uint64_t bytes, const wchar_t* record) {
  if (bytes > INT_MAX) Reject(record, L"larger than 2^31 - 1 bytes");
  return static_cast<int>(bytes);
}

void CheckTotalPoints(const wchar_t* record, std::uint64_t total,
                      const std::vector<Segment>& segments) {
  std::uint64_t sum = 0;
  for (const Segment& s : segments) sum += s.size();
  if (sum != total) {
    Reject(record, L"total point count " + std::to_wstring(total) + L" is not the segments' " +
                       std::to_wstring(sum));
  }
}

void NameRecordInArchiveError(LumenException& e, const wchar_t* record) {
  if (e.GetMessages().size() == 1 && e.GetMessage().rfind(L"Archive ", 0) == 0)
    e.AddMessage(record);
}

}  // namespace LumenUtility::packed
