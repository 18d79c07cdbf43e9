// Matching of entry names against the wildcard patterns of file searches.
#pragma once

#include <string_view>

namespace LumenUtility {

// Whether `name` matches `pattern`: `*` matches any run of characters (the empty one
// included), `?` exactly one character, any other character itself with ASCII letters
// compared without case; the whole pattern `*.*` matches every name. Runs in O(name x pattern)
// time at worst, without recursion.
bool MatchesWildcard(std::wstring_view name, std::wstring_view pattern);

}  // namespace LumenUtility
