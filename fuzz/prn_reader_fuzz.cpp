// Reads arbitrary bytes as a PRN calibration file, then looks the phase up on the file's own
// points and on a sweep across its range. Loading always succeeds and gives one unit phasor
// per finite point; the lookups give one value per point asked for or the lookup code.
#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "lumen/phase/prn_reader.h"
#include "memory_file.h"

namespace {

using lumen_fuzz::MemoryFile;

void Check(bool condition) {
  if (!condition) __builtin_trap();
}

void CheckLookup(const PrnReader& reader, const LumenUtility::InputArray& sweep) {
  try {
    const std::vector<LumenUtility::TsComplex> phase = reader.GetPhase(sweep);
    Check(phase.size() == sweep.size());
  } catch (std::int32_t code) {
    Check(code == PrnReader::kPhaseLookupFailed);
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const MemoryFile file(data, size);
  PrnReader reader;
  Check(reader.LoadFile(file.Path()));
  const LumenUtility::InputArray& points = reader.GetStimulus();
  const std::vector<LumenUtility::TsComplex>& values = reader.GetValues();
  Check(points.size() == values.size());
  for (unsigned k = 0; k < points.size(); ++k) {
    Check(std::isfinite(points[k]));
    Check(std::fabs(std::hypot(values[k].re, values[k].im) - 1.0) < 1e-5);
  }
  CheckLookup(reader, points);
  if (!points.empty()) {
    const auto [low, high] = std::minmax_element(points.begin(), points.end());
    CheckLookup(reader, LumenUtility::InputArray(*low, *high, 5, LumenUtility::SegmentType(0)));
  }
  return 0;
}
