#include "lumen/propertybag/property_bag_subscriber.h"

#include <gtest/gtest.h>

#include <memory>

#include "lumen/propertybag/global_property_bag_subscriber.h"
#include "lumen/propertybag/property_bag.h"
#include "propertybag/test_items.h"

namespace LumenUtility {
namespace {

using testutil::Notice;
using testutil::RecordingSubscriber;

// How many notices one change of `bag` gives `log`.
std::size_t NoticesOfOneChange(PropertyBag& bag, std::vector<Notice>& log) {
  log.clear();
  bag.SignalItemChange("Power", CComVariant(1));
  return log.size();
}

TEST(PropertyBagSubscriber, AttachesWhileInScopeAndReattachesOnInit) {
  std::vector<Notice> log;
  RecordingSubscriber target(&log), other(&log);
  PropertyBag first, second;
  {
    PropertyBagSubscriber attachment(&first, &target);
    EXPECT_EQ(attachment.GetBag(), &first);
    EXPECT_EQ(NoticesOfOneChange(first, log), 1u);

    attachment.Init(&second, &other);  // leaves the first bag
    EXPECT_EQ(NoticesOfOneChange(first, log), 0u);
    EXPECT_EQ(NoticesOfOneChange(second, log), 1u);
    EXPECT_EQ(log[0].subscriber, &other);

    attachment.Init(&second, nullptr);  // detached: a null argument attaches nothing
    EXPECT_EQ(attachment.GetBag(), nullptr);
    EXPECT_EQ(NoticesOfOneChange(second, log), 0u);
    attachment.Init(&first, &target);
  }
  EXPECT_EQ(NoticesOfOneChange(first, log), 0u);  // the destructor detached it
}

TEST(PropertyBagSubscriber, LetsGoWhenItsBagIsDestroyedFirst) {
  std::vector<Notice> log;
  RecordingSubscriber target(&log);
  auto attachment = std::make_unique<PropertyBagSubscriber>();
  auto copy = std::make_unique<PropertyBagSubscriber>();
  {
    PropertyBag bag;
    attachment->Init(&bag, &target);
    *copy = *attachment;
  }
  // Under ASan a touch of the dead bag would be reported here.
  EXPECT_EQ(attachment->GetBag(), nullptr);
  EXPECT_EQ(copy->GetBag(), nullptr);
  attachment.reset();
  copy.reset();
}

TEST(PropertyBagSubscriber, CopiesShareTheAttachmentAndAssignmentLeavesTheOldBag) {
  std::vector<Notice> log;
  RecordingSubscriber target(&log), other(&log);
  PropertyBag bag, second;
  PropertyBagSubscriber attachment(&bag, &target);
  {
    PropertyBagSubscriber copy(attachment);
    EXPECT_EQ(copy.GetBag(), &bag);
    EXPECT_EQ(NoticesOfOneChange(bag, log), 1u);  // the target is subscribed once
    PropertyBagSubscriber same(attachment);
    same = attachment;  // the same attachment: nothing changes
    EXPECT_EQ(NoticesOfOneChange(bag, log), 1u);
  }
  EXPECT_EQ(NoticesOfOneChange(bag, log), 0u);  // detaching a copy ended the subscription

  attachment.Init(&bag, &target);
  PropertyBagSubscriber elsewhere(&second, &other);
  attachment = elsewhere;
  EXPECT_EQ(attachment.GetBag(), &second);
  EXPECT_EQ(NoticesOfOneChange(bag, log), 0u);  // the old attachment was let go
  EXPECT_EQ(NoticesOfOneChange(second, log), 1u);
}

TEST(GlobalPropertyBagSubscriber, SubscribesItsTargetWhileInScope) {
  std::vector<Notice> log;
  RecordingSubscriber target(&log), other(&log);
  PropertyBag bag;
  {
    GlobalPropertyBagSubscriber subscription(&target);
    EXPECT_TRUE(PropertyBag::m_GlobalSubscrbers.Contains(&target));
    EXPECT_EQ(NoticesOfOneChange(bag, log), 1u);

    subscription.Init(&other);
    EXPECT_FALSE(PropertyBag::m_GlobalSubscrbers.Contains(&target));
    EXPECT_TRUE(PropertyBag::m_GlobalSubscrbers.Contains(&other));

    subscription.Init(nullptr);
    EXPECT_EQ(subscription.GetTarget(), nullptr);
    EXPECT_EQ(NoticesOfOneChange(bag, log), 0u);
    subscription.Init(&target);
  }
  EXPECT_EQ(PropertyBag::m_GlobalSubscrbers.Size(), 0u);
}

TEST(GlobalPropertyBagSubscriber, CopiesShareTheSubscriptionAndAssignmentDropsTheOldTarget) {
  std::vector<Notice> log;
  RecordingSubscriber target(&log), other(&log);
  GlobalPropertyBagSubscriber subscription(&target);
  {
    GlobalPropertyBagSubscriber copy(subscription);
    EXPECT_EQ(copy.GetTarget(), &target);
    copy = subscription;  // the same target: still subscribed
    EXPECT_TRUE(PropertyBag::m_GlobalSubscrbers.Contains(&target));
  }
  EXPECT_FALSE(PropertyBag::m_GlobalSubscrbers.Contains(&target));  // the first to go ends it

  subscription.Init(&target);
  const GlobalPropertyBagSubscriber elsewhere(&other);
  subscription = elsewhere;
  EXPECT_FALSE(PropertyBag::m_GlobalSubscrbers.Contains(&target));
  EXPECT_TRUE(PropertyBag::m_GlobalSubscrbers.Contains(&other));
  EXPECT_EQ(subscription.GetTarget(), &other);
}

}  // namespace
}  // namespace LumenUtility
