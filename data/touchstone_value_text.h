// The numbers of a Touchstone file chosen backwards from the values a reader is to hold:
// for each stored float or double, the file number of fewest significant digits whose
// reading (the arithmetic of CSnPFileBase) gives it back bit for bit.
//
// A reading multiplies by a unit, takes cosines of degrees or powers of ten, so an exact file
// number is found by trying the float or double nearest the inverse and its neighbours (two
// steps either way), and then the inverse rounded to 1, 2, ... digits until one of those
// reads back exactly too (a file that said "-0.00758" dB gets "-0.00758" again rather than
// the "-0.007579708" of the float parts). Where no neighbour reads back exactly, the nearest
// one found is taken and the result says so. Thread-safety: pure functions.
#pragma once

#include <string>

#include "lumen/core/ts_complex.h"
#include "lumen/data/snp_types.h"

namespace LumenUtility {

// Appends the shortest text that a C++ stream reads back to exactly `value` ("0.1", "1e-07",
// "-0"). Precondition: `value` is finite.
void AppendShortest(std::string& out, float value);
void AppendShortest(std::string& out, double value);

// A value pair of a file line and what the reader makes of it.
struct FilePair {
  float a = 0.0f;
  float b = 0.0f;
  bool exact = false;  // the reading is the held value bit for bit
  TsComplex readBack;  // the reading (CSNParameter::FromPair)
};

// The pair whose reading in `form` is `value`; for MA and DB the magnitude is >= 0 and the
// angle in [-180, 180] degrees, and an exact zero is written as -1000 dB, which reads back
// as zero. Precondition: both parts of `value` are finite and `form` is RI, MA or DB.
FilePair PairForValue(TsComplex value, ESNPForm form);

// A file number and its reading.
template <typename T>
struct FileNumber {
  T text = T();           // the number to write
  bool exact = false;     // its reading is the held value bit for bit
  double readBack = 0.0;  // the reading
};

// The number q whose reading q * multiplier (in double) is the stimulus `x`.
// Preconditions: `x` finite, `multiplier` one of 1, 1e3, 1e6, 1e9.
FileNumber<double> StimulusInUnit(double x, double multiplier);

// The minimum noise figure in dB whose reading (doubled, then 10^(0.05 * that)) is the noise
// factor `factor`. Precondition: `factor` > 0 and finite.
FileNumber<float> NoiseFigureDb(float factor);

// The normalised noise resistance t whose reading float(t * reference) is `ohms`.
// Precondition: `ohms` finite, `reference` finite and not 0.
FileNumber<float> NormalisedResistance(float ohms, double reference);

}  // namespace LumenUtility
