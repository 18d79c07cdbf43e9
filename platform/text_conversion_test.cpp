#include "lumen/platform/text_conversion.h"

#include <gtest/gtest.h>

namespace LumenUtility {
namespace {

TEST(TextConversion, Utf8RoundTripsEveryPlaneAndReplacesMalformedInput) {
  const std::wstring text = L"f = 1 GHz, \u03a9 \u00b0 \u20ac \U0001F4E1";
  EXPECT_EQ(Utf8ToWide(WideToUtf8(text)), text);
  EXPECT_EQ(WideToUtf8(L"\u00b0"), "\xC2\xB0");
  EXPECT_EQ(WideToUtf8(L"\U0001F4E1"), "\xF0\x9F\x93\xA1");

  EXPECT_EQ(Utf8ToWide("a\xC3"), L"a\uFFFD");                    // truncated sequence
  EXPECT_EQ(Utf8ToWide("\xC0\xAF"), L"\uFFFD");                  // overlong "/"
  EXPECT_EQ(Utf8ToWide("\xED\xA0\x80"), L"\uFFFD");              // encoded surrogate
  EXPECT_EQ(Utf8ToWide(std::string("\xFF") + "b"), L"\uFFFDb");  // impossible lead byte
  EXPECT_EQ(Utf8ToWide("\xF4\x90\x80\x80"), L"\uFFFD");          // past U+10FFFF
}

TEST(TextConversion, Utf16JoinsPairsReplacesStraySurrogatesAndReadsLittleEndianBytes) {
  EXPECT_EQ(Utf16ToWide(u"\U0001F4E1"), L"\U0001F4E1");
  EXPECT_EQ(WideToUtf16(L"\U0001F4E1"), std::u16string(u"\xD83D\xDCE1"));
  const char16_t lone_high[] = {u'x', 0xD83D, u'y', 0};
  EXPECT_EQ(Utf16ToWide(lone_high), L"x\uFFFDy");
  const char16_t lone_low_at_end[] = {0xDCE1, 0};
  EXPECT_EQ(Utf16ToWide(lone_low_at_end), L"\uFFFD");

  const std::string bytes = WideToUtf16LeBytes(L"A\u20ac");
  ASSERT_EQ(bytes, std::string("A\0\xAC\x20", 4));
  const auto* raw = reinterpret_cast<const std::uint8_t*>(bytes.data());
  EXPECT_EQ(Utf16LeBytesToWide(raw, bytes.size()), L"A\u20ac");
  EXPECT_EQ(Utf16LeBytesToWide(raw, 3), L"A");  // odd trailing byte ignored
}

}  // namespace
}  // namespace LumenUtility
