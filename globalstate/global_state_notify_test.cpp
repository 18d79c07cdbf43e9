// The order in which a reference change reaches the channel manager, the table, the hardware,
// the core and the main window.
#include <gtest/gtest.h>

#include <stdexcept>

#include "globalstate/channel_manager_link.h"
#include "globalstate/fake_host.h"
#include "lumen/globalstate/global_state.h"

namespace LumenUtility {
namespace {

using testutil::Events;
using testutil::EventLog;

class ReferenceChange : public testutil::GlobalStateFixture {};

TEST_F(ReferenceChange, StepsRunInsideOneChannelChangeInOrder) {
  GlobalState::SetExternalReference(L"external");
  ASSERT_EQ(Events().size(), 5u);
  // Tokens count on over the test process; what counts is that the end hands back the begin's.
  const std::wstring token = Events()[0].substr(std::wstring(L"begin change ").size());
  // The hardware sees the new value already stored; the message (0x42C) carries 0 and 0.
  EXPECT_EQ(Events(), (EventLog{L"begin change " + token, L"hardware External, stored External",
                                L"core", L"window message 1068 0 0", L"end change " + token}));

  // Setting the same value again goes through every step all the same.
  Events().clear();
  GlobalState::SetExternalReference(L"External");
  ASSERT_EQ(Events().size(), 5u);
  EXPECT_EQ(Events()[1], L"hardware External, stored External");
}

TEST_F(ReferenceChange, RefusedHardwareSwitchRestoresTheReferenceAndEndsTheChange) {
  hardware.refuse = true;
  try {
    GlobalState::SetExternalReference(L"External");
    FAIL() << "the hardware's error was lost";
  } catch (const std::runtime_error& e) {
    EXPECT_STREQ(e.what(), "reference unlocked");  // passes through unchanged
  }
  ASSERT_EQ(Events().size(), 3u);
  EXPECT_EQ(Events()[1], L"hardware External, stored External");
  EXPECT_EQ(Events()[2].rfind(L"end change ", 0), 0u);
  EXPECT_EQ(GlobalState::GetExternalReference(), L"Internal");
  EXPECT_FALSE(hardware.external);
}

TEST_F(ReferenceChange, FailingCoreStillEndsTheChangeAndKeepsTheSwitchedReference) {
  core.refuse = true;
  EXPECT_THROW(GlobalState::SetExternalReference(L"External"), std::runtime_error);
  ASSERT_EQ(Events().size(), 4u);
  EXPECT_EQ(Events()[2], L"core");
  EXPECT_EQ(Events()[3].rfind(L"end change ", 0), 0u);  // no window message after the failure
  EXPECT_EQ(GlobalState::GetExternalReference(), L"External");  // the hardware did switch
  EXPECT_TRUE(hardware.external);
}

TEST(ChannelManagerLink, CreatesTheManagerOnceAFactoryCreatorGivesOneThenKeepsIt) {
  const boost::shared_ptr<IFactory> factory = CreateFactory();
  ChannelManagerLink link;
  factory->Unregister(L"CHANNELS_MANAGER");
  EXPECT_EQ(link.Get(), nullptr);
  // A product of another type, or an empty one, is no manager either.
  factory->Register(L"CHANNELS_MANAGER", [] { return boost::any(5); });
  EXPECT_EQ(link.Get(), nullptr);
  factory->Register(L"CHANNELS_MANAGER",
                    [] { return boost::any(boost::shared_ptr<IChannelManager>()); });
  EXPECT_EQ(link.Get(), nullptr);

  int created = 0;
  factory->Register(L"CHANNELS_MANAGER", [&created] {
    ++created;
    return boost::any(testutil::ProcessChannelManager());
  });
  EXPECT_EQ(link.Get(), testutil::ProcessChannelManager().get());
  factory->Unregister(L"CHANNELS_MANAGER");
  EXPECT_EQ(link.Get(), testutil::ProcessChannelManager().get());
  EXPECT_EQ(created, 1);
  testutil::RegisterChannelManagerCreator();
}

TEST(ChannelManagerLink, CreatorErrorsOtherThanAMissingCreatorPassThrough) {
  ChannelManagerLink link;
  CreateFactory()->Register(L"CHANNELS_MANAGER",
                            []() -> boost::any { throw std::runtime_error("host not ready"); });
  EXPECT_THROW(link.Get(), std::runtime_error);
  testutil::RegisterChannelManagerCreator();
  EXPECT_NE(link.Get(), nullptr);
}

}  // namespace
}  // namespace LumenUtility
