// Formatting of debug print messages.
#pragma once

#include <cstdarg>
#include <string>

namespace LumenUtility {

// Room for a message formatted without the heap: 511 characters and the terminating zero.
inline constexpr std::size_t kDebugTextStackChars = 512;

// Formats `format` with `args` by the C library's wide printf, 8-bit arguments read as UTF-8
// whatever the process's locale. The text goes into `stack` when it fits, else into `heap`;
// returns it. A format the C library refuses (an 8-bit argument that is not UTF-8, a bad
// directive) gives the format itself, unformatted, so the message still shows where it came
// from. `args` is left unused (copies are read).
const wchar_t* FormatDebugText(wchar_t (&stack)[kDebugTextStackChars], std::wstring& heap,
                               const wchar_t* format, va_list args);

// The format of a tagged message: the 8-bit (UTF-8) `file` with every '%' doubled, so that
// it prints as it is, then " (", `line` in decimal, ") " and `format`.
std::wstring TaggedFormat(const char* file, int line, const wchar_t* format);

}  // namespace LumenUtility
