// Feeds random grids, stimulus lists and samples to the vector-kernel resamplers.
//
// Input layout: a 16-byte header (stimulus shape, sample count, grid length, result count,
// grid start and stop choices), then raw bytes read as floats for the samples. Stimuli are
// evenly spaced, uneven, descending, repeated, unordered or with NaN; grids run inside,
// across, beyond or backwards over the data, or are degenerate. Every output array is sized
// exactly as the call states, so AddressSanitizer reports any access beyond it.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "fuzz_input.h"
#include "lumen/interpolation/tarn_interpolation.h"

namespace {

using lumen_fuzz::FuzzInput;
using LumenUtility::TsComplex;

std::vector<double> MakeStimulus(int count, std::uint8_t shape, FuzzInput& in) {
  std::vector<double> x(count);
  const double first = 1.0e6 * (shape >> 4), step = 1.0e5 * ((shape >> 4) + 1);
  for (int i = 0; i < count; ++i) x[i] = first + step * i;
  switch (shape & 7) {
    case 1:  // descending
      for (int i = 0; i < count; ++i) x[i] = first - step * i;
      break;
    case 2:  // uneven
      for (int i = 1; i < count; ++i) x[i] = x[i - 1] + step * (1 + (in.Byte() & 15));
      break;
    case 3:  // repeated values
      for (int i = 1; i < count; ++i) x[i] = (in.Byte() & 1) ? x[i - 1] : x[i - 1] + step;
      break;
    case 4:  // arbitrary values, NaN and infinities among them
      for (int i = 0; i < count; ++i) x[i] = in.Float();
      break;
    case 5:  // a NaN somewhere
      if (count > 0) x[in.Byte() % count] = std::numeric_limits<double>::quiet_NaN();
      break;
    default:
      break;
  }
  return x;
}

double GridLimit(std::uint8_t choice, const std::vector<double>& x, FuzzInput& in) {
  const double lo = x.empty() ? 0.0 : x.front(), hi = x.empty() ? 1.0 : x.back();
  switch (choice % 8) {
    case 0:
      return lo;
    case 1:
      return hi;
    case 2:
      return lo + (hi - lo) * (choice / 255.0);
    case 3:
      return hi + (hi - lo) * (choice / 64.0);
    case 4:
      return lo - (hi - lo) * (choice / 64.0);
    case 5:
      return std::numeric_limits<double>::quiet_NaN();
    case 6:
      return (choice & 8) ? 1e308 : -1e308;
    default:
      return in.Float();
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FuzzInput in(data, size);
  const std::uint8_t shape = in.Byte();
  const int count = static_cast<int>(in.Byte() % 48) - 2;  // -2 .. 45
  const int points = static_cast<int>((in.Byte() | (in.Byte() << 8)) % 1200) - 2;
  const int resultCount = points + static_cast<int>(in.Byte() % 9) - 4;
  const std::uint8_t startChoice = in.Byte(), stopChoice = in.Byte();
  const bool withPhase = in.Byte() & 1;

  const int n = count > 0 ? count : 0;
  const int m = points > 0 ? points : 0;
  const std::vector<double> x = MakeStimulus(n, shape, in);
  const double start = GridLimit(startChoice, x, in), stop = GridLimit(stopChoice, x, in);

  std::vector<float> xf(n);
  for (int i = 0; i < n; ++i) xf[i] = static_cast<float>(x[i]);
  std::vector<TsComplex> samples(n);
  for (TsComplex& v : samples) v = TsComplex(in.Float(), in.Float());

  // Complex linear resampling with a factor.
  std::vector<TsComplex> resampled(m), factor(m, TsComplex(0.5, -0.5)), result(m);
  LumenUtility::TarnInterpolation(samples.data(), xf.data(), count, resampled.data(), factor.data(),
                                  result.data(), start, stop, points, resultCount);

  // Real resampling, with and without a phase code.
  std::vector<TsComplex> work = samples;
  std::vector<float> rs(m), rf(m, 2.0f), rr(m);
  std::vector<std::int16_t> code(m);
  LumenUtility::TarnInterpolation(work.data(), xf.data(), count, rs.data(), rf.data(), rr.data(),
                                  start, stop, points, resultCount,
                                  withPhase ? code.data() : nullptr);

  // Cubic resampling of magnitude and phase, dividing an operand.
  std::vector<float> mag(n), phase(n), rmag(m), rphase(m);
  for (int i = 0; i < n; ++i) {
    mag[i] = samples[i].re;
    phase[i] = samples[i].im;
  }
  std::vector<TsComplex> cr(m), operand(m, TsComplex(1.0, 1.0)), quotient(m);
  LumenUtility::TarnCubicInterpolation(mag.data(), phase.data(), x.data(), count, rmag.data(),
                                       rphase.data(), cr.data(), operand.data(), quotient.data(),
                                       start, stop, points, withPhase);
  return 0;
}
