/** @file */
/// @class LumenUtility::StringMapper
/// StringMapper: maps names through an ordered table of rules, each a regular expression and a
/// replacement format.
///
/// The first rule (in the map's order) whose expression matches the whole input rewrites it
/// with its format, where $1, $2 ... stand for the captured groups and $& for the whole input;
/// an input no rule matches maps to itself. Results are remembered per input until the rules
/// are next set, so repeated lookups of one name cost one map search; the memory grows with the
/// number of distinct inputs.
/// Thread-safety: GetMapping fills the memory of results, so confine each object to one thread
/// (or lock around it). Ownership: a value; copies hold copies of both maps.
#pragma once

#include <map>
#include <string>

#include "lumen/export.h"
#include "lumen/util/local_regex.h"

namespace LumenUtility {

class LUMEN_API StringMapper {
 public:
  StringMapper() = default;
  /// A mapper of `patterns` (pattern, replacement).
  explicit StringMapper(std::map<LocalRegex, std::wstring> patterns)
      : m_patterns(std::move(patterns)) {}

  /// Forgets every remembered result, then takes `patterns` as the rules.
  void SetPatternMap(std::map<LocalRegex, std::wstring> patterns);
  /// The matcher of the standard library recurses once per input character (tens of thousands
  /// of characters overflow an 8 MiB stack), so longer inputs than this are refused.
  static constexpr std::size_t kMaxInputLength = 1024;

  /// The mapped form of `input`. Throws std::regex_error when the matching engine cannot run a
  /// rule on it: error_stack for an input over kMaxInputLength characters (while rules exist),
  /// error_complexity or error_stack from the engine itself. Nothing is remembered then.
  std::wstring GetMapping(const std::wstring& input);
  /// The number of rules.
  int size() const { return static_cast<int>(m_patterns.size()); }

 private:
  std::map<LocalRegex, std::wstring> m_patterns;
  std::map<std::wstring, std::wstring> m_cache;
};

}  // namespace LumenUtility
