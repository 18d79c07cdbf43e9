#include "lumen/platform/lumen_exception.h"

#include <gtest/gtest.h>

namespace {

TEST(LumenException, MessageAloneCarriesTheBoundsCode) {
  const LumenException e(L"couldn't load driver");
  EXPECT_EQ(e.GetCode(), LumenUtility::LUMEN_E_BOUNDS);
  ASSERT_EQ(e.GetMessages().size(), 1u);
  EXPECT_EQ(e.GetMessage(), L"couldn't load driver");
  EXPECT_STREQ(e.what(), "0xE8080882: couldn't load driver");
}

TEST(LumenException, CodeWithoutMessageHasEmptyListAndIsCaughtAsStdException) {
  const LumenException e(LumenUtility::LUMEN_E_UNKNOWN_VERSION);
  EXPECT_TRUE(e.GetMessages().empty());
  EXPECT_EQ(e.GetMessage(), L"");
  EXPECT_STREQ(e.what(), "0xE8080867");
  try {
    throw LumenException(LumenUtility::E_FAIL, L"index");
  } catch (const std::exception& e) {
    EXPECT_STREQ(e.what(), "0x80004005: index");
  }
}

}  // namespace
