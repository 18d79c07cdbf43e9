// Items and subscribers for the property bag tests and fuzz targets; each records what its bag
// asked of it.
#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "lumen/platform/archive.h"
#include "lumen/platform/com_variant.h"
#include "lumen/propertybag/property_bag.h"
#include "lumen/propertybag/property_bag_item.h"
#include "lumen/propertybag/subscriber_interfaces.h"

namespace LumenUtility::testutil {

// A setting of one 32-bit value and one wide text, saved in that order; LoadPreset returns to
// `preset` and CopyFrom takes another RecordingItem's value and text.
class RecordingItem : public PropertyBagItem {
 public:
  explicit RecordingItem(std::int32_t value = 0, std::wstring text = L"", std::int32_t preset = 0)
      : value(value), text(std::move(text)), preset(preset) {}

  void Serialize(CArchive& ar) override {
    if (ar.IsStoring()) {
      ar << value << text;
    } else {
      ar >> value >> text;
    }
  }
  void LegacyRecall(const unsigned char* data, int size) override {
    legacy.emplace_back(data, data + size);
  }
  void LoadPreset(const std::string& key, PropertyBag* bag) override {
    ++presets;
    value = preset;
    if (onPreset) onPreset(key, bag);
  }
  void CopyFrom(PropertyBagItem* source, const char* prefix) override {
    copiedFrom.push_back(source);
    prefixes.push_back(prefix ? prefix : "(null)");
    if (const auto* other = dynamic_cast<const RecordingItem*>(source)) {
      value = other->value;
      text = other->text;
    }
  }

  std::int32_t value;
  std::wstring text;
  std::int32_t preset;
  std::vector<std::vector<unsigned char>> legacy;
  std::atomic<int> presets{0};
  std::vector<PropertyBagItem*> copiedFrom;
  std::vector<std::string> prefixes;
  std::function<void(const std::string&, PropertyBag*)> onPreset;
};

// An item that writes and reads nothing, as the items under the keys an archive carries
// without a payload must.
class SilentItem : public PropertyBagItem {
 public:
  void Serialize(CArchive&) override { ++serialized; }
  void LegacyRecall(const unsigned char*, int) override {}
  void LoadPreset(const std::string&, PropertyBag*) override {}
  void CopyFrom(PropertyBagItem*, const char*) override {}

  int serialized = 0;
};

// One change as a subscriber heard it.
struct Notice {
  const void* subscriber;
  PropertyBag* bag;
  std::string key;
  CComVariant value;
};

// Appends every change it hears to a shared log, then runs `onChange` if set.
class RecordingSubscriber : public IPropertyBagSubscriber {
 public:
  explicit RecordingSubscriber(std::vector<Notice>* log = nullptr) : log(log) {}
  void OnItemChange(PropertyBag* bag, const std::string& key, CComVariant value) override {
    if (log) log->push_back({this, bag, key, value});
    if (onChange) onChange();
  }

  std::vector<Notice>* log;
  std::function<void()> onChange;
};

// Appends itself to a shared log when its bag is destroyed, then runs `onDestroy` if set.
class RecordingDestroySubscriber : public IPropertyBagSubscriberDestroy {
 public:
  explicit RecordingDestroySubscriber(std::vector<const void*>* log = nullptr) : log(log) {}
  void OnPropertyBagBeingDestroyed(PropertyBag* bag) override {
    if (log) log->push_back(this);
    if (onDestroy) onDestroy(bag);
  }

  std::vector<const void*>* log;
  std::function<void(PropertyBag*)> onDestroy;
};

}  // namespace LumenUtility::testutil
