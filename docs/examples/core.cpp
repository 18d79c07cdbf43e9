// Complex values and trace formats: a reflection coefficient shown in the usual formats, and
// the unwrapped phase of a trace.
// guide:begin
#include <cstdio>
#include <cwchar>
#include <vector>

#include "lumen/core.h"

using LumenUtility::TsComplex;

int main() {
  const TsComplex gamma(0.2, -0.1);  // a reflection coefficient
  std::printf("|G| %.4f, %.3f dB, %.4f rad, SWR %.4f\n", gamma.Mag(), gamma.LogMag(),
              gamma.Phase(), gamma.SWR());
  const TsComplex z = gamma.Impedance(TsComplex(50.0));  // against 50 ohms
  std::printf("Z = %.3f %+.3fj ohm\n", z.re, z.im);
  std::printf("LogMag of 0: %.0f dB\n", TsComplex().LogMag());  // the zero value

  double scale = 0;
  wchar_t prefix = 0;
  LumenUtility::GetSIPrefix(2.4e9, scale, prefix, 24, -24);
  std::printf("2.4e9 Hz is %.1f %lcHz\n", 2.4e9 * scale, static_cast<wint_t>(prefix));

  // A delay line: the phase falls 1 rad per point and wraps at pi; unwrapped it keeps falling.
  std::vector<TsComplex> trace;
  for (int k = 0; k < 6; ++k) trace.push_back(TsComplex::FromMagPhase(1.0, -1.0 * k));
  std::vector<float> phase(trace.size());
  if (LumenUtility::FormatUnwrappedPhase(trace.data(), phase.data(), 0, 6) != 0) return 1;
  std::printf("unwrapped: %.3f %.3f rad (wrapped %.3f)\n", phase[4], phase[5], trace[5].Phase());
}
// guide:end
