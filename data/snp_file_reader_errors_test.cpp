// Bad Touchstone input: each text is a valid file with one corruption, read from memory, and
// must fail with -1 and exactly the message given.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "data/testing/snp_texts.h"
#include "lumen/data.h"
#include "lumen/platform.h"

using LumenUtility::fixtures::kV1TwoPort;
using LumenUtility::fixtures::kV2TwoPort;
using LumenUtility::fixtures::Replace;

namespace {

struct Refusal {
  std::string text;
  std::string message;
};

// The message of reading `text` into a `ports`-port reader; the test fails unless the read
// returns -1.
std::string ErrorOf(const std::string& text, int ports = 2) {
  CSnPFileBase file(ports);
  EXPECT_EQ(file.ReadSNPText(text), -1) << text;
  return LumenUtility::WideToUtf8(file.GetReadError());
}

void ExpectRefusals(const std::vector<Refusal>& refusals, int ports = 2) {
  for (const Refusal& r : refusals) EXPECT_EQ(ErrorOf(r.text, ports), r.message) << r.text;
}

TEST(SnPReaderRefuses, KeywordsOutOfPlaceOrMalformed) {
  ExpectRefusals({
      {Replace(kV2TwoPort, "2.0", "1.1"), "line 1: [Version] '1.1' is not read; only 2.0 is"},
      {Replace(kV2TwoPort, "[Version]", "[Ports]"),
       "line 1: [PORTS] before the option line; only [Version] may stand there"},
      {Replace(kV2TwoPort, "[Version] 2.0", "[Version 2.0"),
       "line 1: keyword without a closing ']'"},
      {Replace(kV2TwoPort, "[Number of Ports] 2", "[Reference] 50 50"),
       "line 3: [REFERENCE] where [Number of Ports] must follow the option line"},
      {Replace(kV2TwoPort, "[End]", "[Mixed-Mode Order]"),
       "line 9: [MIXED-MODE ORDER] is not expected among the data"},
  });
}

TEST(SnPReaderRefuses, OptionLineMissingOrWithBadResistance) {
  ExpectRefusals({
      {Replace(kV1TwoPort, "# GHZ S MA R 50", "GHZ S MA R 50"),
       "line 2: the option line (starting with '#') is missing"},
      {"", "line 1: the option line (starting with '#') is missing"},
      {Replace(kV1TwoPort, "R 50", "R ohms"),
       "line 2: option R needs a reference resistance, not 'ohms'"},
      {"# GHz S RI R (50+50j)\n",
       "line 1: option R '(50+50j)': complex reference impedances are not supported"},
      {"# GHz S RI R 50+50j\n",
       "line 1: option R '50+50j': complex reference impedances are not supported"},
  });
}

TEST(SnPReaderRefuses, VersionTwoCountsAndReferencesOutOfRange) {
  const std::string ports = "[Number of Ports] 2";
  ExpectRefusals({
      {Replace(kV2TwoPort, ports, "[Number of Ports] 0"),
       "line 3: [Number of Ports] 0 is outside 1 to 999"},
      {Replace(kV2TwoPort, ports, "[Number of Ports] 1000"),
       "line 3: [Number of Ports] 1000 is outside 1 to 999"},
      {Replace(kV2TwoPort, ports, "[Number of Ports] many"),
       "line 3: [Number of Ports] needs a whole number, not 'many'"},
      {Replace(kV2TwoPort, "[Number of Frequencies] 2", "[Number of Frequencies] 0"),
       "line 5: [Number of Frequencies] must be at least 1"},
      {Replace(kV2TwoPort, "[Network Data]", "[Reference] 50 x\n[Network Data]"),
       "line 6: [Reference] needs one resistance per port, not 'x'"},
  });
}

TEST(SnPReaderRefuses, TruncatedVersionTwoDataSaysDeclaredAndFoundCounts) {
  const std::string onePort =
      "[Version] 2.0\n# Hz RI\n[Number of Ports] 1\n[Number of Frequencies] 4\n"
      "[Network Data]\n1 1 0\n2 2 0\n";
  ExpectRefusals(
      {
          {onePort,
           "line 8: [Number of Frequencies] declares 4 points, but the network data holds 2: "
           "the file is truncated"},
          {onePort + "[End]\n",
           "line 8: [Number of Frequencies] declares 4 points, but the network data holds 2: "
           "the file is truncated"},
          // The count is never taken as a size to reserve.
          {Replace(onePort, "] 4", "] 2000000000"),
           "line 8: [Number of Frequencies] declares 2000000000 points, but the network data "
           "holds 2: the file is truncated"},
      },
      1);
}

TEST(SnPReaderRefuses, ValuesThatAreNoNumbers) {
  ExpectRefusals({
      {Replace(kV1TwoPort, "0.3 80", "0.3 eighty"),
       "line 4: 'eighty' is not a number (in the data point that starts at line 4)"},
      {Replace(kV1TwoPort, "2 0.6", "two 0.6"),
       "line 4: 'two' is not a number (a stimulus value was expected)"},
  });
  // What a C++ stream would not read as a number is no number here either.
  for (const char* bad : {"inf", "nan", "0x10", "1.5e", "+-1", "1,5", "."}) {
    EXPECT_EQ(ErrorOf("# Hz RI\n1 " + std::string(bad) + " 0 0 0 0 0 0 0\n"),
              "line 2: '" + std::string(bad) +
                  "' is not a number (in the data point that starts at line 2)");
  }
}

TEST(SnPReaderRefuses, ValuesBeyondTheirRangeWithTheLine) {
  const std::string single =
      "' is beyond the range of a single-precision value (in the data point that starts at "
      "line 2)";
  ExpectRefusals({
      {"# GHz RI\n1 0.5 0 0 0 0 0 0 0\n1e300 0.5 0 0 0 0 0 0 0\n",
       "line 3: '1e300' GHz is beyond the range of a stimulus value"},
      {"# Hz RI\n1 0.5 0 1e39 0 0 0 0 0\n", "line 2: '1e39" + single},
      {"# Hz RI\n1 1e39 0 0 0 0 0 0 0\n", "line 2: '1e39" + single},
      {"# Hz RI\n1 0.5 0 1e400 0 0 0 0 0\n", "line 2: '1e400" + single},
      {"# Hz DB\n1\n 0 0 800 0\n 0 0 0 0\n",
       "line 2: '800' dB in this data point is beyond the range of a single-precision value"},
      {"# Hz RI\n1e400 0 0 0 0 0 0 0 0\n",
       "line 2: '1e400' is beyond the range of a number (a stimulus value was expected)"},
      {"# Hz RI\n1e309 0 0 0 0 0 0 0 0\n",
       "line 2: '1e309' is beyond the range of a number (a stimulus value was expected)"},
  });
  // Within range, the largest magnitudes still read.
  CSnPFileBase file(1);
  EXPECT_EQ(file.ReadSNPText("# Hz DB\n1 770 0\n1e308 -3e38 0\n"), 2);
}

TEST(SnPReaderRefuses, UnprintableBytesAreQuotedAsHex) {
  EXPECT_EQ(ErrorOf(std::string("# Hz RI\n1 0.5 0 a\0b\x1B\xFF 0 0 0 0 0\n", 32)),
            "line 2: 'a\\x00b\\x1B\\xFF' is not a number (in the data point that starts at "
            "line 2)");
  // Well-formed UTF-8 stays as it is.
  EXPECT_EQ(ErrorOf("# Hz RI\n1 0.5 0 \xC2\xB5 0 0 0 0 0\n"),
            "line 2: '\xC2\xB5' is not a number (in the data point that starts at line 2)");
}

TEST(SnPReaderRefuses, DataEndingInsideAPointOrRecord) {
  ExpectRefusals({
      {Replace(kV1TwoPort, " 0.5 40\n", "\n"),
       "line 5: the file ends inside the data point that starts at line 4: 8 values expected, "
       "6 found"},
      {Replace(kV2TwoPort, "[End]", "[Noise Data]\n1 3 0.5 45"),
       "line 11: the file ends inside the noise record that starts at line 10: 4 values "
       "expected, 3 found"},
      // Noise records (five values) read as network points (nine values) without the marker.
      {std::string(kV1TwoPort) + "1 2 0.5 45 0.2\n",
       "line 6: the file ends inside the data point that starts at line 5: 8 values expected, 4 "
       "found (the frequency drops at line 5; noise data there needs a '! Noise Parameters' "
       "comment before it)"},
  });
  EXPECT_EQ(
      ErrorOf("[Version] 2.0\n# RI\n[Number of Ports] 1\n[Network Data]\n1 0 0\n[Noise Data]\n"),
      "line 7: noise data is only read for two-port networks");
}

}  // namespace
