// The first-pass values of circular interpolation, for a block of new points at a time.
#pragma once

#include "interpolation/arc_math.h"
#include "interpolation/circular_core.h"
#include "interpolation/trig_table.h"

namespace LumenUtility {

// Values of new points between old ones: rotation on the circle through three neighbouring
// old points where they are evenly spaced and the circle turns enough, else magnitude/phase
// interpolation.
//
// A block of up to kMaxPoints points is worked in stages, each a short loop over all of the
// block's intervals or points: the circle, its turn and the rotation of one point depend on
// each other and take about 250 processor cycles one after the other, while those of
// neighbouring intervals do not, so stage by stage the processor overlaps several intervals
// instead of waiting on each. Points in the same interval share its circle and lines.
// Thread-safety: confine to one thread. Ownership: borrows the old stimulus, data and lead
// point, which must outlive it; holds about 12 KB of per-block state.
class BlockInterpolator {
 public:
  static constexpr int kMaxPoints = 64;

  // n >= 2 old points, ascending stimulus x; `lead` (may be null) stands before x[0] as the
  // first point of the circle when n == 2.
  BlockInterpolator(int n, const double* x, const TsComplex* d, InterpolateType type,
                    const LeadPoint* lead);
  BlockInterpolator(const BlockInterpolator&) = delete;
  BlockInterpolator& operator=(const BlockInterpolator&) = delete;

  // For each of `count` (<= kMaxPoints) points j with wanted[j]: the value at stimulus
  // value[j] (beyond the interval it extrapolates) of old interval i = interval[j]
  // (1 .. n - 1), whose share of the interval t[j] = (value[j] - x[i - 1]) / (x[i] - x[i - 1]),
  // written to out[j], or where magnitudeOnly[j] only its magnitude, to magnitude[j]. Off the
  // arc the magnitude is read from the magnitude line, without the turn: rotating changes the
  // value's magnitude only by rounding its parts to float (less than 1.2e-7 of it).
  void Evaluate(int count, const int* interval, const double* value, const double* t,
                const bool* wanted, const bool* magnitudeOnly, TsComplex* out, double* magnitude);

 private:
  // The old interval of each slot, and whether its three points are evenly spaced.
  void FindSlots(int count, const int* interval, const bool* wanted);
  void BuildArcs();
  void EvaluateOnArcs(int count, const double* t, const bool* wanted);
  void EvaluateOnLines(int count, const double* value, const bool* wanted,
                       const bool* magnitudeOnly, double* magnitude);

  const int m_n;
  const double* const m_x;
  const TsComplex* const m_d;
  const InterpolateType m_type;
  const LeadPoint* const m_lead;
  const TrigTable& m_trig;

  // Per slot: one old interval the block's points fall into.
  int m_slots = 0;
  int m_slotInterval[kMaxPoints];
  TsComplex m_triple[kMaxPoints][3];
  int m_first[kMaxPoints];  // old index of the triple's first point; -1 for the lead point
  bool m_even[kMaxPoints];
  Bisector m_firstChord[kMaxPoints];  // of P0P1
  Bisector m_second[kMaxPoints];      // of P1P2
  Arc m_arc[kMaxPoints];
  bool m_arcUsable[kMaxPoints];
  double m_step[kMaxPoints];      // turn across the interval, radians
  TsComplex m_start[kMaxPoints];  // interval start relative to the centre
  // Per point.
  int m_slotOf[kMaxPoints];
  bool m_onArc[kMaxPoints];
  TsComplex m_value[kMaxPoints];
};

}  // namespace LumenUtility
