#include "interpolation/vector_kernels.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

namespace LumenUtility::VectorKernels {
namespace {

TEST(VectorKernels, AngleCodesRoundHalvesAwayAndWrap) {
  const float inf = std::numeric_limits<float>::infinity();
  const std::vector<float> in{0.5f,     -0.5f,    2.5f,
                              -2.5f,    32767.4f, 32768.0f,
                              -32769.f, 98304.f,  65536.0f * 40000.0f + 3.0f,
                              inf,      -inf,     std::numeric_limits<float>::quiet_NaN()};
  std::vector<std::int16_t> out(in.size(), 99);
  ToAngleCode(in.data(), out.data(), in.size());
  EXPECT_EQ(out,
            (std::vector<std::int16_t>{1, -1, 3, -3, 32767, -32768, 32767, -32768, 0, 0, 0, 0}));
}

TEST(VectorKernels, ComplexDivisionSurvivesExtremeAndZeroDivisors) {
  // |b|^2 of 1e30 + 1e30j overflows in float; 1e-30 underflows. Both divide correctly.
  const std::vector<TsComplex> a{{1e30f, 0}, {1e-30f, 0}, {3, 4}, {1, 2}};
  const std::vector<TsComplex> b{{1e30f, 1e30f}, {1e-30f, 1e-30f}, {0, 0}, {0, 1}};
  std::vector<TsComplex> q(4);
  Divide(a.data(), b.data(), q.data(), 4);
  for (int k : {0, 1}) EXPECT_LT((q[k] - TsComplex(0.5f, -0.5f)).Mag(), 1e-7) << k;
  EXPECT_EQ(q[2], TsComplex(0, 0));
  EXPECT_EQ(q[3], TsComplex(2, -1));
  // The quotient may overwrite the dividend.
  std::vector<TsComplex> c{{2, 2}};
  const TsComplex two(2, 0);
  Divide(c.data(), &two, c.data(), 1);
  EXPECT_EQ(c[0], TsComplex(1, 1));
}

TEST(VectorKernels, MagnitudesMayOverlayTheirComplexSource) {
  std::vector<TsComplex> v{{3, 4}, {0, -2}, {-1, 0}, {5, 12}};
  std::vector<float> phase(4);
  CartToPolar(v.data(), Floats(v.data()), phase.data(), 4);
  const float* mag = Floats(v.data());
  EXPECT_EQ((std::vector<float>(mag, mag + 4)), (std::vector<float>{5, 2, 1, 13}));
  EXPECT_FLOAT_EQ(phase[1], -1.5707964f);
  EXPECT_FLOAT_EQ(phase[2], 3.1415927f);
}

}  // namespace
}  // namespace LumenUtility::VectorKernels
