// The text form of the power knob resolution: six decimals, as "%f" writes them in the C
// locale ("0.250000"). Writing and reading ignore the host's locale, so a host that sets a
// decimal comma still writes and reads "0.250000".
#pragma once

#include <optional>
#include <string>

namespace LumenUtility {

// `value` with six decimals ("-0.000000" for -0.0, "1000000.000000" for 1e6). `value` must be
// finite.
std::wstring FormatResolution(double value);

// The value when the whole of `text` is a finite number in decimal or exponent form, with an
// optional sign ("0.250000", "+1", "-2.5e-3"); nothing for anything else: blanks, trailing
// characters, "nan", "inf", hexadecimal, or a number beyond the range of a double.
std::optional<double> ParseResolution(const std::wstring& text);

}  // namespace LumenUtility
