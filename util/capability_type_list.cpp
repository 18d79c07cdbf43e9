#include "util/capability_type_list.h"

#include <algorithm>

namespace LumenUtility {

int CapabilityTypeList::Register(std::string_view name) {
  const auto found = std::find(m_names.begin(), m_names.end(), name);
  if (found != m_names.end()) return static_cast<int>(found - m_names.begin());
  m_names.emplace_back(name);
  return static_cast<int>(m_names.size() - 1);
}

}  // namespace LumenUtility
