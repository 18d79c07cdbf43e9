// Running another program and waiting for it: the stand-in for starting a process with
// CreateProcessW, waiting with WaitForSingleObject and reading GetExitCodeProcess.
// The program is started with posix_spawn, never through a shell, so no character of an
// argument has a meaning to anything but the program itself.
// Thread-safety: callable from any thread. The child inherits no descriptors of the caller
// other than the ones named here (the library opens its own descriptors with O_CLOEXEC).
#pragma once

#include <optional>
#include <string>
#include <vector>

namespace LumenUtility {

// Runs `program` (a path; a name without a slash is looked up in PATH) with `arguments` as
// argv[1...] (argv[0] is `program`), in the directory `workDir` (empty: the caller's) and with
// the caller's environment. Standard input reads from /dev/null, so a program that asks a
// question gets end of file instead of waiting forever; standard output and standard error go
// to the descriptor `outputFd`, or to /dev/null when it is -1. Waits without a time limit.
// Returns the exit status (0 to 255) of a program that ran and exited; std::nullopt when it
// could not be started (missing program, bad directory, no resources), ended by a signal, or
// its status could not be read (SIGCHLD ignored by the caller).
std::optional<int> RunProcess(const std::wstring& program,
                              const std::vector<std::wstring>& arguments,
                              const std::wstring& workDir, int outputFd = -1);

}  // namespace LumenUtility
