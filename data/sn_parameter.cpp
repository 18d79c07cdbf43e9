#include "lumen/data/sn_parameter.h"

#include <algorithm>
#include <cmath>

#include "lumen/interpolation/circular_interpolation.h"

using LumenUtility::InputArray;
using LumenUtility::TsComplex;

CSNParameter::CSNParameter(const InputArray& stimulus)
    : m_data(stimulus.size()), m_spareData(stimulus.size()) {}

TsComplex CSNParameter::FromPair(float a, float b, ESNPForm form) {
  constexpr double kRadiansPerDegree = 0.01745329251994329;
  switch (form) {
    case SNP_RI:
      return TsComplex(a, b);
    case SNP_MA: {
      const double angle = b * kRadiansPerDegree;
      return TsComplex(a * std::cos(angle), a * std::sin(angle));
    }
    case SNP_DB: {
      const double magnitude = std::pow(10.0, a * 0.05);
      const double angle = b * kRadiansPerDegree;
      return TsComplex(magnitude * std::cos(angle), magnitude * std::sin(angle));
    }
  }
  return TsComplex();
}

void CSNParameter::LoadSNP(std::vector<float>& a, std::vector<float>& b, const InputArray& stimulus,
                           ESNPForm form) {
  m_stimulus = stimulus;
  if (form != SNP_RI && form != SNP_MA && form != SNP_DB) return;
  const std::size_t count = std::min({m_data.size(), a.size(), b.size()});
  for (std::size_t i = 0; i < count; ++i) m_data[i] = FromPair(a[i], b[i], form);
}

void CSNParameter::Interpolate(const InputArray& stimulus, bool reset) {
  const unsigned int oldCount =
      std::min(m_stimulus.size(), static_cast<unsigned int>(m_data.size()));
  if (stimulus.empty() || oldCount == 0) return;
  std::vector<TsComplex> out(stimulus.size());
  bool interpolated = false;
  // Out of range leaves `out` at zeros, which is what the trace then holds.
  LumenUtility::CircularInterpolation(static_cast<std::int32_t>(oldCount), m_stimulus.GetRawArray(),
                                      &m_data[0].re, static_cast<std::int32_t>(stimulus.size()),
                                      stimulus.GetRawArray(), &out[0].re, &interpolated,
                                      LumenUtility::INTERP_CIRCULAR);
  std::wstring name = std::move(m_name);
  if (reset) *this = CSNParameter(stimulus);
  m_data = std::move(out);
  m_stimulus = stimulus;
  m_name = std::move(name);
}
