#include "util/capability_table.h"

#include <stdexcept>

namespace LumenUtility {
namespace {

template <class Vector>
void GrowTo(Vector& v, int index) {
  if (v.size() <= static_cast<std::size_t>(index)) v.resize(static_cast<std::size_t>(index) + 1);
}

template <class Vector>
bool Holds(const Vector& v, int index) {
  return index >= 0 && static_cast<std::size_t>(index) < v.size();
}

}  // namespace

bool CapabilityTable::Has(int i, int j, int k) const {
  return Holds(m_table, i) && Holds(m_table[i], j) && Holds(m_table[i][j], k);
}

void CapabilityTable::Set(int i, int j, int k, std::intptr_t value) {
  if (i < 0 || j < 0 || k < 0) throw std::invalid_argument("capability index is negative");
  GrowTo(m_table, i);
  GrowTo(m_table[i], j);
  GrowTo(m_table[i][j], k);
  m_table[i][j][k] = value;
}

std::intptr_t CapabilityTable::Get(int i, int j, int k) {
  if (i < 0 || j < 0 || k < 0) return 0;
  GrowTo(m_table, i);
  if (!Holds(m_table[i], j)) return 0;
  Row& row = m_table[i][j];
  GrowTo(row, k);
  return row[k];
}

int CapabilityTable::RemoveValue(int i, int k, std::intptr_t value) {
  if (!Holds(m_table, i)) return 0;
  for (Row& row : m_table[i]) {
    if (Holds(row, k) && row[k] == value) row[k] = 0;
  }
  return static_cast<int>(m_table[i].size());
}

int CapabilityTable::Clear(int i, int j, int k) {
  if (!Has(i, j, k)) return 0;
  m_table[i][j][k] = 0;
  return k;
}

std::vector<int> CapabilityTable::Find(int i, int k) {
  std::vector<int> found;
  if (i < 0) return found;
  GrowTo(m_table, i);
  const std::vector<Row>& rows = m_table[i];
  for (std::size_t j = 0; j < rows.size(); ++j) {
    if (Holds(rows[j], k) && rows[j][k] != 0) found.push_back(static_cast<int>(j));
  }
  return found;
}

std::size_t CapabilityTable::MiddleSize(int i) const {
  return Holds(m_table, i) ? m_table[i].size() : 0;
}

std::size_t CapabilityTable::InnerSize(int i, int j) const {
  return Holds(m_table, i) && Holds(m_table[i], j) ? m_table[i][j].size() : 0;
}

}  // namespace LumenUtility
