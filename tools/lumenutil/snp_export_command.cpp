#include <iostream>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "lumenutil/noise_records.h"
#include "lumenutil/snp_command_io.h"
#include "lumenutil/snp_commands.h"
#include "lumenutil/snp_file.h"
#include "lumenutil/trace_format.h"

namespace lumenutil {
namespace {

struct ExportOptions {
  std::string path;
  std::string params;
  std::string format = "ri";
  std::string delimiter = ",";
  std::string output;
  int ports = 0;
  int limit = 0;
  bool noise = false;
};

void WriteTable(const ExportOptions& options, std::ostream& out) {
  const CSnPFileBase file = ReadTouchstone(options.path, options.ports);
  if (options.noise) {
    WriteNoiseTable(RequireNoiseRecords(file, options.path), file.GetResultType(),
                    options.delimiter, options.limit, out);
    if (!out) throw std::runtime_error("writing the table failed");
    return;
  }
  const SnPFileInfo& info = file.GetFileInfo();
  const TraceFormatRow& format = TraceFormatNamed(options.format);
  if (info.parameter != 'S' && format.asReflection) {
    std::cerr << "lumenutil snp export: warning: " << options.path << " holds " << info.parameter
              << "-parameters; " << options.format << " treats them as reflection coefficients\n";
  }
  const std::vector<MatrixPosition> positions = SelectPositions(options.params, file);
  const std::string& d = options.delimiter;

  out << AxisOf(file.GetResultType()).column;
  std::vector<std::vector<double>> columns;
  for (const MatrixPosition& p : positions) {
    for (const std::string& name : ColumnNames(format, p.name)) out << d << name;
    const double z0 = format.needsReference ? PortReference(file, p.row, options.path) : 0.0;
    for (std::vector<double>& column : format.convert(TraceAt(file, p).GetData(), z0)) {
      columns.push_back(std::move(column));
    }
  }
  out << '\n';
  const LumenUtility::InputArray& stimulus = file.GetParam(SNP_S11).GetStimulus();
  int points = static_cast<int>(stimulus.size());
  if (options.limit > 0 && options.limit < points) points = options.limit;
  const std::vector<double> x = stimulus.GetArray();
  for (int i = 0; i < points; ++i) {
    out << Shortest(x[i]);
    for (const std::vector<double>& column : columns) {
      // The data are single-precision values: RI columns read back to the stored floats
      // exactly, and derived columns carry every digit a float holds, no invented ones.
      out << d << Shortest(static_cast<float>(column[i]));
    }
    out << '\n';
  }
  if (!out) throw std::runtime_error("writing the table failed");
}

void Export(const ExportOptions& options) {
  if (options.output.empty() || options.output == "-") {
    WriteTable(options, std::cout);
    return;
  }
  RefuseOutputOverInput(options.output, options.path);
  WriteOutputFile(options.output, [&](std::ostream& out) { WriteTable(options, out); });
}

}  // namespace

void AddSnpExportCommand(CLI::App& snp) {
  CLI::App* command = snp.add_subcommand(
      "export",
      "Write the traces of a Touchstone file as a table (CSV by default), one row "
      "per stimulus point, numbers with enough digits to read back exactly");
  auto options = std::make_shared<ExportOptions>();
  command->add_option("FILE", options->path, "Touchstone file")->required();
  CLI::Option* params =
      command->add_option("--params,-p", options->params,
                          "comma-separated traces, e.g. S21,S11 (default: all, in file order)");
  CLI::Option* format =
      command->add_option("--format,-f", options->format, TraceFormatHelp(kExportFormat));
  format->check(CLI::IsMember(TraceFormatNames(kExportFormat)))->capture_default_str();
  command
      ->add_flag("--noise", options->noise,
                 "the noise records instead: frequency, NFmin (dB), |GammaOpt|, its angle "
                 "(degrees) and Rn (ohms)")
      ->excludes(params)
      ->excludes(format);
  command->add_option("--delimiter,-d", options->delimiter, "column separator")
      ->capture_default_str();
  command->add_option("--limit,-n", options->limit, "only the first N points")
      ->check(CLI::NonNegativeNumber);
  AddPortsOption(*command, options->ports);
  command->add_option("--output,-o", options->output, "output file (default: standard output)");
  command->callback([options] { Export(*options); });
}

}  // namespace lumenutil
