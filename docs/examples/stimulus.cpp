// Stimulus arrays: a sweep of two segments, its points, its packed record and an index error.
// guide:begin
#include <cstdio>
#include <vector>

#include "lumen/platform.h"
#include "lumen/stimulus.h"

using namespace LumenUtility;

int main() {
  InputArray sweep(1e9, 2e9, 11, Linear);    // 1 to 2 GHz in 100 MHz steps
  sweep.push_back(Segment(2e9, 8e9, 3, Log));  // then 2, 4 and 8 GHz
  std::printf("%u points in %u segments, %g to %g Hz\n", sweep.size(), sweep.NumSegments(),
              sweep.min_element(), sweep.max_element());
  std::printf("point 12: %g Hz, monotonic: %d\n", sweep[12], sweep.IsMonotonic());

  std::vector<unsigned char> record(sweep.SaveData(nullptr, 0));  // size query
  sweep.SaveData(record.data(), static_cast<int>(record.size()));
  InputArray copy;
  copy.RecallData(record.data(), static_cast<int>(record.size()));
  std::printf("record of %zu bytes reads back equal: %d\n", record.size(), copy == sweep);

  try {
    sweep[14];
  } catch (const LumenException& e) {
    std::printf("error 0x%08X: %ls\n", static_cast<unsigned>(e.GetCode()),
                e.GetMessage().c_str());
  }
}
// guide:end
