// IniDocument: the text of an INI profile as lines, read and changed entry by entry.
//
// Lines are kept as they were read, so rewriting a document after a change keeps comments,
// blank lines, unknown lines and the order of everything else. A header line is '[' name ']'
// (blanks around it allowed; the name is what lies between the brackets, without blanks at
// its ends); an entry line is name '=' value inside a section, both without blanks at their
// ends and the value without one enclosing pair of double quotes. Lines before the first
// header, comment lines (';' first) and other lines belong to no entry. Names compare without
// regard to ASCII case; the first of equal names counts.
// Thread-safety: a plain value; confine each object to one thread.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace LumenUtility {

class IniDocument {
 public:
  // Splits `text` into lines at LF, dropping CRs at the end of each line and a byte-order
  // mark at the very start. Never fails: every text is a document.
  static IniDocument Parse(std::wstring_view text);

  // The value of `entry` in `section`, if the document has one.
  std::optional<std::wstring> Find(std::wstring_view section, std::wstring_view entry) const;

  // Replaces the value of `entry` in `section`, or adds the entry after the last entry of
  // the section, or adds the section with the entry at the end. Returns false, changing
  // nothing, when the names or the value cannot be written as lines (see CanStore).
  bool Set(std::wstring_view section, std::wstring_view entry, std::wstring_view value);

  // Whether Set accepts the three texts: names not empty and without blanks at their ends,
  // no ']' in the section, no '=' in the entry nor '[' or ';' first, and no CR, LF or zero
  // character anywhere.
  static bool CanStore(std::wstring_view section, std::wstring_view entry,
                       std::wstring_view value);

  // The document as text: every line followed by LF.
  std::wstring Text() const;

 private:
  struct Entry {
    std::wstring name;
    std::wstring value;
  };
  struct Line {
    std::wstring text;
    bool isHeader = false;
    // For headers the section name, for entries the entry; empty otherwise.
    Entry parsed;
  };

  static Line ParseLine(std::wstring_view text, bool inSection);
  static std::wstring EntryLine(std::wstring_view entry, std::wstring_view value);
  // The index of the header of `section`, or npos.
  std::size_t FindHeader(std::wstring_view section) const;

  std::vector<Line> m_lines;
};

}  // namespace LumenUtility
