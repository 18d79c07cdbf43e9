#include "lumen/util/from_hresult.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <map>
#include <set>
#include <sstream>
#include <string>

namespace LumenUtility {
namespace {

// The expected mapping, typed apart from the library's table: one "0xCODE number" pair per
// line, '#' starting a comment line.
class FromHResultTest : public ::testing::Test {
 protected:
  static void SetUpTestSuite() {
    const char* root = std::getenv("LUMEN_SOURCE_DIR");
    const std::filesystem::path source =
        root != nullptr ? std::filesystem::path(root)
                        : std::filesystem::path(__FILE__).parent_path().parent_path();
    const std::filesystem::path file = source / "testdata" / "hresult_error_numbers.txt";
    std::ifstream in(file);
    ASSERT_TRUE(in) << "cannot open " << file;
    std::string line;
    int lineNumber = 0;
    while (std::getline(in, line)) {
      ++lineNumber;
      if (line.empty() || line[0] == '#') continue;
      std::istringstream fields(line);
      std::uint32_t code = 0;
      int number = 0;
      ASSERT_TRUE(fields >> std::hex >> code >> std::dec >> number) << file << ':' << lineNumber;
      ASSERT_TRUE(s_expected.emplace(code, number).second)
          << "code listed twice at " << file << ':' << lineNumber;
    }
  }

  static int Expected(std::uint32_t code) {
    const auto found = s_expected.find(code);
    return found == s_expected.end() ? kUnmappedErrorNumber : found->second;
  }

  static int Actual(std::uint32_t code) { return FromHRESULT(static_cast<HRESULT>(code)); }

  static std::map<std::uint32_t, int> s_expected;
};

std::map<std::uint32_t, int> FromHResultTest::s_expected;

TEST_F(FromHResultTest, EveryListedCodeGivesItsNumber) {
  ASSERT_EQ(s_expected.size(), 481u);
  for (const auto& [code, number] : s_expected) {
    EXPECT_EQ(Actual(code), number) << std::hex << "0x" << code;
  }
}

// Sweeps every low word under each high word in use, so gaps between listed codes and the
// ends of each run are all covered, and the same codes with the severity bit flipped.
TEST_F(FromHResultTest, EveryOtherCodeNearListedOnesGivesDefault) {
  std::set<std::uint32_t> listed;
  for (const auto& entry : s_expected) listed.insert(entry.first >> 16);
  std::set<std::uint32_t> highWords = listed;
  for (const std::uint32_t high : listed) highWords.insert(high ^ 0x8000u);
  int mismatches = 0;
  for (const std::uint32_t high : highWords) {
    for (std::uint32_t low = 0; low <= 0xFFFFu; ++low) {
      const std::uint32_t code = (high << 16) | low;
      if (Actual(code) != Expected(code) && ++mismatches <= 10) {
        ADD_FAILURE() << std::hex << "0x" << code << std::dec << " gives " << Actual(code)
                      << ", expected " << Expected(code);
      }
    }
  }
  EXPECT_EQ(mismatches, 0);
}

TEST_F(FromHResultTest, SeverityBitAndExtremesMatter) {
  EXPECT_EQ(FromHRESULT(MakeHResult(0x68020209)), 189);
  EXPECT_EQ(FromHRESULT(MakeHResult(0xE8020209)), 341);
  EXPECT_EQ(FromHRESULT(E_INVALIDARG), -224);
  EXPECT_EQ(FromHRESULT(S_OK), kUnmappedErrorNumber);
  EXPECT_EQ(FromHRESULT(MakeHResult(0xFFFFFFFF)), kUnmappedErrorNumber);
  EXPECT_EQ(FromHRESULT(MakeHResult(0x80000000)), kUnmappedErrorNumber);
  EXPECT_EQ(FromHRESULT(MakeHResult(0x7FFFFFFF)), kUnmappedErrorNumber);
}

}  // namespace
}  // namespace LumenUtility
