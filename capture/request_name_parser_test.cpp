#include "capture/request_name_parser.h"

#include <gtest/gtest.h>

#include <string>

#include "capture/shm_test_util.h"
#include "lumen/platform/error_codes.h"

namespace LumenUtility {
namespace {

using testutil::ThrownCode;

TEST(RequestNameParser, ReadsChannelMeasurementTypeAndCount) {
  const struct {
    const wchar_t* name;
    std::int32_t channel, measurement;
    bool isComplex, isCal;
    std::uint32_t count, size;
  } cases[] = {
      {L"1:2:SDATA:201", 1, 2, true, false, 201, 402},
      {L"12:7:CAL:64", 12, 7, false, true, 64, 64},
      {L"2147483647:007:FDATA:4294967295", 2147483647, 7, false, false, 4294967295u, 4294967295u},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(testing::PrintToString(std::wstring(c.name)));
    const DataRequest r = RequestNameParser::Parse(c.name);
    EXPECT_EQ(r.channel, c.channel);
    EXPECT_EQ(r.measurement, c.measurement);
    EXPECT_EQ(r.isComplex, c.isComplex);
    EXPECT_EQ(r.isCal, c.isCal);
    EXPECT_FALSE(r.isIncremental);
    EXPECT_EQ(r.count, c.count);
    EXPECT_EQ(r.Size(), c.size);
    EXPECT_EQ(r.offset, 0u);
    EXPECT_TRUE(r.blockName.empty());
  }
}

TEST(RequestNameParser, EveryMalformedNameIsAnInvalidArgument) {
  const std::wstring malformed[] = {
      // Three fields, five, a trailing separator making a fifth empty one, none, empty ones.
      L"1:2:SDATA", L"1:2:SDATA:5:6", L"1:2:SDATA:5:", L"", L":::", L"1::FDATA:5",
      // An unknown type, a lower-case one.
      L"1:2:XDATA:5", L"1:2:sdata:5",
      // Channel, measurement or count 0.
      L"0:1:FDATA:5", L"1:0:FDATA:5", L"1:1:FDATA:0", L"1:1:FDATA:00",
      // Signs, spaces, other characters, a digit of another script, a zero character.
      L"-1:1:FDATA:5", L"1:1:FDATA:-5", L"1:1:FDATA:+5", L" 1:1:FDATA:5", L"1:1:FDATA:5 ",
      L"1x:1:FDATA:5", L"a:1:FDATA:5", L"1:1:FDATA:\uff15", std::wstring(L"1:1:FDATA:5\0", 12),
      // Channel or measurement beyond an int, count beyond 32 bits.
      L"2147483648:1:FDATA:1", L"1:2147483648:FDATA:1", L"1:1:FDATA:4294967296",
      L"1:1:FDATA:99999999999999999999999"};
  for (const std::wstring& name : malformed) {
    EXPECT_EQ(ThrownCode([&] { RequestNameParser::Parse(name); }), E_INVALIDARG)
        << testing::PrintToString(name);
  }
}

}  // namespace
}  // namespace LumenUtility
