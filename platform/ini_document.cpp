#include "platform/ini_document.h"

namespace LumenUtility {
namespace {

constexpr std::size_t npos = std::wstring::npos;

bool IsBlank(wchar_t c) {
  return c == L' ' || c == L'\t';
}

std::wstring_view Trim(std::wstring_view s) {
  while (!s.empty() && IsBlank(s.front())) s.remove_prefix(1);
  while (!s.empty() && IsBlank(s.back())) s.remove_suffix(1);
  return s;
}

wchar_t AsciiLower(wchar_t c) {
  return (c >= L'A' && c <= L'Z') ? static_cast<wchar_t>(c - L'A' + L'a') : c;
}

bool SameName(std::wstring_view a, std::wstring_view b) {
  if (a.size() != b.size()) return false;
  for (std::size_t i = 0; i < a.size(); ++i) {
    if (AsciiLower(a[i]) != AsciiLower(b[i])) return false;
  }
  return true;
}

bool IsQuoted(std::wstring_view s) {
  return s.size() >= 2 && s.front() == L'"' && s.back() == L'"';
}

bool HasLineBreakOrZero(std::wstring_view s) {
  return s.find_first_of(std::wstring_view(L"\r\n\0", 3)) != npos;
}

bool IsCleanName(std::wstring_view s) {
  return !s.empty() && Trim(s).size() == s.size() && !HasLineBreakOrZero(s);
}

}  // namespace

IniDocument IniDocument::Parse(std::wstring_view text) {
  IniDocument document;
  if (!text.empty() && text.front() == 0xFEFF) text.remove_prefix(1);
  bool inSection = false;
  while (!text.empty()) {
    const std::size_t end = text.find(L'\n');
    std::wstring_view line = text.substr(0, end);
    text.remove_prefix(end == npos ? text.size() : end + 1);
    // Every CR at the end goes: a stray one would turn into a line end once rewritten.
    while (!line.empty() && line.back() == L'\r') line.remove_suffix(1);
    document.m_lines.push_back(ParseLine(line, inSection));
    inSection = inSection || document.m_lines.back().isHeader;
  }
  return document;
}

IniDocument::Line IniDocument::ParseLine(std::wstring_view text, bool inSection) {
  Line line;
  line.text = text;
  const std::wstring_view trimmed = Trim(text);
  if (trimmed.empty() || trimmed.front() == L';') return line;
  if (trimmed.front() == L'[') {
    const std::size_t close = trimmed.find(L']');
    if (close != npos) {
      line.isHeader = true;
      line.parsed.name = Trim(trimmed.substr(1, close - 1));
    }
    return line;
  }
  const std::size_t equals = trimmed.find(L'=');
  if (!inSection || equals == npos) return line;
  const std::wstring_view name = Trim(trimmed.substr(0, equals));
  if (name.empty()) return line;
  std::wstring_view value = Trim(trimmed.substr(equals + 1));
  if (IsQuoted(value)) value = value.substr(1, value.size() - 2);
  line.parsed = Entry{std::wstring(name), std::wstring(value)};
  return line;
}

std::size_t IniDocument::FindHeader(std::wstring_view section) const {
  for (std::size_t i = 0; i < m_lines.size(); ++i) {
    if (m_lines[i].isHeader && SameName(m_lines[i].parsed.name, section)) return i;
  }
  return npos;
}

std::optional<std::wstring> IniDocument::Find(std::wstring_view section,
                                              std::wstring_view entry) const {
  const std::size_t header = FindHeader(section);
  if (header == npos) return std::nullopt;
  for (std::size_t i = header + 1; i < m_lines.size() && !m_lines[i].isHeader; ++i) {
    const Entry& parsed = m_lines[i].parsed;
    if (!parsed.name.empty() && SameName(parsed.name, entry)) return parsed.value;
  }
  return std::nullopt;
}

bool IniDocument::CanStore(std::wstring_view section, std::wstring_view entry,
                           std::wstring_view value) {
  return IsCleanName(section) && section.find(L']') == npos && IsCleanName(entry) &&
         entry.find(L'=') == npos && entry.front() != L'[' && entry.front() != L';' &&
         !HasLineBreakOrZero(value);
}

std::wstring IniDocument::EntryLine(std::wstring_view entry, std::wstring_view value) {
  // Blanks at the ends would be trimmed and one pair of enclosing quotes dropped when read
  // back; an extra pair of quotes keeps such values whole.
  const bool quote =
      !value.empty() && (IsBlank(value.front()) || IsBlank(value.back()) || IsQuoted(value));
  std::wstring line(entry);
  line += L'=';
  if (quote) line += L'"';
  line += value;
  if (quote) line += L'"';
  return line;
}

bool IniDocument::Set(std::wstring_view section, std::wstring_view entry,
                      std::wstring_view value) {
  if (!CanStore(section, entry, value)) return false;
  Line line = ParseLine(EntryLine(entry, value), true);
  const std::size_t header = FindHeader(section);
  if (header == npos) {
    if (!m_lines.empty() && !Trim(m_lines.back().text).empty()) m_lines.push_back(Line{});
    m_lines.push_back(ParseLine(L"[" + std::wstring(section) + L"]", false));
    m_lines.push_back(std::move(line));
    return true;
  }
  std::size_t insertAt = header + 1;
  for (std::size_t i = header + 1; i < m_lines.size() && !m_lines[i].isHeader; ++i) {
    const Entry& parsed = m_lines[i].parsed;
    if (parsed.name.empty()) continue;
    if (SameName(parsed.name, entry)) {
      m_lines[i] = std::move(line);
      return true;
    }
    insertAt = i + 1;
  }
  m_lines.insert(m_lines.begin() + static_cast<std::ptrdiff_t>(insertAt), std::move(line));
  return true;
}

std::wstring IniDocument::Text() const {
  std::wstring text;
  for (const Line& line : m_lines) {
    text += line.text;
    text += L'\n';
  }
  return text;
}

}  // namespace LumenUtility
