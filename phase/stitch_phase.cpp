#include "lumen/phase/stitch_phase.h"

#include <algorithm>
#include <climits>
#include <cmath>
#include <cstdint>

using LumenUtility::TsComplex;

namespace {

// Stands in for a null point buffer.
TsComplex* ScratchPoint() {
  static TsComplex scratch[StitchPhase::kRotatedValues];
  return scratch;
}

}  // namespace

void StitchPhase::SetState(bool enabled, const std::vector<int>& breaks, int pointsPerBreak,
                           int leadingPoints, int slot, bool hasReferencePoints) {
  *this = StitchPhase();
  m_enabled = enabled;
  m_breaks = breaks;
  m_pointsPerBreak = pointsPerBreak;
  m_leadingPoints = leadingPoints;
  m_slot = slot;
  m_hasReferencePoints = hasReferencePoints;
}

void StitchPhase::StartOfSweep() {
  m_pointCounter = 0;
  m_phaseOffset = 0.0;
}

TsComplex StitchPhase::Rotate(TsComplex v) const {
  const double c = std::cos(m_phaseOffset), s = std::sin(m_phaseOffset);
  return TsComplex(v.re * c - v.im * s, v.re * s + v.im * c);
}

bool StitchPhase::ApplyStitch(TsComplex* point) {
  if (point == nullptr) point = ScratchPoint();
  if (!m_enabled) return false;

  // Saturates instead of overflowing on an endless sweep.
  if (m_pointCounter < INT_MAX) ++m_pointCounter;
  if (m_pointCounter <= m_leadingPoints) return true;

  // 64-bit positions: break positions and counts come from the caller unchecked.
  const std::int64_t p = std::int64_t{m_pointCounter} - m_leadingPoints - 1;
  const std::int64_t perBreak = m_pointsPerBreak;
  const std::int64_t width = m_hasReferencePoints ? perBreak + 2 : perBreak;
  TsComplex zero;
  TsComplex* tracked =
      point == ScratchPoint() && (m_slot < 0 || m_slot >= kRotatedValues) ? &zero : point + m_slot;

  for (std::size_t i = 0; i < m_breaks.size(); ++i) {
    const std::int64_t s = std::int64_t{m_breaks[i]} + 1 + static_cast<std::int64_t>(i) * width;
    if (m_hasReferencePoints) {
      if (p == s) {  // capture: the tracked value as the kept points before the break see it
        m_referenceValue = Rotate(*tracked);
        return true;
      }
      if (p > s && p <= s + perBreak) return true;  // settling
      if (p == s + perBreak + 1) {                  // realign
        // The reference value already carries the previous offset, so the new offset
        // replaces it rather than adding to it.
        m_phaseOffset = (m_referenceValue / *tracked).Phase();
        *tracked = Rotate(*tracked);
        return true;
      }
    } else if (p >= s && p <= s + perBreak - 1) {
      return true;  // settling
    }
  }

  // One cosine and sine for the five values: the trigonometry is most of a kept point's cost.
  const double c = std::cos(m_phaseOffset), s = std::sin(m_phaseOffset);
  for (int k = 0; k < kRotatedValues; ++k) {
    const TsComplex v = point[k];
    point[k] = TsComplex(v.re * c - v.im * s, v.re * s + v.im * c);
  }
  return false;
}

int StitchPhase::ComputeNewSweepSize(int n) const {
  if (!m_enabled) return n;
  const std::int64_t kept = std::int64_t{n} -
                            static_cast<std::int64_t>(m_breaks.size()) * m_pointsPerBreak -
                            m_leadingPoints;
  return static_cast<int>(std::clamp<std::int64_t>(kept, INT_MIN, INT_MAX));
}
