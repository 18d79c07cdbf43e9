#include <iostream>

#include "lumenutil/commands.h"

namespace lumenutil {

void AddVersionCommand(CLI::App& app) {
  CLI::App* command = app.add_subcommand("version", "Print the tool's version");
  command->callback([] { std::cout << "lumenutil " << LUMEN_VERSION << '\n'; });
}

}  // namespace lumenutil
