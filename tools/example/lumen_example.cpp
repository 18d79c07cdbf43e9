// A first look at the library: one measured value in the analyzer's trace formats, and a
// three-band stimulus array with its compact and expanded forms.
#include <cstdio>
#include <sstream>

#include "lumen/core.h"
#include "lumen/platform.h"
#include "lumen/stimulus.h"

using LumenUtility::InputArray;
using LumenUtility::Segment;
using LumenUtility::TsComplex;

namespace {

void ShowValue(const TsComplex& gamma, double frequencyHz) {
  bool isCapacitance = false;
  const double element = gamma.Z_Inductance(50, frequencyHz, isCapacitance);
  const TsComplex z = gamma.Impedance(TsComplex(50));
  std::printf("Reflection coefficient %.4f%+.4fj at %.3f GHz\n", gamma.re, gamma.im,
              frequencyHz / 1e9);
  std::printf("  log magnitude  %9.3f dB\n", gamma.LogMag());
  std::printf("  phase          %9.3f deg\n", gamma.Phase() * 180 / 3.141592653589793);
  std::printf("  SWR            %9.3f\n", gamma.SWR());
  std::printf("  impedance      %9.3f %+.3fj ohm\n", z.re, z.im);
  std::printf("  series element %9.3f %s\n", isCapacitance ? element * 1e12 : element * 1e9,
              isCapacitance ? "pF" : "nH");
}

void ShowStimulus() {
  InputArray sweep(10e6, 1e9, 5, LumenUtility::Log);
  sweep.push_back(Segment(1.5e9, 3e9, 4, LumenUtility::Linear));
  sweep.push_back(Segment(std::vector<double>{4.1e9, 4.7e9, 6e9}));
  std::wostringstream text;
  text << sweep;
  std::printf("\nStimulus array: %u points in %u segments\n", sweep.size(), sweep.NumSegments());
  std::printf("  text form: %s\n", LumenUtility::WideToUtf8(text.str()).c_str());
  std::printf("  points (Hz):");
  for (double f : sweep) std::printf(" %.6g", f);
  std::printf("\n  monotonic: %s, range %.6g .. %.6g Hz\n", sweep.IsMonotonic() ? "yes" : "no",
              sweep.min_element(), sweep.max_element());
}

}  // namespace

int main() {
  ShowValue(TsComplex::FromMagPhase(0.2, -1.1), 2.4e9);
  ShowStimulus();
  return 0;
}
