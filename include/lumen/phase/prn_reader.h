// PrnReader: the phase calibration file of the external phase reference.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/export.h"
#include "lumen/stimulus/input_array.h"

/// Reads the phase reference's calibration file (a PRN file) and gives its calibrated phase
/// on any stimulus.
///
/// A PRN file is text with one calibration point per line: frequency in Hz, a comma, phase in
/// degrees, for example "1e9, 90". Pieces are separated by commas (empty pieces do not count)
/// and further pieces are ignored. A line is skipped when it has fewer than two pieces, when a
/// piece holds no finite number at its start (headers, comments), or when the frequency is 0.
/// The reader keeps the points in the file's line order, each phase as its unit phasor.
///
/// Thread-safety: confine each object to one thread; const calls may run on several threads
/// at once. Ownership: a plain value; copies share the stimulus's storage copy-on-write.
class LUMEN_API PrnReader {
 public:
  /// The thrown code of GetPhase: the stimulus asked for is not covered by the file.
  static constexpr std::int32_t kPhaseLookupFailed = static_cast<std::int32_t>(0xE802029D);

  /// An empty reader: no calibration points.
  PrnReader() = default;
  /// Copies the points and their values.
  PrnReader(const PrnReader&) = default;
  /// Copies the points and their values.
  PrnReader& operator=(const PrnReader&) = default;
  /// Nothing beyond the members to release.
  ~PrnReader() = default;

  /// Reads the PRN file at `path` (UTF-8 on disk), replacing every point loaded before.
  /// Returns true when the file could be opened and read, even if no line held a point (the
  /// reader is then empty). Returns false when it cannot be opened or read; the file error
  /// goes to the debug print (slot DebugPrintPhaseReference) and the reader is unchanged.
  /// Throws std::bad_alloc, and CFileException when the debug print's file cannot be written.
  bool LoadFile(const std::wstring& path);

  /// The calibrated unit phasors at the points of `stimulus` (any unit the file's frequencies
  /// share, normally Hz), by circular interpolation between the file's points; one value per
  /// stimulus point. The second and third arguments are not used. Throws kPhaseLookupFailed
  /// (0xE802029D) as a bare std::int32_t when the reader holds no points or when the first or
  /// last stimulus point lies outside the file's frequency range.
  std::vector<LumenUtility::TsComplex> GetPhase(
      const LumenUtility::InputArray& stimulus, const LumenUtility::InputArray& unused = {},
      const LumenUtility::TsComplex* unusedData = nullptr) const;

  /// The frequencies of the points loaded, in the file's line order.
  const LumenUtility::InputArray& GetStimulus() const { return m_stimulus; }
  /// The unit phasor of each point loaded, in the order of GetStimulus().
  const std::vector<LumenUtility::TsComplex>& GetValues() const { return m_values; }

 private:
  LumenUtility::InputArray m_stimulus;
  std::vector<LumenUtility::TsComplex> m_values;
};
