// lumenutil: the library at the command line, for engineers working on measurement files.
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <exception>
#include <iostream>
#include <string>

#include "lumenutil/commands.h"
#include "lumenutil/exit_status.h"

namespace {

// Command-line usage errors end with status 2, as they do for other command-line tools.
constexpr int kUsageError = 2;

// Standard output is buffered: a write error (a full disk, /dev/full) shows only when the
// buffer is handed to the system, so it is flushed and checked before the run counts as a
// success. A closed pipe never gets here: SIGPIPE ends the process quietly, as for any tool.
int CheckStandardOutput() {
  errno = 0;
  std::cout.flush();
  if (std::cout) return 0;
  const int error = errno;
  std::cerr << "lumenutil: cannot write to standard output"
            << (error != 0 ? std::string(": ") + std::strerror(error) : std::string()) << '\n';
  return lumenutil::ErrorStatus();
}

}  // namespace

int main(int argc, char** argv) {
  CLI::App app{"lumenutil: read, resample, convert and plot network analyzer data"};
  app.require_subcommand(1);
  lumenutil::AddVersionCommand(app);
  lumenutil::AddHResultCommand(app);
  lumenutil::AddSnpCommand(app);
  lumenutil::AddCaptureCommand(app);
  lumenutil::AddZipCommands(app);
  lumenutil::AddPrnCommand(app);
  try {
    app.parse(argc, argv);
  } catch (const CLI::ParseError& e) {
    const int status = app.exit(e);  // prints the help or the usage error
    return status == 0 ? CheckStandardOutput() : kUsageError;
  } catch (const std::exception& e) {
    std::cerr << "lumenutil: " << e.what() << '\n';
    return lumenutil::ErrorStatus();
  } catch (std::int32_t code) {  // a bare error code thrown by the library
    std::cerr << "lumenutil: error 0x" << std::hex << static_cast<std::uint32_t>(code) << '\n';
    return lumenutil::ErrorStatus();
  } catch (...) {
    std::cerr << "lumenutil: unexpected error\n";
    return lumenutil::ErrorStatus();
  }
  const int output = CheckStandardOutput();
  return output != 0 ? output : lumenutil::ResultStatus();
}
