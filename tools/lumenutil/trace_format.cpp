#include "lumenutil/trace_format.h"

#include <algorithm>

#include "lumen/core.h"

using LumenUtility::TsComplex;

namespace lumenutil {

const std::vector<std::string>& TraceFormatNames() {
  static const std::vector<std::string> names = {"ri",     "ma",  "db", "logmag", "phase",
                                                 "uphase", "swr", "z",  "y"};
  return names;
}

TraceFormat TraceFormatFromName(const std::string& name) {
  const std::vector<std::string>& names = TraceFormatNames();
  const auto at = std::find(names.begin(), names.end(), name);
  return static_cast<TraceFormat>(at - names.begin());
}

std::vector<std::string> ColumnNames(TraceFormat format, const std::string& trace) {
  switch (format) {
    case TraceFormat::kRI:
      return {trace + "_re", trace + "_im"};
    case TraceFormat::kMA:
      return {trace + "_mag", trace + "_deg"};
    case TraceFormat::kDB:
      return {trace + "_dB", trace + "_deg"};
    case TraceFormat::kLogMag:
      return {trace + "_dB"};
    case TraceFormat::kPhase:
    case TraceFormat::kUnwrappedPhase:
      return {trace + "_deg"};
    case TraceFormat::kSWR:
      return {trace + "_swr"};
    case TraceFormat::kZ:
      return {trace + "_R_ohm", trace + "_X_ohm"};
    case TraceFormat::kY:
      return {trace + "_G_S", trace + "_B_S"};
  }
  return {};
}

std::vector<std::vector<double>> FormatColumns(const std::vector<TsComplex>& data,
                                               TraceFormat format, double z0) {
  const std::size_t n = data.size();
  std::vector<double> first(n), second(n);
  switch (format) {
    case TraceFormat::kUnwrappedPhase: {
      std::vector<float> phase(n);
      LumenUtility::FormatUnwrappedPhase(data.data(), phase.data(), 0, static_cast<int>(n));
      for (std::size_t i = 0; i < n; ++i) first[i] = phase[i] * kDegreesPerRadian;
      return {first};
    }
    case TraceFormat::kMA: {
      const std::vector<double> magnitude = LumenUtility::Mag(data);
      for (std::size_t i = 0; i < n; ++i) second[i] = data[i].Phase() * kDegreesPerRadian;
      return {magnitude, second};
    }
    default:
      break;
  }
  for (std::size_t i = 0; i < n; ++i) {
    const TsComplex& v = data[i];
    switch (format) {
      case TraceFormat::kRI:
        first[i] = v.re;
        second[i] = v.im;
        break;
      case TraceFormat::kDB:
        first[i] = v.LogMag();
        second[i] = v.Phase() * kDegreesPerRadian;
        break;
      case TraceFormat::kLogMag:
        first[i] = v.LogMag();
        break;
      case TraceFormat::kPhase:
        first[i] = v.Phase() * kDegreesPerRadian;
        break;
      case TraceFormat::kSWR:
        first[i] = v.SWR();
        break;
      case TraceFormat::kZ: {
        const TsComplex z = v.Impedance(TsComplex(z0));
        first[i] = z.re;
        second[i] = z.im;
        break;
      }
      case TraceFormat::kY: {
        const TsComplex y = v.Admittance(TsComplex(z0));
        first[i] = y.re;
        second[i] = y.im;
        break;
      }
      default:
        break;
    }
  }
  if (ColumnNames(format, "").size() == 1) return {first};
  return {first, second};
}

}  // namespace lumenutil
