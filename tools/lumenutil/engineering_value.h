// Reading stimulus values typed on the command line: "2.4e9", "2.4G", "2.4 GHz", "800MHz".
#pragma once

#include <optional>
#include <string_view>

namespace lumenutil {

// A decimal number, optionally followed by one SI prefix (p n u m k M G T; "u" and the micro
// sign both mean 1e-6) and optionally by the unit `unit`, compared without case ("Hz",
// "s"...); blanks may separate the number from the rest. In front of a written-out "Hz" the
// prefixes from kilo up are read without case ("800mhz" is 800 MHz). Nothing for anything
// else, for "inf" or "nan", and for values beyond the double range.
std::optional<double> ParseEngineeringValue(std::string_view text, std::string_view unit);

}  // namespace lumenutil
