/** @file */
/// @class LumenUtility::PropertyBagSubscriber
/// PropertyBagSubscriber: a scoped attachment of a change subscriber (the target) to one bag.
///
/// While attached, the target is among the bag's change subscribers and this object among its
/// destroy subscribers; detaching (Init, destruction, or the bag's destruction) removes both.
/// A copy shares the attachment: it joins the bag's destroy subscribers, so it too lets go when
/// the bag dies first, and detaching any copy ends the target's change subscription. Assigning
/// over an attached object detaches it first.
/// Thread-safety: confine to the bag's thread. Ownership: neither the bag nor the target is
/// owned; both must outlive the attachment (the bag may die first: the object then detaches).
#pragma once

#include "lumen/export.h"
#include "lumen/propertybag/subscriber_interfaces.h"

namespace LumenUtility {

class LUMEN_API PropertyBagSubscriber : public IPropertyBagSubscriberDestroy {
 public:
  PropertyBagSubscriber() = default;
  /// Subscribes `target` to the changes of `bag`; either null: nothing is subscribed.
  PropertyBagSubscriber(PropertyBag* bag, IPropertyBagSubscriber* target);
  /// Subscribes `other`'s target to `other`'s bag once more, for this object.
  PropertyBagSubscriber(const PropertyBagSubscriber& other);
  /// Ends this object's subscription and subscribes as the copy constructor does.
  PropertyBagSubscriber& operator=(const PropertyBagSubscriber& other);
  virtual ~PropertyBagSubscriber();

  /// Detaches from the present bag, then attaches `target` to `bag` when both are non-null
  /// (otherwise stays detached).
  void Init(PropertyBag* bag, IPropertyBagSubscriber* target);
  /// Detaches from the stored bag (the one that is being destroyed).
  void OnPropertyBagBeingDestroyed(PropertyBag* bag) override;

  /// The bag attached to, or null when detached.
  PropertyBag* GetBag() const { return m_bag; }

 private:
  void Detach();

  PropertyBag* m_bag = nullptr;
  IPropertyBagSubscriber* m_target = nullptr;
};

}  // namespace LumenUtility
