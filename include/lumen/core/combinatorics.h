/// @file
/// Factorials and binomial coefficients in integer arithmetic.
///
/// Free, stateless functions; reentrant.
#pragma once

#include <cstdint>

#include "lumen/export.h"

namespace LumenUtility {

/// n! in 64-bit arithmetic; 1 for n < 2. Exact up to 20!; beyond that the product wraps
/// modulo 2^64 (two's complement), and from 66! on it is 0.
LUMEN_API std::int64_t NA_Factorial(std::int32_t n);

/// The binomial coefficient n over k: 0 when n <= 0, k <= 0 or n < k (so k = 0 gives 0), 1
/// when n = k, otherwise n!/((n-k)! k!) computed exactly for any n. Returns -1 when the
/// coefficient does not fit in 32 bits (C(34, 16) is the first row to overflow).
LUMEN_API std::int32_t Combination(std::int32_t n, std::int32_t k);

}  // namespace LumenUtility
