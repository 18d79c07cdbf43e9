#include "lumen/core/trace_stats.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

namespace LumenUtility {
namespace {

struct Stats {
  double mean = -1, stdDev = -1, min = -1, max = -1, meanSquare = -1;
};

Stats Of(const std::vector<double>& v) {
  Stats s;
  ComputeStats(v.data(), v.data() + v.size(), s.mean, s.stdDev, s.min, s.max, s.meanSquare);
  return s;
}

// mean, deviation, min, max and mean square of `v`, in that order.
std::vector<double> All(const std::vector<double>& v) {
  const Stats s = Of(v);
  return {s.mean, s.stdDev, s.min, s.max, s.meanSquare};
}

TEST(TraceStats, SmallSamplesGiveTheTextbookValues) {
  const float values[] = {1, 2, 3, 4};
  float mean, stdDev, min, max, meanSquare;
  ComputeStats(values, values + 4, mean, stdDev, min, max, meanSquare);
  EXPECT_FLOAT_EQ(mean, 2.5f);
  EXPECT_FLOAT_EQ(stdDev, 1.2909944f);  // sample deviation, n - 1
  EXPECT_EQ(min, 1.0f);
  EXPECT_EQ(max, 4.0f);
  EXPECT_FLOAT_EQ(meanSquare, 7.5f);

  EXPECT_EQ(All({-3.0}), (std::vector<double>{-3, 0, -3, -3, 9}));
  EXPECT_EQ(All({5, -1, 2})[2], -1.0);
  EXPECT_EQ(All({5, -1, 2})[3], 5.0);
  EXPECT_EQ(All({}), std::vector<double>(5, -1));  // writes nothing
}

TEST(TraceStats, DeviationSurvivesALargeOffset) {
  // Frequencies near 5 GHz spread by about 1 Hz: the plain sum of squares cancels to noise.
  std::mt19937 rng(5);
  std::normal_distribution<double> noise(0.0, 1.0);
  std::vector<double> v(10001);
  for (double& x : v) x = 5e9 + noise(rng);
  double mean = 0;
  for (double x : v) mean += x;
  mean /= v.size();
  double squares = 0;
  for (double x : v) squares += (x - mean) * (x - mean);
  const double reference = std::sqrt(squares / (v.size() - 1));
  EXPECT_NEAR(Of(v).stdDev, reference, 1e-6 * reference);

  const std::vector<float> constant(1000, 1.0e8f);
  float m, sd = -1, lo, hi, ms;
  ComputeStats(constant.data(), constant.data() + constant.size(), m, sd, lo, hi, ms);
  EXPECT_EQ(sd, 0.0f);
  EXPECT_EQ(m, 1.0e8f);
}

}  // namespace
}  // namespace LumenUtility
