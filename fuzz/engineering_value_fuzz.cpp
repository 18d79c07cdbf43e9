// Stimulus values typed on the command line (--start, --stop): whatever the text, the parser
// either rejects it or returns a finite value that reads back to itself when printed with
// every digit a double holds.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <optional>
#include <string_view>

#include "lumenutil/engineering_value.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  // The first byte picks the unit the value may end in.
  static constexpr std::string_view kUnits[] = {"Hz", "s", "dBm", ""};
  const std::string_view unit = kUnits[data[0] % 4];
  const std::string_view text(reinterpret_cast<const char*>(data) + 1, size - 1);
  const std::optional<double> value = lumenutil::ParseEngineeringValue(text, unit);
  if (!value) return 0;
  if (!std::isfinite(*value)) std::abort();
  char digits[40];
  std::snprintf(digits, sizeof digits, "%.17g", *value);
  if (lumenutil::ParseEngineeringValue(digits, unit) != value) std::abort();
  return 0;
}
