#include "lumenutil/engineering_value.h"

#include <charconv>
#include <cmath>
#include <string>

namespace lumenutil {
namespace {

bool EqualsIgnoringCase(std::string_view a, std::string_view b) {
  if (a.size() != b.size()) return false;
  for (std::size_t i = 0; i < a.size(); ++i) {
    const auto lower = [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c; };
    if (lower(a[i]) != lower(b[i])) return false;
  }
  return true;
}

// The multiplier of the prefix at the start of `rest` and its length in bytes, or 0.
double Prefix(std::string_view rest, std::size_t& length) {
  length = 1;
  if (rest.empty()) return 0;
  if (rest.substr(0, 2) == "\xC2\xB5") {  // micro sign in UTF-8
    length = 2;
    return 1e-6;
  }
  switch (rest.front()) {
    case 'p':
      return 1e-12;
    case 'n':
      return 1e-9;
    case 'u':
      return 1e-6;
    case 'm':
      return 1e-3;
    case 'k':
    case 'K':
      return 1e3;
    case 'M':
      return 1e6;
    case 'G':
      return 1e9;
    case 'T':
      return 1e12;
    default:
      return 0;
  }
}

// The multiplier of a prefix from kilo up in front of a written-out "Hz", read without case;
// 0 for any other prefix, which then keeps its SI meaning.
double FrequencyPrefix(std::string_view prefix) {
  if (prefix.size() != 1) return 0;  // the micro sign
  switch (prefix.front()) {
    case 'k':
    case 'K':
      return 1e3;
    case 'm':
    case 'M':
      return 1e6;
    case 'g':
    case 'G':
      return 1e9;
    case 't':
    case 'T':
      return 1e12;
    default:
      return 0;
  }
}

}  // namespace

std::optional<double> ParseEngineeringValue(std::string_view text, std::string_view unit) {
  if (!text.empty() && text.front() == '+') text.remove_prefix(1);
  double value = 0.0;
  const char* end = text.data() + text.size();
  const std::from_chars_result r = std::from_chars(text.data(), end, value);
  if (r.ec != std::errc() || !std::isfinite(value)) return std::nullopt;
  std::string_view rest(r.ptr, static_cast<std::size_t>(end - r.ptr));
  if (rest.substr(0, 3) == "inf" || rest.substr(0, 3) == "nan") return std::nullopt;
  while (!rest.empty() && rest.front() == ' ') rest.remove_prefix(1);
  if (rest.empty() || EqualsIgnoringCase(rest, unit)) return value;
  std::size_t length = 0;
  double multiplier = Prefix(rest, length);
  const std::string_view prefix = rest.substr(0, length);
  rest.remove_prefix(length);
  if (!rest.empty() && !EqualsIgnoringCase(rest, unit)) return std::nullopt;
  // Frequencies written with their unit ("800mhz", "2.4 ghz") are read without regard to
  // the prefix's case: nobody sweeps in millihertz, and typing the unit shows that the
  // letter was meant as a prefix of it. A bare prefix keeps SI case ("1.5m" is milli).
  if (!rest.empty() && EqualsIgnoringCase(unit, "Hz")) {
    const double frequencyMultiplier = FrequencyPrefix(prefix);
    if (frequencyMultiplier != 0) multiplier = frequencyMultiplier;
  }
  if (multiplier == 0) return std::nullopt;
  // The prefix joins the decimal exponent and the text is read again, so "5u" is exactly
  // the double nearest 5e-6, which 5 * 1e-6 is not.
  const std::string_view number(text.data(), static_cast<std::size_t>(r.ptr - text.data()));
  const std::size_t e = number.find_first_of("eE");
  int exponent = static_cast<int>(std::lround(std::log10(multiplier)));
  if (e != std::string_view::npos) {
    int own = 0;
    std::string_view digits = number.substr(e + 1);
    if (!digits.empty() && digits.front() == '+') digits.remove_prefix(1);
    std::from_chars(digits.data(), digits.data() + digits.size(), own);
    exponent += own;
  }
  const std::string scaled = std::string(number.substr(0, e)) + "e" + std::to_string(exponent);
  const std::from_chars_result again =
      std::from_chars(scaled.data(), scaled.data() + scaled.size(), value);
  if (again.ec != std::errc() || !std::isfinite(value)) return std::nullopt;
  return value;
}

}  // namespace lumenutil
