#include "lumenutil/snp_command_io.h"

#include <fstream>
#include <stdexcept>

#include "lumen/data.h"

namespace lumenutil {

void AddPortsOption(CLI::App& command, int& ports) {
  command
      .add_option("--ports", ports,
                  "port count of a version 1 file whose name does not end in .sNp")
      ->check(CLI::Range(1, CSnPFileBase::kMaxPorts));
}

void WriteOutputFile(const std::string& path, const std::function<void(std::ostream&)>& write) {
  std::ofstream out(path, std::ios::binary);
  if (!out) throw std::runtime_error(path + ": cannot be written");
  write(out);
  if (!out.flush()) throw std::runtime_error(path + ": writing failed");
}

}  // namespace lumenutil
