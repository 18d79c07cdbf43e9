#include "lumen/data/eterm_names.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

namespace LumenUtility {
namespace {

TEST(ETermNames, VocabularyIsFixedAndClosedByEmptyEntry) {
  EXPECT_STREQ(gETermNames[0], L"Directivity");
  EXPECT_STREQ(gETermNames[4], L"TranmissionTracking");
  EXPECT_STREQ(gETermNames[9], L"PowerAdapter:");
  EXPECT_STREQ(gETermNames[kETermNameCount - 1], L"PowerReferenceReading");
  EXPECT_STREQ(gETermNames[kETermNameCount], L"");
  for (int n = 0; n < kETermNameCount; ++n) EXPECT_NE(gETermNames[n][0], L'\0') << n;
}

TEST(ETermNames, PositionsAreOneBasedAndPrefixesComeFirst) {
  EXPECT_EQ(eterm_name(L"LoadMatch", 1, 0), L"LoadMatch(2,1)");
  EXPECT_EQ(eterm_name(L"CrossTalk", 11, 9), L"CrossTalk(12,10)");
  EXPECT_EQ(eterm_name(L"SourceMatch", 3), L"SourceMatch(4)");
  EXPECT_EQ(eterm_name(L"", 0), L"(1)");
  EXPECT_EQ(eterm_name(L"X", INT_MAX, -1), L"X(2147483648,0)");

  // Receiver names put the prefix before the term.
  EXPECT_EQ(reference_eterm_name(0, L"Ch1_"), L"Ch1_ResponseTracking(R1)");
  EXPECT_EQ(test_rcv_eterm_name(2, L""), L"ResponseTracking(C)");
  EXPECT_EQ(test_rcv_eterm_name(1, L"p"), L"pResponseTracking(B)");
  EXPECT_EQ(reference_eterm_name_Kestrel(0, L""), L"ResponseTracking(a1)");
  EXPECT_EQ(test_rcv_eterm_name_Kestrel(1, L""), L"ResponseTracking(b2)");
  EXPECT_EQ(test_rcv_eterm_name_Kestrel(11, L"Ch2_"), L"Ch2_ResponseTracking(b12)");
  EXPECT_EQ(src_cal_eterm_name(3, L"Ch1_"), L"Ch1_SourcePowerCorrection(4)");
}

}  // namespace
}  // namespace LumenUtility
