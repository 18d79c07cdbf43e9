#include "phase/receiver_substitution.h"

#include <gtest/gtest.h>

#include <vector>

#include "lumen/phase/pa_component.h"
#include "phase/fake_host_objects.h"

namespace phase_test {
namespace {

using LumenUtility::ComputeReceiverSubstitution;
using LumenUtility::SlotSubstitution;
using SubstitutionTest = PhaseHostTest;

TEST_F(SubstitutionTest, OnlyAFourPortTestSetWithA1ElsewhereSubstitutes) {
  EXPECT_EQ(ComputeReceiverSubstitution(), (std::vector<SlotSubstitution>{{kA1Slot, 0}}));
  EXPECT_EQ(LumenUtility::ReceiverSubstitution(), ComputeReceiverSubstitution());
  testSet().ports = 2;
  EXPECT_TRUE(ComputeReceiverSubstitution().empty());
  testSet().ports = 4;
  testSet().a1Position = 1;  // a1 is the port-1 reference slot
  EXPECT_TRUE(ComputeReceiverSubstitution().empty());
  testSet().a1Position = 0;  // no such receiver: slot -1
  EXPECT_TRUE(ComputeReceiverSubstitution().empty());
  const HostObjectsMissing missing;
  EXPECT_TRUE(ComputeReceiverSubstitution().empty());
}

TEST_F(SubstitutionTest, ReferenceReceiverIndexOneReplacesPortOneByA1) {
  for (const int referenceIndex : {1, 0}) {
    PAComponent component;
    const PAParameter portOne(1, true, 0, true, 0, false);
    component.AddParameter(portOne);
    component.SetReferenceReceiverIndex(referenceIndex);
    component.SetSweepParameters(2, false, 1);
    std::vector<TsComplex> points = PointBuffer(1.0f);
    const std::vector<TsComplex> second = PointBuffer(2.0f);
    points.insert(points.end(), second.begin(), second.end());
    const std::vector<TsComplex> before = points;
    component.PutData(points.data(), 2, kPointSize, false, false);
    const std::vector<TsComplex>& values = component.GetDataByRef(portOne);
    if (referenceIndex == 1) {
      EXPECT_EQ(values[0], before[kA1Slot]);
      EXPECT_EQ(values[1], before[kPointSize + kA1Slot]);
      EXPECT_EQ(points[kPointSize], before[kPointSize + kA1Slot]);  // in the caller's buffer
    } else {
      EXPECT_EQ(values[0], before[0]);
      EXPECT_EQ(values[1], before[kPointSize]);
      EXPECT_EQ(points, before);
    }
  }
}

}  // namespace
}  // namespace phase_test
