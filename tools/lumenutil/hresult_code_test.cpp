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
  EXPECT_EQ(ParseHResultCode("0xE8080882"), Bits(0xE8080882));
  EXPECT_EQ(ParseHResultCode("0Xe8080882"), Bits(0xE8080882));
  EXPECT_EQ(ParseHResultCode("0x00000000e8080882"), Bits(0xE8080882));  // leading zeros
  EXPECT_EQ(ParseHResultCode("3892840578"), Bits(0xE8080882));
  EXPECT_EQ(ParseHResultCode("-402126718"), Bits(0xE8080882));
  EXPECT_EQ(ParseHResultCode("0"), 0);
  EXPECT_EQ(ParseHResultCode("0x0"), 0);
  EXPECT_EQ(ParseHResultCode("-0"), 0);
  EXPECT_EQ(ParseHResultCode("0100"), 100);  // decimal, not octal
}

TEST(ParseHResultCode, LimitsOfThirtyTwoBits) {
  EXPECT_EQ(ParseHResultCode("0xFFFFFFFF"), -1);
  EXPECT_EQ(ParseHResultCode("4294967295"), -1);
  EXPECT_EQ(ParseHResultCode("-2147483648"), Bits(0x80000000));
  EXPECT_EQ(ParseHResultCode("2147483648"), Bits(0x80000000));
  EXPECT_EQ(ParseHResultCode("0x100000000"), std::nullopt);
  EXPECT_EQ(ParseHResultCode("4294967296"), std::nullopt);
  EXPECT_EQ(ParseHResultCode("-2147483649"), std::nullopt);
  EXPECT_EQ(ParseHResultCode("99999999999999999999999"), std::nullopt);  // past 64 bits
}

TEST(ParseHResultCode, RejectsMalformedText) {
  for (const char* text : {"", "-", "0x", "x10", "-0x1", "+5", " 5", "5 ", "12ab", "0xG1", "0x-1",
                           "1e3", "0b101", "--5"}) {
    EXPECT_EQ(ParseHResultCode(text), std::nullopt) << '"' << text << '"';
  }
}

}  // namespace
}  // namespace lumenutil
