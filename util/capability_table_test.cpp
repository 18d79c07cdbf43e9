#include "util/capability_table.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <stdexcept>
#include <tuple>
#include <vector>

#include "util/capability_type_list.h"

namespace LumenUtility {
namespace {

using Indices = std::vector<int>;

TEST(CapabilityTable, LookupGrowsOnlyOuterLevelOfEmptyTableAndInnerLevelOfExistingRow) {
  CapabilityTable table;
  EXPECT_EQ(table.Get(4, 2, 7), 0);
  EXPECT_EQ(table.OuterSize(), 5u);
  for (int i = 0; i < 5; ++i) EXPECT_EQ(table.MiddleSize(i), 0u) << i;

  // A smaller i never shrinks the table.
  EXPECT_EQ(table.Get(1, 0, 0), 0);
  EXPECT_EQ(table.OuterSize(), 5u);

  table = CapabilityTable();
  table.Set(1, 2, 3, 77);
  EXPECT_EQ(table.MiddleSize(1), 3u);
  EXPECT_EQ(table.InnerSize(1, 2), 4u);
  EXPECT_EQ(table.InnerSize(1, 0), 0u);

  EXPECT_EQ(table.Get(1, 2, 9), 0);
  EXPECT_EQ(table.InnerSize(1, 2), 10u);
  EXPECT_EQ(table.Get(1, 0, 5), 0);  // j = 0 exists (empty): its row grows
  EXPECT_EQ(table.InnerSize(1, 0), 6u);
  EXPECT_EQ(table.Get(1, 5, 3), 0);  // j = 5 does not exist: nothing grows under i = 1
  EXPECT_EQ(table.MiddleSize(1), 3u);
}

TEST(CapabilityTable, FindListsNonZeroEntriesAscendingAndGrowsOuterLevel) {
  CapabilityTable table;
  EXPECT_EQ(table.Find(2, 0), Indices{});
  EXPECT_EQ(table.OuterSize(), 3u);

  table.Set(2, 6, 1, 11);
  table.Set(2, 0, 1, 12);
  table.Set(2, 3, 1, 13);
  table.Set(2, 4, 0, 14);  // other type
  table.Set(2, 5, 1, 0);   // stored 0 counts as empty
  EXPECT_EQ(table.Find(2, 1), (Indices{0, 3, 6}));
  EXPECT_EQ(table.Find(2, 0), (Indices{4}));
  EXPECT_EQ(table.Find(2, 9), Indices{});
  EXPECT_EQ(table.InnerSize(2, 6), 2u);  // looking never grows rows
  EXPECT_EQ(table.Find(7, 1), Indices{});
  EXPECT_EQ(table.OuterSize(), 8u);
}

TEST(CapabilityTable, RemoveValueClearsEveryMatchUnderOneCategory) {
  CapabilityTable table;
  table.Set(1, 2, 3, 77);
  table.Set(1, 0, 3, 77);
  table.Set(1, 1, 3, 78);
  table.Set(1, 2, 4, 77);  // same value, other type
  table.Set(2, 0, 3, 77);  // same value, other category
  EXPECT_EQ(table.RemoveValue(1, 3, 77), 3);
  EXPECT_EQ(table.Find(1, 3), (Indices{1}));
  EXPECT_EQ(table.Get(1, 2, 4), 77);
  EXPECT_EQ(table.Get(2, 0, 3), 77);

  // k beyond some rows: those rows are skipped, not grown.
  EXPECT_EQ(table.RemoveValue(1, 50, 77), 3);
  EXPECT_EQ(table.InnerSize(1, 0), 4u);
}

TEST(CapabilityTable, MissingOrNegativeIndicesChangeNothing) {
  CapabilityTable table;
  table.Set(1, 1, 1, 5);
  EXPECT_EQ(table.RemoveValue(9, 1, 5), 0);
  EXPECT_EQ(table.Clear(1, 1, 4), 0);
  EXPECT_EQ(table.Clear(1, 3, 1), 0);
  EXPECT_EQ(table.Clear(6, 0, 0), 0);
  for (auto [i, j, k] : {std::tuple{-1, 0, 0}, {1, -1, 0}, {1, 1, -1}}) {
    EXPECT_EQ(table.Get(i, j, k), 0);
  }
  EXPECT_EQ(table.Find(-1, 1), Indices{});
  EXPECT_EQ(table.RemoveValue(-1, 1, 5), 0);
  EXPECT_EQ(table.Clear(1, 1, -1), 0);
  EXPECT_THROW(table.Set(1, -2, 0, 5), std::invalid_argument);
  EXPECT_EQ(table.OuterSize(), 2u);
  EXPECT_EQ(table.MiddleSize(1), 2u);
  EXPECT_EQ(table.InnerSize(1, 1), 2u);
  EXPECT_EQ(table.Get(1, 1, 1), 5);
}

TEST(CapabilityTable, SetOverwritesClearZeroesOneEntryAndAddressesKeepFullWidth) {
  CapabilityTable table;
  table.Set(0, 1, 2, 39);
  table.Set(0, 1, 2, 40);
  table.Set(0, 1, 0, 41);
  EXPECT_EQ(table.Get(0, 1, 2), 40);
  EXPECT_EQ(table.Clear(0, 1, 2), 2);
  EXPECT_EQ(table.Get(0, 1, 2), 0);
  EXPECT_EQ(table.Get(0, 1, 0), 41);
  EXPECT_EQ(table.InnerSize(0, 1), 3u);

  table = CapabilityTable();
  const std::intptr_t high = static_cast<std::intptr_t>(0x7FFF'1234'5678'9ABCLL);
  table.Set(3, 0, 0, high);
  table.Set(3, 1, 0, high + 1);
  EXPECT_EQ(table.Get(3, 0, 0), high);
  EXPECT_EQ(table.RemoveValue(3, 0, high & 0xFFFF'FFFF), 2);  // low half alone is no match
  EXPECT_EQ(table.Find(3, 0), (Indices{0, 1}));
}

TEST(CapabilityTypeList, IndicesFollowFirstRegistration) {
  CapabilityTypeList types;
  EXPECT_EQ(types.Register("P6ITestSet"), 0);
  EXPECT_EQ(types.Register("P7AI_FIFO"), 1);
  EXPECT_EQ(types.Register("P6ITestSet"), 0);
  EXPECT_EQ(types.Register("P6ITestSe"), 2);  // names compare whole, not by prefix
  EXPECT_EQ(types.size(), 3u);
}

}  // namespace
}  // namespace LumenUtility
