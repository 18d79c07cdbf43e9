#include "lumen/stimulus/segment.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <sstream>
#include <stdexcept>

#include "lumen/platform/lumen_exception.h"
#include "platform/caught_lumen.h"

namespace LumenUtility {
namespace {

using testutil::CaughtLumen;

TEST(Segment, ConstructionNormalisesTypeAndCountAndExtremesFollowThePoints) {
  const Segment single(1e9, 2e9, 1, Linear);
  EXPECT_EQ(single.GetType(), Fixed);
  EXPECT_EQ(single.at(0), 1e9);
  EXPECT_EQ(Segment(1, 10, 5, Arbitrary).GetType(), Linear);
  EXPECT_EQ(Segment(1, 10, 0, Log).GetType(), Fixed);
  EXPECT_TRUE(Segment().empty());
  EXPECT_EQ(Segment().GetType(), Linear);
  // Extremes and the fixed test look at the points, whatever the type.
  EXPECT_TRUE(Segment(std::vector<double>{2, 2, 2}).IsFixed());
  EXPECT_FALSE(Segment(std::vector<double>{2, 2, 3}).IsFixed());
  EXPECT_TRUE(Segment(4, 4, 3, Linear).IsFixed());
  const Segment arb(std::vector<double>{3, -1, 8});
  EXPECT_EQ(std::make_pair(arb.min_element(), arb.max_element()), std::make_pair(-1.0, 8.0));
  EXPECT_EQ(Segment(10, 1, 5, Linear).min_element(), 1);
  EXPECT_TRUE(std::isnan(Segment(std::vector<double>{}).min_element()));
}

TEST(Segment, PointsHitBothEndsMirrorWhenDescendingAndBadAccessThrows) {
  const Segment s(0.1, 0.7, 7, Linear);
  EXPECT_EQ(s.at(0), 0.1);
  EXPECT_EQ(s.at(6), 0.7);
  EXPECT_DOUBLE_EQ(s.at(3), 0.4);
  const std::vector<double> points = s.GetArray();
  ASSERT_EQ(points.size(), 7u);
  for (unsigned int i = 0; i < 7; ++i) EXPECT_EQ(points[i], s.at(i)) << i;
  EXPECT_EQ(Segment(10, 1, 3, Log).GetArray(), (std::vector<double>{10, 3.1622776601683795, 1}));
  EXPECT_EQ(Segment(1, 10, 3, Log).GetArray(), (std::vector<double>{1, 3.1622776601683795, 10}));
  EXPECT_EQ(CaughtLumen([] { Segment(0, 10, 11, Linear).at(11); }),
            std::make_pair(E_FAIL, std::wstring(L"index")));
  EXPECT_EQ(CaughtLumen([] { Segment(1, 10, 3, Log).at(3); }),
            std::make_pair(E_FAIL, std::wstring(L"index")));
  EXPECT_EQ(CaughtLumen([] { Segment().back(); }),
            std::make_pair(E_FAIL, std::wstring(L"Segment::back()")));
  EXPECT_EQ(Segment(4.0, 2).at(1000), 4.0);  // a constant answers any index
  EXPECT_THROW(Segment(std::vector<double>{1, 2}).at(2), std::out_of_range);
}

TEST(Segment, ComputeLogPointRulesAndSweepsStayInsideAndRejectBadInputUnwritten) {
  EXPECT_DOUBLE_EQ(ComputeLogPoint(1, 1000, 4, 2), 100);
  EXPECT_EQ(ComputeLogPoint(5, 5, 3, 1), 5);
  EXPECT_EQ(ComputeLogPoint(7, 9, 1, 5), 7);  // one point: start, whatever the index
  const auto what = [](unsigned int n, unsigned int i) -> std::string {
    try {
      ComputeLogPoint(1, 10, n, i);
    } catch (const std::invalid_argument& e) {
      return e.what();
    }
    return "nothing thrown";
  };
  EXPECT_EQ(what(0, 0), "numPts");
  EXPECT_EQ(what(3, 3), "index");

  std::vector<double> out;
  ComputeLogPoints(10e6, 20e9, 1001, out);
  ASSERT_EQ(out.size(), 1001u);
  EXPECT_EQ(out.front(), 10e6);
  EXPECT_EQ(out.back(), 20e9);
  for (std::size_t i = 1; i < out.size(); ++i) EXPECT_GT(out[i], out[i - 1]) << i;
  double buffer[3] = {-1, -1, -1};
  EXPECT_THROW(ComputeLogPoints(0, 10, 3, buffer), std::invalid_argument);
  EXPECT_THROW(ComputeLogPoints(1, -10, 3, buffer), std::invalid_argument);
  EXPECT_THROW(ComputeLogPoints(1, 10, -3, buffer), std::invalid_argument);
  EXPECT_EQ(buffer[0], -1);
  std::vector<double> kept = {42};
  EXPECT_THROW(ComputeLogPoints(1, 10, -1, kept), std::invalid_argument);
  EXPECT_EQ(kept, std::vector<double>{42});
}

TEST(Segment, FindOnLinearReturnsExactIndicesAndNeverPassesTheEnd) {
  const Segment s(0, 10, 11, Linear);
  EXPECT_EQ(s.Find(3, false), 3.0);
  EXPECT_EQ(s.Find(3.5, false), 3.5);
  EXPECT_EQ(s.Find(11, false), -1.0);
  EXPECT_EQ(s.Find(std::numeric_limits<double>::quiet_NaN(), false), -1.0);
  // Awkward sweeps whose last value is reached through rounding.
  for (unsigned int n : {3u, 7u, 201u, 1601u, 20001u}) {
    const Segment odd(0.1, 0.7, n, Linear);
    EXPECT_LE(odd.Find(0.7, false), n - 1.0) << n;
    EXPECT_LE(odd.Find(std::nextafter(0.7, 0.0), false), n - 1.0) << n;
    const Segment desc(9.3e9, 3e5, n, Linear);
    EXPECT_LE(desc.Find(3e5, false), n - 1.0) << n;
  }
}

TEST(Segment, FindOnLogFixedAndArbitraryAndEqualityByPoints) {
  const Segment log(1, 1000, 4, Log);
  EXPECT_NEAR(log.Find(100, false), 2.0, 1e-12);
  EXPECT_LE(log.Find(1000, false), 3.0);
  EXPECT_EQ(Segment(5.0, 4).Find(5, true), 1.0);
  EXPECT_EQ(Segment(5.0, 4).Find(5, false), 0.0);
  EXPECT_EQ(Segment(5.0, 4).Find(6, false), -1.0);
  const Segment zigzag(std::vector<double>{0, 1, 0, 1});
  EXPECT_EQ(zigzag.Find(0.5, false), 2.5);  // the highest crossing wins
  EXPECT_EQ(zigzag.Find(0.5, true), 0.5);   // the lowest crossing wins
  EXPECT_EQ(Segment().Find(0, false), -1.0);

  // Equality compares point sequences.
  EXPECT_EQ(Segment(3.0, 4), Segment(3, 3, 4, Linear));
  EXPECT_NE(Segment(3.0, 4), Segment(2, 2, 4, Linear));
  EXPECT_EQ(Segment(1, 10, 2, Log), Segment(1, 10, 2, Linear));
  EXPECT_NE(Segment(1, 10, 3, Log), Segment(1, 10, 3, Linear));
  EXPECT_EQ(Segment(std::vector<double>{1, 2, 3}), Segment(1, 3, 3, Linear));
  EXPECT_NE(Segment(std::vector<double>{1, 2, 3}), Segment(1, 3, 4, Linear));
}

TEST(Segment, AddingToLogTurnsItArbitraryScalingKeepsIt) {
  Segment s(1, 10000, 5, Log);
  Segment scaled = s * 2;
  EXPECT_TRUE(scaled.IsLog());
  EXPECT_EQ(std::make_pair(scaled.front(), scaled.back()), std::make_pair(2.0, 20000.0));
  s += 1;
  EXPECT_TRUE(s.IsArbitrary());
  const std::vector<double> expected = {2, 11, 101, 1001, 10001};
  for (std::size_t i = 0; i < expected.size(); ++i) EXPECT_NEAR(s.at(i), expected[i], 1e-9);
  EXPECT_TRUE((Segment(1, 10, 2, Log) + 1).IsLog());  // two points stay logarithmic
}

TEST(Segment, ChangingOneCopyLeavesItsSharersAlone) {
  const Segment original(std::vector<double>{1, 2, 3});
  Segment copy = original;
  copy += 10;
  copy.reverse();
  EXPECT_EQ(original.GetArray(), (std::vector<double>{1, 2, 3}));
  EXPECT_EQ(copy.GetArray(), (std::vector<double>{13, 12, 11}));
  Segment scaled = original;
  scaled *= 2;
  EXPECT_EQ(original.at(2), 3);
}

TEST(Segment, TextFormRoundTripsAndBadTextLeavesTheSegment) {
  for (const Segment& s : {Segment(std::vector<double>{1, 2, 3}), Segment(1e6, 3e9, 201, Linear),
                           Segment(10, 1000, 3, Log), Segment(7.5, 4), Segment()}) {
    std::wstringstream text;
    text.precision(17);
    text << s;
    Segment back(99.0, 1);
    text >> back;
    EXPECT_FALSE(text.fail()) << text.str();
    EXPECT_EQ(back, s) << text.str();
  }
  std::wostringstream out;
  out << Segment(std::vector<double>{1, 2.5, 3});
  EXPECT_EQ(out.str(), L"ARB,3,1,2.5,3");
  // An unknown token or short data fails and leaves the segment.
  for (const wchar_t* bad : {L"LUN,2,1,2", L"", L"ARB,3,1,2", L"LIN,2,1", L"FIX"}) {
    std::wistringstream text(bad);
    Segment s(5.0, 1);
    text >> s;
    EXPECT_TRUE(text.fail()) << bad;
    EXPECT_EQ(s, Segment(5.0, 1)) << bad;
  }
}

}  // namespace
}  // namespace LumenUtility
