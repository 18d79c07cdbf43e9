/** @file */
/// @class LumenUtility::LocalRegex
/// LocalRegex: a compiled wide regular expression that can key an ordered map, as the rules of
/// a StringMapper do.
///
/// The expression is compiled with the ECMAScript grammar (and any further flags given); it is
/// a std::wregex, so std::regex_match, std::regex_search and std::regex_replace take it as it
/// is. Rules order by their pattern text (then by their flags), so a map of rules is tried in
/// the text's lexicographic order, the same on every run.
/// Thread-safety: a const object may be used by several threads; confine changes to one.
/// Ownership: a value.
#pragma once

#include <regex>
#include <string>

#include "lumen/export.h"

namespace LumenUtility {

class LUMEN_API LocalRegex : public std::wregex {
 public:
  /// Compiles `pattern`. Throws std::regex_error when it is not a valid expression.
  explicit LocalRegex(std::wstring pattern, std::regex_constants::syntax_option_type flags =
                                                std::regex_constants::ECMAScript)
      : std::wregex(pattern, flags), m_pattern(std::move(pattern)), m_flags(flags) {}

  /// The pattern text.
  const std::wstring& GetPattern() const { return m_pattern; }

  /// Orders by pattern text, then flags, so that LocalRegex can key a std::map.
  bool operator<(const LocalRegex& other) const {
    if (m_pattern != other.m_pattern) return m_pattern < other.m_pattern;
    return m_flags < other.m_flags;
  }

 private:
  std::wstring m_pattern;
  std::regex_constants::syntax_option_type m_flags;
};

}  // namespace LumenUtility
