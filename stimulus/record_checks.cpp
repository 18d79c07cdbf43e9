#include "stimulus/record_checks.h"

namespace LumenUtility::packed {

void Reject(const wchar_t* record, const std::wstring& problem) {
  throw LumenException(LUMEN_E_BOUNDS, std::wstring(record) + L": " + problem);
}

void NameRecordInArchiveError(LumenException& e, const wchar_t* record) {
  if (e.GetMessages().size() == 1 && e.GetMessage().rfind(L"Archive ", 0) == 0)
    e.AddMessage(record);
}

}  // namespace LumenUtility::packed
