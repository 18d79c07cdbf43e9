#include "util/wildcard_match.h"

namespace LumenUtility {
namespace {

wchar_t FoldAscii(wchar_t c) {
  return (c >= L'A' && c <= L'Z') ? static_cast<wchar_t>(c - L'A' + L'a') : c;
}

}  // namespace

bool MatchesWildcard(std::wstring_view name, std::wstring_view pattern) {
  if (pattern == L"*.*") return true;
  // Greedy matching that, on a mismatch, lets the last `*` swallow one more character.
  std::size_t n = 0, p = 0;
  std::size_t starAt = std::wstring_view::npos, starName = 0;
  while (n < name.size()) {
    if (p < pattern.size() && pattern[p] == L'*') {
      starAt = p++;
      starName = n;
    } else if (p < pattern.size() &&
               (pattern[p] == L'?' || FoldAscii(pattern[p]) == FoldAscii(name[n]))) {
      ++p;
      ++n;
    } else if (starAt != std::wstring_view::npos) {
      p = starAt + 1;
      n = ++starName;
    } else {
      return false;
    }
  }
  while (p < pattern.size() && pattern[p] == L'*') ++p;
  return p == pattern.size();
}

}  // namespace LumenUtility
