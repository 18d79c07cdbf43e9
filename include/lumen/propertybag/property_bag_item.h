/** @file */
/// @class LumenUtility::PropertyBagItem
/// PropertyBagItem: one setting kept in a PropertyBag under a key. The bag does not know what an
/// item holds; it drives the item through these four operations and never copies the item
/// object itself.
/// Thread-safety: as the item's implementation states; the bag calls it from the bag's thread.
/// Ownership: items are held through boost::shared_ptr and may sit in several bags at once.
#pragma once

#include <string>

#include "lumen/export.h"

class CArchive;

namespace LumenUtility {

class PropertyBag;

class LUMEN_API PropertyBagItem {
 public:
  /// Writes the item's state when `ar` is storing, reads it back when it is loading. An item
  /// must read exactly what it writes: the bag puts no length or delimiter around it.
  virtual void Serialize(CArchive& ar) = 0;
  /// Restores the state from `size` bytes at `data` (the payload of one legacy record; `data`
  /// may be the block's end when `size` is 0).
  virtual void LegacyRecall(const unsigned char* data, int size) = 0;
  /// Returns to the preset value; `key` is the item's key in `bag`, which is the caller.
  virtual void LoadPreset(const std::string& key, PropertyBag* bag) = 0;
  /// Takes over the state of `source`, the item of the same key in another bag; what `prefix`
  /// means is the item's own.
  virtual void CopyFrom(PropertyBagItem* source, const char* prefix) = 0;
  virtual ~PropertyBagItem() = default;

 protected:
  PropertyBagItem() = default;
  ///@{
  /// For derived items; the base holds nothing.
  PropertyBagItem(const PropertyBagItem&) = default;
  PropertyBagItem& operator=(const PropertyBagItem&) = default;
  ///@}
};

}  // namespace LumenUtility
