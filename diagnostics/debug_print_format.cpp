#include "diagnostics/debug_print_format.h"

#include <locale.h>
#include <stdio.h>
#include <stdlib.h>
#include <wchar.h>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

// The UTF-8 character type for 8-bit arguments (null when the system has no such locale:
// the process's own locale is then used).
locale_t Utf8Locale() {
  static const locale_t locale = newlocale(LC_CTYPE_MASK, "C.UTF-8", static_cast<locale_t>(0));
  return locale;
}

// Makes the UTF-8 locale the calling thread's for its lifetime.
class ScopedUtf8Locale {
 public:
  ScopedUtf8Locale() : m_previous(Utf8Locale() ? uselocale(Utf8Locale()) : nullptr) {}
  ~ScopedUtf8Locale() {
    if (m_previous) uselocale(m_previous);
  }
  ScopedUtf8Locale(const ScopedUtf8Locale&) = delete;
  ScopedUtf8Locale& operator=(const ScopedUtf8Locale&) = delete;

 private:
  locale_t m_previous;
};

// Formats into a stream that grows as needed; false when the C library refuses the format.
bool FormatGrowing(std::wstring& out, const wchar_t* format, va_list args) {
  wchar_t* buffer = nullptr;
  size_t length = 0;
  FILE* stream = open_wmemstream(&buffer, &length);
  if (stream == nullptr) return false;
  va_list copy;
  va_copy(copy, args);
  const int written = vfwprintf(stream, format, copy);
  va_end(copy);
  const bool closed = fclose(stream) == 0;
  const bool ok = written >= 0 && closed;
  if (ok) out.assign(buffer, length);
  free(buffer);
  return ok;
}

}  // namespace

const wchar_t* FormatDebugText(wchar_t (&stack)[kDebugTextStackChars], std::wstring& heap,
                               const wchar_t* format, va_list args) {
  const ScopedUtf8Locale utf8;
  va_list copy;
  va_copy(copy, args);
  // -1 both when the text needs more room and when the format is refused; the growing
  // stream tells the two apart.
  const int written = vswprintf(stack, kDebugTextStackChars, format, copy);
  va_end(copy);
  if (written >= 0) return stack;
  if (!FormatGrowing(heap, format, args)) heap = format;
  return heap.c_str();
}

std::wstring TaggedFormat(const char* file, int line, const wchar_t* format) {
  std::wstring tagged;
  for (const wchar_t c : Utf8ToWide(file)) {
    tagged += c;
    if (c == L'%') tagged += L'%';
  }
  tagged += L" (";
  tagged += std::to_wstring(line);
  tagged += L") ";
  tagged += format;
  return tagged;
}

}  // namespace LumenUtility
