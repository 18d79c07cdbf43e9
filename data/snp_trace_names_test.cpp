#include "lumen/data/snp_trace_names.h"

#include <gtest/gtest.h>

namespace {

TEST(SnPTraceNames, NamesReadBackToTheirPositionForEveryPortCount) {
  for (int row : {1, 2, 9, 10, 99, 999}) {
    for (int column : {1, 3, 9, 10, 123, 999}) {
      int r = 0, c = 0;
      ASSERT_TRUE(SnPParseTraceName(SnPTraceName(row, column), r, c)) << row << "," << column;
      EXPECT_EQ(r, row);
      EXPECT_EQ(c, column);
    }
  }
  EXPECT_EQ(SnPTraceName(2, 1), "S21");
  EXPECT_EQ(SnPTraceName(1, 10), "S1_10");
  EXPECT_EQ(SnPMatrixIndex(4, 2, 3), 6);
}

TEST(SnPTraceNames, OnlyOneSpellingOfEachNameReads) {
  int r = 0, c = 0;
  EXPECT_TRUE(SnPParseTraceName("s21", r, c));
  EXPECT_TRUE(SnPParseTraceName("S1_2", r, c));  // the long form of S12 reads too
  for (const char* bad : {"S2", "S211", "S0_1", "S01", "S1_01", "S1_", "S_1", "S1_1000", "S+1_2",
                          "X21", "S1__2", "S 21", ""}) {
    EXPECT_FALSE(SnPParseTraceName(bad, r, c)) << bad;
  }
}

}  // namespace
