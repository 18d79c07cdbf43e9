#include "phase/pa_averaging.h"

#include <cmath>

namespace LumenUtility {

void FoldComplexMean(TsComplex& t, TsComplex sample, int i, int n) {
  if (n == 1) {
    t = sample;
    return;
  }
  if (i == 0) t = TsComplex();
  t += sample;
  if (i + 1 == n) {
    t.re = static_cast<float>(t.re / static_cast<double>(n));
    t.im = static_cast<float>(t.im / static_cast<double>(n));
  }
}

void FoldPowerAndPhase(TsComplex& t, TsComplex& q, TsComplex sample, int i, int n) {
  if (n == 1) {
    t = sample;
    return;
  }
  if (i == 0) {
    t = TsComplex();
    q = TsComplex();
  }
  const double power = double{sample.re} * sample.re + double{sample.im} * sample.im;
  if (power != 0.0) {
    const double magnitude = std::sqrt(power);
    q += TsComplex(sample.re / magnitude, sample.im / magnitude);
  }
  t.re = static_cast<float>(t.re + power);
  if (i + 1 == n) {
    const double meanPower = t.re / static_cast<double>(n);
    const double phase = q.Phase();
    const double amplitude = std::sqrt(meanPower);
    t = TsComplex(amplitude * std::cos(phase), amplitude * std::sin(phase));
  }
}

}  // namespace LumenUtility
