// Shared by the file and archive exceptions: filling a caller's fixed-size message buffer.
#pragma once

#include <string>

namespace LumenUtility {

// `pattern` with its one "%s" replaced by `fileName` ("an unnamed file" when empty).
std::wstring NameInMessage(const wchar_t* pattern, const std::wstring& fileName);
// Copies `message` into `buffer` (at most maxChars characters with the terminator). Returns
// nonzero when something was written: 0 for a null buffer or maxChars 0.
int CopyMessage(const std::wstring& message, wchar_t* buffer, unsigned maxChars,
                unsigned* helpContext);

}  // namespace LumenUtility
