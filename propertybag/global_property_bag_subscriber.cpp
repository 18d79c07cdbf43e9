#include "lumen/propertybag/global_property_bag_subscriber.h"

#include "lumen/propertybag/property_bag.h"

namespace LumenUtility {

GlobalPropertyBagSubscriber::GlobalPropertyBagSubscriber(IPropertyBagSubscriber* target) {
  Init(target);
}

GlobalPropertyBagSubscriber& GlobalPropertyBagSubscriber::operator=(
    const GlobalPropertyBagSubscriber& other) {
  if (this == &other) return *this;
  if (m_target && m_target != other.m_target) PropertyBag::GlobalUnsubscribeChanges(m_target);
  m_target = other.m_target;
  return *this;
}

GlobalPropertyBagSubscriber::~GlobalPropertyBagSubscriber() {
  if (m_target) PropertyBag::GlobalUnsubscribeChanges(m_target);
}

void GlobalPropertyBagSubscriber::Init(IPropertyBagSubscriber* target) {
  if (m_target) {
    PropertyBag::GlobalUnsubscribeChanges(m_target);
    m_target = nullptr;
  }
  if (target) {
    m_target = target;
    PropertyBag::GlobalSubscribeChanges(target);
  }
}

}  // namespace LumenUtility
