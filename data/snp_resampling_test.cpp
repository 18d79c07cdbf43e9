#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "lumen/data.h"

using LumenUtility::InputArray;
using LumenUtility::TsComplex;

namespace {

constexpr double kDegree = 3.14159265358979323846 / 180.0;

// One-port file on 1, 2, 3 GHz: magnitude 0.5, phase 0, 30, 60 degrees (an arc about the
// origin with even steps).
const char kArc[] = "# GHz S MA R 50\n1 0.5 0\n2 0.5 30\n3 0.5 60\n";

CSnPFileBase ReadOnePort(const std::string& text) {
  CSnPFileBase file(1);
  EXPECT_GT(file.ReadSNPText(text), 0)
      << std::string(file.GetReadError().begin(), file.GetReadError().end());
  return file;
}

const CSNParameter& S11(const CSnPFileBase& file) {
  return file.GetParam(SNP_S11);
}

void ExpectPolar(TsComplex v, double magnitude, double degrees, double tolerance) {
  EXPECT_NEAR(v.re, magnitude * std::cos(degrees * kDegree), tolerance);
  EXPECT_NEAR(v.im, magnitude * std::sin(degrees * kDegree), tolerance);
}

TEST(SnPResampling, InteriorPointsFollowTheArcAndKeepTheName) {
  CSnPFileBase file = ReadOnePort(kArc);
  const InputArray target(std::vector<double>{1.5e9, 2.5e9});
  file.InterpolateReadSNPFile(target, true);
  const CSNParameter& s11 = S11(file);
  EXPECT_EQ(s11.GetName(), L"S11");
  EXPECT_EQ(s11.GetStimulus(), target);
  ASSERT_EQ(s11.GetData().size(), 2u);
  // On the circle, not the chord (whose midpoint would have magnitude 0.483).
  ExpectPolar(s11.GetData()[0], 0.5, 15, 1e-5);
  ExpectPolar(s11.GetData()[1], 0.5, 45, 1e-5);
}

TEST(SnPResampling, SamePointsCopyAndDescendingTargetMirrorsAscending) {
  CSnPFileBase file = ReadOnePort(kArc);
  const std::vector<TsComplex> before = S11(file).GetData();
  file.InterpolateReadSNPFile(S11(file).GetStimulus(), false);
  EXPECT_EQ(S11(file).GetData(), before);

  CSnPFileBase up = ReadOnePort(kArc), down = ReadOnePort(kArc);
  up.InterpolateReadSNPFile(InputArray(1.2e9, 2.8e9, 5, LumenUtility::Linear), true);
  down.InterpolateReadSNPFile(InputArray(2.8e9, 1.2e9, 5, LumenUtility::Linear), true);
  for (int i = 0; i < 5; ++i) {
    EXPECT_LT((S11(up).GetData()[i] - S11(down).GetData()[4 - i]).Mag(), 1e-6) << i;
  }
}

TEST(SnPResampling, TargetBeyondTheTraceGivesZerosUnlessWidenedFirst) {
  const InputArray target(0.5e9, 3.5e9, 7, LumenUtility::Linear);
  CSnPFileBase plain = ReadOnePort(kArc);
  plain.InterpolateReadSNPFile(target, true);
  for (const TsComplex& v : S11(plain).GetData()) EXPECT_EQ(v, TsComplex());

  CSnPFileBase widened = ReadOnePort(kArc);
  widened.ExtroplateReadSNPFile(target);
  EXPECT_EQ(S11(widened).GetStartFreq(), 0.5e9);
  EXPECT_EQ(S11(widened).GetStopFreq(), 3.5e9);
  EXPECT_EQ(S11(widened).GetNumPoints(), 5);
  widened.InterpolateReadSNPFile(target, true);
  const std::vector<TsComplex>& data = S11(widened).GetData();
  ExpectPolar(data.front(), 0.5, 0, 1e-6);  // held at the 1 GHz value
  ExpectPolar(data.back(), 0.5, 60, 1e-6);  // held at the 3 GHz value
  ExpectPolar(data[3], 0.5, 30, 1e-6);      // 2 GHz, an old point

  // A descending target widens the same way; a target inside the range changes nothing.
  CSnPFileBase reversed = ReadOnePort(kArc);
  reversed.ExtroplateReadSNPFile(InputArray(3.5e9, 0.5e9, 7, LumenUtility::Linear));
  EXPECT_EQ(S11(reversed).GetStartFreq(), 0.5e9);
  EXPECT_EQ(S11(reversed).GetStopFreq(), 3.5e9);
  CSnPFileBase inside = ReadOnePort(kArc);
  const CSNParameter before = S11(inside);
  inside.ExtroplateReadSNPFile(InputArray(1.5e9, 2.5e9, 3, LumenUtility::Linear));
  EXPECT_EQ(S11(inside).GetStimulus(), before.GetStimulus());
  EXPECT_EQ(S11(inside).GetData(), before.GetData());
}

TEST(SnPResampling, ResetDecidesWhatHappensToTheSpareData) {
  const InputArray target(1e9, 3e9, 5, LumenUtility::Linear);
  CSnPFileBase kept = ReadOnePort(kArc);
  CSNParameter& trace = kept.GetParam(SNP_S11);
  trace.GetSpareData().assign(3, TsComplex(1, 1));
  kept.InterpolateReadSNPFile(target, false);
  EXPECT_EQ(trace.GetSpareData(), std::vector<TsComplex>(3, TsComplex(1, 1)));
  kept.InterpolateReadSNPFile(InputArray(1e9, 3e9, 4, LumenUtility::Linear), true);
  EXPECT_EQ(trace.GetSpareData(), std::vector<TsComplex>(4));
}

TEST(SnPResampling, NoiseTracesKeepTheStimulusTheyWereReadWith) {
  CSnPFileBase file(2);
  ASSERT_EQ(file.ReadSNPText("# GHz S MA R 50\n! Noise Parameters\n"
                             "1 0.5 0 0.1 90 0.2 0 0.4 45\n2 0.6 10 0.3 80 0.2 5 0.5 40\n"
                             "3 0.6 10 0.3 80 0.2 5 0.5 40\n1 3 0.5 45 0.2\n"),
            3);
  const InputArray noiseStimulus = file.GetCustomParam(0).GetStimulus();
  const InputArray target(0.5e9, 3.5e9, 11, LumenUtility::Linear);
  file.ExtroplateReadSNPFile(target);
  file.InterpolateReadSNPFile(target, true);
  for (int i = 0; i < 3; ++i) EXPECT_EQ(file.GetCustomParam(i).GetStimulus(), noiseStimulus);
  for (int k = 0; k < 4; ++k) EXPECT_EQ(file.GetLoopParam(k).GetNumPoints(), 11);
}

TEST(SnPResampling, EmptyTracesAndEmptyTargetsAreLeftAlone) {
  CSNParameter empty;
  empty.Interpolate(InputArray(1e9, 2e9, 3, LumenUtility::Linear), true);
  EXPECT_TRUE(empty.GetData().empty());

  CSnPFileBase file = ReadOnePort(kArc);
  const CSNParameter before = S11(file);
  file.InterpolateReadSNPFile(InputArray(), true);
  file.ExtroplateReadSNPFile(InputArray());
  EXPECT_EQ(S11(file).GetData(), before.GetData());
  EXPECT_EQ(S11(file).GetStimulus(), before.GetStimulus());

  CSnPFileBase noPoints(1);
  ASSERT_EQ(noPoints.ReadSNPText("# GHz\n! no data\n"), 0);
  noPoints.ExtroplateReadSNPFile(InputArray(1e9, 2e9, 3, LumenUtility::Linear));
  noPoints.InterpolateReadSNPFile(InputArray(1e9, 2e9, 3, LumenUtility::Linear), true);
  EXPECT_EQ(S11(noPoints).GetNumPoints(), 0);

  // One point: the trace holds its value over the whole widened range.
  CSnPFileBase single = ReadOnePort("# GHz S RI\n2 0.25 0.5\n");
  const InputArray target(1e9, 3e9, 3, LumenUtility::Linear);
  single.ExtroplateReadSNPFile(target);
  single.InterpolateReadSNPFile(target, true);
  for (const TsComplex& v : S11(single).GetData()) EXPECT_EQ(v, TsComplex(0.25, 0.5));
}

}  // namespace
