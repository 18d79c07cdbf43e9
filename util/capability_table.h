// CapabilityTable: the three-level table behind the capabilities accessor.
//
// table[i][j][k] holds a pointer-sized value; entries that were never set, and entries past
// the end of any level, read as 0. Each level grows on demand, and lookups grow some levels
// too (see Get and Find), so the table's shape depends on the order of calls; hosts written
// against that shape keep working.
//
// Thread-safety: none. Owned by value; the process-wide instance is never destroyed.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace LumenUtility {

class CapabilityTable {
 public:
  // Stores value at [i][j][k], growing every level as needed. Throws std::invalid_argument
  // for a negative index.
  void Set(int i, int j, int k, std::intptr_t value);

  // Grows the outer level to i + 1 entries. When table[i] has more than j entries, grows
  // table[i][j] to k + 1 entries and returns [i][j][k]; otherwise returns 0. A negative
  // index gives 0 and changes nothing.
  std::intptr_t Get(int i, int j, int k);

  // Zeroes [i][j][k] for every j where it equals value; returns the number of j entries
  // under i, or 0 when i does not exist.
  int RemoveValue(int i, int k, std::intptr_t value);

  // Zeroes [i][j][k] and returns k; returns 0 and changes nothing when it does not exist.
  int Clear(int i, int j, int k);

  // Grows the outer level to i + 1 entries and returns, ascending, every j whose [i][j][k]
  // exists and is non-zero. A negative i gives an empty result and changes nothing.
  std::vector<int> Find(int i, int k);

  // The table's shape, for checks: the number of i entries, of j entries under i and of k
  // entries under [i][j] (0 for anything that does not exist).
  std::size_t OuterSize() const { return m_table.size(); }
  std::size_t MiddleSize(int i) const;
  std::size_t InnerSize(int i, int j) const;

 private:
  using Row = std::vector<std::intptr_t>;

  bool Has(int i, int j, int k) const;

  std::vector<std::vector<Row>> m_table;
};

}  // namespace LumenUtility
