// TouchstoneScanner: walks Touchstone text held in memory by lines and by
// whitespace-separated tokens, counting lines for error messages.
//
// Numbers are read the way a C++ stream reads them (optional sign, digits with an optional
// point, optional exponent; no "inf", "nan" or hexadecimal), so a file reads the same as it
// would through operator>>, only without a character-by-character stream in the loop.
// Thread-safety: one thread per object; the text must outlive the scanner.
#pragma once

#include <string>
#include <string_view>

namespace LumenUtility {

class TouchstoneScanner {
 public:
  explicit TouchstoneScanner(std::string_view text)
      : m_pos(text.data()), m_end(text.data() + text.size()) {}

  // 1-based line number of the current position.
  int Line() const { return m_line; }
  bool AtEnd() const { return m_pos == m_end; }

  // Moves past blank lines and comment lines ("!" first after leading blanks) to the first
  // non-blank character of the next meaningful line and returns it; '\0' at end of text.
  // `*marked` becomes true when a skipped comment contains `marker`.
  char PeekLineStart(std::string_view marker = {}, bool* marked = nullptr);
  // Moves to the start of the next line.
  void SkipLine();
  // The text from the current position to the end of its line (without the line break);
  // moves to the start of the next line.
  std::string_view RestOfLine();
  // The text after the leading '!' of `comment` (a token just returned by NextToken) to the
  // end of its line; moves to the start of the next line.
  std::string_view CommentText(std::string_view comment);

  // The next token, crossing line breaks; empty at end of text. A token ends at white space
  // or at a '!' that is not its first character (a comment may follow a value directly).
  std::string_view NextToken();
  // NextToken() past any comments, each read to the end of its line; empty at end of text.
  // `*marked` becomes true when a skipped comment contains `marker`.
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
  // Moves back to the start of `token`, a token of the current line returned by NextToken.
  void Rewind(std::string_view token) { m_pos = token.data(); }

 private:
  // CommentText(comment), setting `*marked` when the text contains a non-empty `marker`.
  void SkipComment(std::string_view comment, std::string_view marker, bool* marked);

  const char* m_pos;
  const char* m_end;
  int m_line = 1;
};

// Whole-token number parsing with the results of a C++ stream: false for anything a stream
// would not read completely, and for magnitudes beyond the type's range (values below it
// become subnormal or zero, as the stream gives them).
bool ParseStreamDouble(std::string_view token, double& value);
bool ParseStreamFloat(std::string_view token, float& value);
// Reads an integer from the start of `token` as a stream reading an int would, ignoring what
// follows the digits; false without digits or beyond the int range.
bool ParseStreamIntPrefix(std::string_view token, int& value);

// ASCII upper case.
std::string ToUpperAscii(std::string_view text);

}  // namespace LumenUtility
