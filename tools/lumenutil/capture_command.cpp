#include <cstdint>
#include <iostream>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>

#include "lumen/capture.h"
#include "lumen/platform/text_conversion.h"
#include "lumenutil/commands.h"
#include "lumenutil/snp_file.h"

namespace lumenutil {
namespace {

constexpr std::int32_t kNoSuchBlock = static_cast<std::int32_t>(0x80070002);  // ENOENT

struct ReadOptions {
  std::string name;
  std::int64_t offset = 0;
  std::int64_t count = -1;  // everything after the offset
  bool complex = false;
};

std::string Hex(std::int32_t code) {
  std::ostringstream text;
  text << "0x" << std::hex << std::uppercase << static_cast<std::uint32_t>(code);
  return text.str();
}

// Prints the floats of a block, one per line, or real,imaginary pairs with --complex, each
// with the digits that read back to the very float.
void Read(const ReadOptions& options) {
  std::unique_ptr<FileMappingReader> block;
  try {
    block = std::make_unique<FileMappingReader>(LumenUtility::Utf8ToWide(options.name));
  } catch (std::int32_t code) {
    if (code == kNoSuchBlock) {
      throw std::runtime_error("no shared-memory block named '" + options.name + "'");
    }
    throw std::runtime_error("cannot open shared-memory block '" + options.name + "': error " +
                             Hex(code));
  }
  const std::int64_t floats = block->GetCount();
  const std::int64_t perValue = options.complex ? 2 : 1;
  if (options.offset > floats) {
    throw std::runtime_error("offset " + std::to_string(options.offset) + " is past the end of '" +
                             options.name + "' (" + std::to_string(floats) + " floats)");
  }
  const std::int64_t available = (floats - options.offset) / perValue;
  const std::int64_t count = options.count < 0 ? available : options.count;
  if (count > available) {
    throw std::runtime_error("'" + options.name + "' holds " + std::to_string(floats) +
                             " floats: " + std::to_string(count) +
                             (options.complex ? " complex values" : " floats") + " from offset " +
                             std::to_string(options.offset) + " do not fit");
  }
  const float* p = block->GetPtr(options.offset);
  for (std::int64_t k = 0; k < count; ++k, p += perValue) {
    std::cout << Shortest(p[0]);
    if (options.complex) std::cout << ',' << Shortest(p[1]);
    std::cout << '\n';
  }
}

}  // namespace

void AddCaptureCommand(CLI::App& app) {
  CLI::App* capture =
      app.add_subcommand("capture", "Shared-memory blocks of the data capture service");
  capture->require_subcommand(1);
  CLI::App* read = capture->add_subcommand(
      "read", "Print the 32-bit floats of an existing block, one per line (read only)");
  auto options = std::make_shared<ReadOptions>();
  read->add_option("NAME", options->name, "block name, e.g. VNASharedMemory_1_4242")->required();
  read->add_option("--offset", options->offset, "first float to print (a request's offset)")
      ->check(CLI::NonNegativeNumber);
  read->add_option("--count", options->count, "how many values to print (default: the rest)")
      ->check(CLI::NonNegativeNumber);
  read->add_flag("--complex", options->complex, "print real,imaginary pairs");
  read->callback([options] { Read(*options); });
}

}  // namespace lumenutil
