#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "lumen/interpolation/linear_interpolation.h"
#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {
namespace {

const double kNaN = std::numeric_limits<double>::quiet_NaN();

TEST(LinearInterpolation, EqualStimuliCopyAndOnePointSpreads) {
  const InputArray stimulus(1e9, 2e9, 11, Linear);
  const std::vector<float> in{1, 2, 3};  // the copy does not look at the length
  std::vector<float> out{9};
  EXPECT_EQ(LinearInterpolation(stimulus, InputArray(stimulus), in, out), INTERP_UNCHANGED);
  EXPECT_EQ(out, in);

  // One old point spreads its value.
  std::vector<TsComplex> spread;
  ASSERT_EQ(LinearInterpolation(InputArray(5.0, 1), InputArray(0.0, 10.0, 3, Linear),
                                std::vector<TsComplex>{{1, 2}}, spread),
            INTERP_DONE);
  EXPECT_EQ(spread, std::vector<TsComplex>(3, TsComplex(1, 2)));
}

TEST(LinearInterpolation, UnorderedOldStimulusLeavesOutputUntouched) {
  const InputArray fresh(0.0, 2.0, 5, Linear);
  const std::vector<double> in{1, 2, 3};
  for (const std::vector<double>& old :
       {std::vector<double>{0, 2, 1}, std::vector<double>{0, kNaN, 2},
        std::vector<double>{0, 1, std::numeric_limits<double>::infinity()},
        std::vector<double>{}}) {
    std::vector<double> out{42};
    EXPECT_EQ(LinearInterpolation(InputArray(old), fresh, in, out), INTERP_NOT_MONOTONIC);
    EXPECT_EQ(out, std::vector<double>{42});
  }
}

TEST(LinearInterpolation, HoldsEndValuesOutsideTheOldRangeInEitherDirection) {
  const std::vector<double> newPoints{-5, 0, 2.5, 5, 7.5, 10, 15};
  const std::vector<float> rising{0, 10, 20, 30, 40};
  std::vector<float> out;
  ASSERT_EQ(
      LinearInterpolation(InputArray(0.0, 10.0, 5, Linear), InputArray(newPoints), rising, out),
      INTERP_DONE);
  EXPECT_EQ(out, (std::vector<float>{0, 0, 10, 20, 30, 40, 40}));

  // The same trace on a falling stimulus: every new point lands on the same data.
  const std::vector<float> falling{40, 30, 20, 10, 0};
  std::vector<float> outFalling;
  ASSERT_EQ(LinearInterpolation(InputArray(10.0, 0.0, 5, Linear), InputArray(newPoints), falling,
                                outFalling),
            INTERP_DONE);
  EXPECT_EQ(outFalling, out);
}

TEST(LinearInterpolation, ResamplesInPlaceAndRejectsShortData) {
  std::vector<double> trace{0, 10, 20};
  ASSERT_EQ(LinearInterpolation(InputArray(0.0, 2.0, 3, Linear), InputArray(0.0, 2.0, 5, Linear),
                                trace, trace),
            INTERP_DONE);
  EXPECT_EQ(trace, (std::vector<double>{0, 5, 10, 15, 20}));

  std::vector<double> out{7};
  EXPECT_THROW(LinearInterpolation(InputArray(0.0, 2.0, 3, Linear), InputArray(1.0, 1),
                                   std::vector<double>{1, 2}, out),
               LumenException);
  EXPECT_EQ(out, std::vector<double>{7});
}

}  // namespace
}  // namespace LumenUtility
