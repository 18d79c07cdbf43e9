#include "capture/request_name_parser.h"

#include <gtest/gtest.h>

#include <string>

#include "capture/shm_test_util.h"
#include "lumen/platform/error_codes.h"

namespace LumenUtility {
namespace {

using testutil::ThrownCode;

TEST(RequestNameParser, ReadsChannelMeasurementTypeAndCount) {
  const DataRequest sdata = RequestNameParser::Parse(L"1:2:SDATA:201");
  EXPECT_EQ(sdata.channel, 1);
  EXPECT_EQ(sdata.measurement, 2);
  EXPECT_TRUE(sdata.isComplex);
  EXPECT_FALSE(sdata.isCal);
  EXPECT_FALSE(sdata.isIncremental);
  EXPECT_EQ(sdata.count, 201u);
  EXPECT_EQ(sdata.Size(), 402u);
  EXPECT_EQ(sdata.offset, 0u);
  EXPECT_TRUE(sdata.blockName.empty());

  const DataRequest cal = RequestNameParser::Parse(L"12:7:CAL:64");
  EXPECT_TRUE(cal.isCal);
  EXPECT_FALSE(cal.isComplex);
  EXPECT_EQ(cal.Size(), 64u);
  const DataRequest fdata = RequestNameParser::Parse(L"2147483647:007:FDATA:4294967295");
  EXPECT_FALSE(fdata.isCal || fdata.isComplex);
  EXPECT_EQ(fdata.channel, 2147483647);
  EXPECT_EQ(fdata.measurement, 7);
  EXPECT_EQ(fdata.count, 4294967295u);
}

TEST(RequestNameParser, EveryMalformedNameIsAnInvalidArgument) {
  for (const wchar_t* name : {
           L"1:2:SDATA",      // three fields
           L"1:2:SDATA:5:6",  // five
           L"1:2:SDATA:5:",   // a trailing separator makes a fifth, empty field
           L"",
           L":::",
           L"1::FDATA:5",
           L"1:2:XDATA:5",  // unknown type
           L"1:2:sdata:5",  // types are upper case
           L"0:1:FDATA:5",  // channel 0
           L"1:0:FDATA:5",  // measurement 0
           L"1:1:FDATA:0",  // count 0
           L"1:1:FDATA:00",
           L"-1:1:FDATA:5",
           L"1:1:FDATA:-5",
           L"1:1:FDATA:+5",  // no signs
           L" 1:1:FDATA:5",
           L"1:1:FDATA:5 ",
           L"1x:1:FDATA:5",
           L"a:1:FDATA:5",
           L"2147483648:1:FDATA:1",  // channel beyond an int
           L"1:2147483648:FDATA:1",
           L"1:1:FDATA:4294967296",  // count beyond 32 bits
           L"1:1:FDATA:99999999999999999999999",
           L"1:1:FDATA:\uff15",  // a digit of another script
       }) {
    EXPECT_EQ(ThrownCode([&] { RequestNameParser::Parse(name); }), E_INVALIDARG) << name;
  }
  EXPECT_EQ(ThrownCode([] { RequestNameParser::Parse(std::wstring(L"1:1:FDATA:5\0", 12)); }),
            E_INVALIDARG);
}

}  // namespace
}  // namespace LumenUtility
