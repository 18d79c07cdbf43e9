#include "lumen/data/snp_trace_names.h"

#include <charconv>
#include <cstdio>

namespace {

// A whole decimal index from 1 to 999 with no sign and no leading zero, so that each index
// has one spelling.
bool ReadIndex(std::string_view text, int& value) {
  if (text.empty() || text.size() > 3 || text.front() < '1' || text.front() > '9') return false;
  const char* end = text.data() + text.size();
  const std::from_chars_result r = std::from_chars(text.data(), end, value);
  return r.ec == std::errc() && r.ptr == end;
}

}  // namespace

std::string SnPTraceName(int row, int column) {
  char name[16];
  std::snprintf(name, sizeof name, row < 10 && column < 10 ? "S%d%d" : "S%d_%d", row, column);
  return name;
}

bool SnPParseTraceName(std::string_view name, int& row, int& column) {
  if (name.size() < 3 || (name[0] != 'S' && name[0] != 's')) return false;
  const std::string_view indices = name.substr(1);
  const std::size_t separator = indices.find('_');
  if (separator == std::string_view::npos) {
    return indices.size() == 2 && ReadIndex(indices.substr(0, 1), row) &&
           ReadIndex(indices.substr(1), column);
  }
  return ReadIndex(indices.substr(0, separator), row) &&
         ReadIndex(indices.substr(separator + 1), column);
}
