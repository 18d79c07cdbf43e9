#include "lumenutil/snp_command_io.h"

#include "lumen/data.h"

namespace lumenutil {

void AddPortsOption(CLI::App& command, int& ports) {
  command
      .add_option("--ports", ports,
                  "port count of a version 1 file whose name does not end in .sNp")
      ->check(CLI::Range(1, CSnPFileBase::kMaxPorts));
}

}  // namespace lumenutil
