// Subcommands of lumenutil; each family of commands registers itself on the app.
#pragma once

#include <CLI/CLI.hpp>

namespace lumenutil {

// Adds `version`.
void AddVersionCommand(CLI::App& app);

// Adds `hresult CODE...`: the error number of each code.
void AddHResultCommand(CLI::App& app);

// Adds `snp` and its commands on Touchstone files.
void AddSnpCommand(CLI::App& app);

// Adds `capture read NAME`: the floats of a data capture block.
void AddCaptureCommand(CLI::App& app);
// Adds `zip OUT [-C DIR] FILES...` and `unzip IN -d DIR`.
void AddZipCommands(CLI::App& app);

// Adds `prn FILE [--start F --stop F --points N]`: the phase of a PRN calibration file.
void AddPrnCommand(CLI::App& app);

}  // namespace lumenutil
