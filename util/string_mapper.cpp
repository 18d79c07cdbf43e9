#include "lumen/util/string_mapper.h"

namespace LumenUtility {

void StringMapper::SetPatternMap(std::map<LocalRegex, std::wstring> patterns) {
  m_cache.clear();
  m_patterns = std::move(patterns);
}

std::wstring StringMapper::GetMapping(const std::wstring& input) {
  const auto cached = m_cache.find(input);
  if (cached != m_cache.end()) return cached->second;
  if (!m_patterns.empty() && input.size() > kMaxInputLength)
    throw std::regex_error(std::regex_constants::error_stack);
  std::wstring result = input;
  for (const auto& [expression, format] : m_patterns) {
    std::wsmatch match;
    if (std::regex_match(input, match, expression)) {
      // Formatting the one whole-input match: replacing all matches would append a second
      // replacement for the empty match at the end that an expression such as \d* also has.
      result = match.format(format);
      break;
    }
  }
  m_cache.emplace(input, result);
  return result;
}

}  // namespace LumenUtility
