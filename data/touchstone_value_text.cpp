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

// The file magnitudes (linear, or dB) that put both parts of a value into their floats when
// the angle is `b` degrees.
struct Window {
  double low;
  double high;
  double Middle() const { return std::isfinite(low) ? (low + high) / 2 : high; }
  bool Holds(double a) const { return low <= a && a <= high; }
};

bool MagnitudeWindow(const TsComplex& value, ESNPForm form, float b, Window& window) {
  const double radians = b * kReaderRadiansPerDegree;
  double low = 0.0;
  double high = std::numeric_limits<double>::infinity();
  if (!NarrowMagnitude(value.re, std::cos(radians), low, high) ||
      !NarrowMagnitude(value.im, std::sin(radians), low, high)) {
    return false;
  }
  if (form == SNP_DB) {
    window = {low > 0 ? 20.0 * std::log10(low) : -std::numeric_limits<double>::infinity(),
              20.0 * std::log10(high)};
  } else {
    window = {low, high};
  }
  return true;
}

// `value` rounded to `digits` significant digits and read as the reader reads a number.
template <typename T>
T RoundedTo(double value, int digits) {
  char text[48];
  const std::to_chars_result r =
      std::to_chars(text, text + sizeof text, value, std::chars_format::scientific, digits - 1);
  T parsed = 0;
  std::from_chars(text, r.ptr, parsed);
  return parsed;
}

// Roundings of one value to 1, 2, ... significant digits, by arithmetic (some ten times
// faster than through text): the integer of `digits` digits divided by an exact power of ten
// is the double nearest the decimal, and its float is the decimal's float but in a
// double-rounding tie, which only makes one candidate less good.
template <typename T>
class Rounding {
 public:
  explicit Rounding(double value)
      : m_value(value),
        m_exponent(value == 0 || !std::isfinite(value)
                       ? 0
                       : static_cast<int>(std::floor(std::log10(std::fabs(value))))) {}

  T To(int digits) const {
    static constexpr double kPowers[] = {1e0,  1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                         1e8,  1e9,  1e10, 1e11, 1e12, 1e13, 1e14, 1e15,
                                         1e16, 1e17, 1e18, 1e19, 1e20, 1e21, 1e22};
    if (m_value == 0 || !std::isfinite(m_value)) return static_cast<T>(m_value);
    const int shift = digits - 1 - m_exponent;
    if (shift > 22 || shift < -22) return RoundedTo<T>(m_value, digits);
    const double power = kPowers[shift >= 0 ? shift : -shift];
    return static_cast<T>(shift >= 0 ? std::nearbyint(m_value * power) / power
                                     : std::nearbyint(m_value / power) * power);
  }

 private:
  double m_value;
  int m_exponent;
};

template <typename T>
bool SameNumber(T a, T b) {
  return a == b && std::signbit(a) == std::signbit(b);
}

