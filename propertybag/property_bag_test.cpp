#include "lumen/propertybag/property_bag.h"

#include <gtest/gtest.h>

#include <boost/make_shared.hpp>

#include "lumen/platform/ole_exception.h"
#include "propertybag/test_items.h"

namespace LumenUtility {
namespace {

using testutil::Notice;
using testutil::RecordingDestroySubscriber;
using testutil::RecordingItem;
using testutil::RecordingSubscriber;

boost::shared_ptr<RecordingItem> Item(std::int32_t value = 0) {
  return boost::make_shared<RecordingItem>(value);
}

// A log of the changes subscribers heard, and four subscribers that write to it.
class PropertyBagTest : public ::testing::Test {
 protected:
  // The subscribers in the order they heard.
  std::vector<const void*> Heard() const {
    std::vector<const void*> order;
    for (const Notice& n : log) order.push_back(n.subscriber);
    return order;
  }

  std::vector<Notice> log;
  RecordingSubscriber subs[4] = {RecordingSubscriber(&log), RecordingSubscriber(&log),
                                 RecordingSubscriber(&log), RecordingSubscriber(&log)};
};

TEST(PropertyBag, AKeyKeepsItsFirstItemAndEmptyItemsAreIgnored) {
  PropertyBag bag;
  const auto a = Item(1), b = Item(2);
  bag.AddItem("Power", a);
  bag.AddItem("Power", b);
  bag.AddItem("Span", boost::shared_ptr<PropertyBagItem>());
  EXPECT_EQ(bag.GetItem("Power"), a.get());
  EXPECT_EQ(bag.GetItem("Span"), nullptr);
  EXPECT_EQ(bag.GetKeys(), std::vector<std::string>{"Power"});
  EXPECT_EQ(bag.GetItemPtr("Power"), a);
  EXPECT_EQ(bag.GetItemPtr("power"), nullptr);

  bag.RemoveItem("Span");  // absent: nothing happens
  bag.RemoveItem("Power");
  EXPECT_EQ(static_cast<const PropertyBag&>(bag).GetItem("Power"), nullptr);
  EXPECT_EQ(a.use_count(), 1);  // the bag dropped its reference
}

TEST(PropertyBag, KeysComeInByteOrder) {
  PropertyBag bag;
  for (const char* key : {"b", "B", "a", "\xC3\xA9t\xC3\xA9", "z", ""}) bag.AddItem(key, Item());
  EXPECT_EQ(bag.GetKeys(), (std::vector<std::string>{"", "B", "a", "b", "z", "\xC3\xA9t\xC3\xA9"}));
}

TEST_F(PropertyBagTest, CopiesShareItemsAndKeepTheirOwnSubscribers) {
  PropertyBag source;
  const auto power = Item(1);
  source.AddItem("Power", power);
  source.SubscribeChanges(&subs[0]);

  PropertyBag copy(source);
  EXPECT_EQ(copy.GetItem("Power"), power.get());
  copy.SignalItemChange("Power", CComVariant(3));
  EXPECT_TRUE(log.empty());  // a copy starts without subscribers

  PropertyBag assigned;
  assigned.AddItem("Span", Item());
  assigned.SubscribeChanges(&subs[0]);
  assigned = copy;
  EXPECT_EQ(assigned.GetKeys(), std::vector<std::string>{"Power"});
  EXPECT_EQ(assigned.GetItem("Power"), power.get());
  assigned.SignalItemChange("Power", CComVariant(4));
  ASSERT_EQ(log.size(), 1u);  // assignment kept this bag's subscribers
  EXPECT_EQ(log[0].bag, &assigned);
  EXPECT_EQ(power.use_count(), 4);

  assigned.RemoveAllItems();
  EXPECT_TRUE(assigned.GetKeys().empty());
  assigned.SignalItemChange("Power", CComVariant(5));
  EXPECT_EQ(log.size(), 2u);  // and so did removing every item
}

TEST_F(PropertyBagTest, CopyMatchesTheSourceKeySet) {
  PropertyBag target, source;
  const auto targetA = Item(1), targetC = Item(3), sourceA = Item(10), sourceB = Item(20);
  target.AddItem("a", targetA);
  target.AddItem("c", targetC);
  source.AddItem("a", sourceA);
  source.AddItem("b", sourceB);
  target.SubscribeChanges(&subs[0]);

  target.Copy(source, "Ch1_");
  EXPECT_EQ(target.GetKeys(), (std::vector<std::string>{"a", "b"}));
  EXPECT_EQ(target.GetItem("a"), targetA.get());  // kept, and given source's state
  EXPECT_EQ(targetA->copiedFrom, std::vector<PropertyBagItem*>{sourceA.get()});
  EXPECT_EQ(targetA->prefixes, std::vector<std::string>{"Ch1_"});
  EXPECT_EQ(targetA->value, 10);
  EXPECT_EQ(target.GetItem("b"), sourceB.get());  // shared
  EXPECT_EQ(targetC.use_count(), 1);              // removed
  EXPECT_TRUE(log.empty());
  EXPECT_TRUE(sourceA->copiedFrom.empty());

  target.Copy(target, nullptr);  // onto itself: every item copies from itself, nothing goes
  EXPECT_EQ(target.GetKeys(), (std::vector<std::string>{"a", "b"}));
  EXPECT_EQ(targetA->prefixes.back(), "(null)");
}

TEST(PropertyBag, PresetsRunInKeyOrderAndMayChangeTheBagMeanwhile) {
  PropertyBag bag;
  std::vector<std::string> visited;
  const auto a = Item(), b = Item(), c = Item(), d = Item();
  using Entry = std::pair<const char*, boost::shared_ptr<RecordingItem>>;
  for (auto [key, item] : {Entry{"d", d}, Entry{"a", a}, Entry{"c", c}, Entry{"b", b}}) {
    item->onPreset = [&visited, &bag, item = item.get()](const std::string& key,
                                                         PropertyBag* caller) {
      EXPECT_EQ(caller, &bag);
      EXPECT_EQ(caller->GetItem(key), item);
      visited.push_back(key);
    };
    bag.AddItem(key, item);
  }
  b->value = 7;
  b->preset = 2;
  bag.LoadPresetValues();
  EXPECT_EQ(visited, (std::vector<std::string>{"a", "b", "c", "d"}));
  EXPECT_EQ(b->value, 2);

  // "a" removes itself and "c" during its preset: the walk goes on with "b" and "d".
  visited.clear();
  a->onPreset = [&](const std::string& key, PropertyBag* caller) {
    visited.push_back(key);
    caller->RemoveItem("a");
    caller->RemoveItem("c");
    EXPECT_EQ(a->presets.load(), 2);  // still alive while its call runs
  };
  bag.LoadPresetValues();
  EXPECT_EQ(visited, (std::vector<std::string>{"a", "b", "d"}));
  EXPECT_EQ(bag.GetKeys(), (std::vector<std::string>{"b", "d"}));
}

TEST_F(PropertyBagTest, ChangesReachBagSubscribersThenGlobalOnesInPointerOrder) {
  PropertyBag bag;
  bag.SubscribeChanges(&subs[2]);
  bag.SubscribeChanges(&subs[0]);
  bag.SubscribeChanges(&subs[0]);  // once only
  bag.SubscribeChanges(nullptr);   // ignored
  PropertyBag::GlobalSubscribeChanges(&subs[1]);
  PropertyBag::GlobalSubscribeChanges(&subs[0]);  // both on the bag and global

  bag.SignalItemChange("Power", CComVariant(-10.0));
  PropertyBag::GlobalUnsubscribeChanges(&subs[0]);
  PropertyBag::GlobalUnsubscribeChanges(&subs[1]);
  EXPECT_EQ(Heard(), (std::vector<const void*>{&subs[0], &subs[2], &subs[0], &subs[1]}));
  for (const Notice& n : log) {
    EXPECT_EQ(n.bag, &bag);
    EXPECT_EQ(n.key, "Power");
    EXPECT_EQ(n.value, CComVariant(-10.0));
  }

  // Subscribing twice and unsubscribing once leaves it unsubscribed.
  log.clear();
  bag.UnsubscribeChanges(&subs[0]);
  bag.UnsubscribeChanges(&subs[1]);  // absent: nothing happens
  bag.SignalItemChange(std::string("Span"), CComVariant(L"wide"));
  EXPECT_EQ(Heard(), std::vector<const void*>{&subs[2]});
}

TEST_F(PropertyBagTest, SubscribersGetTheReferencedValueAndGlobalSignalsNameTheirBag) {
  RecordingSubscriber &local = subs[0], &global = subs[1];
  PropertyBag bag, other;
  bag.SubscribeChanges(&local);
  PropertyBag::GlobalSubscribeChanges(&global);
  std::int32_t points = 201;
  bag.SignalItemChange("Points", CComVariant::Reference(&points));
  PropertyBag::GlobalSignalItemChange(&other, "Points", CComVariant(true));
  bag.SignalItemChange(static_cast<const char*>(nullptr), CComVariant());
  PropertyBag::GlobalUnsubscribeChanges(&global);

  ASSERT_EQ(log.size(), 5u);
  EXPECT_EQ(log[0].value, CComVariant(201));  // a copy, not the reference
  EXPECT_EQ(log[1].value, CComVariant(201));
  EXPECT_EQ(log[2].subscriber, &global);  // only the global subscriber hears GlobalSignal
  EXPECT_EQ(log[2].bag, &other);
  EXPECT_EQ(log[3].key, "");  // a null key is the empty key
}

TEST_F(PropertyBagTest, AFailedCopyStopsTheNotificationWithItsError) {
  PropertyBag bag;
  bag.SubscribeChanges(&subs[0]);
  PropertyBag::GlobalSubscribeChanges(&subs[1]);
  try {
    bag.SignalItemChange("Power", CComVariant::Reference(static_cast<double*>(nullptr)));
    ADD_FAILURE() << "no exception";
  } catch (const COleException& e) {
    EXPECT_EQ(e.m_sc, E_INVALIDARG);
  }
  EXPECT_THROW(PropertyBag::GlobalSignalItemChange(
                   &bag, "Power", CComVariant::Reference(static_cast<std::wstring*>(nullptr))),
               COleException);
  PropertyBag::GlobalUnsubscribeChanges(&subs[1]);
  EXPECT_TRUE(log.empty());
}

TEST_F(PropertyBagTest, SubscribersMayUnsubscribeThemselvesAndOthersDuringANotification) {
  PropertyBag bag;
  for (RecordingSubscriber& s : subs) bag.SubscribeChanges(&s);
  PropertyBag::GlobalSubscribeChanges(&subs[0]);
  PropertyBag::GlobalSubscribeChanges(&subs[1]);
  subs[1].onChange = [&] {
    bag.UnsubscribeChanges(&subs[1]);
    bag.UnsubscribeChanges(&subs[2]);
    PropertyBag::GlobalUnsubscribeChanges(&subs[0]);
    PropertyBag::GlobalUnsubscribeChanges(&subs[1]);
  };
  bag.SignalItemChange("Power", CComVariant(1));
  EXPECT_EQ(Heard(), (std::vector<const void*>{&subs[0], &subs[1], &subs[3]}));
  EXPECT_EQ(PropertyBag::m_GlobalSubscrbers.Size(), 0u);
}

TEST(PropertyBag, DestroySubscribersHearInPointerOrderAndMayLeaveMeanwhile) {
  std::vector<const void*> log;
  RecordingDestroySubscriber subscribers[3] = {RecordingDestroySubscriber(&log),
                                               RecordingDestroySubscriber(&log),
                                               RecordingDestroySubscriber(&log)};
  auto item = Item();
  {
    PropertyBag bag;
    bag.AddItem("Power", item);
    for (int i : {2, 0, 1, 0}) bag.SubscribeDestroy(&subscribers[i]);
    bag.SubscribeDestroy(nullptr);
    subscribers[0].onDestroy = [&](PropertyBag* dying) {
      EXPECT_EQ(dying, &bag);
      EXPECT_EQ(dying->GetItem("Power"), item.get());  // still intact
      dying->UnsubscribeDestroy(&subscribers[0]);
      dying->UnsubscribeDestroy(&subscribers[1]);
    };
  }
  EXPECT_EQ(log, (std::vector<const void*>{&subscribers[0], &subscribers[2]}));
  EXPECT_EQ(item.use_count(), 1);

  log.clear();
  {
    PropertyBag bag;
    bag.SubscribeDestroy(&subscribers[1]);
    bag.UnsubscribeDestroy(&subscribers[1]);
    bag.UnsubscribeDestroy(&subscribers[2]);  // absent: nothing happens
  }
  EXPECT_TRUE(log.empty());
}

}  // namespace
}  // namespace LumenUtility
