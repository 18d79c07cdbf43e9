/** @file */
/// @class LumenUtility::PropertyBag
/// PropertyBag: a keyed container of settings (PropertyBagItem) that tells subscribers when an
/// item's owner signals a change, and drives its items through preset, copy and persistence.
///
/// Keys are 8-bit strings in plain byte order, one item per key. Items are shared: copying a
/// bag, or Copy, puts the same item object into several bags. Change subscribers of this bag
/// hear its changes; the process-wide m_GlobalSubscrbers hear the changes of every bag after
/// them. Destroy subscribers hear of the bag's destruction. Every set walk asks for the next
/// member after the one just called, so subscribers and items may be added or removed from
/// inside a call without upsetting the walk.
/// Thread-safety: confine each bag to one thread. Copies that share items may live on
/// different threads (the items' reference counts are atomic), and m_GlobalSubscrbers may be
/// used from any thread (see GlobalSubscriberSet).
/// Ownership: items are shared through boost::shared_ptr; subscribers are not owned and must
/// unsubscribe before they die.
#pragma once

#include <boost/shared_ptr.hpp>
#include <map>
#include <string>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/com_variant.h"
#include "lumen/propertybag/global_subscriber_set.h"
#include "lumen/propertybag/pointer_set.h"
#include "lumen/propertybag/property_bag_item.h"
#include "lumen/propertybag/subscriber_interfaces.h"

class CArchive;

namespace LumenUtility {

class LUMEN_API PropertyBag {
 public:
  PropertyBag() = default;
  /// Shares `other`'s items; starts with no subscribers.
  PropertyBag(const PropertyBag& other);
  /// Shares `other`'s items in place of this bag's; the subscribers stay as they are.
  PropertyBag& operator=(const PropertyBag& other);
  /// Tells each destroy subscriber, in ascending pointer order, then drops the items.
  ~PropertyBag();

  /// Stores `item` under `key` unless `item` is empty or the key is taken (the old item stays).
  void AddItem(const std::string& key, boost::shared_ptr<PropertyBagItem> item);
  /// Removes the entry under `key`, if any.
  void RemoveItem(const std::string& key);
  /// Removes every entry; the subscribers stay.
  void RemoveAllItems();
  /// The item under `key`, or null.
  PropertyBagItem* GetItem(const std::string& key);
  /// The item under `key`, or null.
  const PropertyBagItem* GetItem(const std::string& key) const;
  /// A shared reference to the item under `key`, or an empty pointer.
  boost::shared_ptr<PropertyBagItem> GetItemPtr(const std::string& key);
  /// All keys in ascending byte order.
  std::vector<std::string> GetKeys() const;

  /// Makes this bag's key set equal to `source`'s: in key order, a key this bag lacks gets
  /// source's item (shared), a key it has gets CopyFrom(source's item, prefix) on its own item;
  /// then every key that `source` lacks is removed. Sends no notification itself.
  void Copy(PropertyBag& source, const char* prefix);
  /// Calls LoadPreset(key, this) on every item in key order.
  void LoadPresetValues();

  /// Tells this bag's change subscribers, then the global ones, in ascending pointer order each,
  /// that `key` changed to `value`; each gets its own copy with references followed. A null
  /// `key` is the empty key. Throws std::bad_alloc or COleException (as AfxCheckError) when a
  /// copy fails; no further subscriber is called then.
  void SignalItemChange(const std::string& key, CComVariant value);
  /// As above; a null `key` is the empty key.
  void SignalItemChange(const char* key, CComVariant value);
  /// Tells only the global subscribers, as SignalItemChange does, naming `bag`.
  static void GlobalSignalItemChange(PropertyBag* bag, const std::string& key, CComVariant value);

  /// Each subscriber is in a set at most once; null is ignored, erasing an absent one does
  /// nothing.
  void SubscribeChanges(IPropertyBagSubscriber* subscriber);
  /// Removes a change subscriber; an absent one changes nothing.
  void UnsubscribeChanges(IPropertyBagSubscriber* subscriber);
  /// Adds a destroy subscriber (null or present: nothing).
  void SubscribeDestroy(IPropertyBagSubscriberDestroy* subscriber);
  /// Removes a destroy subscriber; an absent one changes nothing.
  void UnsubscribeDestroy(IPropertyBagSubscriberDestroy* subscriber);
  /// Adds a subscriber to the changes of every bag (null or present: nothing).
  static void GlobalSubscribeChanges(IPropertyBagSubscriber* subscriber);
  /// Removes a global subscriber; an absent one changes nothing.
  static void GlobalUnsubscribeChanges(IPropertyBagSubscriber* subscriber);

  /// Writes the item count (4 bytes), then per item in key order the key (converted from
  /// UTF-8, in the archive's wide-string form) and what the item's Serialize writes. Throws
  /// CArchiveException genericException, before writing anything, for a key that is not valid
  /// UTF-8 (it could not be found again on recall); a loading archive throws readOnly.
  void SaveContext(CArchive& ar);
  /// Reads what SaveContext wrote: a count below 1 reads nothing more; each key is looked up
  /// and its item's Serialize reads the payload, except under "UnguidedIsolationORRIN" and
  /// "OrrinUserCharacterizerPropBagItem", which carry none. Throws CArchiveException badIndex
  /// for a key the bag does not hold (the rest is not read; items restored so far keep their
  /// new state), and passes on the archive's exceptions (endOfFile for a short archive,
  /// writeOnly for a storing one). Items the archive does not name keep their state.
  void RecallContext(CArchive& ar);
  /// Hands each record of a legacy block of `size` bytes at `data` (a key and its zero byte, a
  /// 4-byte little-endian length L, L payload bytes) to the item under its key, by
  /// LegacyRecall(payload, L); keys the bag does not hold are skipped. Stops at the end of the
  /// block, and before a record whose terminator, length or payload would run past it. Does
  /// nothing for null `data` or `size` below 1.
  void LegacyRecallContext(const unsigned char* data, int size);

  /// The subscribers that hear the changes of every bag.
  static GlobalSubscriberSet m_GlobalSubscrbers;

 private:
  using ItemMap = std::map<std::string, boost::shared_ptr<PropertyBagItem>>;

  ItemMap m_items;
  PointerSet<IPropertyBagSubscriber> m_changeSubscribers;
  PointerSet<IPropertyBagSubscriberDestroy> m_destroySubscribers;
};

}  // namespace LumenUtility
