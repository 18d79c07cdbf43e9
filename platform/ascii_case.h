// Comparisons that ignore the case of the ASCII letters A to Z, as the registry compares key
// paths and value names and as the library compares its keyword values ("Internal",
// "external"). Other characters compare by code value.
#pragma once

#include <string_view>

namespace LumenUtility {

template <typename Char>
constexpr Char AsciiLower(Char c) {
  return c >= Char('A') && c <= Char('Z') ? Char(c - Char('A') + Char('a')) : c;
}

template <typename Char>
constexpr bool EqualsNoCase(std::basic_string_view<Char> a, std::basic_string_view<Char> b) {
  if (a.size() != b.size()) return false;
  for (std::size_t i = 0; i < a.size(); ++i) {
    if (AsciiLower(a[i]) != AsciiLower(b[i])) return false;
  }
  return true;
}

template <typename Char>
constexpr bool StartsWithNoCase(std::basic_string_view<Char> text,
                                std::basic_string_view<Char> prefix) {
  return text.size() >= prefix.size() && EqualsNoCase(text.substr(0, prefix.size()), prefix);
}

}  // namespace LumenUtility
