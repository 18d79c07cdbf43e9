#include "lumen/platform/rigel/cp_collection.h"

namespace Rigel {

CPCollection::Entry CPCollection::ptr_find(const std::wstring& element,
                                           const std::wstring& parameter) const {
  const std::int32_t index = ptr_find_index(element, parameter);
  return index < 0 ? Entry() : m_entries[static_cast<std::size_t>(index)];
}

std::int32_t CPCollection::ptr_find_index(const std::wstring& element,
                                          const std::wstring& parameter) const {
  for (std::size_t i = 0; i < m_entries.size(); ++i) {
    const CommandParameter& entry = *m_entries[i];
    if (entry.element_name() == element && entry.parameter() &&
        entry.parameter()->name() == parameter) {
      return static_cast<std::int32_t>(i);
    }
  }
  return -1;
}

void CPCollection::append(Entry entry) {
  if (entry) m_entries.push_back(std::move(entry));
}

bool CPCollection::remove(std::int32_t index) {
  if (index < 0 || static_cast<std::size_t>(index) >= m_entries.size()) return false;
  m_entries.erase(m_entries.begin() + index);
  return true;
}

CPCollection::Entry CPCollection::at(std::uint32_t index) const {
  return index < m_entries.size() ? m_entries[index] : Entry();
}

}  // namespace Rigel
