#include "lumen/phase/pa_receiver.h"

#include <gtest/gtest.h>

#include "lumen/phase/pa_parameter.h"
#include "phase/fake_host_objects.h"

namespace phase_test {
namespace {

using ReceiverTest = PhaseHostTest;

TEST_F(ReceiverTest, ClassifiesReceiverNumbersThroughTheTestSet) {
  EXPECT_EQ(PAReceiver(-5, true), PAReceiver(false, -1));
  EXPECT_EQ(testSet().classifyCalls, 0);
  EXPECT_EQ(PAReceiver(3, false), PAReceiver(false, 3));
  EXPECT_EQ(PAReceiver(12, false), PAReceiver(true, 2));
  // Reports without a port of their own mean port 1; their neighbours stay as reported.
  testSet().classification = {{20, {-1, 100000}}, {21, {-1, 100001}}, {22, {-1, -1}},
                              {23, {-1, 99999}},  {24, {-1, 100002}}, {25, {0, 7}}};
  EXPECT_EQ(PAReceiver(20, true), PAReceiver(true, 1));
  EXPECT_EQ(PAReceiver(21, true), PAReceiver(true, 1));
  EXPECT_EQ(PAReceiver(22, true), PAReceiver(true, 1));
  EXPECT_EQ(PAReceiver(23, true), PAReceiver(true, 99999));
  EXPECT_EQ(PAReceiver(24, true), PAReceiver(true, 100002));
  EXPECT_EQ(PAReceiver(25, true), PAReceiver(false, 0));  // test index 0 is a test receiver
}

TEST_F(ReceiverTest, MissingTestSetIsAPointerError) {
  const HostObjectsMissing missing;
  for (const auto& call : {+[] { PAReceiver(true, 1).ToSlot(false); },
                           +[] { PAReceiver(1, false); }, +[] { PAParameter().PortCount(); }}) {
    ExpectLumenError(call, LumenUtility::E_POINTER, L"no test set is registered");
  }
  EXPECT_EQ(PAReceiver(-1, false), PAReceiver(false, -1));  // asks nothing, so still works
}

}  // namespace
}  // namespace phase_test
