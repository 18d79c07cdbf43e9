#include <cstdio>
#include <iostream>
#include <memory>
#include <string>
#include <vector>

#include "lumenutil/noise_records.h"
#include "lumenutil/snp_command_io.h"
#include "lumenutil/snp_commands.h"
#include "lumenutil/snp_file.h"

namespace lumenutil {
namespace {

struct InfoOptions {
  std::string path;
  int ports = 0;
};

const char* FormName(ESNPForm form) {
  switch (form) {
    case SNP_RI:
      return "real-imaginary (RI)";
    case SNP_DB:
      return "dB-angle (DB)";
    default:
      return "magnitude-angle (MA)";
  }
}

const char* MatrixName(SnPMatrixFormat format) {
  switch (format) {
    case SNP_MATRIX_LOWER:
      return "lower triangle";
    case SNP_MATRIX_UPPER:
      return "upper triangle";
    default:
      return "full";
  }
}

// One line per noise record under the "noise data" line, in columns.
void PrintNoiseRecords(const std::vector<NoiseRecord>& records, const StimulusAxis& axis,
                       std::ostream& out) {
  const auto row = [&out](const std::string& x, const std::string& nf, const std::string& mag,
                          const std::string& deg, const std::string& rn) {
    char line[160];
    std::snprintf(line, sizeof line, "             %-14s %-12s %-12s %-12s %s\n", x.c_str(),
                  nf.c_str(), mag.c_str(), deg.c_str(), rn.c_str());
    out << line;
  };
  row(LowerAscii(axis.quantity), "NFmin (dB)", "|GammaOpt|", "angle (deg)", "Rn (ohm)");
  for (const NoiseRecord& r : records) {
    row(WithUnit(r.stimulus, axis.unit, axis.siPrefix), Rounded(r.nfMinDb), Rounded(r.gammaMag),
        Rounded(r.gammaDeg), Rounded(r.rnOhm));
  }
}

void PrintInfo(const InfoOptions& options) {
  const CSnPFileBase file = ReadTouchstone(options.path, options.ports);
  const SnPFileInfo& info = file.GetFileInfo();
  const CSNParameter& first = file.GetParam(SNP_S11);
  const StimulusAxis axis = AxisOf(file.GetResultType());
  const int n = file.GetSNPType();
  std::ostream& out = std::cout;
  out << "file         " << options.path << '\n';
  out << "version      " << (info.version == 2 ? "2.0" : "1") << '\n';
  out << "ports        " << n << '\n';
  out << "points       " << first.GetNumPoints();
  if (info.extraPointsIgnored) {
    out << " (as [Number of Frequencies] declares; the points after them were ignored)";
  }
  out << '\n';
  out << "stimulus     ";
  if (first.GetNumPoints() > 0) {
    out << WithUnit(first.GetStartFreq(), axis.unit, axis.siPrefix) << " to "
        << WithUnit(first.GetStopFreq(), axis.unit, axis.siPrefix);
  } else {
    out << "none";
  }
  out << " (" << axis.quantity << ", unit " << info.stimulusUnit << " in the file)\n";
  out << "parameters   " << info.parameter << ", " << FormName(info.form) << '\n';
  out << "reference    " << Shortest(info.referenceResistance) << " ohm";
  if (!info.referenceResistanceGiven) out << " (the file names no reference resistance)";
  bool usable = IsUsableResistance(info.referenceResistance) || !info.portReferences.empty();
  if (!info.portReferences.empty()) {
    out << " (per port:";
    for (double r : info.portReferences) {
      out << ' ' << Shortest(r);
      usable = usable && IsUsableResistance(r);
    }
    out << ')';
  }
  if (!usable) out << ", not usable: impedances and admittances need a resistance above 0";
  out << '\n';
  out << "matrix       " << MatrixName(info.matrixFormat) << '\n';
  if (n == 2) {
    out << "data order   " << (file.Get2PortDataOrder() ? "11 21 12 22" : "11 12 21 22") << '\n';
  }
  out << "noise data   ";
  if (info.noisePoints > 0) {
    out << info.noisePoints << " points (NFmin, GammaOpt, Rn)\n";
    PrintNoiseRecords(NoiseRecords(file), axis, out);
  } else {
    out << "none\n";
  }
  for (const std::string& token : info.ignoredOptions) {
    out << "ignored      " << IgnoredOptionText(token, file) << '\n';
  }
  out << "traces      ";
  for (const MatrixPosition& p : SelectPositions("", file)) out << ' ' << p.name;
  out << '\n';
}

}  // namespace

void AddSnpInfoCommand(CLI::App& snp) {
  CLI::App* command =
      snp.add_subcommand("info",
                         "Describe a Touchstone file: version, ports, points, "
                         "stimulus range, value form, reference, layout, noise data");
  auto options = std::make_shared<InfoOptions>();
  command->add_option("FILE", options->path, "Touchstone file")->required();
  AddPortsOption(*command, options->ports);
  command->callback([options] { PrintInfo(*options); });
}

}  // namespace lumenutil
