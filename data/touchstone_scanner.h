// TouchstoneScanner: walks Touchstone text, held in memory or read in chunks, by lines and
// by whitespace-separated tokens, counting lines for error messages. Lines end in CR LF, LF
// or a lone CR.
//
// Numbers are read the way a C++ stream reads them (optional sign, digits with an optional
// point, optional exponent; no "inf", "nan" or hexadecimal), so a file reads the same as it
// would through operator>>, only without a character-by-character stream in the loop.
// Thread-safety: one thread per object.
#pragma once

#include <cstddef>
#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>

namespace LumenUtility {

// Thrown by a scanner that reads from a source, where a plain bool would not reach the
// parser: the text cannot be read, or a line or value is too long to hold. what() is the
// whole message ("line 3: ...").
class TouchstoneScanError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

// Bytes read in chunks: a file, a pipe, a device, standard input.
class TouchstoneSource {
 public:
  virtual ~TouchstoneSource() = default;
  // Reads up to `capacity` bytes into `buffer` and returns their count, 0 only at the end.
  // Throws TouchstoneScanError when the bytes cannot be read.
  virtual std::size_t Read(char* buffer, std::size_t capacity) = 0;
};

class TouchstoneScanner {
 public:
  // Scans `text`, which must outlive the scanner.
  explicit TouchstoneScanner(std::string_view text)
      : m_pos(text.data()), m_end(text.data() + text.size()) {}
  // Scans what `source` gives, holding one chunk and the line or value in hand, so memory
  // stays bounded whatever the input's size. A line or value longer than kMaxHeld bytes
  // throws TouchstoneScanError. `source` must outlive the scanner.
  explicit TouchstoneScanner(TouchstoneSource& source);
  TouchstoneScanner(const TouchstoneScanner&) = delete;
  TouchstoneScanner& operator=(const TouchstoneScanner&) = delete;

  // The longest line or value a streaming scanner holds (1 MiB): no Touchstone line comes
  // near it, and a longer one is not text of this format.
  static constexpr std::size_t kMaxHeld = std::size_t{1} << 20;

  // 1-based line number of the current position.
  int Line() const { return m_line; }

  // Up to `count` bytes from the current position, fewer only at the end of the text; the
  // view lasts until the next call. Skip(n) moves past n of them.
  std::string_view Peek(std::size_t count);
  void Skip(std::size_t count) { m_pos += count; }

  // Moves past blank lines and comment lines ("!" first after leading blanks) to the first
  // non-blank character of the next meaningful line and returns it; '\0' at end of text.
  // `*marked` becomes true when a skipped comment contains `marker` (in any case).
  char PeekLineStart(std::string_view marker = {}, bool* marked = nullptr);
  // Moves to the start of the next line.
  void SkipLine();
  // The text from the current position to the end of its line (without the line break);
  // moves to the start of the next line. The view lasts until the next call.
  std::string_view RestOfLine();
  // The text after the leading '!' of `comment` (a token just returned by NextToken) to the
  // end of its line; moves to the start of the next line.
  std::string_view CommentText(std::string_view comment);

  // The next token, crossing line breaks; empty at end of text. A token ends at white space
  // or at a '!' that is not its first character (a comment may follow a value directly).
  // The view lasts until the next call.
  std::string_view NextToken();
  // NextToken() past any comments, each read to the end of its line; empty at end of text.
  // `*marked` becomes true when a skipped comment contains `marker` (in any case).
  // Inline: it runs once per value of every data record.
  std::string_view NextValueToken(std::string_view marker = {}, bool* marked = nullptr) {
    for (;;) {
      const std::string_view token = NextToken();
      if (token.empty() || token.front() != '!') return token;
      SkipComment(token, marker, marked);
    }
  }

  // Moves to the next line that starts (after blanks) with '[', leaving the position on the
  // '['. The current line is never taken. Returns false at end of text.
  bool SkipToKeywordLine();
  // With the position on a '[' (or on a token starting with it, see Rewind): reads the
  // keyword up to the ']' on the same line, upper case, into `name` and moves past the ']'.
  // Returns false when the line has no ']'.
  bool ReadKeyword(std::string& name);
  // Moves back to the start of `token`, the token NextToken returned last.
  void Rewind(std::string_view token) { m_pos = token.data(); }

 private:
  // Moves past the line break at the current position (CR LF, LF or a lone CR), if any.
  void SkipLineBreak();
  // CommentText(comment), setting `*marked` when the text contains a non-empty `marker`.
  void SkipComment(std::string_view comment, std::string_view marker, bool* marked);
  // The slow path at the end of the bytes in hand: reads the next chunk of a source behind
  // the bytes from `keep` (at most the current position) on, which move to the front of the
  // buffer; `keep` and the position follow them. False at the end of the text.
  bool Refill(const char*& keep);
  bool RefillHere() {
    const char* keep = m_pos;
    return Refill(keep);
  }

  const char* m_pos;
  const char* m_end;
  TouchstoneSource* m_source = nullptr;
  std::unique_ptr<char[]> m_buffer;  // kMaxHeld + one chunk, for a source
  bool m_sourceEnded = false;
  int m_line = 1;
};

// Whole-token number parsing with the results of a C++ stream: false for anything a stream
// would not read completely, and for magnitudes beyond the type's range (values below it
// become subnormal or zero, as the stream gives them).
bool ParseStreamDouble(std::string_view token, double& value);
bool ParseStreamFloat(std::string_view token, float& value);
// Whether `token` is a well-formed number whose magnitude is beyond the range of a double
// ("1e400"), which ParseStreamDouble refuses like any other bad token.
bool IsBeyondDouble(std::string_view token);
// Reads an integer from the start of `token` as a stream reading an int would, ignoring what
// follows the digits; false without digits or beyond the int range.
bool ParseStreamIntPrefix(std::string_view token, int& value);

// ASCII upper case.
std::string ToUpperAscii(std::string_view text);

}  // namespace LumenUtility
