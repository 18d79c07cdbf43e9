/** @file */
/// @class PAParameterRecord
/// PAParameterRecord: what a PAComponent keeps for one registered parameter.
///
/// `values` holds one stored value per averaging block, sized by the component between
/// sweeps and never resized during one. `count` is the number of completed values; during a
/// sweep the acquisition thread only advances it, with an atomic increment that publishes the
/// value below it, so a consumer thread that loads `count` may read every value below it.
/// Thread-safety: as PAComponent describes; copying loads `count` once.
#pragma once

#include <atomic>
#include <cstdint>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"

class LUMEN_API PAParameterRecord {
 public:
  PAParameterRecord() = default;
  /// A copy; `count` is read once (acquire), so a record filled on another thread is copied at
  /// one consistent count.
  PAParameterRecord(const PAParameterRecord& other);
  /// Replaces every field by `other`'s, reading its `count` once as the copy constructor does.
  PAParameterRecord& operator=(const PAParameterRecord& other);

  /// The values of the sweep, one per point.
  std::vector<LumenUtility::TsComplex> values;
  std::atomic<std::int32_t> count{0};  ///< completed values in `values`
  int begin = 0;                       ///< `count` at the consumer's last GetAvailableDataCount
  /// Running sum of unit phasors while a parameter that is not ratioed is averaged.
  LumenUtility::TsComplex phasorSum;
  /// Running average of a streamed parameter whose `values` has no element at `count`.
  LumenUtility::TsComplex spill;
};
