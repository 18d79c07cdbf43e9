// Writing a Touchstone file from a command: the library's writer behind the tool's
// whole-or-untouched output file, with its refusals and roundings said in the tool's words.
#pragma once

#include <string>

#include "lumen/data.h"

namespace lumenutil {

// Throws std::runtime_error("OUTPUT names N ports, but the network has M") when the ".sNp"
// extension of `output` names another port count than `file` has; other names pass.
void CheckOutputPorts(const std::string& output, const CSnPFileBase& file);

// Writes `file` to `path` as `options` say, through WriteOutputFile (a failure leaves `path`
// as it was). A set the writer refuses throws std::runtime_error("cannot write PATH: WHY")
// before any file is touched. With `dropUnwritableNoise`, noise data that alone stands in the
// way is left out, and a warning naming why goes to standard error after "lumenutil
// COMMAND: ". Values that the chosen form or unit cannot hold exactly are counted in a note
// on standard error.
void WriteTouchstoneFile(const CSnPFileBase& file, LumenUtility::TouchstoneWriteOptions options,
                         const std::string& path, const std::string& command,
                         bool dropUnwritableNoise);

}  // namespace lumenutil
