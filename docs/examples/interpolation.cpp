// Interpolation: a real trace and a complex trace carried onto a finer stimulus.
// guide:begin
#include <cstdio>
#include <vector>

#include "lumen/interpolation.h"

using namespace LumenUtility;

int main() {
  const InputArray measured(1e9, 5e9, 5, Linear);  // 1, 2, ... 5 GHz
  const InputArray wanted(1e9, 5e9, 9, Linear);    // every 500 MHz
  const std::vector<double> gainDb = {10, 12, 13, 12, 10};
  std::vector<double> resampled;
  tagInterpStatus status = LinearInterpolation(measured, wanted, gainDb, resampled);
  std::printf("linear: status %d, %.1f dB at 1.5 GHz\n", status, resampled[1]);

  // A delay: the value turns 90 degrees per GHz along the unit circle.
  std::vector<TsComplex> s21, fine(wanted.size());
  for (unsigned k = 0; k < measured.size(); ++k)
    s21.push_back(TsComplex::FromMagPhase(1.0, -1.5707963 * k));
  bool interpolated = false;
  status = CircularInterpolation(measured, s21.data(), wanted, fine.data(), &interpolated,
                                 INTERP_CIRCULAR);
  std::printf("circular: status %d, |S21| %.4f at %.4f rad\n", status, fine[1].Mag(),
              fine[1].Phase());

  const InputArray beyond(0.5e9, 5e9, 10, Linear);  // starts below the measured range
  fine.resize(beyond.size());
  const tagInterpStatus held = LinearInterpolation(measured, beyond, gainDb, resampled);
  status = CircularInterpolation(measured, s21.data(), beyond, fine.data(), &interpolated,
                                 INTERP_CIRCULAR);
  std::printf("below the range: linear %d (%.1f dB held), circular %d\n", held, resampled[0],
              status);
}
// guide:end
