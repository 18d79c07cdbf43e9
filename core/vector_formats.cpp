#include "lumen/core/vector_formats.h"

#include <cmath>
#include <cstddef>

#include "core/phase_unwrap.h"
#include "lumen/platform/error_codes.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/input_array.h"

namespace LumenUtility {

namespace {

constexpr double kHalfPi = 1.5707963267948966;

}  // namespace

void FromLogMag(std::vector<TsComplex>& v) {
  for (TsComplex& z : v) z = TsComplex::FromLogMag(z.re);
}

void ToLogMag(std::vector<TsComplex>& v) {
  const double zeroValue = TsComplex::GetLogMagZeroValue();
  TsComplex* p = v.data();
  const std::size_t n = v.size();
  for (std::size_t i = 0; i < n; ++i) {
    const double power = double{p[i].re} * p[i].re + double{p[i].im} * p[i].im;
    const double dB = power == 0.0 ? zeroValue : 10.0 * std::log10(power);
    p[i] = TsComplex(dB, 0.0);
  }
}

std::vector<float> FormatLogMag(const std::vector<TsComplex>& v) {
  const double zeroValue = TsComplex::GetLogMagZeroValue();
  std::vector<float> out(v.size());
  const TsComplex* p = v.data();
  const std::size_t n = v.size();
  for (std::size_t i = 0; i < n; ++i) {
    const double power = double{p[i].re} * p[i].re + double{p[i].im} * p[i].im;
    out[i] = static_cast<float>(power == 0.0 ? zeroValue : 10.0 * std::log10(power));
  }
  return out;
}

std::vector<double> Mag(const std::vector<TsComplex>& v) {
  std::vector<double> out(v.size());
  for (std::size_t i = 0; i < v.size(); ++i) out[i] = v[i].Mag();
  return out;
}

void Sq(std::vector<TsComplex>& v) {
  for (TsComplex& z : v) z = z * z;
}

void Invert(std::vector<TsComplex>& v) {
  const TsComplex one(1.0);
  for (TsComplex& z : v) z = one / z;
}

void Sqrt(std::vector<TsComplex>& v) {
  for (std::size_t i = 0; i < v.size(); ++i) {
    const TsComplex root = v[i].Sqrt();
    if (i == 0) {
      v[i] = root;
      continue;
    }
    // Of the two roots, keep the one whose angle to the previous result is smaller; an
    // exact tie keeps the principal root.
    const TsComplex& previous = v[i - 1];
    const double keep = std::abs((root / previous).Phase());
    const double flip = std::abs((-root / previous).Phase());
    v[i] = keep > flip ? -root : root;
  }
}

void SqrtEx(const InputArray& stimulus, float expectedPhase, std::vector<TsComplex>& v) {
  Sqrt(v);
  if (v.empty() || stimulus.empty()) return;
  const int n = static_cast<int>(v.size());
  std::vector<float> unwrapped(n);
  FormatUnwrappedPhase(v.data(), unwrapped.data(), 0, n);
  const double slope =
      (double{unwrapped[n - 1]} - unwrapped[0]) / (stimulus.back() - stimulus.front());
  // Phase the line gains from stimulus 0 to the first point, negated.
  const double x = -stimulus.front() * slope;
  const double delta =
      (TsComplex::FromMagPhase(1.0, x) / TsComplex::FromMagPhase(1.0, expectedPhase)).Phase();
  if (std::abs(delta) > kHalfPi) {
    for (TsComplex& z : v) z = -z;
  }
}

std::vector<TsComplex> Mult(const std::vector<TsComplex>& a, const std::vector<TsComplex>& b) {
  if (b.size() < a.size()) {
    throw LumenException(E_INVALIDARG, L"Mult: second trace shorter than the first");
  }
  std::vector<TsComplex> out(a.size());
  for (std::size_t i = 0; i < a.size(); ++i) out[i] = a[i] * b[i];
  return out;
}

std::int32_t FormatUnwrappedPhase(const TsComplex* data, float* phase, int begin, int end) {
  if (begin < 0 || end < begin) return E_INVALIDARG;
  if (begin == end) return S_OK;
  if (data == nullptr || phase == nullptr) return E_INVALIDARG;

  UnwrapPhase(phase, begin, end, [data](int i) { return data[i].Phase(); });
  return S_OK;
}

}  // namespace LumenUtility
