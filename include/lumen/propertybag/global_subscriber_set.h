/** @file */
/// @class LumenUtility::GlobalSubscriberSet
/// GlobalSubscriberSet: the change subscribers that hear from every property bag
/// (PropertyBag::m_GlobalSubscrbers), in ascending pointer order.
///
/// Bags live on different threads and all notify through this one set, so it is the place
/// where threads meet: every operation takes the set's lock, and Notify holds it while it calls
/// the subscribers. Once Erase returns, the erased subscriber is not being called on any other
/// thread and will not be, so it may be destroyed. The lock is recursive: a subscriber may
/// subscribe or unsubscribe (itself or others) from inside its call. A subscriber must not wait
/// there for another thread that notifies or subscribes, which would wait for the lock.
/// Thread-safety: every operation may be called from any thread.
/// Ownership: the pointers only; subscribers are not deleted.
#pragma once

#include <cstddef>
#include <mutex>
#include <string>

#include "lumen/export.h"
#include "lumen/platform/com_variant.h"
#include "lumen/propertybag/pointer_set.h"
#include "lumen/propertybag/subscriber_interfaces.h"

namespace LumenUtility {

class LUMEN_API GlobalSubscriberSet {
 public:
  constexpr GlobalSubscriberSet() = default;
  GlobalSubscriberSet(const GlobalSubscriberSet&) = delete;
  GlobalSubscriberSet& operator=(const GlobalSubscriberSet&) = delete;

  /// Adds `subscriber` once; null and repeats change nothing.
  void Insert(IPropertyBagSubscriber* subscriber);
  /// Removes `subscriber`; an absent one changes nothing.
  void Erase(IPropertyBagSubscriber* subscriber);
  /// True when `subscriber` is in the set.
  bool Contains(const IPropertyBagSubscriber* subscriber) const;
  /// Number of subscribers.
  std::size_t Size() const;
  /// Tells every subscriber, in ascending pointer order, that `key` of `bag` changed to
  /// `value` (each gets its own copy with references followed). Throws as AfxCheckError when a
  /// copy fails (std::bad_alloc or COleException); no further subscriber is called then.
  void Notify(PropertyBag* bag, const std::string& key, const CComVariant& value);

 private:
  mutable std::recursive_mutex m_lock;
  PointerSet<IPropertyBagSubscriber> m_subscribers;
};

}  // namespace LumenUtility
