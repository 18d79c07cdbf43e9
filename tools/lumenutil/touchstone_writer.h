// Writing traces back out as a Touchstone version 1 file.
#pragma once

#include <ostream>
#include <string>

#include "lumen/data.h"

namespace lumenutil {

// Writes the matrix traces of `file` as a Touchstone version 1 file in real-imaginary form
// with the stimulus in Hz (or SEC, DBM, POINT as the file's result type says), every number
// with enough digits to read back to the same float or double. Pairs follow version 1 order:
// 11 21 12 22 for two ports, rows of at most four pairs otherwise, each matrix row starting
// a line. `comment` lines come first, each after "! ". Two-port noise data is written when it
// reads back, that is when its first stimulus value does not exceed the last network one;
// otherwise a warning goes to `warnings`. Precondition: every matrix trace has as many points
// as S11.
void WriteTouchstoneV1(const CSnPFileBase& file, const std::string& comment, std::ostream& out,
                       std::ostream& warnings);

}  // namespace lumenutil
