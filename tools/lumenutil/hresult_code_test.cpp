#include "lumenutil/hresult_code.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <optional>

namespace lumenutil {
namespace {

constexpr std::int32_t Bits(std::uint32_t bits) {
  return static_cast<std::int32_t>(bits);
}

TEST(ParseHResultCode, HexAndDecimalSpellingsOfOneCodeAgree) {
  for (const char* text :
       {"0xE8080882", "0Xe8080882", "0x00000000e8080882", "3892840578", "-402126718"}) {
    EXPECT_EQ(ParseHResultCode(text), Bits(0xE8080882)) << text;
  }
  for (const char* zero : {"0", "0x0", "-0"}) EXPECT_EQ(ParseHResultCode(zero), 0) << zero;
  EXPECT_EQ(ParseHResultCode("0100"), 100);  // decimal, not octal
}

TEST(ParseHResultCode, LimitsOfThirtyTwoBits) {
  EXPECT_EQ(ParseHResultCode("0xFFFFFFFF"), -1);
  EXPECT_EQ(ParseHResultCode("4294967295"), -1);
  EXPECT_EQ(ParseHResultCode("-2147483648"), Bits(0x80000000));
  EXPECT_EQ(ParseHResultCode("2147483648"), Bits(0x80000000));
  // The last is past 64 bits.
  for (const char* text : {"0x100000000", "4294967296", "-2147483649", "99999999999999999999999"}) {
    EXPECT_EQ(ParseHResultCode(text), std::nullopt) << text;
  }
}

TEST(ParseHResultCode, RejectsMalformedText) {
  for (const char* text : {"", "-", "0x", "x10", "-0x1", "+5", " 5", "5 ", "12ab", "0xG1", "0x-1",
                           "1e3", "0b101", "--5"}) {
    EXPECT_EQ(ParseHResultCode(text), std::nullopt) << '"' << text << '"';
  }
}

}  // namespace
}  // namespace lumenutil
