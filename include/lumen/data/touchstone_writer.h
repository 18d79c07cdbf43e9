/** @file */
/// @class LumenUtility::TouchstoneWriter
/// TouchstoneWriter: writes the traces of a CSnPFileBase as a Touchstone file, version 1 or
/// 2.0, in RI, MA or DB form, with the frequency in Hz, kHz, MHz or GHz.
///
/// Every number is written as the shortest text that reads back to the very float (values)
/// or double (stimulus) that CSnPFileBase then holds: the value pair or stimulus text is
/// chosen so that the reader's own arithmetic (angle in degrees, 10^(dB/20), scaling by the
/// unit) lands on the stored bits, and among such texts one of fewest digits is taken. So a
/// set read from a file and written in that file's form and unit reads back bit for bit, with
/// numbers no longer than the file had ("-0.00758" dB stays "-0.00758"), writing it again
/// gives the same text, and RI in Hz keeps any finite trace exactly. A float that
/// another form cannot express exactly (MA and DB use 24-bit magnitudes and angles, so some
/// real and imaginary pairs lie between their grid points) is written as the nearest pair;
/// Write reports how many values that touched and the largest relative change (about 1e-7).
///
/// Thread-safety: confine each object to one thread. The writer keeps a reference to the
/// trace set, which must outlive it and stay unchanged while it is used.
#pragma once

#include <cstddef>
#include <ostream>
#include <string>
#include <string_view>

#include "lumen/data/snp_file_base.h"
#include "lumen/data/snp_types.h"
#include "lumen/export.h"

namespace LumenUtility {

/// Unit of a frequency stimulus in the file; the option-line tokens "HZ" ... "GHZ".
enum SnPFrequencyUnit : int {
  SNP_UNIT_HZ = 0,
  SNP_UNIT_KHZ = 1,
  SNP_UNIT_MHZ = 2,
  SNP_UNIT_GHZ = 3,
};

///@{
/// The option-line token of `unit` ("HZ", "KHZ", "MHZ", "GHZ") and its size in Hz (1 to 1e9).
/// Precondition: `unit` is one of the enumerators.
LUMEN_API const char* SnPUnitToken(SnPFrequencyUnit unit);
LUMEN_API double SnPUnitMultiplier(SnPFrequencyUnit unit);
///@}
/// The unit a token names, in any case ("ghz", "GHz"); false for anything else.
LUMEN_API bool SnPUnitFromToken(std::string_view token, SnPFrequencyUnit& unit);
/// The option-line token of a value form ("RI", "MA", "DB"); precondition: a valid form.
LUMEN_API const char* SnPFormToken(ESNPForm form);
/// The form a token names, in any case ("ri", "Ma"); false for anything else.
LUMEN_API bool SnPFormFromToken(std::string_view token, ESNPForm& form);

/// How a trace set is written.
struct TouchstoneWriteOptions {
  int version = 1;  ///< 1, or 2 for Touchstone 2.0
  /// Value form of the data lines: RI, MA (linear magnitude, degrees) or DB (dB, degrees).
  ESNPForm form = SNP_RI;
  /// Unit of a frequency stimulus; a stimulus of seconds, dBm or points (see
  /// CSnPFileBase::GetResultType) is written in its own unit whatever this says.
  SnPFrequencyUnit unit = SNP_UNIT_HZ;
  /// Written first, each line after "! " (a trailing line break adds no empty line).
  std::string comment;
  /// Whether the noise traces of a two-port set are written (as they are when present).
  bool noise = true;
};

/// What a write could not keep bit for bit; all zero for a set read from a file and written
/// in its own form and unit, and for any set written in RI and Hz.
struct TouchstoneWriteResult {
  std::size_t values = 0;            ///< complex values written, network and noise
  std::size_t inexactValues = 0;     ///< of those, values that read back to other floats
  double largestValueChange = 0;     ///< largest |read back - held| / |held| among them
  std::size_t inexactStimulus = 0;   ///< stimulus values the unit cannot hold exactly
  double largestStimulusChange = 0;  ///< largest relative change among them (about 1e-16)
};

class LUMEN_API TouchstoneWriter {
 public:
  /// Takes `file`'s matrix traces, its noise traces (two ports only), its result type and
  /// file facts (parameter letter, reference resistance, per-port references). Checks before
  /// anything is written that the set can be written as asked, and throws
  /// LumenException(LUMEN_E_BOUNDS, message) when it cannot: version or form unknown, traces
  /// of different lengths or on different stimulus points, a value or stimulus that is not
  /// finite, noise traces that do not make three matching traces of a two-port set, an NFmin
  /// that is no positive noise factor, a version 2.0 file without network points, and for
  /// version 1 per-port references that differ or noise data that does not start at or below
  /// the last network stimulus (a version 1 reader would take it for more network points).
  TouchstoneWriter(const CSnPFileBase& file, const TouchstoneWriteOptions& options);

  /// Writes the whole file to `out`. Throws LumenException(LUMEN_E_BOUNDS, "writing the
  /// Touchstone file failed", followed by ": " and the system's reason when the stream's last
  /// system call left one) when the stream fails; what reached it by then is incomplete.
  TouchstoneWriteResult Write(std::ostream& out) const;

 private:
  void CheckNetwork() const;
  /// Also settles the reference resistance of the option line and whether noise is written.
  void CheckNoise();

  const CSnPFileBase& m_file;
  TouchstoneWriteOptions m_options;
  double m_multiplier = 1.0;  ///< the file's stimulus unit, in units of the held stimulus
  double m_reference = 50.0;  ///< the option line's R, ohms
  bool m_writeNoise = false;
};

}  // namespace LumenUtility
