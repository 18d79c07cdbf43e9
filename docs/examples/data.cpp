// Measurement data files: a Touchstone file read, resampled and inspected; a malformed one.
// guide:begin
#include <cstdio>
#include <string>

#include "lumen/data.h"
#include "lumen/platform.h"

using namespace LumenUtility;

int main(int argc, char** argv) {
  if (argc < 2) return 2;
  CSnPFileBase file(2);  // a two-port file
  if (file.ReadSNPFile(Utf8ToWide(argv[1])) < 0) {
    std::printf("%ls\n", file.GetReadError().c_str());
    return 1;
  }
  const CSNParameter& s21 = file.GetParam(SNP_S21);
  std::printf("%s: %d points, %g to %g Hz\n", file.GetFileInfo().stimulusUnit.c_str(),
              s21.GetNumPoints(), s21.GetStartFreq(), s21.GetStopFreq());

  const InputArray passband(2.3e9, 2.5e9, 5, Linear);
  file.InterpolateReadSNPFile(passband, false);
  for (unsigned k = 0; k < passband.size(); ++k)
    std::printf("%.2f GHz  S21 %7.3f dB\n", passband[k] / 1e9, s21.GetData()[k].LogMag());

  CSnPFileBase broken(2);
  if (broken.ReadSNPText("# GHZ S RI R 50\n1.0 0.5 x\n") < 0)
    std::printf("rejected: %ls\n", broken.GetReadError().c_str());
}
// guide:end
