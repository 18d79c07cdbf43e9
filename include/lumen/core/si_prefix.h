/// @file
/// Engineering (SI) prefixes for displaying values such as frequencies and times.
///
/// Free, stateless functions; reentrant.
#pragma once

#include "lumen/export.h"

namespace LumenUtility {

/// Chooses the SI prefix for showing `value`: the caller displays value * scale followed by
/// `prefix`. The prefix's exponent is log10(|value|) truncated toward zero, then lowered to a
/// multiple of 3, and kept within [minExponent, maxExponent] (each first truncated to a
/// multiple of 3 toward zero, and limited to [-24, 24]). Prefixes run y z a f p n u m, blank
/// (no prefix), k M G T P E Z Y, with micro as U+00B5. So 1.5e9 gives scale 1e-9 and 'G', 0.05
/// gives 1e3 and 'm', and 0.5 gives 1 and the blank (its exponent truncates to 0). Zero, NaN
/// and infinities take the blank unless the limits exclude it.
LUMEN_API void GetSIPrefix(double value, double& scale, wchar_t& prefix, int maxExponent,
                           int minExponent);

/// The same with the prefix narrowed to its low byte (micro becomes the byte 0xB5).
LUMEN_API void GetSIPrefix(double value, double& scale, char& prefix, int maxExponent,
                           int minExponent);

}  // namespace LumenUtility
