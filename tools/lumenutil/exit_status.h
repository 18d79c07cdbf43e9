// The exit status of a lumenutil run, for commands whose status carries a result: `snp
// diff` ends with 1 when the files differ and with 2 on any error, where other commands end
// with 0 and 1. One run executes one command, on one thread.
#pragma once

namespace lumenutil {

// The status of a run that completes: 0 unless the command set another.
void SetResultStatus(int status);
int ResultStatus();

// The status of a run that fails (an exception, or output that cannot be written): 1 unless
// the command set another.
void SetErrorStatus(int status);
int ErrorStatus();

}  // namespace lumenutil
