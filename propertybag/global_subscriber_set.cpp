#include "lumen/propertybag/global_subscriber_set.h"

#include "propertybag/change_notice.h"

namespace LumenUtility {

void GlobalSubscriberSet::Insert(IPropertyBagSubscriber* subscriber) {
  const std::lock_guard<std::recursive_mutex> hold(m_lock);
  m_subscribers.Insert(subscriber);
}

void GlobalSubscriberSet::Erase(IPropertyBagSubscriber* subscriber) {
  const std::lock_guard<std::recursive_mutex> hold(m_lock);
  m_subscribers.Erase(subscriber);
}

bool GlobalSubscriberSet::Contains(const IPropertyBagSubscriber* subscriber) const {
  const std::lock_guard<std::recursive_mutex> hold(m_lock);
  return m_subscribers.Contains(subscriber);
}

std::size_t GlobalSubscriberSet::Size() const {
  const std::lock_guard<std::recursive_mutex> hold(m_lock);
  return m_subscribers.Size();
}

void GlobalSubscriberSet::Notify(PropertyBag* bag, const std::string& key,
                                 const CComVariant& value) {
  const std::lock_guard<std::recursive_mutex> hold(m_lock);
  NotifyEach(m_subscribers, bag, key, value);
}

}  // namespace LumenUtility
