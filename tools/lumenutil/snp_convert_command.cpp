#include <memory>
#include <stdexcept>
#include <string>

#include "lumenutil/snp_command_io.h"
#include "lumenutil/snp_commands.h"
#include "lumenutil/snp_file.h"
#include "lumenutil/touchstone_output.h"

namespace lumenutil {
namespace {

struct ConvertOptions {
  std::string input;
  std::string output;
  int version = 0;     // 0: the input's own
  std::string format;  // empty: the input's own
  std::string unit;    // empty: the input's own
  int ports = 0;
};

void Convert(const ConvertOptions& options) {
  const CSnPFileBase file = ReadTouchstone(options.input, options.ports);
  const SnPFileInfo& info = file.GetFileInfo();
  CheckOutputPorts(options.output, file);

  LumenUtility::TouchstoneWriteOptions write;
  write.version = options.version != 0 ? options.version : info.version;
  write.form = info.form;
  if (!options.format.empty()) LumenUtility::SnPFormFromToken(options.format, write.form);
  if (file.GetResultType() == RESULT_FREQUENCY) {
    LumenUtility::SnPUnitFromToken(info.stimulusUnit, write.unit);
    if (!options.unit.empty()) LumenUtility::SnPUnitFromToken(options.unit, write.unit);
  } else if (!options.unit.empty()) {
    throw std::runtime_error("--unit sets a frequency unit, but " + options.input + " holds " +
                             LowerAscii(AxisOf(file.GetResultType()).quantity) + " values (" +
                             info.stimulusUnit + ")");
  }
  write.comment = "Converted by lumenutil from " + options.input;
  WriteTouchstoneFile(file, write, options.output, "snp convert", false);
}

}  // namespace

void AddSnpConvertCommand(CLI::App& snp) {
  CLI::App* command = snp.add_subcommand(
      "convert",
      "Write a Touchstone file in another version, value form or frequency unit; every "
      "value reads back as the same float wherever the new form can hold it");
  auto options = std::make_shared<ConvertOptions>();
  command->add_option("IN", options->input, "Touchstone file to read")->required();
  command->add_option("OUT", options->output, "Touchstone file to write (may be IN)")->required();
  command->add_option("--version", options->version, "1 or 2 (Touchstone 2.0); default: IN's")
      ->check(CLI::IsMember({1, 2}));
  command
      ->add_option("--format,-f", options->format,
                   "ri, ma (magnitude, degrees) or db (dB, degrees); default: IN's")
      ->check(CLI::IsMember({"ri", "ma", "db"}, CLI::ignore_case));
  command->add_option("--unit", options->unit, "frequency unit: hz, khz, mhz or ghz; default: IN's")
      ->check(CLI::IsMember({"hz", "khz", "mhz", "ghz"}, CLI::ignore_case));
  AddPortsOption(*command, options->ports);
  command->callback([options] { Convert(*options); });
}

}  // namespace lumenutil
