#include "lumen/phase/pa_parameter.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

#include "phase/fake_host_objects.h"

namespace phase_test {
namespace {

using ParameterTest = PhaseHostTest;

void ExpectParameter(const PAParameter& p, PAReceiver num, PAReceiver den, bool ratioed, int id) {
  EXPECT_EQ(p.numerator, num);
  EXPECT_EQ(p.denominator, den);
  EXPECT_EQ(p.ratioed, ratioed);
  EXPECT_EQ(p.id, id);
  EXPECT_EQ(p.portCount, -1);
}

TEST_F(ParameterTest, ConstructorsSetReceiversRatioAndId) {
  ExpectParameter(PAParameter(), {true, 0}, {true, 0}, false, -1);
  ExpectParameter(PAParameter(3, false, 2, true, 7, true), {false, 3}, {true, 2}, true, 7);
  // From receivers: only a denominator index above 0 is used.
  ExpectParameter(PAParameter(PAReceiver(true, 0), PAReceiver(true, 0), 3), {true, 0}, {true, 0},
                  false, 3);
  ExpectParameter(PAParameter(PAReceiver(true, 2), PAReceiver(false, 1), 3), {true, 2},
                  {false, 1}, true, 3);
  // From receiver numbers: ratioed by the raw number, before classification.
  ExpectParameter(PAParameter(4, -1, 2), {false, 4}, {false, -1}, false, 2);
  ExpectParameter(PAParameter(4, 11, 2), {false, 4}, {true, 1}, true, 2);
  ExpectParameter(PAParameter(12), {true, 2}, {true, 0}, false, -1);

  PAParameter p(4, 11, 2);
  p.PortCount();
  p.Init(false, 9);
  ExpectParameter(p, {false, 4}, {true, 1}, false, 9);
}

TEST_F(ParameterTest, OrdersByIdThenDenominatorThenNumerator) {
  const PAParameter idOne(4, false, 4, false, 1, true), idTwo(1, true, 1, true, 2, true);
  EXPECT_TRUE(idOne < idTwo);
  EXPECT_FALSE(idTwo < idOne);
  const PAParameter refDen(4, false, 1, true, 1, true);
  EXPECT_TRUE(refDen < idOne);
  // Equal ids and denominators: a reference numerator first; ratioed takes no part.
  const PAParameter refNum(3, true, 4, false, 1, false);
  EXPECT_TRUE(refNum < idOne);
  PAParameter same = idOne;
  same.ratioed = false;
  same.PortCount();
  EXPECT_FALSE(same < idOne);
  EXPECT_FALSE(idOne < same);
}

TEST_F(ParameterTest, PortCountIsAskedOnceAndCopiesCarryIt) {
  const PAParameter p(1);
  EXPECT_EQ(p.PortCount(), 4);
  testSet().ports = 2;
  EXPECT_EQ(p.PortCount(), 4);
  const PAParameter copy = p;
  EXPECT_EQ(copy.PortCount(), 4);
  EXPECT_EQ(testSet().portCountCalls, 1);
}

TEST_F(ParameterTest, RatioBucketDividesNumeratorByDenominator) {
  // Property: out * d reproduces n to float rounding (relative 1e-6 of |n|).
  std::mt19937 random(42);
  std::uniform_real_distribution<float> value(-10.0f, 10.0f);
  const PAParameter ratio(1, false, 2, true, 0, true), plain(1, false, 2, true, 0, false);
  for (int trial = 0; trial < 200; ++trial) {
    std::vector<TsComplex> point = PointBuffer();
    const TsComplex n(value(random), value(random)), d(value(random), value(random));
    point[4] = n;  // test receiver 1
    point[1] = d;  // reference receiver 2
    TsComplex out;
    ratio.RatioBucket(point.data(), out, false);
    const TsComplex back = out * d;
    EXPECT_LE(std::hypot(back.re - n.re, back.im - n.im), 1e-6 * n.Mag() + 1e-30) << trial;
    plain.RatioBucket(point.data(), out, false);
    EXPECT_EQ(out, n);
  }
}

TEST_F(ParameterTest, RatioBucketZeroDenominatorGivesZeroAndMappingFlagMovesSlots) {
  std::vector<TsComplex> point = PointBuffer();
  const PAParameter ratio(1, false, 2, true, 0, true);
  point[4] = TsComplex(3, -2);
  point[1] = TsComplex(0, 0);
  TsComplex out(9, 9);
  ratio.RatioBucket(point.data(), out, false);
  EXPECT_EQ(out, TsComplex(0, 0));  // n * conj(0) over the smallest normal float

  point[1] = TsComplex(std::numeric_limits<float>::quiet_NaN(), 0);
  ratio.RatioBucket(point.data(), out, false);
  EXPECT_TRUE(std::isnan(out.re) && std::isnan(out.im));

  // Mapped: test receiver 1 at slot 3, reference 2 at slot 6.
  point[3] = TsComplex(2, 4);
  point[6] = TsComplex(0, 2);
  ratio.RatioBucket(point.data(), out, true);
  EXPECT_EQ(out, TsComplex(2, -1));
}

}  // namespace
}  // namespace phase_test
