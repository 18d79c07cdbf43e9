// Feeds random stimulus arrays and data to the linear and circular resamplers.
//
// Input layout: a header of 8 bytes (old and new stimulus shapes, point counts, circular
// variant, band-break count), then bytes consumed as stimulus steps, segment choices and data
// values. Stimuli ascend, descend, come unordered, repeat values, hold NaN or infinities, and
// are built from linear, log, fixed and explicit segments, so the bisecting searches meet every
// order the plain search accepts. Output arrays are sized exactly as each call states, so
// AddressSanitizer reports any access beyond them. The only exceptions allowed are the
// documented LumenException throws.
#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

#include "fuzz_input.h"
#include "lumen/interpolation/circular_interpolation.h"
#include "lumen/interpolation/linear_interpolation.h"
#include "lumen/platform/lumen_exception.h"

namespace {

using namespace LumenUtility;
using lumen_fuzz::FuzzInput;

// Values by shape: 0 ascending with repeats, 1 descending with repeats, 2 unordered small
// integers (many repeats), 3 ascending with a NaN or infinity, 4 raw floats from the input.
std::vector<double> MakeValues(int count, std::uint8_t shape, FuzzInput& in) {
  std::vector<double> v(count);
  double current = 1e6 * (in.Byte() % 4) + 0.5 * (in.Byte() % 3);
  for (int i = 0; i < count; ++i) {
    const std::uint8_t b = in.Byte();
    switch (shape % 5) {
      case 0:
      case 3:
        current += (b % 4 == 0) ? 0.0 : 0.05 * b;
        v[i] = current;
        break;
      case 1:
        current -= (b % 4 == 0) ? 0.0 : 0.05 * b;
        v[i] = current;
        break;
      case 2:
        v[i] = b % 16;
        break;
      default:
        v[i] = in.Float();
    }
  }
  if (shape % 5 == 3 && count > 0) {
    const double odd[] = {std::numeric_limits<double>::quiet_NaN(),
                          std::numeric_limits<double>::infinity(),
                          -std::numeric_limits<double>::infinity()};
    v[in.Byte() % count] = odd[in.Byte() % 3];
  }
  return v;
}

// The values cut into segments: mostly explicit, sometimes a linear, log or fixed segment
// spanning the same ends (log only for positive ends).
InputArray MakeStimulus(const std::vector<double>& values, FuzzInput& in) {
  InputArray stimulus;
  std::size_t start = 0;
  while (start < values.size()) {
    const std::size_t n = std::min<std::size_t>(values.size() - start, 1 + in.Byte() % 8);
    const double first = values[start], last = values[start + n - 1];
    const std::uint8_t kind = in.Byte() % 6;
    if (kind == 1) {
      stimulus.push_back(Segment(first, last, n, Linear));
    } else if (kind == 2 && first > 0 && last > 0 && std::isfinite(first) && std::isfinite(last)) {
      stimulus.push_back(Segment(first, last, n, Log));
    } else if (kind == 3) {
      stimulus.push_back(Segment(first, n));
    } else {
      stimulus.push_back(
          Segment(std::vector<double>(values.begin() + start, values.begin() + start + n)));
    }
    start += n;
  }
  return stimulus;
}

template <typename T>
void ResampleLinearly(const InputArray& oldStimulus, const InputArray& newStimulus,
                      std::vector<T> in) {
  std::vector<T> out;
  try {
    LinearInterpolation(oldStimulus, newStimulus, in, out);
  } catch (const LumenException&) {
    // Data shorter than the old stimulus.
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FuzzInput in(data, size);
  const std::uint8_t oldShape = in.Byte(), newShape = in.Byte();
  const int oldCount = in.Byte() % 40, newCount = in.Byte() % 40;
  const auto type = static_cast<InterpolateType>(in.Byte() % 3);
  const int breakCount = in.Byte() % 5;
  const bool shortData = in.Byte() % 8 == 0;
  const double nearIndex = in.Byte() / 8.0;

  const InputArray oldStimulus = MakeStimulus(MakeValues(oldCount, oldShape, in), in);
  const InputArray newStimulus = MakeStimulus(MakeValues(newCount, newShape, in), in);
  const int n = static_cast<int>(oldStimulus.size()), m = static_cast<int>(newStimulus.size());
  std::vector<TsComplex> oldData(shortData && n > 0 ? n - 1 : n);
  for (TsComplex& v : oldData) v = TsComplex(in.Float(), in.Float());
  std::vector<double> breaks(breakCount);
  for (double& b : breaks) b = (in.Byte() % 16 == 0) ? std::nan("") : in.Byte() % 16;

  // Linear resampling takes data of any length: too short is an exception, never a read.
  std::vector<float> floats(oldData.size());
  std::vector<double> doubles(oldData.size());
  for (std::size_t k = 0; k < oldData.size(); ++k) floats[k] = doubles[k] = oldData[k].re;
  ResampleLinearly(oldStimulus, newStimulus, floats);
  ResampleLinearly(oldStimulus, newStimulus, doubles);
  ResampleLinearly(oldStimulus, newStimulus, oldData);
  for (int k = 0; k < m; ++k) FindNearestIndex(oldStimulus, nearIndex, newStimulus[k]);
  try {
    LinearInterpolate(oldStimulus, nearIndex);
    if (n > 0) LogInterpolate(oldStimulus, nearIndex);
  } catch (const LumenException&) {
    // Index out of the stimulus' range.
  }

  // The circular forms read exactly n old values.
  if (static_cast<int>(oldData.size()) != n) return 0;
  std::vector<TsComplex> out(m);
  bool flag = false;
  CircularInterpolation(oldStimulus, oldData.data(), newStimulus, out.data(), &flag, type);
  CircularInterpolationEx(oldStimulus, oldData.data(), newStimulus, out.data(), &flag);
  CircularInterpolationUsingBandBreaks(oldStimulus, oldData.data(), newStimulus, out.data(), breaks,
                                       &flag);
  std::vector<float> pairs(2 * m);
  CircularInterpolationEx(n, oldStimulus.GetRawArray(),
                          reinterpret_cast<const float*>(oldData.data()), m,
                          newStimulus.GetRawArray(), pairs.data(), nullptr);
  // Resampling in place over the old data.
  std::vector<TsComplex> shared(oldData);
  shared.resize(std::max(n, m));
  CircularInterpolation(oldStimulus, shared.data(), newStimulus, shared.data(), &flag, type);
  return 0;
}
