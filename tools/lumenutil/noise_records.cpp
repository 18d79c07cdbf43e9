#include "lumenutil/noise_records.h"

#include <algorithm>
#include <cmath>
#include <stdexcept>

#include "lumenutil/snp_file.h"
#include "lumenutil/trace_format.h"

namespace lumenutil {

std::vector<NoiseRecord> NoiseRecords(const CSnPFileBase& file) {
  std::vector<NoiseRecord> records;
  if (file.GetNumCustomParams() < 3) return records;
  // The reader keeps NFmin as the noise factor 10^(NFmin/10), GammaOpt as a complex value
  // and Rn in ohms, each on the records' own stimulus.
  const CSNParameter& nf = file.GetCustomParam(0);
  const CSNParameter& gamma = file.GetCustomParam(1);
  const CSNParameter& rn = file.GetCustomParam(2);
  const std::vector<double> x = nf.GetStimulus().GetArray();
  const std::size_t count =
      std::min({x.size(), nf.GetData().size(), gamma.GetData().size(), rn.GetData().size()});
  for (std::size_t i = 0; i < count; ++i) {
    const LumenUtility::TsComplex& g = gamma.GetData()[i];
    // atan2 rather than Phase(): a GammaOpt of exactly 0 shows 0 degrees, not 90.
    records.push_back(
        {x[i], 10.0 * std::log10(static_cast<double>(nf.GetData()[i].re)), g.Mag(),
         std::atan2(static_cast<double>(g.im), static_cast<double>(g.re)) * kDegreesPerRadian,
         rn.GetData()[i].re});
  }
  return records;
}

std::vector<NoiseRecord> RequireNoiseRecords(const CSnPFileBase& file, const std::string& path) {
  std::vector<NoiseRecord> records = NoiseRecords(file);
  if (records.empty()) throw std::runtime_error(path + ": holds no noise data");
  return records;
}

void WriteNoiseTable(const std::vector<NoiseRecord>& records, ResultType stimulus,
                     const std::string& delimiter, int limit, std::ostream& out) {
  const std::string& d = delimiter;
  out << AxisOf(stimulus).column << d << "NFmin_dB" << d << "GammaOpt_mag" << d << "GammaOpt_deg"
      << d << "Rn_ohm\n";
  std::size_t count = records.size();
  if (limit > 0 && static_cast<std::size_t>(limit) < count) count = static_cast<std::size_t>(limit);
  for (std::size_t i = 0; i < count; ++i) {
    const NoiseRecord& r = records[i];
    // Single-precision data: every digit a float holds, as the other exports print them.
    out << Shortest(r.stimulus) << d << Shortest(static_cast<float>(r.nfMinDb)) << d
        << Shortest(static_cast<float>(r.gammaMag)) << d << Shortest(static_cast<float>(r.gammaDeg))
        << d << Shortest(static_cast<float>(r.rnOhm)) << '\n';
  }
}

}  // namespace lumenutil
