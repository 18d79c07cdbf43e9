#include "platform/command_line.h"

#include <gtest/gtest.h>

namespace {

using LumenUtility::SplitCommandLine;
using Args = std::vector<std::wstring>;

TEST(SplitCommandLine, FollowsTheRuntimeQuotingAndBackslashRules) {
  struct Case {
    const wchar_t* line;
    Args arguments;
  } cases[] = {
      {LR"("abc" d e)", {L"abc", L"d", L"e"}},
      {LR"(a\\b d"e f"g h)", {LR"(a\\b)", L"de fg", L"h"}},
      {LR"(a\\\"b c d)", {LR"(a\"b)", L"c", L"d"}},
      {LR"(a\\\\"b c" d e)", {LR"(a\\b c)", L"d", L"e"}},
      {LR"(a"b"" c d)", {LR"(ab" c d)"}},
      {L"  \tx \t y  ", {L"x", L"y"}},
      {LR"("" x "")", {L"", L"x", L""}},
      {LR"("open quote runs to the end)", {L"open quote runs to the end"}},
      {LR"(trailing\)", {LR"(trailing\)"}},
      {L"", {}},
  };
  for (const Case& c : cases) EXPECT_EQ(SplitCommandLine(c.line), c.arguments) << c.line;
}

TEST(SplitCommandLine, QuotedPathsWithSpacesStayWhole) {
  EXPECT_EQ(SplitCommandLine(LR"(a -tzip -mx=1 "/tmp/my dir/out.zip" "x y.txt")"),
            (Args{L"a", L"-tzip", L"-mx=1", L"/tmp/my dir/out.zip", L"x y.txt"}));
}

}  // namespace
