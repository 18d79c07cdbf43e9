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
  explicit GlobalPropertyBagSubscriber(IPropertyBagSubscriber* target);
  GlobalPropertyBagSubscriber(const GlobalPropertyBagSubscriber& other) = default;
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
