// Counts heap allocations of the benchmark process, so a benchmark can report how many
// allocations and bytes an operation costs (the counters cover every thread).
#pragma once

#include <cstddef>
#include <cstdint>

namespace lumen_bench {

struct AllocationTotals {
  std::uint64_t count = 0;
  std::uint64_t bytes = 0;
};

AllocationTotals CurrentAllocations();

// Allocations made between construction and Totals().
class AllocationScope {
 public:
  AllocationScope() : m_start(CurrentAllocations()) {}
  AllocationTotals Totals() const {
    const AllocationTotals now = CurrentAllocations();
    return {now.count - m_start.count, now.bytes - m_start.bytes};
  }

 private:
  AllocationTotals m_start;
};

}  // namespace lumen_bench
