/** @file */
/// @class Rigel::CPCollection
/// Rigel::CPCollection: an ordered list of command parameters, found by element and
/// parameter name.
///
/// Names compare exactly (case-sensitive). Several entries may carry the same pair; the finds
/// answer the first of them.
/// Thread-safety: confine to one thread. Ownership: entries are shared pointers; the
/// collection keeps them alive while they are in it.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "lumen/export.h"
#include "lumen/platform/rigel/command_parameter.h"

namespace Rigel {

class LUMEN_API CPCollection {
 public:
  /// How entries are held.
  using Entry = boost::shared_ptr<CommandParameter>;

  /// The first entry of element `element` whose value is named `parameter`, or an empty
  /// pointer.
  Entry ptr_find(const std::wstring& element, const std::wstring& parameter) const;
  /// The position of that entry, or -1.
  std::int32_t ptr_find_index(const std::wstring& element, const std::wstring& parameter) const;
  /// Adds `entry` at the end; an empty pointer is ignored.
  void append(Entry entry);
  /// Removes the entry at `index`; returns false and changes nothing when there is none.
  bool remove(std::int32_t index);

  /// Number of entries.
  std::uint32_t size() const { return static_cast<std::uint32_t>(m_entries.size()); }
  /// The entry at `index`, or an empty pointer past the end.
  Entry at(std::uint32_t index) const;

 private:
  std::vector<Entry> m_entries;
};

}  // namespace Rigel
