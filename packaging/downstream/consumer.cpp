// A program built against the installed library, as a downstream project builds it: reads a
// two-port Touchstone file, carries its traces onto one frequency and prints the transmission
// there as "S21 at F Hz: M dB, P deg".
#include <cmath>
#include <cstdio>
#include <cstdlib>

#include "lumen/core.h"
#include "lumen/data.h"
#include "lumen/platform/text_conversion.h"
#include "lumen/stimulus.h"

int main(int argc, char** argv) {
  if (argc != 3) {
    std::fprintf(stderr, "usage: %s FILE.s2p FREQUENCY_HZ\n", argv[0]);
    return 2;
  }
  char* end = nullptr;
  const double frequency = std::strtod(argv[2], &end);
  if (*end != '\0' || !(frequency > 0)) {
    std::fprintf(stderr, "%s: not a frequency in Hz: '%s'\n", argv[0], argv[2]);
    return 2;
  }
  CSnPFileBase file(2);
  if (file.ReadSNPFile(LumenUtility::Utf8ToWide(argv[1])) < 0) {
    std::fprintf(stderr, "%s: %s: %s\n", argv[0], argv[1],
                 LumenUtility::WideToUtf8(file.GetReadError()).c_str());
    return 1;
  }
  file.InterpolateReadSNPFile(LumenUtility::InputArray(frequency, 1), true);
  const CSNParameter& s21 = file.GetParam(SNP_S21);
  if (s21.GetData().size() != 1) {
    std::fprintf(stderr, "%s: %s: no S21 value at %g Hz\n", argv[0], argv[1], frequency);
    return 1;
  }
  const LumenUtility::TsComplex value = s21.GetData().front();
  std::printf("S21 at %g Hz: %.4f dB, %.3f deg\n", frequency, value.LogMag(),
              value.Phase() * 180.0 / M_PI);
  return 0;
}
