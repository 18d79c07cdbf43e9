// Splitting a command line into arguments by the rules of the Windows C runtime, so that the
// command lines other programs were given on that platform reach a program here as the same
// argument vector.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace LumenUtility {

// The arguments of `commandLine` (the part after the program name):
// - spaces and tabs outside quotes separate arguments; runs of them count as one;
// - a double quote starts or ends a quoted part, which may hold spaces and tabs; within a
//   quoted part two double quotes stand for one literal double quote;
// - 2n backslashes before a double quote give n backslashes and the quote acts as above;
//   2n + 1 backslashes before a double quote give n backslashes and a literal double quote;
// - other backslashes are literal.
// A quoted part still open at the end of the text ends there. `""` is an empty argument.
// Pure; throws only std::bad_alloc.
std::vector<std::wstring> SplitCommandLine(std::wstring_view commandLine);

}  // namespace LumenUtility
