// lumenutil: the library at the command line, for engineers working on measurement files.
#include <exception>
#include <iostream>

#include "lumenutil/commands.h"

int main(int argc, char** argv) {
  CLI::App app{"lumenutil: read, resample, convert and plot network analyzer data"};
  app.require_subcommand(1);
  lumenutil::AddVersionCommand(app);
  lumenutil::AddHResultCommand(app);
  lumenutil::AddSnpCommand(app);
  try {
    app.parse(argc, argv);
  } catch (const CLI::ParseError& e) {
    return app.exit(e);
  } catch (const std::exception& e) {
    std::cerr << "lumenutil: " << e.what() << '\n';
    return 1;
  }
  return 0;
}
