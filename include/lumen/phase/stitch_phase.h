/** @file */
/// @class StitchPhase
/// StitchPhase: makes the phase of a phase-coherent sweep continuous across band breaks.
///
/// The acquisition inserts extra points into a sweep: leading points at its start and, at
/// every band break, a run of settling points, optionally framed by a capture point just
/// before the break and a realign point just after it, both measuring the tracked receiver.
/// ApplyStitch is called once per acquired point in acquisition order; it says which points to
/// discard, measures the phase jump between capture and realign points, and rotates every kept
/// point by the accumulated correction (radians).
/// Thread-safety: confine to one thread. Null points share one process-wide scratch buffer,
/// so only one thread at a time may pass null points.
#pragma once

#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"

class LUMEN_API StitchPhase {
 public:
  /// Number of values of a point buffer that a kept point has rotated.
  static constexpr int kRotatedValues = 5;

  /// Disabled, every number 0, no breaks, reference value 0 + 0j.
  StitchPhase() = default;

  /// Resets every member to the default state, then stores the arguments. `breaks` holds, per
  /// band break and ascending, the 0-based position among kept points of the last kept point
  /// before it. `pointsPerBreak` settling points are discarded at each break (plus a capture
  /// and a realign point when `hasReferencePoints`), `leadingPoints` at the start of each
  /// sweep. `slot` is the position of the tracked receiver in a point buffer.
  void SetState(bool enabled, const std::vector<int>& breaks, int pointsPerBreak,
                int leadingPoints, int slot, bool hasReferencePoints);

  /// Starts a sweep: point counter and phase offset back to 0; the reference value stays.
  void StartOfSweep();

  /// Processes the next point of the sweep. Returns true when the caller must discard it;
  /// false when it is kept, its first kRotatedValues values then rotated in place by the phase
  /// offset. Disabled, every point is kept untouched. A null point is processed against a
  /// process-wide scratch buffer of kRotatedValues zeros (a tracked slot outside it reads as
  /// zero). Otherwise `point` must hold the tracked slot and kRotatedValues values.
  bool ApplyStitch(LumenUtility::TsComplex* point);

  /// Points a sweep of n acquired points keeps: n less the settling points of every break and
  /// the leading points when enabled (capture and realign points are not subtracted), n when
  /// disabled. Clamped to the int range.
  int ComputeNewSweepSize(int n) const;

  /// The `enabled` flag of the last SetState (false until then).
  bool IsEnabled() const { return m_enabled; }
  /// Whether each break carries a capture and a realign point.
  bool HasReferencePoints() const { return m_hasReferencePoints; }
  /// Points discarded at the start of each sweep.
  int GetLeadingPoints() const { return m_leadingPoints; }
  /// Settling points discarded at each break.
  int GetPointsPerBreak() const { return m_pointsPerBreak; }
  /// Position of the tracked receiver in a point buffer.
  int GetSlot() const { return m_slot; }
  /// Points processed in the current sweep.
  int GetPointCounter() const { return m_pointCounter; }
  double GetPhaseOffset() const { return m_phaseOffset; }  ///< radians
  /// The break points, as given.
  const std::vector<int>& GetBreaks() const { return m_breaks; }
  /// The tracked receiver's value at the last capture point, with the phase offset applied.
  LumenUtility::TsComplex GetReferenceValue() const { return m_referenceValue; }

 private:
  /// v * e^(j * phaseOffset), computed in double.
  LumenUtility::TsComplex Rotate(LumenUtility::TsComplex v) const;

  int m_leadingPoints = 0;
  bool m_enabled = false;
  bool m_hasReferencePoints = false;
  int m_pointsPerBreak = 0;
  int m_slot = 0;
  int m_pointCounter = 0;
  double m_phaseOffset = 0.0;
  std::vector<int> m_breaks;
  LumenUtility::TsComplex m_referenceValue;
};
