#include "interpolation/monotonic_locator.h"

#include <gtest/gtest.h>

#include <cfloat>
#include <cmath>
#include <limits>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "lumen/interpolation/linear_interpolation.h"

namespace LumenUtility {
namespace {

const double kNaN = std::numeric_limits<double>::quiet_NaN();

// The crossing search in its plain form, kept as the yardstick for the resampler's bisection:
// every segment answers through Segment::Find, every gap between segments is crossed linearly,
// and the first crossing found (the one nearest index 0) is kept.
double PlainSearch(const InputArray& stimulus, double value) {
  const std::vector<Segment>& segments = stimulus.GetSegments();
  double best = DBL_MAX;
  unsigned int base = 0;
  for (std::size_t k = 0; k < segments.size(); ++k) {
    const unsigned int n = segments[k].size();
    if (n == 0) continue;
    const double r = segments[k].Find(value, false);
    if (r >= 0.0 && base + r < best) best = base + r;
    base += n;
    for (std::size_t next = k + 1; next < segments.size(); ++next) {
      if (segments[next].empty()) continue;
      const double low = segments[k].at(n - 1);
      const double t = (value - low) / (segments[next].at(0) - low);
      if (t >= 0.0 && t <= 1.0 && (base - 1) + t < best) best = (base - 1) + t;
      break;
    }
  }
  if (best != DBL_MAX) return best;
  const double toFirst = std::fabs(value - stimulus[0]);
  const double toLast = std::fabs(value - stimulus[stimulus.size() - 1]);
  return toLast <= toFirst ? stimulus.size() - 1.0 : 0.0;
}

// An ordered stimulus of random segments of every type, with repeated values inside
// segments, flat segments and zero-width gaps; values positive so log segments are valid.
InputArray RandomOrderedStimulus(std::mt19937& rng) {
  std::uniform_int_distribution<int> kind(0, 5), count(1, 12);
  std::uniform_real_distribution<double> step(0.0, 3.0);
  auto nextStep = [&] { return rng() % 4 == 0 ? 0.0 : step(rng); };
  InputArray stimulus;
  double current = 1.0;
  const int segmentCount = 1 + static_cast<int>(rng() % 6);
  for (int s = 0; s < segmentCount; ++s) {
    const unsigned int n = count(rng);
    const double start = current + nextStep();
    switch (kind(rng)) {
      case 0:
        stimulus.push_back(Segment(start, start + n * step(rng), n, Linear));
        break;
      case 1:
        stimulus.push_back(Segment(start, start * (1.0 + step(rng)), n, Log));
        break;
      case 2:
        stimulus.push_back(Segment(start, n));
        break;
      default: {
        std::vector<double> points{start};
        while (points.size() < n) points.push_back(points.back() + nextStep());
        stimulus.push_back(Segment(points));
      }
    }
    current = stimulus.back();
  }
  if (rng() % 2 == 0) stimulus.reverse();
  return stimulus;
}

// New points that hit old points exactly, fall between them, in gaps, beyond both ends, and
// repeat; now and then NaN.
InputArray RandomNewStimulus(std::mt19937& rng, const InputArray& old) {
  const double low = std::min(old.front(), old.back());
  const double high = std::max(old.front(), old.back());
  std::uniform_real_distribution<double> anywhere(low - 2.0, high + 2.0);
  std::vector<double> points;
  for (int k = 0; k < 40; ++k) {
    switch (rng() % 5) {
      case 0:
        points.push_back(old[rng() % old.size()]);
        break;
      case 1:
        points.push_back(points.empty() ? low : points.back());
        break;
      case 2:
        points.push_back(rng() % 8 == 0 ? kNaN : high);
        break;
      default:
        points.push_back(anywhere(rng));
    }
  }
  return InputArray(points);
}

std::wstring Describe(const InputArray& stimulus) {
  std::wostringstream text;
  text.precision(17);
  text << stimulus;
  return text.str();
}

// The locator against the plain search on ordered stimuli of every segment type, and the
// resampler's output against the data at the plain search's index.
TEST(MonotonicLocator, ChoosesTheSameCrossingAsThePlainSearch) {
  std::mt19937 rng(20240611);
  for (int trial = 0; trial < 3000; ++trial) {
    const InputArray old = RandomOrderedStimulus(rng);
    const InputArray fresh = RandomNewStimulus(rng, old);
    SCOPED_TRACE(Describe(old));
    MonotonicLocator locator(old);
    // Distinct data per point, so a different crossing shows in the output.
    std::vector<double> in(old.size());
    std::vector<TsComplex> complexIn(old.size());
    for (unsigned int k = 0; k < old.size(); ++k) {
      in[k] = 1000.0 * k + (rng() % 997);
      complexIn[k] = TsComplex(in[k], -0.5 * in[k]);
    }
    std::vector<double> out;
    std::vector<TsComplex> complexOut;
    ASSERT_EQ(LinearInterpolation(old, fresh, in, out), INTERP_DONE);
    ASSERT_EQ(LinearInterpolation(old, fresh, complexIn, complexOut), INTERP_DONE);
    for (unsigned int k = 0; k < fresh.size(); ++k) {
      const double index = PlainSearch(old, fresh[k]);
      ASSERT_EQ(FindNearestIndex(old, 0.0, fresh[k]), index) << "value " << fresh[k];
      ASSERT_EQ(locator.Find(fresh[k]), index) << "value " << fresh[k];
      ASSERT_EQ(out[k], LinearInterpolate(in, index)) << "value " << fresh[k];
      ASSERT_EQ(complexOut[k], LinearInterpolate(complexIn, index)) << "value " << fresh[k];
    }
    // Every answer came from the bisection, none from the plain search standing in.
    ASSERT_EQ(locator.PlainSearchFallbacks(), 0u);
  }
}

}  // namespace
}  // namespace LumenUtility
