#include "lumen/propertybag/property_bag.h"

#include <utility>

#include "propertybag/change_notice.h"

namespace LumenUtility {

namespace {

// Calls `call(key, item)` for each entry of `items` in key order, continuing after each call
// with the first key above the one called, so the call may add or remove entries. The item
// is held for the call even when its entry goes.
template <typename Call>
void ForEachItem(std::map<std::string, boost::shared_ptr<PropertyBagItem>>& items, Call call) {
  for (auto entry = items.begin(); entry != items.end();) {
    const std::string key = entry->first;
    const boost::shared_ptr<PropertyBagItem> item = entry->second;
    call(key, item);
    entry = items.upper_bound(key);
  }
}

}  // namespace

constinit GlobalSubscriberSet PropertyBag::m_GlobalSubscrbers;

PropertyBag::PropertyBag(const PropertyBag& other) : m_items(other.m_items) {}

PropertyBag& PropertyBag::operator=(const PropertyBag& other) {
  if (this != &other) m_items = other.m_items;
  return *this;
}

PropertyBag::~PropertyBag() {
  for (IPropertyBagSubscriberDestroy* subscriber = m_destroySubscribers.NextAfter(nullptr);
       subscriber; subscriber = m_destroySubscribers.NextAfter(subscriber)) {
    subscriber->OnPropertyBagBeingDestroyed(this);
  }
}

void PropertyBag::AddItem(const std::string& key, boost::shared_ptr<PropertyBagItem> item) {
  if (item) m_items.emplace(key, std::move(item));
}

void PropertyBag::RemoveItem(const std::string& key) {
  m_items.erase(key);
}

void PropertyBag::RemoveAllItems() {
  m_items.clear();
}

PropertyBagItem* PropertyBag::GetItem(const std::string& key) {
  const auto entry = m_items.find(key);
  return entry == m_items.end() ? nullptr : entry->second.get();
}

const PropertyBagItem* PropertyBag::GetItem(const std::string& key) const {
  const auto entry = m_items.find(key);
  return entry == m_items.end() ? nullptr : entry->second.get();
}

boost::shared_ptr<PropertyBagItem> PropertyBag::GetItemPtr(const std::string& key) {
  const auto entry = m_items.find(key);
  return entry == m_items.end() ? boost::shared_ptr<PropertyBagItem>() : entry->second;
}

std::vector<std::string> PropertyBag::GetKeys() const {
  std::vector<std::string> keys;
  keys.reserve(m_items.size());
  for (const auto& entry : m_items) keys.push_back(entry.first);
  return keys;
}

void PropertyBag::Copy(PropertyBag& source, const char* prefix) {
  ForEachItem(source.m_items,
              [&](const std::string& key, const boost::shared_ptr<PropertyBagItem>& item) {
                const auto own = m_items.find(key);
                if (own == m_items.end()) {
                  m_items.emplace(key, item);
                } else {
                  const boost::shared_ptr<PropertyBagItem> target = own->second;
                  target->CopyFrom(item.get(), prefix);
                }
              });
  for (auto entry = m_items.begin(); entry != m_items.end();) {
    entry = source.m_items.count(entry->first) ? std::next(entry) : m_items.erase(entry);
  }
}

void PropertyBag::LoadPresetValues() {
  ForEachItem(m_items,
              [this](const std::string& key, const boost::shared_ptr<PropertyBagItem>& item) {
                item->LoadPreset(key, this);
              });
}

void PropertyBag::SignalItemChange(const std::string& key, CComVariant value) {
  NotifyEach(m_changeSubscribers, this, key, value);
  GlobalSignalItemChange(this, key, std::move(value));
}

void PropertyBag::SignalItemChange(const char* key, CComVariant value) {
  SignalItemChange(std::string(key ? key : ""), std::move(value));
}

void PropertyBag::GlobalSignalItemChange(PropertyBag* bag, const std::string& key,
                                         CComVariant value) {
  m_GlobalSubscrbers.Notify(bag, key, value);
}

void PropertyBag::SubscribeChanges(IPropertyBagSubscriber* subscriber) {
  m_changeSubscribers.Insert(subscriber);
}

void PropertyBag::UnsubscribeChanges(IPropertyBagSubscriber* subscriber) {
  m_changeSubscribers.Erase(subscriber);
}

void PropertyBag::SubscribeDestroy(IPropertyBagSubscriberDestroy* subscriber) {
  m_destroySubscribers.Insert(subscriber);
}

void PropertyBag::UnsubscribeDestroy(IPropertyBagSubscriberDestroy* subscriber) {
  m_destroySubscribers.Erase(subscriber);
}

void PropertyBag::GlobalSubscribeChanges(IPropertyBagSubscriber* subscriber) {
  m_GlobalSubscrbers.Insert(subscriber);
}

void PropertyBag::GlobalUnsubscribeChanges(IPropertyBagSubscriber* subscriber) {
  m_GlobalSubscrbers.Erase(subscriber);
}

}  // namespace LumenUtility
