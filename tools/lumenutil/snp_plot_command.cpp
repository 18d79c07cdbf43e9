#include <cmath>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "lumenutil/noise_records.h"
#include "lumenutil/snp_command_io.h"
#include "lumenutil/snp_commands.h"
#include "lumenutil/snp_file.h"
#include "lumenutil/svg_chart.h"
#include "lumenutil/trace_format.h"

namespace lumenutil {
namespace {

// More traces than this make a legend nobody can read and lines nobody can tell apart.
constexpr std::size_t kMaxTraces = 64;

struct PlotOptions {
  std::string path;
  std::string output;
  std::string format = "logmag";
  std::string params;
  int ports = 0;
};

std::string BaseName(const std::string& path) {
  const std::size_t slash = path.rfind('/');
  return slash == std::string::npos ? path : path.substr(slash + 1);
}

// Breaks the line where a wrapped phase jumps by more than half a turn, so the wrap is not
// drawn as a vertical stroke across the chart.
ChartSeries BreakAtWraps(ChartSeries s) {
  ChartSeries out{s.name, {}, {}};
  for (std::size_t i = 0; i < s.y.size(); ++i) {
    if (i > 0 && std::fabs(s.y[i] - s.y[i - 1]) > 180) {
      out.x.push_back(NAN);
      out.y.push_back(NAN);
    }
    out.x.push_back(s.x[i]);
    out.y.push_back(s.y[i]);
  }
  return out;
}

// A chart over the stimulus, titled and labelled as `format` says.
CartesianChart ChartOver(const StimulusAxis& axis, const std::string& path,
                         const TraceFormatRow& format) {
  CartesianChart chart;
  chart.title = BaseName(path) + ": " + format.chartTitle;
  chart.xQuantity = axis.quantity;
  chart.xUnit = axis.unit;
  chart.xSiPrefix = axis.siPrefix;
  chart.yLabel = format.axisLabel;
  return chart;
}

std::string RenderNoiseFigure(const PlotOptions& options, const CSnPFileBase& file,
                              const TraceFormatRow& format) {
  ChartSeries nf{"NFmin", {}, {}};
  for (const NoiseRecord& r : RequireNoiseRecords(file, options.path)) {
    nf.x.push_back(r.stimulus);
    nf.y.push_back(r.nfMinDb);
  }
  CartesianChart chart = ChartOver(AxisOf(file.GetResultType()), options.path, format);
  chart.series.push_back(std::move(nf));
  return RenderCartesianSvg(chart);
}

std::string Render(const PlotOptions& options) {
  const TraceFormatRow& format = TraceFormatNamed(options.format);
  const CSnPFileBase file = ReadTouchstone(options.path, options.ports);
  if (format.plot == PlotKind::kNoiseFigure) return RenderNoiseFigure(options, file, format);
  std::vector<MatrixPosition> positions = SelectPositions(options.params, file);
  const bool smith = format.plot == PlotKind::kSmithChart;
  if (smith && options.params.empty()) {
    // A Smith chart shows reflections; transmissions would only cross it.
    std::erase_if(positions, [](const MatrixPosition& p) { return p.row != p.column; });
  }
  if (positions.size() > kMaxTraces) {
    throw std::runtime_error(options.path + ": " + std::to_string(positions.size()) +
                             " traces are too many for one plot (at most " +
                             std::to_string(kMaxTraces) +
                             "); choose the traces with --params, e.g. --params S21,S12");
  }
  const std::vector<double> x = file.GetParam(SNP_S11).GetStimulus().GetArray();
  std::vector<ChartSeries> series;
  for (const MatrixPosition& p : positions) {
    const double z0 = format.needsReference ? PortReference(file, p.row, options.path) : 0.0;
    std::vector<std::vector<double>> columns = format.convert(TraceAt(file, p).GetData(), z0);
    if (smith) {
      series.push_back({p.name, std::move(columns[0]), std::move(columns[1])});
    } else {
      ChartSeries trace{p.name, x, std::move(columns[0])};
      const bool wraps = format.plot == PlotKind::kWrappedPhase;
      series.push_back(wraps ? BreakAtWraps(std::move(trace)) : std::move(trace));
    }
  }
  if (smith) return RenderSmithSvg(BaseName(options.path) + ": " + format.chartTitle, series);
  CartesianChart chart = ChartOver(AxisOf(file.GetResultType()), options.path, format);
  if (format.plot == PlotKind::kWrappedPhase) {
    chart.fixedY = true;
    chart.yMin = -180;
    chart.yMax = 180;
    chart.yStep = 45;
  }
  chart.series = std::move(series);
  return RenderCartesianSvg(chart);
}

void Plot(const PlotOptions& options) {
  RefuseOutputOverInput(options.output, options.path);
  const std::string svg = Render(options);
  WriteOutputFile(options.output, [&](std::ostream& out) { out << svg; });
}

}  // namespace

void AddSnpPlotCommand(CLI::App& snp) {
  CLI::App* command = snp.add_subcommand(
      "plot",
      "Draw the traces of a Touchstone file as an SVG picture: log magnitude or phase "
      "over the stimulus, or reflections on a Smith chart");
  auto options = std::make_shared<PlotOptions>();
  command->add_option("FILE", options->path, "Touchstone file")->required();
  command->add_option("--output,-o", options->output, "SVG file to write")->required();
  command
      ->add_option("--format,-f", options->format, TraceFormatHelp(kPlotFormat))
      ->check(CLI::IsMember(TraceFormatNames(kPlotFormat)))
      ->capture_default_str();
  command->add_option("--params,-p", options->params,
                      "comma-separated traces, e.g. S21,S11 (default: all; for smith, the "
                      "reflections S11, S22, ...)");
  AddPortsOption(*command, options->ports);
  command->callback([options] { Plot(*options); });
}

}  // namespace lumenutil
