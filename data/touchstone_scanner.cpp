#include "data/touchstone_scanner.h"

#include <charconv>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <system_error>

namespace LumenUtility {
namespace {

// The C locale's white space, which is what a stream skips between tokens.
inline bool IsSpace(char c) {
  return c == ' ' || (c >= '\t' && c <= '\r');
}
inline bool IsBlank(char c) {
  return c == ' ' || c == '\t' || c == '\r' || c == '\v' || c == '\f';
}
inline bool IsDigit(char c) {
  return c >= '0' && c <= '9';
}

// Sets *marked when `comment` contains a non-empty `marker`.
void NoteMarker(std::string_view comment, std::string_view marker, bool* marked) {
  if (marked && !marker.empty() && comment.find(marker) != std::string_view::npos) *marked = true;
}

// Strips a stream-style leading '+' and rejects what a stream would not start a number with
// (from_chars alone would also take "inf", "nan" and a doubled sign after the '+').
bool PrepareNumber(std::string_view& token) {
  if (!token.empty() && token.front() == '+') {
    token.remove_prefix(1);
    if (!token.empty() && token.front() == '-') return false;
  }
  const std::size_t first = (!token.empty() && token.front() == '-') ? 1 : 0;
  return token.size() > first && (IsDigit(token[first]) || token[first] == '.');
}

template <typename T>
T StrToFloating(const char* text, char** end);
template <>
double StrToFloating<double>(const char* text, char** end) {
  return std::strtod(text, end);
}
template <>
float StrToFloating<float>(const char* text, char** end) {
  return std::strtof(text, end);
}

template <typename T>
bool ParseStreamFloating(std::string_view token, T& value) {
  if (!PrepareNumber(token)) return false;
  const char* last = token.data() + token.size();
  T parsed{};
  const std::from_chars_result r =
      std::from_chars(token.data(), last, parsed, std::chars_format::general);
  if (r.ptr != last) return false;
  if (r.ec == std::errc()) {
    value = parsed;
    return true;
  }
  if (r.ec != std::errc::result_out_of_range) return false;
  // A stream fails on overflow but takes the subnormal or zero result of an underflow;
  // from_chars reports both alike, so the rare out-of-range token is read again by strtod.
  const std::string copy(token);
  const T slow = StrToFloating<T>(copy.c_str(), nullptr);
  if (std::isinf(slow)) return false;
  value = slow;
  return true;
}

}  // namespace

char TouchstoneScanner::PeekLineStart(std::string_view marker, bool* marked) {
  while (m_pos != m_end) {
    while (m_pos != m_end && IsBlank(*m_pos)) ++m_pos;
    if (m_pos == m_end) break;
    if (*m_pos == '\n') {
      ++m_pos;
      ++m_line;
      continue;
    }
    if (*m_pos == '!') {
      NoteMarker(RestOfLine(), marker, marked);
      continue;
    }
    return *m_pos;
  }
  return '\0';
}

void TouchstoneScanner::SkipLine() {
  RestOfLine();
}

std::string_view TouchstoneScanner::RestOfLine() {
  const char* start = m_pos;
  while (m_pos != m_end && *m_pos != '\n') ++m_pos;
  const char* stop = m_pos;
  if (m_pos != m_end) {
    ++m_pos;
    ++m_line;
  }
  if (stop != start && stop[-1] == '\r') --stop;
  return std::string_view(start, static_cast<std::size_t>(stop - start));
}

std::string_view TouchstoneScanner::CommentText(std::string_view comment) {
  m_pos = comment.data() + 1;
  return RestOfLine();
}

std::string_view TouchstoneScanner::NextToken() {
  while (m_pos != m_end && IsSpace(*m_pos)) {
    if (*m_pos == '\n') ++m_line;
    ++m_pos;
  }
  const char* start = m_pos;
  if (m_pos != m_end) ++m_pos;
  while (m_pos != m_end && !IsSpace(*m_pos) && *m_pos != '!') ++m_pos;
  return std::string_view(start, static_cast<std::size_t>(m_pos - start));
}

void TouchstoneScanner::SkipComment(std::string_view comment, std::string_view marker,
                                    bool* marked) {
  NoteMarker(CommentText(comment), marker, marked);
}

bool TouchstoneScanner::SkipToKeywordLine() {
  SkipLine();
  while (m_pos != m_end) {
    while (m_pos != m_end && IsBlank(*m_pos)) ++m_pos;
    if (m_pos != m_end && *m_pos == '[') return true;
    SkipLine();
  }
  return false;
}

bool TouchstoneScanner::ReadKeyword(std::string& name) {
  const char* p = m_pos;
  if (p != m_end && *p == '[') ++p;
  const char* start = p;
  while (p != m_end && *p != ']' && *p != '\n') ++p;
  if (p == m_end || *p != ']') return false;
  name = ToUpperAscii(std::string_view(start, static_cast<std::size_t>(p - start)));
  m_pos = p + 1;
  return true;
}

bool ParseStreamDouble(std::string_view token, double& value) {
  return ParseStreamFloating(token, value);
}

bool ParseStreamFloat(std::string_view token, float& value) {
  return ParseStreamFloating(token, value);
}

bool ParseStreamIntPrefix(std::string_view token, int& value) {
  if (!token.empty() && token.front() == '+') {
    token.remove_prefix(1);
    if (!token.empty() && token.front() == '-') return false;
  }
  int parsed = 0;
  const std::from_chars_result r =
      std::from_chars(token.data(), token.data() + token.size(), parsed);
  if (r.ec != std::errc()) return false;
  value = parsed;
  return true;
}

std::string ToUpperAscii(std::string_view text) {
  std::string upper(text);
  for (char& c : upper) {
    if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
  }
  return upper;
}

}  // namespace LumenUtility
