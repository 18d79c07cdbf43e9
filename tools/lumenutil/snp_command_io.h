// Command-line plumbing the `snp` commands share: the --ports option of the Touchstone file
// they read, and (through output_file.h) the writing of the file they produce.
#pragma once

#include <CLI/CLI.hpp>

#include "lumenutil/output_file.h"

namespace lumenutil {

// Adds the --ports option of a command that reads a Touchstone file: the port count, 1 to the
// reader's limit, stored in `ports` (left alone when not given) for ReadTouchstone. `ports`
// must outlive `command`.
void AddPortsOption(CLI::App& command, int& ports);

}  // namespace lumenutil
