#include "platform/ini_document.h"

#include <gtest/gtest.h>

#include <optional>
#include <string>

namespace {

using LumenUtility::IniDocument;

TEST(IniDocument, FindsEntriesOfTheirSectionWhateverTheCaseAndBlanks) {
  const IniDocument document = IniDocument::Parse(
      L"\xFEFF" L"top=ignored\r\n"
      L"; comment=no\n"
      L"  [ Debug ]  \r\n"
      L"  Debug Print  =  0101 \n"
      L"not an entry\n"
      L"=no name\n"
      L"Empty=\n"
      L"[Other]\n"
      L"Debug Print=1111");
  EXPECT_EQ(document.Find(L"debug", L"DEBUG PRINT"), L"0101");
  EXPECT_EQ(document.Find(L"Debug", L"Empty"), L"");
  EXPECT_EQ(document.Find(L"other", L"debug print"), L"1111");  // last line without LF
  EXPECT_EQ(document.Find(L"Debug", L"top"), std::nullopt);     // before every header
  EXPECT_EQ(document.Find(L"Debug", L"; comment"), std::nullopt);
  EXPECT_EQ(document.Find(L"Debug", L"not an entry"), std::nullopt);
  EXPECT_EQ(document.Find(L"Missing", L"Debug Print"), std::nullopt);
  // Only ASCII letters fold: these are different names.
  EXPECT_EQ(IniDocument::Parse(L"[Ä]\nx=1\n").Find(L"ä", L"x"), std::nullopt);
}

TEST(IniDocument, FirstOfRepeatedNamesCountsAndOneQuotePairIsDropped) {
  const IniDocument document = IniDocument::Parse(
      L"[A]\nk=first\nK=second\nq=\"  padded \"\nqq=\"\"x\"\"\nhalf=\"open\n"
      L"[a]\nk=other section\nlate=found only here\n");
  EXPECT_EQ(document.Find(L"A", L"k"), L"first");
  EXPECT_EQ(document.Find(L"A", L"q"), L"  padded ");
  EXPECT_EQ(document.Find(L"A", L"qq"), L"\"x\"");
  EXPECT_EQ(document.Find(L"A", L"half"), L"\"open");
  EXPECT_EQ(document.Find(L"A", L"late"), std::nullopt);
}

TEST(IniDocument, SetChangesTheEntryInPlaceAndKeepsEveryOtherLine) {
  IniDocument document = IniDocument::Parse(
      L"; settings\n[Debug]\nDebug Print=0\n; keep me\nDebug Print File=1\n\n[Next]\nx=1\n");
  ASSERT_TRUE(document.Set(L"debug", L"DEBUG PRINT", L"0101"));
  ASSERT_TRUE(document.Set(L"Debug", L"Debug Print Filename", L"out.txt"));
  ASSERT_TRUE(document.Set(L"New", L"a", L"b"));
  EXPECT_EQ(document.Text(),
            L"; settings\n[Debug]\nDEBUG PRINT=0101\n; keep me\nDebug Print File=1\n"
            L"Debug Print Filename=out.txt\n\n[Next]\nx=1\n\n[New]\na=b\n");
  EXPECT_EQ(IniDocument::Parse(document.Text()).Text(), document.Text());
  // Carriage returns at line ends, doubled or before the end of the text, are line ends too.
  const IniDocument crs = IniDocument::Parse(L"[a]\r\r\nk=v\r\r\nx=1\ry\r");
  EXPECT_EQ(crs.Text(), L"[a]\nk=v\nx=1\ry\n");
  EXPECT_EQ(crs.Find(L"a", L"k"), L"v");
}

TEST(IniDocument, ValuesComeBackAsTheyWereSet) {
  for (const std::wstring value :
       {L"", L" ", L"  lead", L"trail\t", L"\"quoted\"", L"\"", L"a\"b", L"x=y;z", L"[s]",
        L"µ€ 𝄞"}) {
    IniDocument document;
    ASSERT_TRUE(document.Set(L"S", L"e", value));
    EXPECT_EQ(IniDocument::Parse(document.Text()).Find(L"s", L"E"), value) << document.Text();
  }
}

TEST(IniDocument, NamesAndValuesThatCannotBeLinesAreRefused) {
  struct Case {
    std::wstring section, entry, value;
  };
  const Case refused[] = {
      {L"", L"e", L"v"},   {L" S", L"e", L"v"},  {L"S]", L"e", L"v"},   {L"S\n", L"e", L"v"},
      {L"S", L"", L"v"},   {L"S", L"e ", L"v"},  {L"S", L"a=b", L"v"},  {L"S", L"[e", L"v"},
      {L"S", L";e", L"v"}, {L"S", L"e", L"a\nb"}, {L"S", L"e", L"a\rb"},
      {L"S", L"e", std::wstring(L"a\0b", 3)}};
  for (const Case& c : refused) {
    IniDocument document = IniDocument::Parse(L"[S]\ne=old\n");
    EXPECT_FALSE(document.Set(c.section, c.entry, c.value)) << c.section << "/" << c.entry;
    EXPECT_EQ(document.Text(), L"[S]\ne=old\n");
  }
}

}  // namespace
