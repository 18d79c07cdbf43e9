#include "data/touchstone_value_text.h"

#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>

#include "lumen/data/sn_parameter.h"

namespace LumenUtility {
namespace {

constexpr double kDegreesPerRadian = 57.295779513082320876798;
// The reader's factor from degrees to radians (CSNParameter::FromPair), to the last digit.
constexpr double kReaderRadiansPerDegree = 0.01745329251994329;
// Two steps either way: the rounding of a held float moves the inverse by at most about one
// step of the file number, and a second step covers the rounding of the inverse itself.
constexpr int kSearchSteps = 2;
// A zero magnitude in dB: 10^(-1000/20) = 1e-50 is far below half the smallest float
// (7e-46), so it reads back as zero, with the sign of zero that the angle gives.
constexpr float kZeroDb = -1000.0f;

template <typename T>
T Step(T value, int steps) {
  const T toward =
      steps < 0 ? -std::numeric_limits<T>::infinity() : std::numeric_limits<T>::infinity();
  for (int i = std::abs(steps); i > 0; --i) value = std::nextafter(value, toward);
  return value;
}

bool SameBits(const TsComplex& x, const TsComplex& y) {
  return std::bit_cast<std::uint32_t>(x.re) == std::bit_cast<std::uint32_t>(y.re) &&
         std::bit_cast<std::uint32_t>(x.im) == std::bit_cast<std::uint32_t>(y.im);
}

double Distance(const TsComplex& x, const TsComplex& y) {
  return std::hypot(static_cast<double>(x.re) - y.re, static_cast<double>(x.im) - y.im);
}

// The magnitude of a pair at angle factor k (the cosine or sine of its angle) must round,
// times k, into the float `part`: narrows [low, high] to the magnitudes that do. False when
// none is left.
bool NarrowMagnitude(float part, double k, double& low, double& high) {
  const double below =
      (static_cast<double>(part) + std::nextafter(part, -std::numeric_limits<float>::infinity())) /
      2;
  const double above =
      (static_cast<double>(part) + std::nextafter(part, std::numeric_limits<float>::infinity())) /
      2;
  if (k == 0) return below <= 0 && 0 <= above;
  low = std::max(low, (k > 0 ? below : above) / k);
  high = std::min(high, (k > 0 ? above : below) / k);
  return low <= high;
}

// Tries the file magnitudes around `start` (in `form`'s own terms) at angle `b`.
bool TryMagnitudes(const TsComplex& value, ESNPForm form, float start, float b, FilePair& found) {
  for (int step : {0, -1, 1, -2, 2}) {
    const float a = Step(start, step);
    const TsComplex read = CSNParameter::FromPair(a, b, form);
    if (SameBits(read, value)) {
      found = {a, b, true, read};
      return true;
    }
  }
  return false;
}

// The pair nearest to `value` among those around the direct inverse (a0, b0).
FilePair NearestPair(const TsComplex& value, ESNPForm form, float a0, float b0) {
  FilePair best;
  double bestDistance = std::numeric_limits<double>::infinity();
  for (int i = -1; i <= 1; ++i) {
    for (int j = -1; j <= 1; ++j) {
      const float a = Step(a0, i);
      const float b = Step(b0, j);
      const TsComplex read = CSNParameter::FromPair(a, b, form);
      const double distance = Distance(read, value);
      if (distance < bestDistance) {
        bestDistance = distance;
        best = {a, b, false, read};
      }
    }
  }
  return best;
}

// Tries the numbers around `start` for one whose reading `read` gives `target` exactly.
template <typename T, typename Read>
FileNumber<T> SearchNumber(T start, double target, Read read) {
  FileNumber<T> best{start, false, read(start)};
  for (int ring = 0; ring <= kSearchSteps; ++ring) {
    for (int sign = -1; sign <= 1; sign += 2) {
      if (ring == 0 && sign > 0) break;
      const T candidate = Step(start, sign * ring);
      const double got = read(candidate);
      if (got == target && std::signbit(got) == std::signbit(target)) {
        return {candidate, true, got};
      }
      if (std::fabs(got - target) < std::fabs(best.readBack - target)) {
        best = {candidate, false, got};
      }
    }
  }
  return best;
}

template <typename T>
void Append(std::string& out, T value) {
  char text[32];
  const std::to_chars_result r = std::to_chars(text, text + sizeof text, value);
  out.append(text, r.ptr);
}

}  // namespace

void AppendShortest(std::string& out, float value) {
  Append(out, value);
}

void AppendShortest(std::string& out, double value) {
  Append(out, value);
}

FilePair PairForValue(TsComplex value, ESNPForm form) {
  if (form == SNP_RI) return {value.re, value.im, true, value};
  const double re = value.re;
  const double im = value.im;
  // atan2 keeps the signs of zero parts: (-0, +0) gives 180 degrees, whose cosine makes the
  // real part -0 again.
  const float angle = static_cast<float>(std::atan2(im, re) * kDegreesPerRadian);
  const auto inForm = [form](double magnitude) {
    if (form == SNP_MA) return static_cast<float>(magnitude);
    return magnitude > 0 ? static_cast<float>(20.0 * std::log10(magnitude)) : kZeroDb;
  };
  FilePair found;
  if (re == 0 && im == 0) {
    if (TryMagnitudes(value, form, inForm(0.0), angle, found)) return found;
  }
  // The magnitude straight from the parts carries the rounding of the larger part, which can
  // be many steps of a fine grid (dB near 0 dB) off what the smaller part needs. So for each
  // angle near the direct one, the magnitudes that put both parts into their floats are
  // worked out first, and only their middle is tried.
  for (int step : {0, -1, 1, -2, 2}) {
    const float b = Step(angle, step);
    const double radians = b * kReaderRadiansPerDegree;
    double low = 0.0;
    double high = std::numeric_limits<double>::infinity();
    if (!NarrowMagnitude(value.re, std::cos(radians), low, high) ||
        !NarrowMagnitude(value.im, std::sin(radians), low, high)) {
      continue;
    }
    if (TryMagnitudes(value, form, inForm((low + high) / 2), b, found)) return found;
  }
  return NearestPair(value, form, inForm(std::hypot(re, im)), angle);
}

FileNumber<double> StimulusInUnit(double x, double multiplier) {
  if (multiplier == 1.0) return {x, true, x};
  return SearchNumber(x / multiplier, x, [multiplier](double q) { return q * multiplier; });
}

FileNumber<float> NoiseFigureDb(float factor) {
  // The reader doubles the figure in float and reads the double as dB of a magnitude.
  const auto read = [](float db) {
    return static_cast<double>(CSNParameter::FromPair(db * 2.0f, 0.0f, SNP_DB).re);
  };
  return SearchNumber(static_cast<float>(10.0 * std::log10(static_cast<double>(factor))),
                      static_cast<double>(factor), read);
}

FileNumber<float> NormalisedResistance(float ohms, double reference) {
  const auto read = [reference](float t) {
    return static_cast<double>(static_cast<float>(t * reference));
  };
  return SearchNumber(static_cast<float>(ohms / reference), static_cast<double>(ohms), read);
}

}  // namespace LumenUtility
