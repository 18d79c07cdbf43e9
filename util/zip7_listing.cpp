#include "util/zip7_listing.h"

namespace LumenUtility {

void AppendListedNames(const std::vector<std::wstring>& lines, std::vector<std::wstring>& names) {
  constexpr std::size_t kColumnsBeforeName = 5;
  bool inTable = false;
  for (const std::wstring& line : lines) {
    if (line.find(L"-----") != std::wstring::npos) {
      if (inTable) return;
      inTable = true;
      continue;
    }
    if (!inTable) continue;
    std::size_t at = 0;
    for (std::size_t piece = 0; piece < kColumnsBeforeName && at != std::wstring::npos; ++piece) {
      at = line.find_first_not_of(L' ', at);
      if (at != std::wstring::npos) at = line.find(L' ', at);
    }
    if (at == std::wstring::npos) continue;
    at = line.find_first_not_of(L' ', at);
    if (at == std::wstring::npos) continue;
    names.push_back(line.substr(at, line.find_last_not_of(L' ') + 1 - at));
  }
}

}  // namespace LumenUtility
