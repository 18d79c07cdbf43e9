#include "lumenutil/engineering_value.h"

#include <gtest/gtest.h>

namespace lumenutil {
namespace {

TEST(EngineeringValue, NumbersTakeAPrefixAndTheUnit) {
  for (const char* text : {"2.4e9", "2.4G", "2.4 GHz"}) {
    EXPECT_EQ(ParseEngineeringValue(text, "Hz"), 2.4e9) << text;
  }
  // With "Hz" written out the prefix's case does not matter; a bare prefix keeps SI case.
  for (const char* text : {"800mhz", "800 MHz", "800Mhz", "0.8 gHz"}) {
    EXPECT_EQ(ParseEngineeringValue(text, "Hz"), 800e6) << text;
  }
  EXPECT_EQ(ParseEngineeringValue("1.5m", "Hz"), 1.5e-3);
  EXPECT_EQ(ParseEngineeringValue("1.5M", "Hz"), 1.5e6);
  EXPECT_EQ(ParseEngineeringValue("1.5ms", "s"), 1.5e-3);
  EXPECT_EQ(ParseEngineeringValue("5nHz", "Hz"), 5e-9);
  EXPECT_EQ(ParseEngineeringValue("800MHZ", "Hz"), 800e6);
  EXPECT_EQ(ParseEngineeringValue("5 \xC2\xB5s", "s"), 5e-6);
  EXPECT_EQ(ParseEngineeringValue("+10", "dBm"), 10.0);
  EXPECT_EQ(ParseEngineeringValue("-10 dBm", "dBm"), -10.0);
  EXPECT_EQ(ParseEngineeringValue("7 Hz", "Hz"), 7.0);
}

TEST(EngineeringValue, AnythingElseIsRefused) {
  for (const char* bad : {"", "G", "2.4X", "2.4 GHzz", "2.4GG", "inf", "nan", "1e400", "1e300T",
                          "--1", "2.4 Hz", "0x10"}) {
    EXPECT_FALSE(ParseEngineeringValue(bad, "s").has_value()) << bad;
  }
}

}  // namespace
}  // namespace lumenutil
