#include "lumen/core/natural_compare.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

namespace LumenUtility {
namespace {

TEST(NaturalCompare, NumbersCompareByValueAndFractionsDigitByDigit) {
  EXPECT_EQ(strnatcmp(L"x2", L"x10"), -1);
  EXPECT_EQ(strnatcmp(L"  a\t1 ", L"a1"), 0);   // white space is skipped
  EXPECT_EQ(strnatcmp(L"1.010", L"1.02"), -1);  // leading zero: left-aligned
  EXPECT_EQ(strnatcmp(L"x01", L"x1"), -1);
  EXPECT_EQ(strnatcmp(L"x05", L"x050"), -1);  // the run that ends first is smaller
  EXPECT_EQ(strnatcmp(L"1.5", L"1.45"), -1);  // no leading zero: read as integers
  // Runs longer than any machine integer still compare by value.
  EXPECT_EQ(strnatcmp(L"n123456789012345678901234567890", L"n123456789012345678901234567891"), -1);
  EXPECT_EQ(strnatcmp(L"n99999999999999999999999", L"n100000000000000000000000"), -1);
  EXPECT_EQ(strnatcmp(L"abc", L"abcd"), -1);
  EXPECT_EQ(strnatcmp(L"", L""), 0);
  EXPECT_EQ(strnatcmp(nullptr, L""), 0);
  EXPECT_EQ(strnatcmp(L"a", nullptr), 1);

  // The NoCase form folds letters only.
  EXPECT_EQ(strnatcmpNoCase(L"ABC", L"abc"), 0);
  EXPECT_EQ(strnatcmp(L"ABC", L"abc"), -1);
  EXPECT_EQ(strnatcmpNoCase(L"Trace9", L"trace10"), -1);
  EXPECT_EQ(strnatcmpNoCase(L"b", L"A"), 1);
}

TEST(NaturalCompare, SortsAnAwkwardList) {
  std::vector<std::wstring> names = {
      L"S21",  L"S1_10", L"S1_2", L"",     L" ",     L"s21",
      L"S012", L"S12",   L"S2",   L"S10",  L"007",   L"7",
      L"x 2",  L"x10",   L"1.5",  L"1.45", L"1.045", L"99999999999999999999"};
  // "" and " " compare equal; a stable sort keeps them in list order.
  std::stable_sort(names.begin(), names.end(), [](const std::wstring& a, const std::wstring& b) {
    return strnatcmp(a.c_str(), b.c_str()) < 0;
  });
  const std::vector<std::wstring> expected = {
      L"",     L" ",    L"007",   L"1.045", L"1.5", L"1.45", L"7",   L"99999999999999999999",
      L"S012", L"S1_2", L"S1_10", L"S2",    L"S10", L"S12",  L"S21", L"s21",
      L"x 2",  L"x10"};
  EXPECT_EQ(names, expected);
}

}  // namespace
}  // namespace LumenUtility
