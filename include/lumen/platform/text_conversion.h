/// @file
/// Conversions between the library's wide strings and its byte encodings.
///
/// UTF-8 stands for the thread's 8-bit code page (property-bag keys, message text, file
/// names); UTF-16 is the encoding of persisted wide text. wchar_t holds one UTF-32 code unit.
/// Invalid input (stray surrogates, overlong or truncated UTF-8, code points past U+10FFFF)
/// becomes U+FFFD; no conversion throws except std::bad_alloc.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "lumen/export.h"

namespace LumenUtility {

/// UTF-8 to wide text; an ill-formed sequence becomes U+FFFD.
LUMEN_API std::wstring Utf8ToWide(std::string_view utf8);
/// Wide text to UTF-8; a value that is no Unicode scalar becomes U+FFFD.
LUMEN_API std::string WideToUtf8(std::wstring_view wide);

/// UTF-16 to wide text; an unpaired surrogate becomes U+FFFD.
LUMEN_API std::wstring Utf16ToWide(std::u16string_view utf16);
/// Wide text to UTF-16 (surrogate pairs above U+FFFF); a value that is no Unicode scalar
/// becomes U+FFFD.
LUMEN_API std::u16string WideToUtf16(std::wstring_view wide);

///@{
/// Persisted forms store UTF-16 little-endian: `byteCount` bytes at `bytes` (an odd last
/// byte is ignored) and the reverse.
LUMEN_API std::wstring Utf16LeBytesToWide(const std::uint8_t* bytes, std::size_t byteCount);
LUMEN_API std::string WideToUtf16LeBytes(std::wstring_view wide);
///@}

}  // namespace LumenUtility
