// Where threads meet in the property bag: copies of one bag on different threads share items
// and all notify through the process-wide subscriber set, while other threads subscribe and
// unsubscribe there. Run under ThreadSanitizer to check it.
#include <gtest/gtest.h>

#include <atomic>
#include <boost/make_shared.hpp>
#include <thread>
#include <vector>

#include "lumen/propertybag/global_property_bag_subscriber.h"
#include "lumen/propertybag/property_bag.h"
#include "lumen/propertybag/property_bag_subscriber.h"

namespace LumenUtility {
namespace {

class CountingSubscriber : public IPropertyBagSubscriber {
 public:
  void OnItemChange(PropertyBag*, const std::string&, CComVariant value) override {
    count.fetch_add(1, std::memory_order_relaxed);
    sum.fetch_add(value.GetLong(), std::memory_order_relaxed);
  }
  std::atomic<int> count{0};
  std::atomic<long long> sum{0};
};

// An item that may be shared between threads: its only state is an atomic preset count.
class PresetCounter : public PropertyBagItem {
 public:
  void Serialize(CArchive&) override {}
  void LegacyRecall(const unsigned char*, int) override {}
  void LoadPreset(const std::string&, PropertyBag*) override {
    presets.fetch_add(1, std::memory_order_relaxed);
  }
  void CopyFrom(PropertyBagItem*, const char*) override {}
  std::atomic<int> presets{0};
};

TEST(PropertyBagThreads, CopiesOnTwoThreadsSignalWhileGlobalSubscriptionsComeAndGo) {
  constexpr int kThreads = 2, kSignals = 3000, kPresetEvery = 100;
  CountingSubscriber always, sometimes, local[kThreads];
  const GlobalPropertyBagSubscriber subscription(&always);
  const auto power = boost::make_shared<PresetCounter>();
  PropertyBag original;
  original.AddItem("Power", power);
  original.AddItem("Span", boost::make_shared<PresetCounter>());
  std::vector<PropertyBag> copies(kThreads, original);

  std::atomic<bool> done{false};
  std::thread toggler([&] {
    GlobalPropertyBagSubscriber coming;
    while (!done.load()) {
      coming.Init(&sometimes);
      coming.Init(nullptr);
    }
  });
  std::vector<std::thread> workers;
  for (int t = 0; t < kThreads; ++t) {
    workers.emplace_back([&, t] {
      PropertyBag& bag = copies[t];
      const PropertyBagSubscriber attachment(&bag, &local[t]);
      for (int k = 0; k < kSignals; ++k) {
        bag.SignalItemChange("Power", CComVariant(k));
        if (k % kPresetEvery == 0) {
          const PropertyBag passing(bag);  // takes and drops references to the shared items
          bag.LoadPresetValues();
        }
      }
    });
  }
  for (std::thread& worker : workers) worker.join();
  done.store(true);
  toggler.join();

  constexpr long long kSum = static_cast<long long>(kSignals) * (kSignals - 1) / 2;
  EXPECT_EQ(always.count.load(), kThreads * kSignals);
  EXPECT_EQ(always.sum.load(), kThreads * kSum);
  for (const CountingSubscriber& s : local) EXPECT_EQ(s.sum.load(), kSum);
  EXPECT_LE(sometimes.count.load(), kThreads * kSignals);
  EXPECT_EQ(power->presets.load(), kThreads * kSignals / kPresetEvery);
  EXPECT_EQ(power.use_count(), 1 + 1 + kThreads);  // here, the original and the copies
  EXPECT_FALSE(PropertyBag::m_GlobalSubscrbers.Contains(&sometimes));
}

}  // namespace
}  // namespace LumenUtility
