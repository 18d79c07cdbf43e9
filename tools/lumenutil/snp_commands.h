// The `snp` commands on Touchstone files; each adds itself to the `snp` command.
#pragma once

#include <CLI/CLI.hpp>

namespace lumenutil {

void AddSnpInfoCommand(CLI::App& snp);
void AddSnpExportCommand(CLI::App& snp);
void AddSnpPlotCommand(CLI::App& snp);
void AddSnpResampleCommand(CLI::App& snp);
void AddSnpConvertCommand(CLI::App& snp);
void AddSnpDiffCommand(CLI::App& snp);

}  // namespace lumenutil
