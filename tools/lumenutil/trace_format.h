// Trace formats of the `snp export` and `snp plot` commands: a complex trace turned into one
// or two real columns with the library's own formats.
#pragma once

#include <string>
#include <vector>

#include "lumen/core/ts_complex.h"

namespace lumenutil {

// 180 / pi, for angles shown in degrees.
constexpr double kDegreesPerRadian = 57.29577951308232;

enum class TraceFormat { kRI, kMA, kDB, kLogMag, kPhase, kUnwrappedPhase, kSWR, kZ, kY };

// The --format names: ri ma db logmag phase uphase swr z y.
const std::vector<std::string>& TraceFormatNames();
// Precondition: `name` is one of TraceFormatNames().
TraceFormat TraceFormatFromName(const std::string& name);

// Column headers of trace `trace` in `format`: "S21_re", "S21_im"; "S21_dB"; ...
std::vector<std::string> ColumnNames(TraceFormat format, const std::string& trace);

// The columns of `data` in `format`, each as long as data. Angles are degrees, log
// magnitudes dB, impedances ohms and admittances siemens against `z0` (ohms). The RI
// columns hold the stored floats exactly.
std::vector<std::vector<double>> FormatColumns(const std::vector<LumenUtility::TsComplex>& data,
                                               TraceFormat format, double z0);

}  // namespace lumenutil
