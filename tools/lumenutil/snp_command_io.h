// Command-line plumbing the `snp` commands share: the --ports option of the Touchstone file
// they read and the checked writing of the file they produce.
#pragma once

#include <CLI/CLI.hpp>
#include <functional>
#include <ostream>
#include <string>

namespace lumenutil {

// Adds the --ports option of a command that reads a Touchstone file: the port count, 1 to the
// reader's limit, stored in `ports` (left alone when not given) for ReadTouchstone. `ports`
// must outlive `command`.
void AddPortsOption(CLI::App& command, int& ports);

// Creates or truncates the file at `path` (UTF-8) and lets `write` fill it; the bytes are
// written as given. Throws std::runtime_error("PATH: cannot be written") when the file cannot
// be opened and "PATH: writing failed" when a write fails; exceptions of `write` pass through.
void WriteOutputFile(const std::string& path, const std::function<void(std::ostream&)>& write);

}  // namespace lumenutil
