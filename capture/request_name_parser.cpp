#include "capture/request_name_parser.h"

#include <cstdint>
#include <limits>
#include <vector>

#include "lumen/platform/error_codes.h"

namespace LumenUtility {

namespace {

[[noreturn]] void Malformed() {
  throw E_INVALIDARG;
}

std::vector<std::wstring_view> SplitFields(std::wstring_view name) {
  std::vector<std::wstring_view> fields;
  std::size_t begin = 0;
  for (;;) {
    const std::size_t colon = name.find(L':', begin);
    fields.push_back(name.substr(begin, colon == std::wstring_view::npos ? colon : colon - begin));
    if (colon == std::wstring_view::npos) return fields;
    begin = colon + 1;
  }
}

// A decimal number of 1 to `maximum`.
std::uint64_t PositiveNumber(std::wstring_view digits, std::uint64_t maximum) {
  if (digits.empty()) Malformed();
  std::uint64_t value = 0;
  for (const wchar_t c : digits) {
    if (c < L'0' || c > L'9') Malformed();
    value = value * 10 + static_cast<std::uint64_t>(c - L'0');
    if (value > maximum) Malformed();
  }
  if (value == 0) Malformed();
  return value;
}

}  // namespace

DataRequest RequestNameParser::Parse(std::wstring_view name) {
  const std::vector<std::wstring_view> fields = SplitFields(name);
  if (fields.size() != 4) Malformed();
  DataRequest request;
  constexpr std::uint64_t kMaxNumber = std::numeric_limits<int>::max();
  request.channel = static_cast<int>(PositiveNumber(fields[0], kMaxNumber));
  request.measurement = static_cast<int>(PositiveNumber(fields[1], kMaxNumber));
  if (fields[2] == L"SDATA") {
    request.isComplex = true;
  } else if (fields[2] == L"CAL") {
    request.isCal = true;
  } else if (fields[2] != L"FDATA") {
    Malformed();
  }
  request.count = static_cast<std::uint32_t>(
      PositiveNumber(fields[3], std::numeric_limits<std::uint32_t>::max()));
  return request;
}

}  // namespace LumenUtility
