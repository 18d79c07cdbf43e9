// Reads arbitrary bytes as a CSV file, field by field to the end, twice: alone, and after a
// first line of 0 to 10 characters (the first byte's choice) that shifts the text against the
// 10-byte reads. Both must give the same fields and statuses, within the documented ranges.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "lumen/data.h"
#include "memory_file.h"

namespace {

using lumen_fuzz::MemoryFile;

struct Token {
  int ok;
  unsigned status;
  std::string field;
  bool operator==(const Token&) const = default;
};

void Check(bool condition) {
  if (!condition) __builtin_trap();
}

std::vector<Token> ReadRest(CCSVFile& csv) {
  std::vector<Token> tokens;
  for (;;) {
    Token t;
    t.ok = csv.ReadField(t.field, &t.status);
    Check(t.field.size() <= CCSVFile::kMaxFieldLength);
    Check(t.ok ? t.status <= CCSVFile::kOpenQuoteAtEnd
               : t.status >= CCSVFile::kEndOfLine && t.status != CCSVFile::kFileError);
    Check(t.ok || t.field.empty() || t.status == CCSVFile::kFieldTooLong);
    tokens.push_back(t);
    if (t.status == CCSVFile::kEndOfFile || csv.IsError(t.status)) return tokens;
    if (t.status == CCSVFile::kEndOfLine) {
      Token end;
      end.ok = csv.ReadEndOfLine(&end.status);
      Check(end.ok && end.status == CCSVFile::kEndOfLine);
      tokens.push_back(end);
    }
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  const std::string text(reinterpret_cast<const char*>(data) + 1, size - 1);
  const int shift = data[0] % 11;

  const MemoryFile alone(text);
  CCSVFile first;
  Check(first.Open(alone.Path().c_str(), CFile::modeRead));
  const std::vector<Token> expected = ReadRest(first);

  const MemoryFile shifted(std::string(shift, 's') + "\r\n" + text);
  CCSVFile second;
  Check(second.Open(shifted.Path().c_str(), CFile::modeRead));
  std::string field;
  unsigned status;
  if (shift > 0) Check(second.ReadField(field, &status) && field.size() == std::size_t(shift));
  Check(!second.ReadField(field, &status) && status == CCSVFile::kEndOfLine);
  Check(second.ReadEndOfLine(&status));
  Check(ReadRest(second) == expected);
  return 0;
}
