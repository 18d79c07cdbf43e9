#include "lumenutil/touchstone_output.h"

#include <iostream>
#include <optional>
#include <stdexcept>

#include "lumen/platform.h"
#include "lumenutil/output_file.h"
#include "lumenutil/snp_file.h"

using LumenUtility::TouchstoneWriteOptions;
using LumenUtility::TouchstoneWriter;

namespace lumenutil {
namespace {

std::string MessageOf(const LumenException& e) {
  return LumenUtility::WideToUtf8(e.GetMessage());
}

}  // namespace

void CheckOutputPorts(const std::string& output, const CSnPFileBase& file) {
  const int outputPorts = SnPPortCountFromFileName(LumenUtility::Utf8ToWide(output));
  if (outputPorts > 0 && outputPorts != file.GetSNPType()) {
    throw std::runtime_error(output + " names " + std::to_string(outputPorts) +
                             " ports, but the network has " + std::to_string(file.GetSNPType()));
  }
}

void WriteTouchstoneFile(const CSnPFileBase& file, TouchstoneWriteOptions options,
                         const std::string& path, const std::string& command,
                         bool dropUnwritableNoise) {
  std::optional<TouchstoneWriter> writer;
  try {
    writer.emplace(file, options);
  } catch (const LumenException& refusal) {
    if (!dropUnwritableNoise || file.GetNumCustomParams() == 0) {
      throw std::runtime_error("cannot write " + path + ": " + MessageOf(refusal));
    }
    options.noise = false;
    try {
      writer.emplace(file, options);
    } catch (const LumenException& again) {
      throw std::runtime_error("cannot write " + path + ": " + MessageOf(again));
    }
    std::cerr << "lumenutil " << command
              << ": warning: noise data not written: " << MessageOf(refusal) << '\n';
  }
  LumenUtility::TouchstoneWriteResult result;
  WriteOutputFile(path, [&](std::ostream& out) {
    try {
      result = writer->Write(out);
    } catch (const LumenException& failure) {
      throw std::runtime_error(path + ": " + MessageOf(failure));
    }
  });
  if (result.inexactValues > 0) {
    std::cerr << "lumenutil " << command << ": note: " << result.inexactValues << " of "
              << result.values << " values lie between the values "
              << LumenUtility::SnPFormToken(options.form)
              << " can hold and were written to the nearest, moving by up to "
              << Rounded(result.largestValueChange, 2) << " of their magnitude\n";
  }
  if (result.inexactStimulus > 0) {
    std::cerr << "lumenutil " << command << ": note: " << result.inexactStimulus
              << " stimulus values have no exact text in "
              << LumenUtility::SnPUnitToken(options.unit)
              << " and were written to the nearest, moving by up to "
              << Rounded(result.largestStimulusChange, 2)
              << " of their value; HZ keeps them exactly\n";
  }
}

}  // namespace lumenutil
