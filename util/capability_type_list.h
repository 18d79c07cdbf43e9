// CapabilityTypeList: the names of the interface types used as the table's third key.
//
// A type's index is its position in order of first registration, so two modules that
// register the same type (by name, as std::type_info::name gives it) agree on its index
// without sharing any code.
//
// Thread-safety: none. Owned by value; the process-wide instance is never destroyed.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace LumenUtility {

class CapabilityTypeList {
 public:
  // Returns the position of name, appending it when it is new.
  int Register(std::string_view name);

  std::size_t size() const { return m_names.size(); }

 private:
  std::vector<std::string> m_names;
};

}  // namespace LumenUtility
