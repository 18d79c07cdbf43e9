// `lumenutil prn FILE [--start F --stop F --points N]`: the calibrated phase of a phase
// reference's PRN file, as read or on a linear sweep.
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <iostream>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "lumen/phase/prn_reader.h"
#include "lumen/platform/text_conversion.h"
#include "lumenutil/commands.h"
#include "lumenutil/engineering_value.h"
#include "lumenutil/snp_file.h"

using LumenUtility::InputArray;
using LumenUtility::TsComplex;

namespace lumenutil {
namespace {

// Ten million points, far past any analyzer sweep, keep the output within a few hundred MB.
constexpr int kMaxPoints = 10'000'000;

struct PrnOptions {
  std::string path;
  std::string start;
  std::string stop;
  int points = 0;
};

double Frequency(const std::string& text) {
  return ParseEngineeringValue(text, "Hz").value();  // the option's validator accepted it
}

// Degrees in (-180, 180], to 1e-4 degree: a single-precision phasor carries its angle to
// about 1e-5 degree, so the fourth decimal is the last one that means something.
std::string Degrees(TsComplex phasor) {
  double degrees =
      std::atan2(double(phasor.im), double(phasor.re)) * (180 / 3.14159265358979323846);
  char text[32];
  std::snprintf(text, sizeof text, "%.4f", degrees);
  if (std::string(text) == "-0.0000") return "0.0000";
  return text;
}

// The output is itself a PRN file: the header line is skipped when it is read back.
void Print(const InputArray& stimulus, const std::vector<TsComplex>& phase) {
  std::cout << "Frequency (Hz),Phase (deg)\n";
  for (unsigned k = 0; k < stimulus.size(); ++k) {
    std::cout << Shortest(stimulus[k]) << ',' << Degrees(phase[k]) << '\n';
  }
}

void ShowPrn(const PrnOptions& options) {
  PrnReader reader;
  if (!reader.LoadFile(LumenUtility::Utf8ToWide(options.path))) {
    throw std::runtime_error(options.path + ": cannot be read");
  }
  const InputArray& points = reader.GetStimulus();
  if (points.empty()) throw std::runtime_error(options.path + ": no calibration points");
  if (options.points == 0) {
    Print(points, reader.GetValues());
    return;
  }
  const double start = Frequency(options.start);
  const double stop = Frequency(options.stop);
  if (start == stop && options.points > 1) {
    throw CLI::ValidationError("--start and --stop are equal: " + std::to_string(options.points) +
                               " points need --stop apart from --start");
  }
  const InputArray sweep =
      options.points == 1 ? InputArray(start, 1)
                          : InputArray(start, stop, options.points, LumenUtility::SegmentType(0));
  try {
    Print(sweep, reader.GetPhase(sweep, InputArray(), nullptr));
  } catch (std::int32_t code) {
    if (code != PrnReader::kPhaseLookupFailed) throw;
    const auto [low, high] = std::minmax_element(points.begin(), points.end());
    throw std::runtime_error(options.path + ": the sweep " + Shortest(start) + " to " +
                             Shortest(stop) + " Hz reaches outside the calibration, " +
                             Shortest(*low) + " to " + Shortest(*high) + " Hz");
  }
}

const CLI::Validator kFrequency(
    [](std::string& text) {
      return ParseEngineeringValue(text, "Hz") ? std::string()
                                               : "'" + text +
                                                     "' is not a frequency (examples: "
                                                     "1.5e9, 1.5G, 1.5 GHz)";
    },
    "FREQ");

}  // namespace

void AddPrnCommand(CLI::App& app) {
  CLI::App* command = app.add_subcommand(
      "prn",
      "Print the calibrated phase of a phase reference calibration (PRN) file in degrees, as "
      "read or on a linear sweep by circular interpolation: lines of Hz,degrees");
  auto options = std::make_shared<PrnOptions>();
  command->add_option("FILE", options->path, "PRN file: lines of frequency in Hz, phase in degrees")
      ->required()
      ->check(CLI::ExistingFile);
  CLI::Option* start =
      command->add_option("--start", options->start, "first sweep frequency, e.g. 1.5e9 or 1.5GHz")
          ->check(kFrequency);
  CLI::Option* stop =
      command->add_option("--stop", options->stop, "last sweep frequency")->check(kFrequency);
  CLI::Option* points =
      command->add_option("--points", options->points, "number of sweep points, 1 to 10000000")
          ->check(CLI::Range(1, kMaxPoints));
  start->needs(stop)->needs(points);
  stop->needs(start)->needs(points);
  points->needs(start)->needs(stop);
  command->callback([options] { ShowPrn(*options); });
}

}  // namespace lumenutil
