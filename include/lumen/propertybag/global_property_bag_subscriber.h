/** @file */
/// @class LumenUtility::GlobalPropertyBagSubscriber
/// GlobalPropertyBagSubscriber: a scoped subscription of a change subscriber (the target) to
/// the changes of every bag (PropertyBag::m_GlobalSubscrbers).
///
/// Copies share the subscription; the first of them to let go ends it. Assigning over an
/// attached object lets go of its own target first.
/// Thread-safety: one object on one thread at a time; different objects may attach and detach
/// on different threads. Ownership: the target is not owned and must outlive the subscription.
#pragma once

#include "lumen/export.h"
#include "lumen/propertybag/subscriber_interfaces.h"

namespace LumenUtility {

class LUMEN_API GlobalPropertyBagSubscriber {
 public:
  GlobalPropertyBagSubscriber() = default;
  /// Subscribes `target` (may be null: then nothing) to the changes of every bag.
  explicit GlobalPropertyBagSubscriber(IPropertyBagSubscriber* target);
  /// Shares `other`'s subscription; it ends when the last copy goes.
  GlobalPropertyBagSubscriber(const GlobalPropertyBagSubscriber& other) = default;
  /// Gives up this object's share of its subscription and shares `other`'s.
  GlobalPropertyBagSubscriber& operator=(const GlobalPropertyBagSubscriber& other);
  ~GlobalPropertyBagSubscriber();

  /// Unsubscribes the stored target, if any, then subscribes `target` when it is non-null.
  void Init(IPropertyBagSubscriber* target);
  /// The subscribed target, or null.
  IPropertyBagSubscriber* GetTarget() const { return m_target; }

 private:
  IPropertyBagSubscriber* m_target = nullptr;
};

}  // namespace LumenUtility
