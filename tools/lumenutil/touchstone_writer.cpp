#include "lumenutil/touchstone_writer.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <sstream>
#include <vector>

#include "lumenutil/snp_file.h"
#include "lumenutil/trace_format.h"

namespace lumenutil {
namespace {

void WritePair(std::ostream& out, const LumenUtility::TsComplex& v) {
  out << ' ' << Shortest(v.re) << ' ' << Shortest(v.im);
}

void WriteNoise(const CSnPFileBase& file, double lastNetworkStimulus, std::ostream& out,
                std::ostream& warnings) {
  const SnPFileInfo& info = file.GetFileInfo();
  if (file.GetSNPType() != SNP_2PORT || info.noisePoints <= 0 || file.GetNumCustomParams() < 3) {
    return;
  }
  const CSNParameter& nf = file.GetCustomParam(0);
  const CSNParameter& gamma = file.GetCustomParam(1);
  const CSNParameter& rn = file.GetCustomParam(2);
  const int records = std::min(info.noisePoints, nf.GetNumPoints());
  if (records <= 0) return;
  const std::vector<double> x = nf.GetStimulus().GetArray();
  if (x.front() > lastNetworkStimulus) {
    warnings << "noise data not written: it starts above the last network point, where a "
                "version 1 reader would take it for network data\n";
    return;
  }
  out << "! Noise Parameters\n";
  const double r = info.referenceResistance;
  for (int i = 0; i < records; ++i) {
    // The reader stores 10^(NFmin/10) as a magnitude and Rn in ohms.
    const double nfDb = 10.0 * std::log10(nf.GetData()[i].re);
    const double angle = gamma.GetData()[i].Phase() * kDegreesPerRadian;
    char line[160];
    std::snprintf(line, sizeof line, " %.9g %.9g %.9g %.9g", nfDb, gamma.GetData()[i].Mag(), angle,
                  r != 0 ? rn.GetData()[i].re / r : 0.0);
    out << Shortest(x[i]) << line << '\n';
  }
}

}  // namespace

void WriteTouchstoneV1(const CSnPFileBase& file, const std::string& comment, std::ostream& out,
                       std::ostream& warnings) {
  const SnPFileInfo& info = file.GetFileInfo();
  const int n = file.GetSNPType();
  std::istringstream lines(comment);
  for (std::string line; std::getline(lines, line);) out << "! " << line << '\n';
  out << "# " << AxisOf(file.GetResultType()).token << ' ' << info.parameter << " RI R "
      << Shortest(info.referenceResistance) << '\n';
  const std::vector<double> x = file.GetParam(SNP_S11).GetStimulus().GetArray();
  const auto value = [&](int row, int column, std::size_t i) {
    return file.GetParam(static_cast<ESNParam>((row - 1) * n + column - 1)).GetData().at(i);
  };
  for (std::size_t i = 0; i < x.size(); ++i) {
    out << Shortest(x[i]);
    if (n <= 2) {
      // Two-port pairs in version 1 order: 11 21 12 22.
      for (int column = 1; column <= n; ++column) {
        for (int row = 1; row <= n; ++row) WritePair(out, value(row, column, i));
      }
      out << '\n';
      continue;
    }
    for (int row = 1; row <= n; ++row) {
      for (int column = 1; column <= n; ++column) {
        if (column > 1 && (column - 1) % 4 == 0) out << "\n ";
        WritePair(out, value(row, column, i));
      }
      out << (row < n ? "\n " : "\n");
    }
  }
  if (!x.empty()) WriteNoise(file, x.back(), out, warnings);
}

}  // namespace lumenutil
