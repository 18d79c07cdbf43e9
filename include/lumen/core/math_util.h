/// @file
/// MathUtil: rounding of user-entered values to an instrument resolution, range clamping, and
/// the check that a value needs no more than a given number of significant digits.
///
/// Free, stateless functions at global scope (outside LumenUtility); reentrant.
#pragma once

#include "lumen/export.h"

namespace MathUtil {

/// `value` rounded to the nearest multiple of `resolution` (same unit as value, > 0), ties
/// away from zero: 2.5 -> 3, -2.5 -> -3 at resolution 1. A resolution <= 0 (or NaN) returns
/// value.
LUMEN_API double Resolution(double value, double resolution);

/// `value` clamped to [min, max] (a value below min gives min even when min > max), then
/// rounded by Resolution.
LUMEN_API double MinMaxRes(double value, double min, double max, double resolution);

/// True when `value`, read to 15 significant digits, already has at most `digits` significant
/// digits, none below 1e-18: rounding it to that many digits moves it by less than one unit of
/// its fifteenth digit. digits <= 0 means no limit (true). False for NaN and infinities.
LUMEN_API bool ValidCheck(double value, int digits);

}  // namespace MathUtil
