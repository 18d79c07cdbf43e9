#include "interpolation/trig_table.h"

#include <complex>

namespace LumenUtility {

const TrigTable& TrigTable::Get() {
  static const TrigTable table;
  return table;
}

TrigTable::TrigTable() {
  // In long double (64 or 113 significant bits where the platform has them), so that nearly
  // every entry is the double nearest to the true value.
  const long double pi = 3.141592653589793238462643383279502884L;
  for (int k = 0; k < kSteps; ++k) {
    const long double angle = 2 * pi * k / kSteps;
    m_sinCos[k] = {static_cast<double>(std::sin(angle)), static_cast<double>(std::cos(angle))};
  }
  for (int j = 0; j <= kAtanSteps; ++j) {
    const long double c = static_cast<long double>(j) / kAtanSteps;
    m_atan[j].atan = static_cast<double>(std::atan(c));
    // atan' = 1 / (1 + x^2) = Im(1 / (x - i)), whose k-th derivative over k! at c is
    // Im((-1)^k (c - i)^-(k + 1)); atan's k-th Taylor coefficient is that for k - 1, over k.
    const std::complex<long double> inverse = 1.0L / std::complex<long double>(c, -1.0L);
    std::complex<long double> power = inverse;
    for (int k = 1; k <= 4; ++k) {
      const long double sign = k % 2 == 1 ? 1.0L : -1.0L;
      m_atan[j].d[k - 1] = static_cast<double>(sign * power.imag() / k);
      power *= inverse;
    }
  }
}

}  // namespace LumenUtility
