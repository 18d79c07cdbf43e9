#include "lumen/util/string_mapper.h"

#include <gtest/gtest.h>

namespace {

using LumenUtility::LocalRegex;
using LumenUtility::StringMapper;
using Rules = std::map<LocalRegex, std::wstring>;

TEST(StringMapper, FirstWholeInputMatchRewritesWithCapturedGroups) {
  StringMapper mapper(
      Rules{{LocalRegex(L"S(\\d)(\\d)"), L"S$1_$2"}, {LocalRegex(L"T(\\d)"), L"Tx$1"}});
  EXPECT_EQ(mapper.size(), 2);
  EXPECT_EQ(mapper.GetMapping(L"S21"), L"S2_1");
  EXPECT_EQ(mapper.GetMapping(L"T5"), L"Tx5");
  EXPECT_EQ(mapper.GetMapping(L"S2"), L"S2");
  EXPECT_EQ(mapper.GetMapping(L"xS21"), L"xS21");  // a match of part of the input does not count
  EXPECT_EQ(mapper.GetMapping(L"S21"), L"S2_1");   // remembered, same answer
}

TEST(StringMapper, RulesAreTriedInTheOrderOfTheirPatternText) {
  // Both match "A1"; "A\\d" sorts before "[A-Z]1".
  StringMapper mapper(Rules{{LocalRegex(L"[A-Z]1"), L"letter"}, {LocalRegex(L"A\\d"), L"digit"}});
  EXPECT_EQ(mapper.GetMapping(L"A1"), L"digit");
  EXPECT_EQ(mapper.GetMapping(L"B1"), L"letter");
  EXPECT_TRUE(LocalRegex(L"A\\d") < LocalRegex(L"[A-Z]1"));
  EXPECT_TRUE(std::regex_match(L"A7", LocalRegex(L"A\\d")));  // usable as a std::wregex
}

TEST(StringMapper, PatternThatAlsoMatchesEmptyGivesOneReplacement) {
  StringMapper mapper(Rules{{LocalRegex(L"\\d*"), L"<$&>"}});
  EXPECT_EQ(mapper.GetMapping(L"123"), L"<123>");
  EXPECT_EQ(mapper.GetMapping(L""), L"<>");
  // The text before and after the match is empty: the whole input was matched.
  StringMapper context(Rules{{LocalRegex(L"(\\w+)"), L"[$`|$1|$']"}});
  EXPECT_EQ(context.GetMapping(L"abc"), L"[|abc|]");
}

TEST(StringMapper, NewRulesForgetRememberedResults) {
  StringMapper mapper;
  EXPECT_EQ(mapper.size(), 0);
  EXPECT_EQ(mapper.GetMapping(L"S21"), L"S21");
  mapper.SetPatternMap(Rules{{LocalRegex(L"S21"), L"Y"}});
  EXPECT_EQ(mapper.GetMapping(L"S21"), L"Y");
  StringMapper copy = mapper;
  mapper.SetPatternMap(Rules{});
  EXPECT_EQ(mapper.GetMapping(L"S21"), L"S21");
  EXPECT_EQ(copy.GetMapping(L"S21"), L"Y");
}

TEST(StringMapper, OverlongInputIsARegexErrorNotACrash) {
  StringMapper mapper(Rules{{LocalRegex(L".*"), L"all"}});
  const std::wstring longest(StringMapper::kMaxInputLength, L'a');
  EXPECT_EQ(mapper.GetMapping(longest), L"all");
  try {
    mapper.GetMapping(longest + L"a");
    FAIL() << "no exception";
  } catch (const std::regex_error& e) {
    EXPECT_EQ(e.code(), std::regex_constants::error_stack);
  }
  EXPECT_EQ(StringMapper().GetMapping(longest + L"a"), longest + L"a");  // no rule, no matcher
  EXPECT_THROW(LocalRegex(L"(unclosed"), std::regex_error);
}

}  // namespace
