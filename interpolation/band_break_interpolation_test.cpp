#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "lumen/interpolation/circular_interpolation.h"

namespace LumenUtility {
namespace {

// Old points 0, 1, ..., 9 on the unit circle about (0.2, 0.1), 0.3 rad per unit of stimulus.
class BandBreaks : public ::testing::Test {
 protected:
  BandBreaks() {
    for (int k = 0; k < 10; ++k) {
      m_x.push_back(k);
      m_d.push_back(OnCircle(k));
    }
  }

  static TsComplex OnCircle(double f) {
    return TsComplex(0.2 + std::cos(0.3 * f), 0.1 + std::sin(0.3 * f));
  }

  std::vector<TsComplex> Resample(const std::vector<double>& newX,
                                  const std::vector<double>& breaks) {
    std::vector<TsComplex> out(newX.size());
    m_status = CircularInterpolationUsingBandBreaks(InputArray(m_x), m_d.data(), InputArray(newX),
                                                    out.data(), breaks, &m_interpolated);
    return out;
  }

  // What CircularInterpolationEx makes of new point f from old points first .. last alone.
  TsComplex FromOldPoints(int first, int last, double f) {
    const std::vector<double> x(m_x.begin() + first, m_x.begin() + last + 1);
    TsComplex out;
    CircularInterpolationEx(InputArray(x), m_d.data() + first, InputArray(std::vector<double>{f}),
                            &out, nullptr);
    return out;
  }

  std::vector<double> m_x;
  std::vector<TsComplex> m_d;
  tagInterpStatus m_status = INTERP_DONE;
  bool m_interpolated = true;
};

TEST_F(BandBreaks, EachRunUsesOnlyTheOldPointsOfItsBand) {
  // Bands: up to 3 (3 itself included), up to 6, above 6. Runs in the order given.
  const std::vector<double> newX{2.5, 4.5, 5.5, 8.5, 1.5, 7};
  const std::vector<TsComplex> expected{FromOldPoints(0, 3, 2.5), FromOldPoints(4, 6, 4.5),
                                        FromOldPoints(4, 6, 5.5), FromOldPoints(7, 9, 8.5),
                                        FromOldPoints(0, 3, 1.5), m_d[7]};
  EXPECT_EQ(Resample(newX, {3, 6}), expected);
  // The last run only copied: its status and flag stand for the whole call.
  EXPECT_EQ(m_status, INTERP_UNCHANGED);
  EXPECT_FALSE(m_interpolated);

  // Breaks in any order mean the same bands.
  EXPECT_EQ(Resample(newX, {6, 3}), expected);
}

TEST_F(BandBreaks, TwoPointBandTakesThePointBeforeItAsThirdPoint) {
  // Band (3, 5] holds 4 and 5; the circle through 3, 4 and 5 is the data's own circle.
  const std::vector<TsComplex> out = Resample({4.5}, {3, 5});
  EXPECT_EQ(m_status, INTERP_DONE);
  EXPECT_TRUE(m_interpolated);
  EXPECT_LT((out[0] - OnCircle(4.5)).Mag(), 1e-5);

  // At the very start there is no point before: magnitude and phase between 0 and 1.
  EXPECT_EQ(Resample({0.5}, {1.5})[0], LinearInterpolateUsingMagPhase(0, 1, m_d[0], m_d[1], 0.5));
}

TEST_F(BandBreaks, EmptyBandsBorrowNeighboursAndOneOldPointIsCopied) {
  // No old point lies in (3.2, 3.8]: the run takes old points 4 and 5 (and 3 before them) and
  // extrapolates back along their circle.
  EXPECT_LT((Resample({3.5}, {3.2, 3.8})[0] - OnCircle(3.5)).Mag(), 1e-5);
  // Above the last old point the last two are taken.
  const std::vector<TsComplex> top = Resample({9.5, 12}, {9.2});
  EXPECT_LT((top[0] - OnCircle(9.5)).Mag(), 1e-5);
  EXPECT_LT((top[1] - OnCircle(12)).Mag(), 1e-5);

  // One old point gives its value everywhere.
  std::vector<TsComplex> out(3);
  bool flag = false;
  EXPECT_EQ(CircularInterpolationUsingBandBreaks(InputArray(4.0, 1), m_d.data(),
                                                 InputArray(std::vector<double>{1, 4, 8}),
                                                 out.data(), {3, 6}, &flag),
            INTERP_DONE);
  EXPECT_TRUE(flag);
  EXPECT_EQ(out, std::vector<TsComplex>(3, m_d[0]));
}

}  // namespace
}  // namespace LumenUtility
