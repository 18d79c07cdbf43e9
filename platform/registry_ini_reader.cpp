#include "platform/registry_ini_reader.h"

#include <string>

#include "lumen/platform/cfile.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/text_conversion.h"
#include "platform/ascii_case.h"

namespace LumenUtility {

namespace {

constexpr std::string_view kBlanks = " \t";

std::string_view Trimmed(std::string_view text) {
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  const std::size_t last = text.find_last_not_of(kBlanks);
  return text.substr(first, last - first + 1);
}

[[noreturn]] void ThrowAtLine(std::size_t line, const std::wstring& what) {
  throw LumenException(LUMEN_E_BOUNDS,
                       L"registry configuration line " + std::to_wstring(line) + L": " + what);
}

// The text of a string value: the part inside double quotes when it is quoted.
std::wstring StringValue(std::string_view text, std::size_t line) {
  if (!text.empty() && text.front() == '"') {
    if (text.size() < 2 || text.back() != '"') ThrowAtLine(line, L"a quoted text has no end quote");
    text = text.substr(1, text.size() - 2);
  }
  return Utf8ToWide(text);
}

std::uint32_t DwordValue(std::string_view digits, std::size_t line) {
  if (digits.empty() || digits.size() > 8) {
    ThrowAtLine(line, L"a dword value needs 1 to 8 hexadecimal digits");
  }
  std::uint32_t value = 0;
  for (const char c : digits) {
    int digit;
    if (c >= '0' && c <= '9') {
      digit = c - '0';
    } else if (AsciiLower(c) >= 'a' && AsciiLower(c) <= 'f') {
      digit = AsciiLower(c) - 'a' + 10;
    } else {
      ThrowAtLine(line, L"a dword value needs 1 to 8 hexadecimal digits");
    }
    value = value * 16 + static_cast<std::uint32_t>(digit);
  }
  return value;
}

RegistryValue ParseValue(std::string_view text, std::size_t line) {
  constexpr std::string_view kDword = "dword:";
  constexpr std::string_view kExpand = "expand:";
  RegistryValue value;
  if (StartsWithNoCase(text, kDword)) {
    value.type = REG_DWORD;
    value.dword = DwordValue(Trimmed(text.substr(kDword.size())), line);
  } else if (StartsWithNoCase(text, kExpand)) {
    value.type = REG_EXPAND_SZ;
    value.text = StringValue(Trimmed(text.substr(kExpand.size())), line);
  } else {
    value.type = REG_SZ;
    value.text = StringValue(text, line);
  }
  return value;
}

}  // namespace

RegistryStore RegistryIniReader::Parse(std::string_view text) {
  constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
  if (text.substr(0, kByteOrderMark.size()) == kByteOrderMark) {
    text.remove_prefix(kByteOrderMark.size());
  }
  RegistryStore store;
  std::wstring keyPath;
  bool inKey = false;
  std::size_t lineNumber = 0;
  while (!text.empty()) {
    ++lineNumber;
    const std::size_t end = text.find('\n');
    std::string_view line = text.substr(0, end);
    text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
    line = Trimmed(line);
    if (line.empty() || line.front() == ';' || line.front() == '#') continue;

    if (line.front() == '[') {
      if (line.back() != ']') ThrowAtLine(lineNumber, L"a key path in brackets has no ']'");
      const std::string_view path = Trimmed(line.substr(1, line.size() - 2));
      if (path.empty()) ThrowAtLine(lineNumber, L"the key path is empty");
      keyPath = Utf8ToWide(path);
      inKey = true;
      continue;
    }
    const std::size_t equals = line.find('=');
    if (equals == std::string_view::npos) {
      ThrowAtLine(lineNumber, L"expected [key path], name = value or a comment");
    }
    const std::string_view name = Trimmed(line.substr(0, equals));
    if (name.empty()) ThrowAtLine(lineNumber, L"the value has no name");
    if (!inKey) ThrowAtLine(lineNumber, L"a value before the first [key path]");
    store.SetValue(keyPath, Utf8ToWide(name),
                   ParseValue(Trimmed(line.substr(equals + 1)), lineNumber));
  }
  return store;
}

RegistryStore RegistryIniReader::ReadFile(const std::wstring& path) {
  CFile file(path.c_str(), CFile::modeRead | CFile::shareDenyWrite);
  std::string text;
  char buffer[4096];
  for (;;) {
    const unsigned n = file.Read(buffer, sizeof buffer);
    if (n == 0) break;
    if (text.size() + n > kMaxFileBytes) {
      throw LumenException(LUMEN_E_BOUNDS,
                           L"registry configuration larger than 1 MiB in " + path);
    }
    text.append(buffer, n);
  }
  try {
    return Parse(text);
  } catch (LumenException& e) {
    throw LumenException(e.GetCode(), e.GetMessage() + L" in " + path);
  }
}

}  // namespace LumenUtility
