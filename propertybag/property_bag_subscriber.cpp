#include "lumen/propertybag/property_bag_subscriber.h"

#include "lumen/propertybag/property_bag.h"

namespace LumenUtility {

PropertyBagSubscriber::PropertyBagSubscriber(PropertyBag* bag, IPropertyBagSubscriber* target) {
  Init(bag, target);
}

PropertyBagSubscriber::PropertyBagSubscriber(const PropertyBagSubscriber& other)
    : IPropertyBagSubscriberDestroy(other), m_bag(other.m_bag), m_target(other.m_target) {
  if (m_bag) m_bag->SubscribeDestroy(this);
}

PropertyBagSubscriber& PropertyBagSubscriber::operator=(const PropertyBagSubscriber& other) {
  // The same attachment stays as it is: detaching first would end the target's subscription.
  if (m_bag == other.m_bag && m_target == other.m_target) return *this;
  Detach();
  m_bag = other.m_bag;
  m_target = other.m_target;
  if (m_bag) m_bag->SubscribeDestroy(this);
  return *this;
}

PropertyBagSubscriber::~PropertyBagSubscriber() {
  Detach();
}

void PropertyBagSubscriber::Init(PropertyBag* bag, IPropertyBagSubscriber* target) {
  Detach();
  if (!bag || !target) return;
  m_bag = bag;
  m_target = target;
  bag->SubscribeChanges(target);
  bag->SubscribeDestroy(this);
}

void PropertyBagSubscriber::OnPropertyBagBeingDestroyed(PropertyBag*) {
  Detach();
}

void PropertyBagSubscriber::Detach() {
  if (m_bag && m_target) {
    m_bag->UnsubscribeChanges(m_target);
    m_bag->UnsubscribeDestroy(this);
  }
  m_bag = nullptr;
  m_target = nullptr;
}

}  // namespace LumenUtility
