#include "lumenutil/trace_format.h"

#include <stdexcept>

#include "lumen/core.h"

using LumenUtility::TsComplex;

namespace lumenutil {
namespace {

using Columns = std::vector<std::vector<double>>;

// One column, `f` applied to each value.
template <typename F>
Columns OneColumn(const std::vector<TsComplex>& data, F f) {
  std::vector<double> column(data.size());
  for (std::size_t i = 0; i < data.size(); ++i) column[i] = f(data[i]);
  return {column};
}

// Two columns, the real and imaginary part of `f` applied to each value.
template <typename F>
Columns ComplexColumns(const std::vector<TsComplex>& data, F f) {
  std::vector<double> re(data.size()), im(data.size());
  for (std::size_t i = 0; i < data.size(); ++i) {
    const TsComplex v = f(data[i]);
    re[i] = v.re;
    im[i] = v.im;
  }
  return {re, im};
}

double Degrees(const TsComplex& v) { return v.Phase() * kDegreesPerRadian; }

// The RI columns hold the stored floats exactly.
Columns RealImaginary(const std::vector<TsComplex>& data, double) {
  return ComplexColumns(data, [](const TsComplex& v) { return v; });
}

Columns MagnitudeAngle(const std::vector<TsComplex>& data, double) {
  return {LumenUtility::Mag(data), OneColumn(data, Degrees)[0]};
}

Columns DecibelAngle(const std::vector<TsComplex>& data, double) {
  return {OneColumn(data, [](const TsComplex& v) { return v.LogMag(); })[0],
          OneColumn(data, Degrees)[0]};
}

Columns LogMagnitude(const std::vector<TsComplex>& data, double) {
  return OneColumn(data, [](const TsComplex& v) { return v.LogMag(); });
}

Columns Phase(const std::vector<TsComplex>& data, double) { return OneColumn(data, Degrees); }

Columns UnwrappedPhase(const std::vector<TsComplex>& data, double) {
  const std::size_t n = data.size();
  std::vector<float> phase(n);
  LumenUtility::FormatUnwrappedPhase(data.data(), phase.data(), 0, static_cast<int>(n));
  std::vector<double> degrees(n);
  for (std::size_t i = 0; i < n; ++i) degrees[i] = phase[i] * kDegreesPerRadian;
  return {degrees};
}

Columns StandingWaveRatio(const std::vector<TsComplex>& data, double) {
  return OneColumn(data, [](const TsComplex& v) { return v.SWR(); });
}

Columns Impedance(const std::vector<TsComplex>& data, double z0) {
  return ComplexColumns(data, [z0](const TsComplex& v) { return v.Impedance(TsComplex(z0)); });
}

Columns Admittance(const std::vector<TsComplex>& data, double z0) {
  return ComplexColumns(data, [z0](const TsComplex& v) { return v.Admittance(TsComplex(z0)); });
}

constexpr unsigned kBoth = kExportFormat | kPlotFormat;

}  // namespace

const std::vector<TraceFormatRow>& TraceFormats() {
  static const std::vector<TraceFormatRow> rows = {
      {"ri", "", {"_re", "_im"}, RealImaginary, kExportFormat, false, false, PlotKind::kNone,
       "", ""},
      {"ma", "linear magnitude, degrees", {"_mag", "_deg"}, MagnitudeAngle, kExportFormat, false,
       false, PlotKind::kNone, "", ""},
      {"db", "dB, degrees", {"_dB", "_deg"}, DecibelAngle, kExportFormat, false, false,
       PlotKind::kNone, "", ""},
      {"logmag", "", {"_dB"}, LogMagnitude, kBoth, false, false, PlotKind::kOverStimulus,
       "log magnitude", "Magnitude (dB)"},
      {"phase", "", {"_deg"}, Phase, kBoth, false, false, PlotKind::kWrappedPhase, "phase",
       "Phase (degrees)"},
      {"uphase", "unwrapped", {"_deg"}, UnwrappedPhase, kExportFormat, false, false,
       PlotKind::kNone, "", ""},
      {"swr", "", {"_swr"}, StandingWaveRatio, kExportFormat, false, true, PlotKind::kNone, "",
       ""},
      {"z", "ohms", {"_R_ohm", "_X_ohm"}, Impedance, kExportFormat, true, true, PlotKind::kNone,
       "", ""},
      {"y", "siemens", {"_G_S", "_B_S"}, Admittance, kExportFormat, true, true, PlotKind::kNone,
       "", ""},
      {"smith", "", {"_re", "_im"}, RealImaginary, kPlotFormat, false, false,
       PlotKind::kSmithChart, "Smith chart", ""},
      {"nf", "minimum noise figure of the noise data", {}, nullptr, kPlotFormat, false, false,
       PlotKind::kNoiseFigure, "minimum noise figure", "NFmin (dB)"},
  };
  return rows;
}

std::vector<std::string> TraceFormatNames(TraceFormatUse use) {
  std::vector<std::string> names;
  for (const TraceFormatRow& row : TraceFormats()) {
    if (row.uses & use) names.emplace_back(row.name);
  }
  return names;
}

std::string TraceFormatHelp(TraceFormatUse use) {
  std::vector<std::string> items;
  for (const TraceFormatRow& row : TraceFormats()) {
    if (!(row.uses & use)) continue;
    items.emplace_back(row.name);
    if (*row.help != '\0') items.back() += std::string(" (") + row.help + ")";
  }
  std::string text;
  for (std::size_t i = 0; i < items.size(); ++i) {
    if (i > 0) text += ", ";
    if (i > 0 && i + 1 == items.size()) text += "or ";
    text += items[i];
  }
  return text;
}

const TraceFormatRow& TraceFormatNamed(const std::string& name) {
  for (const TraceFormatRow& row : TraceFormats()) {
    if (name == row.name) return row;
  }
  throw std::out_of_range("no trace format '" + name + "'");
}

std::vector<std::string> ColumnNames(const TraceFormatRow& format, const std::string& trace) {
  std::vector<std::string> names;
  for (const char* column : format.columns) names.push_back(trace + column);
  return names;
}

}  // namespace lumenutil
