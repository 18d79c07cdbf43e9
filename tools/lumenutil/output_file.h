// Output files that are either complete or not there: what a command writes goes to a
// temporary file beside the target, which replaces the target only once it is whole.
#pragma once

#include <functional>
#include <ostream>
#include <string>

namespace lumenutil {

// Lets `write` fill the file at `path` (UTF-8). A regular file, or a path that does not
// exist yet, is written as a temporary file in the same directory, flushed to disk and
// renamed over `path` only when `write` returned and every byte was written; the new file
// keeps the mode of the file it replaces (new files get 0666 less the umask). On any failure,
// and when the process is stopped by SIGINT, SIGTERM, SIGHUP or SIGXFSZ meanwhile (those it
// does not ignore), the temporary file is removed and `path` stays exactly as it was.
// Anything else (a device such as /dev/null, a FIFO) is written in place.
// Throws std::runtime_error("PATH: cannot be written: REASON") when the file cannot be
// created and "PATH: writing failed: REASON" when a write fails; exceptions of `write` pass
// through.
void WriteOutputFile(const std::string& path, const std::function<void(std::ostream&)>& write);

// As WriteOutputFile, for writers that take a path: `write` fills the file named by the path it
// is given (the temporary file, or `path` itself when written in place) and returns whether it
// succeeded. When it returns false, nothing replaces `path` and false is returned.
bool WriteOutputFileAt(const std::string& path,
                       const std::function<bool(const std::string& file)>& write);

// Throws std::runtime_error("OUTPUT: is the input file; choose another output") when
// `output` names the same existing file as `input` (also through another spelling or a
// link). For commands that write another format, which would otherwise destroy their input.
void RefuseOutputOverInput(const std::string& output, const std::string& input);

}  // namespace lumenutil
