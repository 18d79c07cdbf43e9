#include "interpolation/trig_table.h"

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
    m_atan[j] = static_cast<double>(std::atan(static_cast<long double>(j) / kAtanSteps));
  }
}

}  // namespace LumenUtility
