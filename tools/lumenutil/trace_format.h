// Trace formats of the `snp export` and `snp plot` commands, as one table: each row names a
// format, says what it shows, gives its column headers and turns a complex trace into those
// columns with the library's own formats. The commands take their --format checks, their
// --help lists and their conversions from the table, so a new format is one more row.
// The table is built once and never changed: safe to read from any thread.
#pragma once

#include <string>
#include <vector>

#include "lumen/core/ts_complex.h"

namespace lumenutil {

// 180 / pi, for angles shown in degrees.
constexpr double kDegreesPerRadian = 57.29577951308232;

// The commands that take a --format from the table; a row may serve both.
enum TraceFormatUse : unsigned { kExportFormat = 1u, kPlotFormat = 2u };

// How `snp plot` draws a format.
enum class PlotKind {
  kNone,           // not plotted
  kOverStimulus,   // the one column over the stimulus
  kWrappedPhase,   // degrees over the stimulus on a fixed -180..180 axis, broken at each wrap
  kSmithChart,     // the two columns (re, im) as points of the reflection plane
  kNoiseFigure,    // the noise records' NFmin over their frequencies; no trace conversion
};

// The columns of a trace, each as long as `data`. `z0` is the port's reference resistance in
// ohms (> 0) for the rows that need one, else unused.
using TraceConversion = std::vector<std::vector<double>> (*)(
    const std::vector<LumenUtility::TsComplex>& data, double z0);

struct TraceFormatRow {
  const char* name;                  // the --format value
  const char* help;                  // said after the name in --help; "" when the name says it
  std::vector<const char*> columns;  // appended to the trace name: "_re" gives "S21_re"
  TraceConversion convert;           // one column per entry of `columns`; null for kNoiseFigure
  unsigned uses;                     // TraceFormatUse bits
  bool needsReference;               // convert takes the port's reference resistance
  bool asReflection;                 // meaningful for S-parameters only (taken as reflections)
  PlotKind plot;
  const char* chartTitle;            // after the file name in the plot's title
  const char* axisLabel;             // the plot's y axis
};

// Every format, in the order --help lists them.
const std::vector<TraceFormatRow>& TraceFormats();

// The names of the formats `use` takes, in table order.
std::vector<std::string> TraceFormatNames(TraceFormatUse use);

// The --help text of the formats `use` takes: "ri, ma (linear magnitude, degrees), ..., or y
// (siemens)".
std::string TraceFormatHelp(TraceFormatUse use);

// The row named `name`. Precondition: `name` is in TraceFormats() (the --format check ensures
// it); throws std::out_of_range otherwise.
const TraceFormatRow& TraceFormatNamed(const std::string& name);

// Column headers of trace `trace` in `format`: "S21_re", "S21_im"; "S21_dB"; ...
std::vector<std::string> ColumnNames(const TraceFormatRow& format, const std::string& trace);

}  // namespace lumenutil
