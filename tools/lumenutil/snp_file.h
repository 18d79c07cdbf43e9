// What the `snp` commands share: reading a Touchstone file with errors that name the file
// and line, choosing traces by name, and printing numbers that read back exactly.
#pragma once

#include <string>
#include <vector>

#include "lumen/data.h"

namespace lumenutil {

// Reads the Touchstone file at `path` (UTF-8), or standard input for "-". Version 1 files are read as `ports` ports when
// that is above 0, else as the ".sNp" extension says, else as two ports. Throws
// std::runtime_error("PATH: line N: what is wrong") when the file cannot be read.
CSnPFileBase ReadTouchstone(const std::string& path, int ports);

// The warning for an option-line token the reader ignored, saying what the file is read as
// instead: "option 'THZ' ignored; frequencies read in GHz". ReadTouchstone prints one per
// such token on standard error.
std::string IgnoredOptionText(const std::string& token, const CSnPFileBase& file);

// Whether a reference resistance (ohms) can serve impedance and admittance conversions.
bool IsUsableResistance(double ohms);
// The reference resistance of `port` (from 1) in ohms: its [Reference] value, else the option
// line's. Throws std::runtime_error naming `path` when it is 0, negative or not finite.
double PortReference(const CSnPFileBase& file, int port, const std::string& path);

// Throws std::runtime_error("PATH: line N: ...") naming the first point whose stimulus is
// not above the one before: interpolation over such a trace means nothing.
void RequireAscendingStimulus(const CSnPFileBase& file, const std::string& path);

// A matrix position, rows and columns from 1, and its trace name ("S21", "S1_10").
struct MatrixPosition {
  int row;
  int column;
  std::string name;
};

// The positions named in a comma-separated list such as "S21,s11,S1_10" (order kept), or,
// for an empty list, every position in the order a file lists them (S11, S21, S12, S22 for a
// two-port file in that order). Throws std::runtime_error for a name that is not a position
// of a `ports`-port network.
std::vector<MatrixPosition> SelectPositions(const std::string& list, const CSnPFileBase& file);

// The trace at `position`.
const CSNParameter& TraceAt(const CSnPFileBase& file, const MatrixPosition& position);

// The shortest decimal text that reads back to exactly `value`.
std::string Shortest(double value);
std::string Shortest(float value);

// What the stimulus column of a file holds, for labels and column headers.
struct StimulusAxis {
  std::string quantity;  // "Frequency", "Time", "Power", "Point"
  std::string unit;      // "Hz", "s", "dBm", ""
  std::string column;    // CSV header: "frequency_Hz", ...
  bool siPrefix;         // whether values take engineering prefixes (1.5 GHz)
  std::string token;     // the unit on a Touchstone option line: "HZ", "SEC", "DBM", "POINT"
};
StimulusAxis AxisOf(ResultType type);

// `value` with an engineering prefix for `unit` and at most `digits` significant digits,
// as "1.5 GHz"; without a prefix when `siPrefix` is false ("-10 dBm").
std::string WithUnit(double value, const std::string& unit, bool siPrefix, int digits = 6);

// `value` with at most `digits` significant digits, for tables people read ("0.1", "-3.5e-05").
std::string Rounded(double value, int digits = 6);
// `text` in ASCII lower case ("Frequency" becomes "frequency").
std::string LowerAscii(std::string text);

}  // namespace lumenutil
