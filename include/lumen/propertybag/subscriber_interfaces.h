/// @file
/// The two interfaces through which a PropertyBag reaches the components that watch it:
/// IPropertyBagSubscriber learns of every signalled change, IPropertyBagSubscriberDestroy of the
/// bag's destruction.
/// Thread-safety: a bag calls its subscribers on the thread that signals or destroys it; global
/// subscribers (PropertyBag::m_GlobalSubscrbers) are called on the thread of any bag.
/// Ownership: bags hold bare pointers and never delete a subscriber; a subscriber unsubscribes
/// before it dies (PropertyBagSubscriber and GlobalPropertyBagSubscriber do so for a target).
#pragma once

#include <string>

#include "lumen/platform/com_variant.h"

namespace LumenUtility {

class PropertyBag;

/// Told of every change signalled on a bag it subscribed to.
class IPropertyBagSubscriber {
 public:
  /// The item under `key` in `bag` changed to `value` (a by-value copy: references are already
  /// followed). The subscriber may subscribe or unsubscribe itself or others during the call:
  /// the notification goes on with the next subscriber above this one in pointer order.
  virtual void OnItemChange(PropertyBag* bag, const std::string& key, CComVariant value) = 0;

 protected:
  ~IPropertyBagSubscriber() = default;
};

/// Told when a bag it subscribed to is destroyed.
class IPropertyBagSubscriberDestroy {
 public:
  /// `bag` is being destroyed; its items and subscriber sets are still intact during the call,
  /// and the subscriber may unsubscribe itself (or others) from it.
  virtual void OnPropertyBagBeingDestroyed(PropertyBag* bag) = 0;

 protected:
  ~IPropertyBagSubscriberDestroy() = default;
};

}  // namespace LumenUtility
