#include "lumen/core/math_util.h"

#include <charconv>
#include <cmath>
#include <cstdint>
#include <limits>
#include <system_error>

namespace MathUtil {

namespace {

// Digits read from a double: 15 significant digits are exact for every decimal input of up to
// 15 digits, which is the promise ValidCheck makes.
constexpr int kSignificantDigits = 15;
// No digit below 1e-18 is ever kept.
constexpr int kLowestExponent = -18;

// |value| > 0 and finite, rounded half up (on its 15-digit decimal form) so that its last
// digit kept has decimal exponent max(exponent of the leading digit - digits + 1, -18).
double RoundMagnitudeToDigits(double magnitude, int digits) {
  // "d.dddddddddddddde+XX"
  char text[40];
  const auto printed = std::to_chars(text, text + sizeof text, magnitude,
                                     std::chars_format::scientific, kSignificantDigits - 1);
  if (printed.ec != std::errc()) return magnitude;
  char mantissa[kSignificantDigits];
  int count = 0;
  const char* p = text;
  for (; p < printed.ptr && *p != 'e'; ++p) {
    if (*p >= '0' && *p <= '9' && count < kSignificantDigits) mantissa[count++] = *p;
  }
  int exponent = 0;
  if (p < printed.ptr) {
    const char* e = p + 1;
    if (*e == '+') ++e;
    std::from_chars(e, printed.ptr, exponent);
  }

  int lowest = exponent - digits + 1;
  if (lowest < kLowestExponent) lowest = kLowestExponent;
  const int keep = exponent - lowest + 1;  // leading digits that survive
  if (keep >= count) return magnitude;
  if (keep < 0) return 0.0;

  std::int64_t kept = 0;
  for (int i = 0; i < keep; ++i) kept = kept * 10 + (mantissa[i] - '0');
  if (mantissa[keep] >= '5') ++kept;
  if (kept == 0) return 0.0;

  // kept * 10^lowest, correctly rounded through the decimal reader.
  char result[48];
  char* const last = result + sizeof result;
  auto w = std::to_chars(result, last - 8, kept);  // leaves room for "e-NNNN"
  if (w.ec != std::errc()) return magnitude;
  *w.ptr = 'e';
  w = std::to_chars(w.ptr + 1, last, lowest);
  if (w.ec != std::errc()) return magnitude;
  double rounded = magnitude;
  std::from_chars(result, w.ptr, rounded);
  return rounded;
}

}  // namespace

double Resolution(double value, double resolution) {
  if (!(resolution > 0.0)) return value;
  const double q = value / resolution;
  if (value >= 0.0) return std::floor(q + 0.5) * resolution;
  return -std::floor(0.5 - q) * resolution;
}

double MinMaxRes(double value, double min, double max, double resolution) {
  if (value < min) {
    value = min;
  } else if (value > max) {
    value = max;
  }
  return Resolution(value, resolution);
}

bool ValidCheck(double value, int digits) {
  if (!std::isfinite(value)) return false;
  if (digits <= 0 || value == 0.0) return true;
  const double magnitude = std::abs(value);
  // One unit of the fifteenth significant digit.
  const double tolerance = std::pow(10.0, std::floor(std::log10(magnitude)) - 14);
  const double rounded = RoundMagnitudeToDigits(magnitude, digits);
  return std::abs(rounded - magnitude) < tolerance;
}

}  // namespace MathUtil
