#include "lumenutil/commands.h"
#include "lumenutil/snp_commands.h"

namespace lumenutil {

void AddSnpCommand(CLI::App& app) {
  CLI::App* snp = app.add_subcommand("snp",
                                     "Touchstone files (.s1p, .s2p, ... version 1 and 2.0): "
                                     "inspect, export, plot, resample, convert, compare");
  snp->require_subcommand(1);
  AddSnpInfoCommand(*snp);
  AddSnpExportCommand(*snp);
  AddSnpPlotCommand(*snp);
  AddSnpResampleCommand(*snp);
  AddSnpConvertCommand(*snp);
  AddSnpDiffCommand(*snp);
}

}  // namespace lumenutil
