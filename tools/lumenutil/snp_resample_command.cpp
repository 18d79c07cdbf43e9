#include <iostream>
#include <memory>
#include <stdexcept>
#include <string>

#include "lumen/platform.h"
#include "lumen/stimulus.h"
#include "lumenutil/engineering_value.h"
#include "lumenutil/snp_command_io.h"
#include "lumenutil/snp_commands.h"
#include "lumenutil/snp_file.h"
#include "lumenutil/touchstone_output.h"
#include "lumenutil/trace_carrier.h"

using LumenUtility::InputArray;

namespace lumenutil {
namespace {

struct ResampleOptions {
  std::string path;
  std::string start;
  std::string stop;
  int points = 0;
  bool log = false;
  bool holdEnds = false;
  int version = 1;
  std::string output;
  int ports = 0;
};

double ReadStimulus(const std::string& text, const StimulusAxis& axis, const char* option) {
  const std::optional<double> value = ParseEngineeringValue(text, axis.unit);
  if (!value) {
    throw std::runtime_error(std::string(option) + " '" + text + "' is not a value" +
                             (axis.unit.empty() ? "" : " in " + axis.unit) +
                             " (examples: 1.5e9, 1.5G, 1.5 GHz)");
  }
  return *value;
}

constexpr int kMaxResamplePoints = 10'000'000;

void Resample(const ResampleOptions& options) {
  CSnPFileBase file = ReadTouchstone(options.path, options.ports);
  const StimulusAxis axis = AxisOf(file.GetResultType());
  const double start = ReadStimulus(options.start, axis, "--start");
  const double stop = ReadStimulus(options.stop, axis, "--stop");
  // A Touchstone file's frequencies ascend, and so must the sweep written into one.
  if (start > stop) {
    throw std::runtime_error("--start " + options.start + " is above --stop " + options.stop +
                             ": the new sweep must ascend");
  }
  if (start == stop && options.points > 1) {
    throw std::runtime_error("--start and --stop are equal: " + std::to_string(options.points) +
                             " points need --stop above --start");
  }
  if (options.log && (start <= 0 || stop <= 0)) {
    throw std::runtime_error("a logarithmic sweep needs --start and --stop above 0");
  }
  CheckOutputPorts(options.output, file);
  const CSNParameter& s11 = file.GetParam(SNP_S11);
  if (s11.GetNumPoints() == 0) throw std::runtime_error(options.path + ": no data points");
  RequireAscendingStimulus(file, options.path);
  const InputArray target(start, stop, options.points,
                          options.log ? LumenUtility::Log : LumenUtility::Linear);
  const double low = std::min(start, stop), high = std::max(start, stop);
  if (!options.holdEnds && (low < s11.GetStartFreq() || high > s11.GetStopFreq())) {
    throw std::runtime_error("the new sweep " + WithUnit(low, axis.unit, axis.siPrefix) + " to " +
                             WithUnit(high, axis.unit, axis.siPrefix) +
                             " reaches outside the file's " +
                             WithUnit(s11.GetStartFreq(), axis.unit, axis.siPrefix) + " to " +
                             WithUnit(s11.GetStopFreq(), axis.unit, axis.siPrefix) +
                             "; --hold-ends extends each trace with its end values");
  }
  CarryOnto(file, target, options.holdEnds);

  const std::string comment =
      "Resampled by lumenutil from " + options.path + " onto " + std::to_string(options.points) +
      (options.log ? " logarithmic" : " linear") + " points, " +
      WithUnit(start, axis.unit, axis.siPrefix) + " to " +
      WithUnit(stop, axis.unit, axis.siPrefix) + (options.holdEnds ? ", end values held" : "");
  LumenUtility::TouchstoneWriteOptions write;  // RI, Hz
  write.version = options.version;
  write.comment = comment;
  WriteTouchstoneFile(file, write, options.output, "snp resample", true);
}

}  // namespace

void AddSnpResampleCommand(CLI::App& snp) {
  CLI::App* command = snp.add_subcommand(
      "resample",
      "Carry every trace of a Touchstone file onto a new linear or logarithmic "
      "sweep by circular interpolation and write a Touchstone file (version 1 unless "
      "--version 2), real-imaginary in Hz");
  auto options = std::make_shared<ResampleOptions>();
  command->add_option("FILE", options->path, "Touchstone file")->required();
  command->add_option("--start", options->start, "first stimulus value, e.g. 1.5e9, 1.5G or 1.5GHz")
      ->required();
  command->add_option("--stop", options->stop, "last stimulus value")->required();
  // Ten million points, far past any analyzer sweep, keep a two-port resample within about
  // a gigabyte of memory.
  command->add_option("--points", options->points, "number of points, 1 to 10000000")
      ->required()
      ->check(CLI::Range(1, kMaxResamplePoints));
  command->add_flag("--log", options->log, "logarithmic instead of linear spacing");
  command->add_flag("--hold-ends", options->holdEnds,
                    "where the sweep reaches beyond the file, hold each trace's end values");
  command->add_option("--output,-o", options->output, "Touchstone file to write (OUT.sNp)")
      ->required();
  command->add_option("--version", options->version, "Touchstone version written: 1 or 2 (2.0)")
      ->check(CLI::IsMember({1, 2}))
      ->capture_default_str();
  AddPortsOption(*command, options->ports);
  command->callback([options] { Resample(*options); });
}

}  // namespace lumenutil
