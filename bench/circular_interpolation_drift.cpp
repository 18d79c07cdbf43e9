// Measures how far the circular interpolation's results move between two builds of the
// library: `record FILE` resamples a fixed set of random traces and stores every output value;
// `compare FILE`, run with another build, resamples the same traces and reports how many output
// values changed and the largest change relative to the stored value's magnitude.
//
// The traces mimic measurements (a delay turning the phase, a resonance tracing an arc, a little
// noise) on grids with exactly even steps, random steps and even steps with a few uneven ones,
// resampled onto interleaved, finer, coarser, random and descending grids, with and without
// extrapolation, in every InterpolateType. The generator is seeded, so both runs see the same
// traces.
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>
#include <random>
#include <string>
#include <vector>

#include "lumen/interpolation/circular_interpolation.h"

namespace {

using LumenUtility::InputArray;
using LumenUtility::InterpolateType;
using LumenUtility::TsComplex;

constexpr int kTraces = 3000;
constexpr double kPi = 3.141592653589793;

struct Trace {
  std::vector<double> oldX;
  std::vector<TsComplex> data;
  std::vector<double> newX;
  InterpolateType type = LumenUtility::INTERP_CIRCULAR;
  bool extrapolate = false;
};

std::vector<double> OldGrid(std::mt19937& rng, int n) {
  std::uniform_int_distribution<int> form(0, 2);
  const double start = std::ldexp(1.0, 20) * std::uniform_int_distribution<int>(1, 4000)(rng);
  const double step = 1000.0 * std::uniform_int_distribution<int>(1, 10000)(rng);
  std::uniform_real_distribution<double> ragged(0.5, 1.5);
  const int kind = form(rng);
  std::vector<double> x(n);
  double f = start;
  for (int k = 0; k < n; ++k) {
    x[k] = f;
    // Exactly even steps, random steps, or even steps with one in 50 stretched.
    const bool uneven = kind == 1 || (kind == 2 && k % 50 == 17);
    f += uneven ? step * ragged(rng) : step;
  }
  return x;
}

std::vector<TsComplex> Data(std::mt19937& rng, const std::vector<double>& x) {
  std::uniform_real_distribution<double> unit(0.0, 1.0);
  const double span = x.back() - x.front() + 1.0;
  // Delay of 0.2 to 40 turns over the span, a resonance somewhere in it, noise at -80 dB.
  const double tau = (0.2 + 40 * unit(rng)) / span;
  const double f0 = x.front() + span * unit(rng);
  const double q = 5 + 200 * unit(rng);
  const double level = 0.01 + unit(rng);
  std::normal_distribution<double> noise(0.0, 1e-4 * level);
  std::vector<TsComplex> d(x.size());
  for (std::size_t k = 0; k < x.size(); ++k) {
    const double detune = q * (x[k] / f0 - f0 / x[k]);
    // 1 / (1 + j detune): a circle through 0 and 1.
    const double re = 1 / (1 + detune * detune), im = -detune * re;
    const double phase = -2 * kPi * (x[k] - x.front()) * tau;
    const double c = std::cos(phase), s = std::sin(phase);
    // The two draws in sequence, so that every compiler makes the same traces.
    const double noiseRe = noise(rng);
    const double noiseIm = noise(rng);
    d[k] = TsComplex(level * (0.3 + 0.6 * (re * c - im * s)) + noiseRe,
                     level * 0.6 * (re * s + im * c) + noiseIm);
  }
  return d;
}

std::vector<double> NewGrid(std::mt19937& rng, const std::vector<double>& x, bool extrapolate) {
  const int n = static_cast<int>(x.size());
  const double low = x.front(), high = x.back(), span = high - low;
  const double margin = extrapolate ? 0.02 * span : 0.0;
  std::vector<double> v;
  switch (std::uniform_int_distribution<int>(0, 4)(rng)) {
    case 0:  // between the old points
      for (int k = 0; k < n; ++k) v.push_back(low + span * (k + 0.5) / n);
      break;
    case 1: {  // 2 to 5 times finer
      const int m = n * std::uniform_int_distribution<int>(2, 5)(rng);
      for (int k = 0; k <= m; ++k) v.push_back(low - margin + (span + 2 * margin) * k / m);
      break;
    }
    case 2: {  // 2 to 5 times coarser
      const int m = std::max(2, n / std::uniform_int_distribution<int>(2, 5)(rng));
      for (int k = 0; k <= m; ++k) v.push_back(low - margin + (span + 2 * margin) * k / m);
      break;
    }
    case 3: {  // random points, some on old ones
      std::uniform_real_distribution<double> at(low - margin, high + margin);
      for (int k = 0; k < n; ++k) v.push_back(k % 7 == 0 ? x[k] : at(rng));
      v.front() = low - margin;
      v.back() = high + margin;
      break;
    }
    default:  // the interleaved grid descending
      for (int k = n - 1; k >= 0; --k) v.push_back(low + span * (k + 0.5) / n);
      break;
  }
  return v;
}

std::vector<Trace> Traces() {
  std::mt19937 rng(20261206);
  std::vector<Trace> traces(kTraces);
  for (int t = 0; t < kTraces; ++t) {
    Trace& trace = traces[t];
    const int n = t % 10 == 0 ? std::uniform_int_distribution<int>(1, 6)(rng)
                              : std::uniform_int_distribution<int>(7, 2000)(rng);
    trace.oldX = OldGrid(rng, n);
    trace.data = Data(rng, trace.oldX);
    trace.extrapolate = t % 4 == 3;
    trace.type = static_cast<InterpolateType>(t % 3);
    trace.newX = NewGrid(rng, trace.oldX, trace.extrapolate);
  }
  return traces;
}

std::vector<TsComplex> Resample(const Trace& trace) {
  std::vector<TsComplex> out(trace.newX.size());
  const InputArray oldStimulus(trace.oldX), newStimulus(trace.newX);
  bool interpolated = false;
  if (trace.extrapolate) {
    LumenUtility::CircularInterpolationEx(oldStimulus, trace.data.data(), newStimulus, out.data(),
                                          &interpolated);
  } else {
    LumenUtility::CircularInterpolation(oldStimulus, trace.data.data(), newStimulus, out.data(),
                                        &interpolated, trace.type);
  }
  return out;
}

bool SameBits(TsComplex a, TsComplex b) {
  return std::memcmp(&a, &b, sizeof a) == 0;
}

int Record(const char* path) {
  std::ofstream file(path, std::ios::binary);
  for (const Trace& trace : Traces()) {
    const std::vector<TsComplex> out = Resample(trace);
    file.write(reinterpret_cast<const char*>(out.data()),
               static_cast<std::streamsize>(out.size() * sizeof(TsComplex)));
  }
  file.close();
  if (!file) {
    std::fprintf(stderr, "cannot write %s\n", path);
    return 1;
  }
  return 0;
}

int Compare(const char* path) {
  std::ifstream file(path, std::ios::binary);
  const std::string stored((std::istreambuf_iterator<char>(file)),
                           std::istreambuf_iterator<char>());
  std::size_t offset = 0, values = 0, changed = 0;
  double largest = 0.0;
  // Circles through 1 to 6 points sit on short, lopsided grids and amplify rounding; the
  // largest change over the longer traces is reported apart.
  double largestLong = 0.0;
  const char* names[] = {"mag/phase", "circular", "circular, no phase fit"};
  double largestOfType[3] = {0, 0, 0};
  std::size_t largestTrace = 0, largestPoint = 0, traceIndex = 0;
  std::size_t changedOfType[3] = {0, 0, 0};
  for (const Trace& trace : Traces()) {
    const std::vector<TsComplex> out = Resample(trace);
    const std::size_t bytes = out.size() * sizeof(TsComplex);
    if (offset + bytes > stored.size()) {
      std::fprintf(stderr, "%s holds fewer values than the traces give\n", path);
      return 1;
    }
    const int type = trace.extrapolate ? 1 : trace.type;
    for (std::size_t k = 0; k < out.size(); ++k) {
      TsComplex before;
      std::memcpy(&before, stored.data() + offset + k * sizeof before, sizeof before);
      ++values;
      if (SameBits(before, out[k])) continue;
      ++changed;
      ++changedOfType[type];
      const double scale = std::max(before.Mag(), 1e-30);
      const double change = (out[k] - before).Mag() / scale;
      if (!(change <= largest)) {
        largest = change;
        largestTrace = traceIndex;
        largestPoint = k;
      }
      if (!(change <= largestOfType[type])) largestOfType[type] = change;
      if (trace.oldX.size() >= 7 && !(change <= largestLong)) largestLong = change;
    }
    offset += bytes;
    ++traceIndex;
  }
  std::printf("%zu values, %zu changed (%.3f %%), largest change %.3g of the magnitude\n", values,
              changed, 100.0 * changed / values, largest);
  std::printf("  largest at trace %zu, point %zu\n", largestTrace, largestPoint);
  std::printf("  largest over traces of 7 or more old points %.3g\n", largestLong);
  for (int t = 0; t < 3; ++t) {
    std::printf("  %-24s %8zu changed, largest %.3g\n", names[t], changedOfType[t],
                largestOfType[t]);
  }
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  if (argc == 3 && std::strcmp(argv[1], "record") == 0) return Record(argv[2]);
  if (argc == 3 && std::strcmp(argv[1], "compare") == 0) return Compare(argv[2]);
  std::fprintf(stderr, "usage: %s record|compare FILE\n", argv[0]);
  return 2;
}
