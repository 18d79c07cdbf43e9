#include "lumenutil/hresult_code.h"

#include <charconv>
#include <system_error>

namespace lumenutil {
namespace {

// Parses all of digits (no sign, no prefix) in base; nothing on any leftover character or
// on overflow of 64 bits.
std::optional<std::uint64_t> ParseDigits(std::string_view digits, int base) {
  if (digits.empty()) return std::nullopt;
  std::uint64_t value = 0;
  const char* end = digits.data() + digits.size();
  const auto [stop, error] = std::from_chars(digits.data(), end, value, base);
  if (error != std::errc() || stop != end) return std::nullopt;
  return value;
}

}  // namespace

std::optional<std::int32_t> ParseHResultCode(std::string_view text) {
  constexpr std::uint64_t kMaxUnsigned = 0xFFFFFFFFu;
  constexpr std::uint64_t kMaxNegative = 0x80000000u;  // magnitude of INT32_MIN
  if (text.size() > 2 && text[0] == '0' && (text[1] == 'x' || text[1] == 'X')) {
    const auto value = ParseDigits(text.substr(2), 16);
    if (!value || *value > kMaxUnsigned) return std::nullopt;
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(*value));
  }
  const bool negative = !text.empty() && text[0] == '-';
  const auto magnitude = ParseDigits(negative ? text.substr(1) : text, 10);
  if (!magnitude) return std::nullopt;
  if (negative) {
    if (*magnitude > kMaxNegative) return std::nullopt;
    return static_cast<std::int32_t>(-static_cast<std::int64_t>(*magnitude));
  }
  if (*magnitude > kMaxUnsigned) return std::nullopt;
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(*magnitude));
}

}  // namespace lumenutil
