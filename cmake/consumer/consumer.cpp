#include <cstdio>

#include "lumen/core.h"
#include "lumen/stimulus.h"

int main() {
  const LumenUtility::InputArray sweep(1e9, 2e9, 3, LumenUtility::Linear);
  const double dB = LumenUtility::TsComplex(0.5).LogMag();
  std::printf("%u points, %.3f dB\n", sweep.size(), dB);
  return sweep.size() == 3 && dB < -6.0 && dB > -6.1 ? 0 : 1;
}
