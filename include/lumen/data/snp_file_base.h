/** @file */
/// @class CSnPFileBase
/// CSnPFileBase: reads a Touchstone file (version 1 or 2.0) into the traces of a
/// CSNParameterS, and carries them onto other stimulus points (the usual order is
/// ExtroplateReadSNPFile, then InterpolateReadSNPFile with the same stimulus).
///
/// Reading fills one trace per matrix position, named "S11", "S21", ... ("S10_1" and the like
/// past nine ports), all on the file's stimulus points in Hz (or in the file's own unit when
/// it holds seconds, dBm or point numbers, see GetResultType). Two-port noise data adds
/// three custom traces, one value per noise record on the records' own stimulus points (in
/// the unit of the network data). A failed read leaves the object as it was and says why in
/// GetReadError. Thread-safety: confine each object to one thread. A copyable value.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "lumen/data/sn_parameter_s.h"
#include "lumen/data/snp_types.h"
#include "lumen/export.h"

namespace LumenUtility {
class TouchstoneParser;
}

/// Facts about the last file read successfully, beyond its traces.
struct SnPFileInfo {
  int version = 0;                   ///< 1 or 2; 0 before the first successful read
  std::string stimulusUnit = "GHZ";  ///< the option line's unit token, upper case
  double stimulusMultiplier = 1e9;   ///< stimulus unit of the file, in Hz (1 for SEC, DBM...)
  char parameter = 'S';              ///< S, Y, Z, H or G as the option line names it
  /// Value form of the option line (RI, MA or DB).
  ESNPForm form = SNP_MA;
  double referenceResistance = 50.0;   ///< ohms, the option line's R
  bool referenceResistanceGiven = false;  ///< the option line gave R a value
  std::vector<double> portReferences;  ///< ohms per port from [Reference]; empty without it
  /// [Matrix Format] of a version 2 file; full for version 1.
  SnPMatrixFormat matrixFormat = SNP_MATRIX_FULL;
  int declaredFrequencies = 0;  ///< [Number of Frequencies]; 0 when absent
  int noisePoints = 0;          ///< noise records read (two-port files only)
  bool extraPointsIgnored = false;  ///< network data went on past [Number of Frequencies]
  std::vector<std::string> ignoredOptions;  ///< option-line tokens not understood, upper case
  std::vector<int> pointLines;  ///< line of each network point's stimulus value, from 1
};

class LUMEN_API CSnPFileBase : public CSNParameterS {
 public:
  /// Networks larger than this are refused as implausible (a 999-port matrix already holds
  /// about a million traces).
  static constexpr int kMaxPorts = 999;

  /// Empty traces for `ports` ports; sweep and result type 0. Precondition: 1 <= ports <= 999.
  explicit CSnPFileBase(int ports = 2);

  /// Reads the Touchstone file at `path` (UTF-8 on disk). Version 1 files are read with the
  /// object's port count; a version 2 file's [Number of Ports] replaces it. Returns the
  /// number of stimulus points of network data read, or -1 when the file cannot be opened or
  /// is malformed (GetReadError then says what and where).
  /// The file is read in chunks as it is parsed, so memory stays within what the traces need
  /// plus about 2 MiB, and text that is not Touchstone is refused at its first lines
  /// whatever its size. A line or value longer than 1 MiB is refused.
  int ReadSNPFile(const std::wstring& path);
  /// The same for an open descriptor (a pipe, a device, standard input), read to its end in
  /// chunks; the descriptor stays open.
  int ReadSNPDescriptor(int fd);
  /// The same for file contents already in memory.
  int ReadSNPText(std::string_view text);

  /// Why the last read failed, as "line N: ..." (without a line when none is to blame); empty
  /// after a successful read.
  const std::wstring& GetReadError() const { return m_readError; }
  /// Facts about the last file read successfully.
  const SnPFileInfo& GetFileInfo() const { return m_info; }

  /// Interpolate(stimulus, reset) on every matrix trace; the noise traces stay as read. A new
  /// point within 0.1 stimulus units of an old one takes the old value (right for Hz): a
  /// caller whose steps are near or below one unit (seconds, dBm) scales both stimuli first,
  /// for example into picoseconds, so that 0.1 of the unit is far below a step.
  void InterpolateReadSNPFile(const LumenUtility::InputArray& stimulus, bool reset);
  /// Widens every matrix trace that does not cover the range of `stimulus`: a point at the
  /// target's lowest value is put before the trace's first point, holding that point's value,
  /// and one at the target's highest value after its last point likewise. Traces are taken to
  /// ascend; traces without points, and an empty target, are left untouched, as are the noise
  /// traces.
  void ExtroplateReadSNPFile(const LumenUtility::InputArray& stimulus);

  /// The sweep type a caller stored; never set by reading.
  SweepTypeEnum GetSweepType() const { return m_sweepType; }
  /// Stores a sweep type for callers.
  void SetSweepType(SweepTypeEnum type) { m_sweepType = type; }
  /// What the stimulus is: frequency (Hz) unless the file's unit is seconds, dBm or points.
  ResultType GetResultType() const { return m_resultType; }
  /// Overrides the result type.
  void SetResultType(ResultType type) { m_resultType = type; }

 private:
  /// Stores what `parser` reads; the object stays as it was when that fails.
  int ReadParsed(LumenUtility::TouchstoneParser& parser);

  int m_constructedPorts;
  SweepTypeEnum m_sweepType = SWEEP_UNSPECIFIED;
  ResultType m_resultType = RESULT_FREQUENCY;
  SnPFileInfo m_info;
  std::wstring m_readError;
};

/// The unit an option-line stimulus token stands for, as people write it: L"GHz" for "GHZ",
/// L"s" for "SEC", L"dBm" for "DBM", L"point numbers" for "POINT"; the token itself otherwise.
LUMEN_API std::wstring SnPUnitName(const std::string& unitToken);

/// The port count a file name implies: N of an ".sNp" extension (any case), or -1 when the
/// name has no such extension or N is outside 1..999.
LUMEN_API int SnPPortCountFromFileName(const std::wstring& path);
