/** @file */
/// @class PAComponent
/// PAComponent: collects phase-coherent measurement data while a sweep runs.
///
/// The acquisition hands it raw per-point receiver buffers (PutData). Each point is first
/// phase-stitched (StitchPhase); each registered PAParameter whose acquisition ID is the
/// current one is then formed from it (PAParameter::RatioBucket) and averaged over a fixed
/// number of consecutive points into one stored value. The component cycles through the
/// distinct IDs of its parameters, giving each one averaging block before moving to the next.
/// Completed values either stay in a per-parameter array, which a consumer thread reads while
/// the sweep runs, or stream to the host's FIFO (AI_IFIFO) in runs of up to 20001 values.
/// Host objects (ITestSet, AI_IFIFO) are looked up in the capabilities table, category 3,
/// index 0; the component never owns them.
///
/// Consumer protocol: GetBegin (where the consumer stopped last time), GetAvailableDataCount
/// (how far the data go now, which becomes the next begin), then GetDataByRef, whose elements
/// below that count are final.
///
/// Thread-safety: one acquisition thread calls PutData while one consumer thread may call
/// GetBegin, GetAvailableDataCount and GetDataByRef; every other operation, copying included,
/// needs the component to itself. The FIFO staging buffer and the receiver substitution are
/// process-wide: only one component may receive data at a time.
#pragma once

#include <cstdint>
#include <map>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"
#include "lumen/phase/pa_parameter.h"
#include "lumen/phase/pa_parameter_record.h"
#include "lumen/phase/pa_receiver.h"
#include "lumen/phase/stitch_phase.h"

class LUMEN_API PAComponent {
 public:
  /// Values staged before the FIFO is written.
  static constexpr int kFifoRun = 20001;

  /// No parameters, stitching off, every counter 0. Reserves the process-wide FIFO staging
  /// buffer and, on the first construction in the process, sets up the receiver substitution
  /// from the test set (none when no test set is registered).
  PAComponent();
  ///@{
  /// Copies the parameter set, records and stitching state; not for a component that is being
  /// filled on another thread.
  PAComponent(const PAComponent&) = default;
  PAComponent& operator=(const PAComponent&) = default;
  ///@}
  ~PAComponent() = default;

  /// Registers `p` with an empty record unless an equal parameter (by the map's ordering) is
  /// registered already, which keeps its record and data.
  void AddParameter(const PAParameter& p);
  /// Removes every parameter and its data.
  void ClearParameterData();

  /// Starts a sweep: every record gets `points` values (0 + 0j for new ones) and count and
  /// begin 0; averaging restarts with `averagingCount` samples per value (values below 1 count
  /// as 1); stitching restarts. The bool is not used; the current ID stays (ResetCurrentID).
  /// Throws LumenException(E_INVALIDARG) for negative `points`, changing nothing.
  void SetSweepParameters(int points, bool unused, int averagingCount);

  /// Consumes `count` point buffers, point k starting at points + k * stride (stride counted
  /// in values). The buffers are modified in place by the receiver substitution and by
  /// stitching. Each buffer must hold every slot the test set names and StitchPhase's rotated
  /// values. With `toFifo`, completed values go to the FIFO (one Write per 20001 values and
  /// one with the rest at the end of the call) and counts stay; without, they are stored and
  /// counted, and values completing past the end of a record's array are dropped.
  /// A null `points` or a count below 1 does nothing. Throws LumenException(E_POINTER), having
  /// consumed nothing, when a parameter is registered and no test set is, or when streaming
  /// and no FIFO is registered; errors of host objects pass through.
  void PutData(const LumenUtility::TsComplex* points, int count, int stride, bool mappingFlag,
               bool toFifo);

  /// -1 when `p` is not registered; otherwise the record's count, which also becomes its begin.
  int GetAvailableDataCount(const PAParameter& p);
  /// The record's begin; -1 when `p` is not registered.
  int GetBegin(const PAParameter& p) const;
  /// The record's values; an empty array when `p` is not registered. The reference stays
  /// valid until the parameter set changes.
  const std::vector<LumenUtility::TsComplex>& GetDataByRef(const PAParameter& p) const;
  /// True when `p` is registered.
  bool IsParameterAvailable(const PAParameter& p) const;

  /// Every parameter's numerator and, when ratioed, denominator, in key order; duplicates kept.
  std::vector<PAReceiver> GetReceivers() const;

  /// 1 switches the receiver substitution on for PutData; other values switch it off.
  void SetReferenceReceiverIndex(int index) { m_referenceReceiverIndex = index; }
  /// The ID cycle restarts at the smallest ID.
  void ResetCurrentID() { m_currentIDIndex = 0; }

  /// Switches stitching on, tracking the phase of p's numerator receiver (its slot with
  /// mapping flag false) across `breaks`; see StitchPhase::SetState. Throws as
  /// PAReceiver::ToSlot does, leaving the stitch state as it was.
  void SetPhaseStitch(PAParameter& p, const std::vector<int>& breaks, int pointsPerBreak,
                      int leadingPoints, bool hasReferencePoints);
  /// The phase stitching state.
  const StitchPhase& GetStitchPhaseComponent() const { return m_stitch; }

 private:
  using ParameterMap = std::map<PAParameter, PAParameterRecord>;

  /// Forms and folds point B into every parameter of the current ID.
  void CollectPoint(const LumenUtility::TsComplex* point, bool mappingFlag, bool toFifo);
  void WriteToFifo(LumenUtility::TsComplex value);
  void FlushToFifo();
  void CalculateUniqueIDs();

  ParameterMap m_parameters;
  std::vector<int> m_uniqueIDs;  ///< ascending
  StitchPhase m_stitch;
  int m_averagingCount = 0;
  int m_averagingIndex = 0;   ///< 0-based position in the current averaging block
  int m_currentIDIndex = 0;   ///< into m_uniqueIDs
  int m_referenceReceiverIndex = 0;
};
