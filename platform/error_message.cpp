#include "platform/error_message.h"

#include <algorithm>

namespace LumenUtility {

std::wstring NameInMessage(const wchar_t* pattern, const std::wstring& fileName) {
  std::wstring message = pattern;
  const std::size_t at = message.find(L"%s");
  if (at != std::wstring::npos)
    message.replace(at, 2, fileName.empty() ? std::wstring(L"an unnamed file") : fileName);
  return message;
}

int CopyMessage(const std::wstring& message, wchar_t* buffer, unsigned maxChars,
                unsigned* helpContext) {
  if (helpContext) *helpContext = 0;
  if (!buffer || maxChars == 0) return 0;
  const std::size_t count = std::min<std::size_t>(message.size(), maxChars - 1);
  std::copy_n(message.data(), count, buffer);
  buffer[count] = L'\0';
  return 1;
}

}  // namespace LumenUtility
