#include "lumen/phase/pa_component.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "phase/fake_host_objects.h"
#include "phase/stitch_sweep.h"

namespace phase_test {
namespace {

using ComponentTest = PhaseHostTest;

double Distance(TsComplex a, TsComplex b) {
  return std::hypot(double{a.re} - b.re, double{a.im} - b.im);
}

// Not ratioed, numerator test receiver `receiver` (slot 3 + receiver).
PAParameter Plain(int receiver, int id) {
  return PAParameter(receiver, false, 0, true, id, false);
}

// Points whose every value is (k + 1) + 0.5j at point k.
void Feed(PAComponent& component, int points, bool toFifo = false) {
  for (int k = 0; k < points; ++k) {
    std::vector<TsComplex> point(kPointSize, TsComplex(k + 1.0, 0.5));
    component.PutData(point.data(), 1, kPointSize, false, toFifo);
  }
}

TEST_F(ComponentTest, EachIdGetsOneAveragingBlockInTurn) {
  PAComponent component;
  const PAParameter idTwo = Plain(1, 2), idOne = Plain(2, 1), idThree = Plain(3, 3);
  component.AddParameter(idTwo);
  component.AddParameter(idOne);
  component.SetSweepParameters(4, false, 1);
  Feed(component, 3);
  EXPECT_EQ(component.GetAvailableDataCount(idOne), 2);
  EXPECT_EQ(component.GetAvailableDataCount(idTwo), 1);
  EXPECT_EQ(component.GetDataByRef(idOne)[1], TsComplex(3, 0.5));
  EXPECT_EQ(component.GetDataByRef(idTwo)[0], TsComplex(2, 0.5));

  // Blocks of two over three IDs; the cycle restarts only when asked.
  component.AddParameter(idThree);
  component.SetSweepParameters(4, false, 2);
  component.ResetCurrentID();
  Feed(component, 8);
  EXPECT_EQ(component.GetAvailableDataCount(idOne), 2);
  EXPECT_EQ(component.GetAvailableDataCount(idTwo), 1);
  EXPECT_EQ(component.GetAvailableDataCount(idThree), 1);
  // Points 5 and 6: the root-mean-square magnitude of 5 + 0.5j and 6 + 0.5j.
  EXPECT_NEAR(component.GetDataByRef(idThree)[0].Mag(), std::sqrt(30.75), 1e-6);
}

TEST_F(ComponentTest, RatioedValuesAverageToTheComplexMean) {
  PAComponent component;
  const PAParameter ratio(1, false, 1, true, 0, true);  // slot 4 over slot 0
  component.AddParameter(ratio);
  component.SetSweepParameters(2, false, 3);
  const TsComplex n[3] = {{1, 2}, {-3, 1}, {0.5, 0.5}}, d[3] = {{1, 0}, {0, 2}, {2, -2}};
  TsComplex mean;
  for (int k = 0; k < 3; ++k) {
    EXPECT_EQ(component.GetAvailableDataCount(ratio), 0);
    std::vector<TsComplex> point = PointBuffer();
    point[4] = n[k];
    point[0] = d[k];
    component.PutData(point.data(), 1, kPointSize, false, false);
    mean += (n[k] / d[k]) / 3.0;
  }
  EXPECT_EQ(component.GetAvailableDataCount(ratio), 1);
  EXPECT_LE(Distance(component.GetDataByRef(ratio)[0], mean), 1e-6);
}

// Property: samples of one phase average to that phase (1e-6 rad) at their root-mean-square
// magnitude (relative 1e-6); opposite samples cancel to the +90 degree phasor of their power.
TEST_F(ComponentTest, PlainValuesAverageRmsPowerAndPhasorAngle) {
  PAComponent component;
  const PAParameter plain = Plain(1, 0);
  component.AddParameter(plain);
  component.SetSweepParameters(8, false, 16);
  std::mt19937 random(7);
  std::uniform_real_distribution<double> magnitude(0.1, 5.0), phase(-3.1, 3.1);
  for (int block = 0; block < 8; ++block) {
    const double angle = phase(random);
    double power = 0.0;
    for (int k = 0; k < 16; ++k) {
      std::vector<TsComplex> point = PointBuffer();
      const double m = k == 3 ? 0.0 : magnitude(random);  // a zero sample adds no phasor
      point[4] = TsComplex::FromMagPhase(m, angle);
      power += double{point[4].re} * point[4].re + double{point[4].im} * point[4].im;
      component.PutData(point.data(), 1, kPointSize, false, false);
    }
    const TsComplex value = component.GetDataByRef(plain)[block];
    EXPECT_NEAR(value.Phase(), angle, 1e-6) << block;
    EXPECT_NEAR(value.Mag(), std::sqrt(power / 16), 1e-6 * std::sqrt(power / 16)) << block;
  }

  component.SetSweepParameters(1, false, 2);
  for (const float re : {1.0f, -1.0f}) {
    std::vector<TsComplex> point = PointBuffer();
    point[4] = TsComplex(re, 0);
    component.PutData(point.data(), 1, kPointSize, false, false);
  }
  EXPECT_LE(Distance(component.GetDataByRef(plain)[0], TsComplex(0, 1)), 1e-7);
}

TEST_F(ComponentTest, DiscardedPointsMoveNoCounter) {
  PAComponent component;
  PAParameter idOne = Plain(1, 1);
  const PAParameter idTwo = Plain(2, 2);
  component.AddParameter(idOne);
  component.AddParameter(idTwo);
  component.SetPhaseStitch(idOne, {}, 0, 2, false);
  component.SetSweepParameters(4, false, 1);
  Feed(component, 2);  // both leading points
  EXPECT_EQ(component.GetAvailableDataCount(idOne), 0);
  EXPECT_EQ(component.GetAvailableDataCount(idTwo), 0);
  Feed(component, 1);
  EXPECT_EQ(component.GetAvailableDataCount(idOne), 1);  // still the first ID's turn
  EXPECT_EQ(component.GetAvailableDataCount(idTwo), 0);
}

TEST_F(ComponentTest, ConsumerProtocolAndUnregisteredParameters) {
  PAComponent component;
  const PAParameter registered = Plain(1, 0), unregistered = Plain(2, 0);
  component.AddParameter(registered);
  component.SetSweepParameters(5, false, 1);
  Feed(component, 2);
  EXPECT_EQ(component.GetBegin(registered), 0);
  EXPECT_EQ(component.GetAvailableDataCount(registered), 2);
  EXPECT_EQ(component.GetAvailableDataCount(registered), 2);
  EXPECT_EQ(component.GetBegin(registered), 2);

  EXPECT_EQ(component.GetAvailableDataCount(unregistered), -1);
  EXPECT_EQ(component.GetBegin(unregistered), -1);
  EXPECT_TRUE(component.GetDataByRef(unregistered).empty());
  EXPECT_FALSE(component.IsParameterAvailable(unregistered));

  // Registering again keeps the record; a copy carries it and then goes its own way.
  component.AddParameter(PAParameter(1, false, 0, true, 0, false));
  EXPECT_EQ(component.GetAvailableDataCount(registered), 2);
  PAComponent copy = component;
  Feed(copy, 1);
  EXPECT_EQ(copy.GetDataByRef(registered)[1], TsComplex(2, 0.5));
  EXPECT_EQ(copy.GetAvailableDataCount(registered), 3);
  EXPECT_EQ(component.GetAvailableDataCount(registered), 2);
}

TEST_F(ComponentTest, ValuesPastAFullArrayAreDropped) {
  PAComponent component;
  const PAParameter plain = Plain(1, 0);
  component.AddParameter(plain);
  component.SetSweepParameters(2, false, 1);
  Feed(component, 5);
  EXPECT_EQ(component.GetAvailableDataCount(plain), 2);
  EXPECT_EQ(component.GetDataByRef(plain), (std::vector<TsComplex>{{1, 0.5}, {2, 0.5}}));
}

TEST_F(ComponentTest, IdCycleStaysInsideAShrunkenIdList) {
  PAComponent component;
  Feed(component, 3);  // no parameters: nothing to cycle through
  for (int id = 1; id <= 3; ++id) component.AddParameter(Plain(id, id));
  component.SetSweepParameters(2, false, 1);
  Feed(component, 2);  // the third ID is next
  component.ClearParameterData();
  EXPECT_TRUE(component.GetReceivers().empty());
  const PAParameter only = Plain(4, 9);
  component.AddParameter(only);
  component.SetSweepParameters(2, false, 1);
  Feed(component, 1);
  EXPECT_EQ(component.GetAvailableDataCount(only), 1);
}

TEST_F(ComponentTest, ReceiversInKeyOrderWithDenominatorsOfRatios) {
  PAComponent component;
  component.AddParameter(PAParameter(2, false, 3, true, 1, true));
  component.AddParameter(PAParameter(2, false, 4, true, 0, false));
  component.AddParameter(PAParameter(2, false, 3, true, 0, true));
  EXPECT_EQ(component.GetReceivers(),
            (std::vector<PAReceiver>{{false, 2}, {true, 3}, {false, 2}, {false, 2}, {true, 3}}));
}

TEST_F(ComponentTest, MissingTestSetOrNegativeSizeChangeNothing) {
  PAComponent component;
  const PAParameter plain = Plain(1, 0);
  component.AddParameter(plain);
  component.SetReferenceReceiverIndex(1);
  component.SetSweepParameters(3, false, 1);
  std::vector<TsComplex> point = PointBuffer();
  const std::vector<TsComplex> before = point;
  {
    const HostObjectsMissing missing;
    ExpectLumenError([&] { component.PutData(point.data(), 1, kPointSize, false, false); },
                     LumenUtility::E_POINTER, L"no test set is registered");
  }
  EXPECT_EQ(point, before);  // not even substituted
  ExpectLumenError([&] { component.SetSweepParameters(-1, false, 1); },
                   LumenUtility::E_INVALIDARG, L"negative number of points");
  EXPECT_EQ(component.GetDataByRef(plain).size(), 3u);
  component.PutData(nullptr, 1, kPointSize, false, false);
  component.PutData(point.data(), 1, kPointSize, false, false);
  EXPECT_EQ(component.GetAvailableDataCount(plain), 1);  // the averaging block started afresh
}

// Stitching through the component across two breaks: with reference points the stored values
// of an untracked receiver come out without the jumps (1e-5 of magnitude 3), without them as
// acquired.
TEST_F(ComponentTest, StitchesAcrossTwoBreaksBeforeFormingValues) {
  for (const bool hasReference : {true, false}) {
    PAComponent component;
    PAParameter tracked(2, true, 0, true, 0, false);     // slot 1
    const PAParameter other(3, true, 0, true, 0, false);  // slot 2
    component.AddParameter(tracked);
    component.AddParameter(other);
    component.SetPhaseStitch(tracked, {3, 8}, 2, 1, hasReference);
    StitchSweep sweep = MakeStitchSweep(12, {3, 8}, {1.0, -2.0}, 2, 1, hasReference, kPointSize);
    component.SetSweepParameters(12, false, 1);
    for (std::vector<TsComplex>& point : sweep.acquired) {
      component.PutData(point.data(), 1, kPointSize, false, false);
    }
    ASSERT_EQ(component.GetAvailableDataCount(other), 12);
    const auto& expected = hasReference ? sweep.truth : sweep.raw;
    for (int m = 0; m < 12; ++m) {
      EXPECT_LE(Distance(component.GetDataByRef(other)[m], expected[m][2]), 3e-5) << m;
    }
  }
}

}  // namespace
}  // namespace phase_test
