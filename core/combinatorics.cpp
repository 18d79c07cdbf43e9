#include "lumen/core/combinatorics.h"

#include <limits>

namespace LumenUtility {

namespace {

// 66! holds 64 factors of two, so it and every larger factorial is 0 modulo 2^64.
constexpr std::int32_t kFirstFactorialWrappingToZero = 66;

}  // namespace

std::int64_t NA_Factorial(std::int32_t n) {
  if (n >= kFirstFactorialWrappingToZero) return 0;
  std::uint64_t product = 1;  // unsigned, so wrapping past 20! is defined
  for (std::int32_t i = n; i >= 2; --i) product *= static_cast<std::uint64_t>(i);
  return static_cast<std::int64_t>(product);
}

std::int32_t Combination(std::int32_t n, std::int32_t k) {
  if (n <= 0 || k <= 0 || n < k) return 0;
  if (n == k) return 1;
  // Dividing factorials goes wrong from 21! on (and divides by zero from 66!), so build the
  // coefficient as C(n, i) = C(n, i-1) * (n-i+1) / i, which stays exact: every step is a
  // binomial coefficient, and it is checked against the 32-bit limit before it can overflow.
  const std::int64_t steps = k < n - k ? k : n - k;
  constexpr std::int64_t kLimit = std::numeric_limits<std::int32_t>::max();
  std::int64_t c = 1;
  for (std::int64_t i = 1; i <= steps; ++i) {
    // c <= 2^31 - 1 and the factor <= 2^31, so the product fits in 63 bits.
    c = c * (n - i + 1) / i;
    if (c > kLimit) return -1;
  }
  return static_cast<std::int32_t>(c);
}

}  // namespace LumenUtility
