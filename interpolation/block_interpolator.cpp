#include "interpolation/block_interpolator.h"

#include <cfloat>
#include <cmath>
#include <optional>

namespace LumenUtility {

BlockInterpolator::BlockInterpolator(int n, const double* x, const TsComplex* d,
                                     InterpolateType type, const LeadPoint* lead)
    : m_n(n), m_x(x), m_d(d), m_type(type), m_lead(lead), m_trig(TrigTable::Get()) {}

void BlockInterpolator::Evaluate(int count, const int* interval, const double* value,
                                 const double* t, const bool* wanted, const bool* magnitudeOnly,
                                 TsComplex* out, double* magnitude) {
  FindSlots(count, interval, wanted);
  BuildArcs();
  EvaluateOnArcs(count, t, wanted);
  EvaluateOnLines(count, value, wanted, magnitudeOnly, magnitude);
  for (int j = 0; j < count; ++j) {
    if (!wanted[j]) continue;
    if (!magnitudeOnly[j]) {
      out[j] = m_value[j];
    } else if (m_onArc[j]) {
      magnitude[j] = Magnitude(m_value[j]);
    }
  }
}

void BlockInterpolator::FindSlots(int count, const int* interval, const bool* wanted) {
  m_slots = 0;
  int last = -1;
  for (int j = 0; j < count; ++j) {
    if (!wanted[j]) continue;
    if (interval[j] != last) {
      last = interval[j];
      m_slotInterval[m_slots++] = last;
    }
    m_slotOf[j] = m_slots - 1;
  }
  // Three consecutive old points per slot; the last interval looks back one point further.
  // Two old points borrow the lead point before them, if there is one.
  for (int s = 0; s < m_slots; ++s) {
    const int i = m_slotInterval[s];
    m_even[s] = false;
    if (m_type == INTERP_MAG_PHASE) continue;
    double x0, x1, x2;
    m_first[s] = -1;
    if (m_n >= 3) {
      const int first = i == m_n - 1 ? i - 2 : i - 1;
      m_first[s] = first;
      x0 = m_x[first], x1 = m_x[first + 1], x2 = m_x[first + 2];
      m_triple[s][0] = m_d[first], m_triple[s][1] = m_d[first + 1];
      m_triple[s][2] = m_d[first + 2];
    } else if (m_lead != nullptr) {
      x0 = m_lead->x, x1 = m_x[0], x2 = m_x[1];
      m_triple[s][0] = m_lead->value, m_triple[s][1] = m_d[0], m_triple[s][2] = m_d[1];
    } else {
      continue;
    }
    // Only exactly even steps: the arc assumes the data turns by equal angles per equal step.
    m_even[s] = x1 - x0 == x2 - x1;
  }
}

void BlockInterpolator::BuildArcs() {
  // The bisector of each slot's second chord P1P2; the first chord P0P1 is the second of the
  // slot before when that circle starts one old point earlier, as in a sweep.
  for (int s = 0; s < m_slots; ++s) {
    if (m_even[s]) m_second[s] = BisectorOf(m_triple[s][1], m_triple[s][2]);
  }
  for (int s = 0; s < m_slots; ++s) {
    if (!m_even[s]) continue;
    const bool shared =
        s > 0 && m_even[s - 1] && m_first[s] >= 0 && m_first[s] == m_first[s - 1] + 1;
    m_firstChord[s] = shared ? m_second[s - 1] : BisectorOf(m_triple[s][0], m_triple[s][1]);
  }
  for (int s = 0; s < m_slots; ++s) {
    if (!m_even[s]) continue;
    const Bisector& first = m_firstChord[s];
    const Bisector& second = m_second[s];
    const TsComplex(&p)[3] = m_triple[s];
    // Either chord lifted: the circle as ArcThrough lifts it.
    m_arc[s] = first.nudged || second.nudged
                   ? ArcThrough(p[0], p[1], p[2])
                   : ArcFromBisectors(first.m, first.c, first.inverse, second.m, second.c, p[0].re,
                                      p[0].im, p[1].re, p[1].im, p[2].re, p[2].im);
  }
  for (int s = 0; s < m_slots; ++s) {
    m_arcUsable[s] = m_even[s] && m_arc[s].TurnsAboveMinimum();
    if (!m_arcUsable[s]) continue;
    const bool lastInterval = m_slotInterval[s] == m_n - 1;
    m_step[s] = lastInterval ? m_arc[s].Turn12(m_trig) : m_arc[s].Turn01(m_trig);
    m_start[s] = lastInterval ? m_arc[s].w1 : m_arc[s].w0;
  }
}

void BlockInterpolator::EvaluateOnArcs(int count, const double* t, const bool* wanted) {
  for (int j = 0; j < count; ++j) {
    m_onArc[j] = false;
    if (!wanted[j]) continue;
    const int s = m_slotOf[j];
    if (!m_arcUsable[s]) continue;
    const double theta = t[j] * m_step[s];
    if (!(std::fabs(theta) > kMinimumArcStep)) continue;
    m_value[j] = RotateOnArc(m_arc[s], m_start[s], theta, m_trig);
    m_onArc[j] = true;
  }
}

void BlockInterpolator::EvaluateOnLines(int count, const double* value, const bool* wanted,
                                        const bool* magnitudeOnly, double* magnitude) {
  // The lines of the slot last asked for: a sweep asks for one slot after the other.
  int lineSlot = -1, magnitudeSlot = -1;
  std::optional<MagPhaseLine> line;
  std::optional<MagnitudeLine> magnitudeLine;
  for (int j = 0; j < count; ++j) {
    if (!wanted[j] || m_onArc[j]) continue;
    const int s = m_slotOf[j];
    const int i = m_slotInterval[s];
    if (magnitudeOnly[j]) {
      if (magnitudeSlot != s) {
        magnitudeLine.emplace(m_x[i - 1], m_x[i], m_d[i - 1], m_d[i]);
        magnitudeSlot = s;
      }
      const double m = magnitudeLine->At(value[j]);
      // A line beyond the float range (or NaN) is as the rounded value makes it.
      if (std::fabs(m) <= FLT_MAX) {
        magnitude[j] = std::fabs(m);
        continue;
      }
    }
    if (lineSlot != s) {
      line.emplace(m_x[i - 1], m_x[i], m_d[i - 1], m_d[i]);
      lineSlot = s;
    }
    m_value[j] = line->At(value[j]);
    if (magnitudeOnly[j]) magnitude[j] = Magnitude(m_value[j]);
  }
}

}  // namespace LumenUtility
