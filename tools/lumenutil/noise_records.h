// The two-port noise data of a Touchstone file as engineers read it: one record per noise
// frequency, in the units of the file's noise block.
#pragma once

#include <ostream>
#include <string>
#include <vector>

#include "lumen/data.h"

namespace lumenutil {

struct NoiseRecord {
  double stimulus;  // Hz (or the file's own stimulus unit)
  double nfMinDb;   // minimum noise figure, dB
  double gammaMag;  // |GammaOpt|, the optimum source reflection
  double gammaDeg;  // its angle, degrees
  double rnOhm;     // equivalent noise resistance, ohms
};

// The noise records of `file` (none when it holds no noise data).
std::vector<NoiseRecord> NoiseRecords(const CSnPFileBase& file);

// The records of the file at `path`; throws std::runtime_error("PATH: holds no noise data")
// when there are none.
std::vector<NoiseRecord> RequireNoiseRecords(const CSnPFileBase& file, const std::string& path);

// Writes the records as a table: the stimulus column of the file's axis, then NFmin_dB,
// GammaOpt_mag, GammaOpt_deg and Rn_ohm, separated by `delimiter`; only the first `limit`
// records when `limit` is above 0.
void WriteNoiseTable(const std::vector<NoiseRecord>& records, ResultType stimulus,
                     const std::string& delimiter, int limit, std::ostream& out);

}  // namespace lumenutil
