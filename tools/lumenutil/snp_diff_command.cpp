#include <cmath>
#include <cstdio>
#include <iostream>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "lumenutil/exit_status.h"
#include "lumenutil/snp_command_io.h"
#include "lumenutil/snp_commands.h"
#include "lumenutil/snp_file.h"
#include "lumenutil/trace_format.h"

using LumenUtility::InputArray;
using LumenUtility::TsComplex;

namespace lumenutil {
namespace {

// snp diff ends with 1 when the files differ and with 2 on any error, so that a regression
// check tells a difference from a broken run.
constexpr int kDiffer = 1;
constexpr int kDiffError = 2;

struct DiffOptions {
  std::string a;
  std::string b;
  std::string params;
  double toleranceDb = 0;
  double toleranceDeg = 0;
  bool holdEnds = false;
  std::string format = "table";
  int ports = 0;
};

// The largest absolute difference of one kind and the point where it occurs.
struct Largest {
  double value = 0;  // signed, B - A
  std::size_t at = 0;
  void Note(double d, std::size_t i) {
    if (std::fabs(d) > std::fabs(value)) {
      value = d;
      at = i;
    }
  }
};

struct ParameterDifference {
  MatrixPosition position;
  std::vector<double> db;   // per point, B - A
  std::vector<double> deg;  // per point, B - A wrapped into (-180, 180]
  Largest magnitude;
  Largest phase;
  bool magnitudeOutside = false;  // beyond --tolerance-db
  bool phaseOutside = false;      // beyond --tolerance-deg
};

const InputArray& StimulusOf(const CSnPFileBase& file) {
  return file.GetParam(SNP_S11).GetStimulus();
}

std::string Range(const CSnPFileBase& file) {
  const InputArray& x = StimulusOf(file);
  const StimulusAxis axis = AxisOf(file.GetResultType());
  return WithUnit(x.front(), axis.unit, axis.siPrefix) + " to " +
         WithUnit(x.back(), axis.unit, axis.siPrefix);
}

// Interpolating across a stimulus that turns back has no meaning, nor has the point where a
// difference peaks; such a file is refused at its first offending point.
void RefuseUnlessAscending(const std::string& path, const CSnPFileBase& file) {
  const InputArray& x = StimulusOf(file);
  if (x.empty()) throw std::runtime_error(path + ": no data points");
  const StimulusAxis axis = AxisOf(file.GetResultType());
  for (unsigned int i = 1; i < x.size(); ++i) {
    if (!(x[i] > x[i - 1])) {
      throw std::runtime_error(path + ": the " + LowerAscii(axis.quantity) +
                               " must ascend strictly, but point " + std::to_string(i + 1) + " (" +
                               WithUnit(x[i], axis.unit, axis.siPrefix) +
                               ") does not lie above point " + std::to_string(i) + " (" +
                               WithUnit(x[i - 1], axis.unit, axis.siPrefix) + ")");
    }
  }
}

// Carries B onto A's points; returns how B's line of the table describes that.
std::string CarryOnto(const DiffOptions& options, const CSnPFileBase& a, CSnPFileBase& b) {
  const InputArray& target = StimulusOf(a);
  const std::string own = std::to_string(StimulusOf(b).size()) + " points, " + Range(b);
  if (StimulusOf(b) == target) return own + ", the points of A";
  const bool beyond =
      target.front() < StimulusOf(b).front() || target.back() > StimulusOf(b).back();
  if (beyond && !options.holdEnds) {
    throw std::runtime_error(options.b + " covers " + Range(b) + ", not all of " + Range(a) +
                             " of " + options.a +
                             "; --hold-ends extends its traces with their end values");
  }
  if (beyond) b.ExtroplateReadSNPFile(target);
  b.InterpolateReadSNPFile(target, true);
  return own + ", carried onto the points of A by circular interpolation" +
         (beyond ? ", end values held" : "");
}

ParameterDifference Compare(const CSnPFileBase& a, const CSnPFileBase& b,
                            const MatrixPosition& position) {
  const std::vector<TsComplex>& x = TraceAt(a, position).GetData();
  const std::vector<TsComplex>& y = TraceAt(b, position).GetData();
  ParameterDifference d{
      position, std::vector<double>(x.size()), std::vector<double>(x.size()), {}, {}};
  for (std::size_t i = 0; i < x.size(); ++i) {
    d.db[i] = y[i].LogMag() - x[i].LogMag();
    double degrees = std::remainder((y[i].Phase() - x[i].Phase()) * kDegreesPerRadian, 360.0);
    if (degrees == -180.0) degrees = 180.0;
    d.deg[i] = degrees;
    d.magnitude.Note(d.db[i], i);
    d.phase.Note(d.deg[i], i);
  }
  return d;
}

void PrintCsv(const CSnPFileBase& a, const std::vector<ParameterDifference>& differences) {
  std::ostream& out = std::cout;
  out << AxisOf(a.GetResultType()).column;
  for (const ParameterDifference& d : differences) {
    out << ',' << d.position.name << "_dB," << d.position.name << "_deg";
  }
  out << '\n';
  const std::vector<double> x = StimulusOf(a).GetArray();
  for (std::size_t i = 0; i < x.size(); ++i) {
    out << Shortest(x[i]);
    for (const ParameterDifference& d : differences) {
      // The data are floats: a difference has no more digits than they do.
      out << ',' << Shortest(static_cast<float>(d.db[i])) << ','
          << Shortest(static_cast<float>(d.deg[i]));
    }
    out << '\n';
  }
}

void PrintTable(const DiffOptions& options, const CSnPFileBase& a, const std::string& bLine,
                const std::vector<ParameterDifference>& differences) {
  const StimulusAxis axis = AxisOf(a.GetResultType());
  const std::vector<double> x = StimulusOf(a).GetArray();
  const auto at = [&](std::size_t i) { return WithUnit(x[i], axis.unit, axis.siPrefix); };
  std::ostream& out = std::cout;
  out << "A          " << options.a << ": " << x.size() << " points, " << Range(a) << '\n';
  out << "B          " << options.b << ": " << bLine << '\n';
  char line[256];
  std::snprintf(line, sizeof line, "%-10s %-14s %-14s %-14s %s\n", "parameter", "dB (B-A)", "at",
                "degrees (B-A)", "at");
  out << line;
  std::string outside;
  const auto by = [&](const Largest& largest, const char* unit) {
    return Rounded(largest.value) + unit + " at " + at(largest.at);
  };
  for (const ParameterDifference& d : differences) {
    std::snprintf(line, sizeof line, "%-10s %-14s %-14s %-14s %s\n", d.position.name.c_str(),
                  Rounded(d.magnitude.value).c_str(), at(d.magnitude.at).c_str(),
                  Rounded(d.phase.value).c_str(), at(d.phase.at).c_str());
    out << line;
    if (!d.magnitudeOutside && !d.phaseOutside) continue;
    outside += (outside.empty() ? "" : "; ") + d.position.name + " by " +
               (d.magnitudeOutside ? by(d.magnitude, " dB") : "") +
               (d.magnitudeOutside && d.phaseOutside ? " and " : "") +
               (d.phaseOutside ? by(d.phase, " degrees") : "");
  }
  const std::string tolerances =
      Rounded(options.toleranceDb) + " dB and " + Rounded(options.toleranceDeg) + " degrees";
  if (outside.empty()) {
    out << "result     within " << tolerances << '\n';
  } else {
    out << "result     outside " << tolerances << ": " << outside << '\n';
  }
}

void Diff(const DiffOptions& options) {
  SetErrorStatus(kDiffError);
  const CSnPFileBase a = ReadTouchstone(options.a, options.ports);
  CSnPFileBase b = ReadTouchstone(options.b, options.ports);
  if (a.GetSNPType() != b.GetSNPType()) {
    throw std::runtime_error(options.a + " has " + std::to_string(a.GetSNPType()) + " ports and " +
                             options.b + " " + std::to_string(b.GetSNPType()) +
                             "; only networks of one size compare");
  }
  if (a.GetResultType() != b.GetResultType()) {
    throw std::runtime_error(
        options.a + " holds " + LowerAscii(AxisOf(a.GetResultType()).quantity) + " values and " +
        options.b + " " + LowerAscii(AxisOf(b.GetResultType()).quantity) + " values");
  }
  RefuseUnlessAscending(options.a, a);
  RefuseUnlessAscending(options.b, b);
  const std::vector<MatrixPosition> positions = SelectPositions(options.params, a);
  const std::string bLine = CarryOnto(options, a, b);
  std::vector<ParameterDifference> differences;
  bool within = true;
  for (const MatrixPosition& p : positions) {
    ParameterDifference d = Compare(a, b, p);
    d.magnitudeOutside = std::fabs(d.magnitude.value) > options.toleranceDb;
    d.phaseOutside = std::fabs(d.phase.value) > options.toleranceDeg;
    within = within && !d.magnitudeOutside && !d.phaseOutside;
    differences.push_back(std::move(d));
  }
  if (options.format == "csv") {
    PrintCsv(a, differences);
  } else {
    PrintTable(options, a, bLine, differences);
  }
  SetResultStatus(within ? 0 : kDiffer);
}

}  // namespace

void AddSnpDiffCommand(CLI::App& snp) {
  CLI::App* command = snp.add_subcommand(
      "diff",
      "Compare two Touchstone files trace by trace on A's points: the largest magnitude (dB) "
      "and phase (degrees) difference of each parameter and where it occurs. Exit status 0 "
      "within the tolerances, 1 outside them, 2 on an error");
  auto options = std::make_shared<DiffOptions>();
  command->add_option("A", options->a, "Touchstone file compared against")->required();
  command
      ->add_option("B", options->b,
                   "Touchstone file compared; carried onto A's points when they differ")
      ->required();
  command->add_option("--params,-p", options->params,
                      "comma-separated traces, e.g. S21,S11 (default: all, in file order)");
  command
      ->add_option("--tolerance-db", options->toleranceDb,
                   "largest magnitude difference accepted, in dB")
      ->check(CLI::NonNegativeNumber)
      ->capture_default_str();
  command
      ->add_option("--tolerance-deg", options->toleranceDeg,
                   "largest phase difference accepted, in degrees")
      ->check(CLI::NonNegativeNumber)
      ->capture_default_str();
  command->add_flag("--hold-ends", options->holdEnds,
                    "where A reaches beyond B, hold B's end values instead of refusing");
  command
      ->add_option("--format,-f", options->format,
                   "table (largest differences) or csv (the difference at every point)")
      ->check(CLI::IsMember({"table", "csv"}))
      ->capture_default_str();
  AddPortsOption(*command, options->ports);
  command->callback([options] { Diff(*options); });
}

}  // namespace lumenutil
