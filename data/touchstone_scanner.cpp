#include "data/touchstone_scanner.h"

#include <charconv>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <algorithm>
#include <limits>
#include <system_error>
#include <type_traits>

namespace LumenUtility {
namespace {

// The C locale's white space, which is what a stream skips between tokens.
inline bool IsSpace(char c) {
  return c == ' ' || (c >= '\t' && c <= '\r');
}
// White space within a line: a CR is a line break (alone, or with the LF after it).
inline bool IsBlank(char c) {
  return c == ' ' || c == '\t' || c == '\v' || c == '\f';
}
inline bool IsLineBreak(char c) {
  return c == '\n' || c == '\r';
}
// Bytes asked of a source at a time: few system calls (about ten for a 10 MB file), and
// little memory.
constexpr std::size_t kChunk = std::size_t{1} << 20;

inline bool IsDigit(char c) {
  return c >= '0' && c <= '9';
}

inline char LowerAscii(char c) {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

// Whether `text` contains `part`, ignoring ASCII case.
bool ContainsIgnoringCase(std::string_view text, std::string_view part) {
  if (part.size() > text.size()) return false;
  for (std::size_t at = 0; at + part.size() <= text.size(); ++at) {
    std::size_t i = 0;
    while (i < part.size() && LowerAscii(text[at + i]) == LowerAscii(part[i])) ++i;
    if (i == part.size()) return true;
  }
  return false;
}

// Sets *marked when `comment` contains a non-empty `marker`, in any case: files write the
// noise marker as "Noise Parameters", "NOISE PARAMETERS" and "noise parameters".
void NoteMarker(std::string_view comment, std::string_view marker, bool* marked) {
  if (marked && !marker.empty() && ContainsIgnoringCase(comment, marker)) *marked = true;
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
  T slow;
  if constexpr (std::is_same_v<T, float>) {
    slow = std::strtof(copy.c_str(), nullptr);
  } else {
    slow = std::strtod(copy.c_str(), nullptr);
  }
  if (std::isinf(slow)) return false;
  value = slow;
  return true;
}

}  // namespace

TouchstoneScanner::TouchstoneScanner(TouchstoneSource& source)
    : m_pos(nullptr), m_end(nullptr), m_source(&source),
      m_buffer(new char[kMaxHeld + kChunk]) {
  m_pos = m_end = m_buffer.get();
}

bool TouchstoneScanner::Refill(const char*& keep) {
  if (m_source == nullptr || m_sourceEnded) return false;
  const std::size_t kept = static_cast<std::size_t>(m_end - keep);
  const std::size_t position = static_cast<std::size_t>(m_pos - keep);
  if (kept >= kMaxHeld) {
    throw TouchstoneScanError("line " + std::to_string(m_line) +
                              ": a line or value longer than 1 MiB is not read");
  }
  char* base = m_buffer.get();
  if (kept > 0 && keep != base) std::memmove(base, keep, kept);
  const std::size_t got = m_source->Read(base + kept, kMaxHeld + kChunk - kept);
  if (got == 0) m_sourceEnded = true;
  keep = base;
  m_pos = base + position;
  m_end = base + kept + got;
  return got > 0;
}

std::string_view TouchstoneScanner::Peek(std::size_t count) {
  while (static_cast<std::size_t>(m_end - m_pos) < count && RefillHere()) {
  }
  return std::string_view(m_pos, std::min(count, static_cast<std::size_t>(m_end - m_pos)));
}

char TouchstoneScanner::PeekLineStart(std::string_view marker, bool* marked) {
  for (;;) {
    while (m_pos != m_end && IsBlank(*m_pos)) ++m_pos;
    if (m_pos == m_end) {
      if (RefillHere()) continue;
      return '\0';
    }
    if (IsLineBreak(*m_pos)) {
      SkipLineBreak();
    } else if (*m_pos == '!') {
      NoteMarker(RestOfLine(), marker, marked);
    } else {
      return *m_pos;
    }
  }
}

void TouchstoneScanner::SkipLine() {
  // Nothing of the line is held, so a skipped line may be of any length.
  for (;;) {
    while (m_pos != m_end && !IsLineBreak(*m_pos)) ++m_pos;
    if (m_pos != m_end || !RefillHere()) break;
  }
  SkipLineBreak();
}

std::string_view TouchstoneScanner::RestOfLine() {
  const char* start = m_pos;
  for (;;) {
    while (m_pos != m_end && !IsLineBreak(*m_pos)) ++m_pos;
    if (m_pos == m_end) {
      if (Refill(start)) continue;
      break;
    }
    // A CR that ends the bytes in hand may be the first half of a CR LF.
    if (*m_pos == '\r' && m_pos + 1 == m_end && Refill(start)) continue;
    break;
  }
  const std::string_view line(start, static_cast<std::size_t>(m_pos - start));
  SkipLineBreak();  // the LF of a CR LF is in hand: the buffer does not move
  return line;
}

void TouchstoneScanner::SkipLineBreak() {
  if (m_pos == m_end) return;
  // CR LF, LF and a lone CR (old Mac text) each end one line.
  if (*m_pos == '\r') {
    ++m_pos;
    if (m_pos == m_end) RefillHere();
    if (m_pos != m_end && *m_pos == '\n') ++m_pos;
  } else {
    ++m_pos;
  }
  ++m_line;
}

std::string_view TouchstoneScanner::CommentText(std::string_view comment) {
  m_pos = comment.data() + 1;
  return RestOfLine();
}

std::string_view TouchstoneScanner::NextToken() {
  for (;;) {
    while (m_pos != m_end && IsSpace(*m_pos)) {
      if (*m_pos == '\r' && m_pos + 1 == m_end) RefillHere();
      // A CR counts as a line only when no LF follows it, so CR LF is one line.
      if (*m_pos == '\n' || (*m_pos == '\r' && (m_pos + 1 == m_end || m_pos[1] != '\n'))) {
        ++m_line;
      }
      ++m_pos;
    }
    if (m_pos != m_end || !RefillHere()) break;
  }
  const char* start = m_pos;
  if (m_pos == m_end) return {};
  ++m_pos;
  for (;;) {
    while (m_pos != m_end && !IsSpace(*m_pos) && *m_pos != '!') ++m_pos;
    if (m_pos != m_end || !Refill(start)) break;
  }
  return std::string_view(start, static_cast<std::size_t>(m_pos - start));
}

void TouchstoneScanner::SkipComment(std::string_view comment, std::string_view marker,
                                    bool* marked) {
  NoteMarker(CommentText(comment), marker, marked);
}

bool TouchstoneScanner::SkipToKeywordLine() {
  SkipLine();
  for (;;) {
    while (m_pos != m_end && IsBlank(*m_pos)) ++m_pos;
    if (m_pos == m_end) {
      if (RefillHere()) continue;
      return false;
    }
    if (*m_pos == '[') return true;
    SkipLine();
  }
}

bool TouchstoneScanner::ReadKeyword(std::string& name) {
  // Offsets from the position stay valid when a refill moves the bytes in hand.
  std::size_t at = (m_pos != m_end && *m_pos == '[') ? 1 : 0;
  const std::size_t first = at;
  for (;; ++at) {
    while (m_pos + at == m_end) {
      if (!RefillHere()) return false;
    }
    if (m_pos[at] == ']') break;
    if (IsLineBreak(m_pos[at])) return false;
  }
  name = ToUpperAscii(std::string_view(m_pos + first, at - first));
  m_pos += at + 1;
  return true;
}

bool ParseStreamDouble(std::string_view token, double& value) {
  return ParseStreamFloating(token, value);
}

bool IsBeyondDouble(std::string_view token) {
  if (!PrepareNumber(token)) return false;
  double unused = 0.0;
  const char* last = token.data() + token.size();
  const std::from_chars_result r =
      std::from_chars(token.data(), last, unused, std::chars_format::general);
  if (r.ptr != last || r.ec != std::errc::result_out_of_range) return false;
  const std::string copy(token);
  return std::isinf(std::strtod(copy.c_str(), nullptr));
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
