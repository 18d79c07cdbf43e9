#include "globalstate/resolution_text.h"

#include <charconv>
#include <cmath>
#include <string_view>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility {

std::wstring FormatResolution(double value) {
  // 309 integer digits, a point, six decimals and a sign fit in 320 characters.
  char buffer[320];
  const auto [end, error] =
      std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed, 6);
  if (error != std::errc()) return L"0.000000";  // not reached for a finite double
  return Utf8ToWide(std::string_view(buffer, static_cast<std::size_t>(end - buffer)));
}

std::optional<double> ParseResolution(const std::wstring& text) {
  const std::string narrow = WideToUtf8(text);
  std::string_view view = narrow;
  if (!view.empty() && view.front() == '+') {
    view.remove_prefix(1);  // from_chars takes a '-' only; one sign at most
    if (!view.empty() && view.front() == '-') return std::nullopt;
  }
  double value = 0.0;
  const char* const last = view.data() + view.size();
  const auto [end, error] = std::from_chars(view.data(), last, value, std::chars_format::general);
  if (error != std::errc() || end != last || !std::isfinite(value)) return std::nullopt;
  return value;
}

}  // namespace LumenUtility