// Tries the file magnitudes around `middle` (in `form`'s own terms) at angle `b`.
bool TryMagnitudes(const TsComplex& value, ESNPForm form, double middle, float b, FilePair& found) {
  const float start = static_cast<float>(middle);
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

// Characters of the shortest text of `value`.
std::size_t TextLength(float value) {
  char text[32];
  return static_cast<std::size_t>(std::to_chars(text, text + sizeof text, value).ptr - text);
}

constexpr int kFloatDigits = 9;  // enough for any float

// With `pair` exact and `window` the exact magnitudes at its angle: its magnitude replaced by
// the one of fewest digits, rounded from the window's middle, that still reads back exactly.
void ShortenMagnitude(const TsComplex& value, ESNPForm form, const Window& window, FilePair& pair) {
  const Rounding<float> middle(window.Middle());
  for (int digits = 1; digits <= kFloatDigits; ++digits) {
    const float a = middle.To(digits);
    if (SameNumber(a, pair.a)) return;
    if (window.Holds(a) && SameBits(CSNParameter::FromPair(a, pair.b, form), value)) {
      pair.a = a;
      return;
    }
  }
}

// With `found` exact and `window` the exact magnitudes at its angle: the exact pair of
// shortest text among the angles rounded from the exact angle `degrees` to 1, 2, ... digits,
// each with its shortest magnitude. A file that wrote "0.5 45" gets "0.5 45" again, not the
// 45.0000001 that the float parts give.
void Shorten(const TsComplex& value, ESNPForm form, double degrees, const Window& window,
             FilePair& found) {
  ShortenMagnitude(value, form, window, found);
  std::size_t bestLength = TextLength(found.a) + TextLength(found.b);
  const Rounding<float> angle(degrees);
  float previous = std::numeric_limits<float>::quiet_NaN();
  for (int digits = 1; digits <= kFloatDigits; ++digits) {
    // The angle takes at least `digits` characters and the magnitude one.
    if (static_cast<std::size_t>(digits) + 1 >= bestLength) break;
    const float b = angle.To(digits);
    if (SameNumber(b, previous) || SameNumber(b, found.b)) continue;
    previous = b;
    Window at;
    FilePair candidate;
    if (!MagnitudeWindow(value, form, b, at) ||
        !TryMagnitudes(value, form, at.Middle(), b, candidate)) {
      continue;
    }
    ShortenMagnitude(value, form, at, candidate);
    const std::size_t length = TextLength(candidate.a) + TextLength(candidate.b);
    if (length < bestLength) {
      found = candidate;
      bestLength = length;
    }
  }
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

// The number whose reading `read` is `target` exactly: tried around `middle` (the exact
// inverse), then shortened to the fewest digits that still read back exactly.
template <typename T, typename Read>
FileNumber<T> SearchNumber(double middle, double target, Read read) {
  const T start = static_cast<T>(middle);
  FileNumber<T> best{start, false, read(start)};
  for (int ring = 0; ring <= kSearchSteps && !best.exact; ++ring) {
    for (int sign = -1; sign <= 1; sign += 2) {
      if (ring == 0 && sign > 0) break;
      const T candidate = Step(start, sign * ring);
      const double got = read(candidate);
      if (SameNumber(got, target)) {
        best = {candidate, true, got};
        break;
      }
      if (std::fabs(got - target) < std::fabs(best.readBack - target)) {
        best = {candidate, false, got};
      }
    }
  }
  if (!best.exact) return best;
  const int maxDigits = std::numeric_limits<T>::max_digits10;
  const Rounding<T> rounding(middle);
  for (int digits = 1; digits <= maxDigits; ++digits) {
    const T candidate = rounding.To(digits);
    if (SameNumber(candidate, best.text)) break;
    if (SameNumber(read(candidate), target)) {
      best.text = candidate;
      break;
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
  const double degrees = std::atan2(im, re) * kDegreesPerRadian;
  const float angle = static_cast<float>(degrees);
  FilePair found;
  if (re == 0 && im == 0) {
    const double zero = form == SNP_MA ? 0.0 : kZeroDb;
    if (TryMagnitudes(value, form, zero, angle, found)) return found;
  }
  // The magnitude straight from the parts carries the rounding of the larger part, which can
  // be many steps of a fine grid (dB near 0 dB) off what the smaller part needs. So for each
  // angle near the direct one, the magnitudes that put both parts into their floats are
  // worked out first, and their middle is tried.
  for (int step : {0, -1, 1, -2, 2}) {
    const float b = Step(angle, step);
    Window window;
    if (MagnitudeWindow(value, form, b, window) &&
        TryMagnitudes(value, form, window.Middle(), b, found)) {
      Shorten(value, form, degrees, window, found);
      return found;
    }
  }
  const double magnitude = std::hypot(re, im);
  return NearestPair(value, form,
                     form == SNP_MA  ? static_cast<float>(magnitude)
                     : magnitude > 0 ? static_cast<float>(20.0 * std::log10(magnitude))
                                     : kZeroDb,
                     angle);
}

FileNumber<double> StimulusInUnit(double x, double multiplier) {
  // In the stimulus's own unit the shortest text of x reads back as x itself.
  if (multiplier == 1.0) return {x, true, x};
  return SearchNumber<double>(x / multiplier, x, [multiplier](double q) { return q * multiplier; });
}

FileNumber<float> NoiseFigureDb(float factor) {
  // The reader doubles the figure in float and reads the double as dB of a magnitude.
  const auto read = [](float db) {
    return static_cast<double>(CSNParameter::FromPair(db * 2.0f, 0.0f, SNP_DB).re);
  };
  return SearchNumber<float>(10.0 * std::log10(static_cast<double>(factor)),
                             static_cast<double>(factor), read);
}

FileNumber<float> NormalisedResistance(float ohms, double reference) {
  const auto read = [reference](float t) {
    return static_cast<double>(static_cast<float>(t * reference));
  };
  return SearchNumber<float>(ohms / reference, static_cast<double>(ohms), read);
}

}  // namespace LumenUtility
