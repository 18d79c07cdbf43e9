#include <gtest/gtest.h>

#include <unistd.h>

#include <cmath>
#include <cstdio>
#include <fstream>
#include <memory>
#include <string>

#include "lumen/data.h"
#include "lumen/platform.h"

using LumenUtility::TsComplex;

namespace {

constexpr double kDegree = 3.14159265358979323846 / 180.0;

// Two-port network in version 1 order (11, 21, 12, 22), magnitude and angle.
const char kV1TwoPort[] =
    "! two-port test network\n"
    "# GHZ S MA R 50\n"
    "1 0.5 0 0.1 90 0.2 0 0.4 45\n"
    "2 0.6 10 0.3 80 0.2 5 0.5 40\n";

// The same network in version 2 with 11, 12, 21, 22 order.
const char kV2TwoPort[] =
    "[Version] 2.0\n"
    "# GHz S MA R 50\n"
    "[Number of Ports] 2\n"
    "[Two-Port Data Order] 12_21\n"
    "[Number of Frequencies] 2\n"
    "[Network Data]\n"
    "1 0.5 0 0.2 0 0.1 90 0.4 45\n"
    "2 0.6 10 0.2 5 0.3 80 0.5 40\n"
    "[End]\n";

// A reader-test fixture: each test writes a file of its own (usually a valid one with a
// small corruption) and reads it through the file path.
class SnPReaderTest : public ::testing::Test {
 protected:
  int Read(const std::string& text, int ports = 2) {
    const std::string path = ::testing::TempDir() + "snp_reader_" + std::to_string(::getpid()) +
                             "_" + ::testing::UnitTest::GetInstance()->current_test_info()->name() +
                             ".s2p";
    std::ofstream(path, std::ios::binary) << text;
    reader = std::make_unique<CSnPFileBase>(ports);
    const int points = reader->ReadSNPFile(std::wstring(path.begin(), path.end()));
    std::remove(path.c_str());
    return points;
  }
  // `text` with its first `from` replaced by `to`; the test fails if `from` is absent.
  static std::string Replace(std::string text, const std::string& from, const std::string& to) {
    const std::size_t at = text.find(from);
    EXPECT_NE(at, std::string::npos) << from;
    if (at != std::string::npos) text.replace(at, from.size(), to);
    return text;
  }
  TsComplex Value(int row, int column, int point = 0) const {
    const int n = reader->GetSNPType();
    return reader->GetParam(static_cast<ESNParam>((row - 1) * n + column - 1)).GetData().at(point);
  }
  std::string Error() const { return LumenUtility::WideToUtf8(reader->GetReadError()); }

  std::unique_ptr<CSnPFileBase> reader;
};

void ExpectPolar(TsComplex v, double magnitude, double degrees) {
  EXPECT_NEAR(v.re, magnitude * std::cos(degrees * kDegree), 1e-6);
  EXPECT_NEAR(v.im, magnitude * std::sin(degrees * kDegree), 1e-6);
}

TEST_F(SnPReaderTest, VersionOneTwoPortPutsSecondPairIntoS21) {
  ASSERT_EQ(Read(kV1TwoPort), 2);
  const CSNParameter& s21 = reader->GetParam(SNP_S21);
  EXPECT_EQ(s21.GetName(), L"S21");
  EXPECT_EQ(s21.GetStartFreq(), 1e9);
  EXPECT_EQ(s21.GetStopFreq(), 2e9);
  ExpectPolar(s21.GetData()[0], 0.1, 90);
  ExpectPolar(Value(1, 2), 0.2, 0);
  ExpectPolar(Value(2, 2), 0.4, 45);
  EXPECT_TRUE(reader->Get2PortDataOrder());
  EXPECT_EQ(reader->GetFileInfo().version, 1);
  EXPECT_TRUE(reader->GetReadError().empty());
}

TEST_F(SnPReaderTest, VersionTwoWith12_21OrderReadsTheSameNamedTraces) {
  ASSERT_EQ(Read(kV1TwoPort), 2);
  const CSnPFileBase v1 = *reader;
  ASSERT_EQ(Read(kV2TwoPort), 2) << Error();
  EXPECT_FALSE(reader->Get2PortDataOrder());
  EXPECT_EQ(reader->GetFileInfo().version, 2);
  for (int k = 0; k < 4; ++k) {
    const CSNParameter& a = v1.GetParam(static_cast<ESNParam>(k));
    const CSNParameter& b = reader->GetParam(static_cast<ESNParam>(k));
    EXPECT_EQ(a.GetName(), b.GetName());
    EXPECT_EQ(a.GetData(), b.GetData()) << k;
    EXPECT_EQ(a.GetStimulus(), b.GetStimulus());
  }
  // The older keyword spelling and any other order token.
  ASSERT_EQ(Read(Replace(kV2TwoPort, "[Two-Port Data Order] 12_21", "[Two-Port Order] 12_21")), 2);
  EXPECT_FALSE(reader->Get2PortDataOrder());
  ASSERT_EQ(Read(Replace(kV2TwoPort, "12_21", "21_12")), 2);
  ExpectPolar(Value(2, 1), 0.2, 0);
}

TEST_F(SnPReaderTest, OptionLineSetsUnitFormResistanceAndResultType) {
  struct Case {
    const char* option;
    double stimulus;  // of the data value 2
    ResultType result;
  } cases[] = {{"#", 2e9, RESULT_FREQUENCY},        {"# hz ri", 2, RESULT_FREQUENCY},
               {"# KHz RI", 2e3, RESULT_FREQUENCY}, {"# MHZ RI", 2e6, RESULT_FREQUENCY},
               {"# DBM RI", 2, RESULT_DBM},         {"# SEC RI", 2, RESULT_SEC},
               {"# POINT RI", 2, RESULT_POINT}};
  for (const Case& c : cases) {
    ASSERT_EQ(Read(std::string(c.option) + "\n2 1 0 0 0 0 0 0 0\n"), 1) << c.option;
    EXPECT_EQ(reader->GetParam(SNP_S11).GetStartFreq(), c.stimulus) << c.option;
    EXPECT_EQ(reader->GetResultType(), c.result) << c.option;
  }
  ASSERT_EQ(Read("# GHz S RI R 75 ! MA in a comment is no option\n1 0.25 -0.5 0 0 0 0 0 0\n"), 1);
  EXPECT_EQ(Value(1, 1), TsComplex(0.25, -0.5));
  EXPECT_EQ(reader->GetFileInfo().referenceResistance, 75.0);
  ASSERT_EQ(Read("# GHz Z DB\n1 -6.0205999 90 0 0 0 0 0 0\n"), 1);
  ExpectPolar(Value(1, 1), 0.5, 90);
  EXPECT_EQ(reader->GetFileInfo().parameter, 'Z');
}

TEST_F(SnPReaderTest, TriangularMatricesMirrorIntoTheOtherTriangle) {
  // Four ports, ten pairs per point: the stored pair number j holds the value j + 1.
  const std::string upper =
      "[Version] 2.0\n# Hz S RI\n[Number of Ports] 4\n[Matrix Format] Upper\n[Network Data]\n"
      "5 1 0 2 0 3 0 4 0\n  5 0 6 0 7 0\n  8 0 9 0\n  10 0\n";
  ASSERT_EQ(Read(upper), 1) << Error();
  const int expectedUpper[4][4] = {{1, 2, 3, 4}, {2, 5, 6, 7}, {3, 6, 8, 9}, {4, 7, 9, 10}};
  for (int r = 1; r <= 4; ++r) {
    for (int c = 1; c <= 4; ++c) EXPECT_EQ(Value(r, c).re, expectedUpper[r - 1][c - 1]) << r << c;
  }
  ASSERT_EQ(Read(Replace(upper, "Upper", "lower")), 1);
  const int expectedLower[4][4] = {{1, 2, 4, 7}, {2, 3, 5, 8}, {4, 5, 6, 9}, {7, 8, 9, 10}};
  for (int r = 1; r <= 4; ++r) {
    for (int c = 1; c <= 4; ++c) EXPECT_EQ(Value(r, c).re, expectedLower[r - 1][c - 1]) << r << c;
  }
  EXPECT_EQ(reader->GetFileInfo().matrixFormat, SNP_MATRIX_LOWER);
  // Any other layout word is the full matrix: ten pairs are then too few for one point.
  EXPECT_EQ(Read(Replace(upper, "Upper", "Full")), -1);
}

TEST_F(SnPReaderTest, ManyPortsAreRowMajorAndNamedWithSeparatorPastNine) {
  std::string text = "[Version] 2.0\n# Hz S RI\n[Number of Ports] 10\n[Network Data]\n1";
  for (int k = 0; k < 100; ++k) text += " " + std::to_string(k) + " 0" + (k % 4 == 3 ? "\n" : "");
  ASSERT_EQ(Read(text), 1) << Error();
  EXPECT_EQ(reader->GetParam(static_cast<ESNParam>(12)).GetName(), L"S23");
  EXPECT_EQ(Value(2, 3).re, 12.0f);
  EXPECT_EQ(reader->GetParam(static_cast<ESNParam>(9)).GetName(), L"S1_10");
  EXPECT_EQ(reader->GetParam(static_cast<ESNParam>(99)).GetName(), L"S10_10");
  // Version 1 files take the port count the reader was made with.
  ASSERT_EQ(Read("# Hz RI\n1 1 0 2 0 3 0\n4 0 5 0 6 0\n7 0 8 0 9 0\n", 3), 1);
  EXPECT_EQ(Value(2, 1).re, 4.0f);
  EXPECT_EQ(reader->GetParam(static_cast<ESNParam>(5)).GetName(), L"S23");
}

const char kV1Noise[] =
    "# GHZ S MA R 50\n"
    "1 0.5 0 0.1 90 0.2 0 0.4 45\n"
    "2 0.6 10 0.3 80 0.2 5 0.5 40\n"
    "! Noise Parameters\n"
    "1 3 0.5 45 0.2\n"
    "2 4 0.25 30 0.3\n";

TEST_F(SnPReaderTest, NoiseDataAfterTheMarkerBecomesThreeCustomTraces) {
  ASSERT_EQ(Read(kV1Noise), 2);
  ASSERT_EQ(reader->GetNumCustomParams(), 3);
  const CSNParameter& nf = reader->GetCustomParam(0);
  EXPECT_EQ(nf.GetName(), L"Noise Figure Cold Source:NFmin");
  EXPECT_NEAR(nf.GetData()[1].re, std::pow(10.0, 4.0 / 10), 1e-5);
  ExpectPolar(reader->GetCustomParam(1).GetData()[0], 0.5, 45);
  EXPECT_NEAR(reader->GetCustomParam(2).GetData()[1].re, 0.3 * 50, 1e-5);
  EXPECT_EQ(reader->GetCustomParam(2).GetStimulus(), nf.GetStimulus());
  EXPECT_EQ(reader->GetParam(SNP_S21).GetName(), L"Noise Figure Cold Source:S21");
  EXPECT_EQ(reader->GetFileInfo().noisePoints, 2);

  // The marker may stand anywhere after the option line, also before the network data.
  const std::string early = Replace(Replace(kV1Noise, "! Noise Parameters\n", ""), "R 50\n",
                                    "R 50\n! Noise Parameters follow the data\n");
  ASSERT_EQ(Read(early), 2);
  EXPECT_EQ(reader->GetNumCustomParams(), 3);

  // Without the marker the drop in frequency is one more network point.
  EXPECT_EQ(Read(std::string(kV1TwoPort) + "1.5 0.5 0 0.1 90 0.2 0 0.4 45\n"), 3);
  EXPECT_EQ(reader->GetNumCustomParams(), 0);

  // Version 2 marks its noise data with a keyword.
  std::string v2 = Replace(kV2TwoPort, "[End]\n", "[Noise Data]\n1 3 0.5 45 0.2\n[End]\n");
  v2 = Replace(v2, "[Network Data]", "[Number of Noise Frequencies] 1\n[Network Data]");
  ASSERT_EQ(Read(v2), 2) << Error();
  EXPECT_EQ(reader->GetNumCustomParams(), 3);
  EXPECT_EQ(reader->GetFileInfo().noisePoints, 1);
  // A later read of a file without noise data drops the old noise traces.
  ASSERT_EQ(reader->ReadSNPText(kV2TwoPort), 2);
  EXPECT_EQ(reader->GetNumCustomParams(), 0);
}

TEST_F(SnPReaderTest, CommentsBlankLinesLineEndingsAndByteOrderMarks) {
  const std::string text =
      "! a\r\n\r\n[Version] 2.0 ! version\r\n! b\r\n  # GHz S MA R 50 ! options\r\n"
      "[Number of Ports] 2\r\n! c\r\n[Two-Port Data Order] 12_21\r\n[Reference] 50\r\n 50\r\n"
      "[Begin Information]\r\nanything at all 1 2 3\r\n[End Information]\r\n"
      "[Network Data]\r\n! d\r\n1 0.5 0!directly after a value\r\n 0.2 0 ! inside a point\r\n"
      "0.1 90 0.4 45\r\n\r\n2 0.6 10 0.2 5 0.3 80 0.5 40\r\n";
  ASSERT_EQ(Read(text), 2) << Error();
  ExpectPolar(Value(2, 1), 0.1, 90);
  ExpectPolar(Value(2, 2, 1), 0.5, 40);
  EXPECT_EQ(reader->GetFileInfo().portReferences, (std::vector<double>{50, 50}));

  // A UTF-8 byte-order mark is skipped; a broken one or a UTF-16 one is refused.
  EXPECT_EQ(Read("\xEF\xBB\xBF" + std::string(kV1TwoPort)), 2);
  EXPECT_EQ(Read("\xEF\xBB" + std::string(kV1TwoPort)), -1);
  EXPECT_EQ(Read("\xFF\xFE" + std::string(kV1TwoPort)), -1);
  EXPECT_NE(Error().find("UTF-16"), std::string::npos);
  EXPECT_EQ(Read("\xFE\xFF" + std::string(kV1TwoPort)), -1);
}

TEST_F(SnPReaderTest, MalformedFilesGiveMinusOneWithTheLine) {
  struct Case {
    std::string text;
    const char* error;  // part of the expected message
  } cases[] = {
      {Replace(kV2TwoPort, "2.0", "1.1"), "line 1:"},
      {Replace(kV2TwoPort, "[Version]", "[Ports]"), "[PORTS]"},
      {Replace(kV2TwoPort, "[Version] 2.0", "[Version 2.0"), "]"},
      {Replace(kV1TwoPort, "# GHZ S MA R 50", "GHZ S MA R 50"), "option line"},
      {Replace(kV1TwoPort, "R 50", "R ohms"), "reference resistance, not 'ohms'"},
      {Replace(kV2TwoPort, "[Number of Ports] 2", "[Reference] 50 50"), "[Number of Ports]"},
      {Replace(kV2TwoPort, "[Number of Ports] 2", "[Number of Ports] 0"), "outside 1 to 999"},
      {Replace(kV2TwoPort, "[Number of Ports] 2", "[Number of Ports] 1000"), "outside"},
      {Replace(kV2TwoPort, "[Number of Ports] 2", "[Number of Ports] many"), "whole number"},
      {Replace(kV2TwoPort, "[Number of Frequencies] 2", "[Number of Frequencies] 0"), "least 1"},
      {Replace(kV2TwoPort, "[Network Data]", "[Reference] 50 x\n[Network Data]"), "'x'"},
      {Replace(kV1TwoPort, "0.3 80", "0.3 eighty"), "line 4: 'eighty' is not a number"},
      {Replace(kV1TwoPort, "2 0.6", "two 0.6"), "line 4: 'two'"},
      {Replace(kV1TwoPort, " 0.5 40\n", "\n"), "ends inside the data point that starts at line 4"},
      {Replace(kV2TwoPort, "[End]", "[Mixed-Mode Order]"), "not expected"},
      {Replace(kV2TwoPort, "[End]", "[Noise Data]\n1 3 0.5 45"), "noise record"},
      {"[Version] 2.0\n# RI\n[Number of Ports] 1\n[Network Data]\n1 0 0\n[Noise Data]\n",
       "two-port"},
  };
  for (const Case& c : cases) {
    EXPECT_EQ(Read(c.text), -1) << c.text;
    EXPECT_NE(Error().find(c.error), std::string::npos) << Error();
  }
}

TEST_F(SnPReaderTest, NumbersReadLikeAStream) {
  const auto s11 = [&](const std::string& value) {
    const int points = Read("# Hz RI\n1 " + value + " 0 0 0 0 0 0 0\n");
    return points == 1 ? Value(1, 1).re : NAN;
  };
  EXPECT_EQ(s11("+0.5"), 0.5f);
  EXPECT_EQ(s11("-.5e1"), -5.0f);
  EXPECT_EQ(s11("5."), 5.0f);
  EXPECT_EQ(s11("1e-400"), 0.0f);  // underflow reads as zero
  for (const char* bad : {"1e39", "inf", "nan", "0x10", "1.5e", "+-1", "1,5", "."}) {
    EXPECT_TRUE(std::isnan(s11(bad))) << bad;
  }
  EXPECT_EQ(Read("# Hz RI\n1e309 0 0 0 0 0 0 0 0\n"), -1);
}

TEST_F(SnPReaderTest, DeclaredFrequencyCountEndsTheNetworkData) {
  std::string text =
      "[Version] 2.0\n# Hz RI\n[Number of Ports] 1\n[Number of Frequencies] 3\n"
      "[Network Data]\n1 1 0\n2 2 0\n3 3 0\n4 4 0\n5 5 0\n";
  EXPECT_EQ(Read(text), 3);
  EXPECT_EQ(reader->GetParam(SNP_S11).GetStopFreq(), 3.0);
  EXPECT_TRUE(reader->GetFileInfo().extraPointsIgnored);
  EXPECT_EQ(Read(Replace(text, "] 3", "] 5")), 5);
  EXPECT_FALSE(reader->GetFileInfo().extraPointsIgnored);
}

// Bad input read from memory, each checked against the whole message.
class SnPReaderMessageTest : public SnPReaderTest {
 protected:
  std::string ErrorOf(const std::string& text, int ports = 2) {
    CSnPFileBase file(ports);
    EXPECT_EQ(file.ReadSNPText(text), -1) << text;
    return LumenUtility::WideToUtf8(file.GetReadError());
  }
  static constexpr const char* kV2OnePort =
      "[Version] 2.0\n# Hz RI\n[Number of Ports] 1\n[Number of Frequencies] 4\n"
      "[Network Data]\n1 1 0\n2 2 0\n";
};

TEST_F(SnPReaderMessageTest, TruncatedVersionTwoDataSaysDeclaredAndFoundCounts) {
  const std::string expected =
      "line 8: [Number of Frequencies] declares 4 points, but the network data holds 2: the "
      "file is truncated";
  EXPECT_EQ(ErrorOf(kV2OnePort, 1), expected);
  EXPECT_EQ(ErrorOf(std::string(kV2OnePort) + "[End]\n", 1),
            "line 8: [Number of Frequencies] declares 4 points, but the network data holds 2: "
            "the file is truncated");
  // The count is never taken as a size to reserve.
  EXPECT_NE(ErrorOf(Replace(kV2OnePort, "] 4", "] 2000000000"), 1).find("declares 2000000000"),
            std::string::npos);
}

TEST_F(SnPReaderMessageTest, ValuesBeyondTheirRangeFailWithTheLine) {
  EXPECT_EQ(ErrorOf("# GHz RI\n1 0.5 0 0 0 0 0 0 0\n1e300 0.5 0 0 0 0 0 0 0\n"),
            "line 3: '1e300' GHz is beyond the range of a stimulus value");
  EXPECT_EQ(ErrorOf("# Hz RI\n1 0.5 0 1e39 0 0 0 0 0\n"),
            "line 2: '1e39' is beyond the range of a single-precision value (in the data point "
            "that starts at line 2)");
  EXPECT_EQ(ErrorOf("# Hz RI\n1 0.5 0 1e400 0 0 0 0 0\n"),
            "line 2: '1e400' is beyond the range of a single-precision value (in the data point "
            "that starts at line 2)");
  EXPECT_EQ(ErrorOf("# Hz DB\n1\n 0 0 800 0\n 0 0 0 0\n"),
            "line 2: '800' dB in this data point is beyond the range of a single-precision value");
  EXPECT_EQ(ErrorOf("# Hz RI\n1e400 0 0 0 0 0 0 0 0\n"),
            "line 2: '1e400' is beyond the range of a number (a stimulus value was expected)");
  // Within range, the largest magnitudes still read.
  CSnPFileBase file(1);
  EXPECT_EQ(file.ReadSNPText("# Hz DB\n1 770 0\n1e308 -3e38 0\n"), 2);
}

TEST_F(SnPReaderMessageTest, UnprintableBytesAreQuotedAsHex) {
  EXPECT_EQ(ErrorOf(std::string("# Hz RI\n1 0.5 0 a\0b\x1B\xFF 0 0 0 0 0\n", 32)),
            "line 2: 'a\\x00b\\x1B\\xFF' is not a number (in the data point that starts at "
            "line 2)");
  // Well-formed UTF-8 stays as it is.
  EXPECT_EQ(ErrorOf("# Hz RI\n1 0.5 0 \xC2\xB5 0 0 0 0 0\n"),
            "line 2: '\xC2\xB5' is not a number (in the data point that starts at line 2)");
}

TEST_F(SnPReaderMessageTest, AFailureAfterAFrequencyDropHintsAtNoiseData) {
  // Noise records (five values) read as network points (nine values) without the marker.
  EXPECT_EQ(ErrorOf(std::string(kV1TwoPort) + "1 2 0.5 45 0.2\n"),
            "line 6: the file ends inside the data point that starts at line 5: 8 values "
            "expected, 4 found (the frequency drops at line 5; noise data there needs a '! "
            "Noise Parameters' comment before it)");
}

TEST_F(SnPReaderTest, LoneCarriageReturnsEndLines) {
  std::string text = "! old Mac text\r# GHZ S MA R 50\r1 0.5 0 0.1 90 0.2 0 0.4 45\r"
                     "2 0.6 10 0.3 80 0.2 5 0.5 40\r";
  ASSERT_EQ(Read(text), 2) << Error();
  ExpectPolar(Value(2, 2, 1), 0.5, 40);
  EXPECT_EQ(reader->GetFileInfo().pointLines, (std::vector<int>{3, 4}));
  // Lines still count right in a mix, CR LF being one line end.
  EXPECT_EQ(Read(Replace(text, "0.3 80", "0.3 x")), -1);
  EXPECT_EQ(Error().rfind("line 4: 'x'", 0), 0u) << Error();
  EXPECT_EQ(Read("# Hz RI\r\n\r1 1 0 0 0 0 0 0 0\n\r\nx"), -1);
  EXPECT_EQ(Error().rfind("line 5: 'x'", 0), 0u) << Error();
}

TEST_F(SnPReaderTest, FilesFromTheFieldRead) {
  // [Reference] one value per line, each with a comment naming its port.
  const std::string reference = Replace(
      kV2TwoPort, "[Network Data]", "[Reference]\n  50  ! Port[1]\n  75  ! Port[2]\n[Network Data]");
  ASSERT_EQ(Read(reference), 2) << Error();
  EXPECT_EQ(reader->GetFileInfo().portReferences, (std::vector<double>{50, 75}));

  // A bare R keeps the default of 50 ohms and says so.
  ASSERT_EQ(Read(Replace(kV1TwoPort, "R 50", "R")), 2) << Error();
  EXPECT_EQ(reader->GetFileInfo().referenceResistance, 50.0);
  EXPECT_FALSE(reader->GetFileInfo().referenceResistanceGiven);
  ASSERT_EQ(Read(kV1TwoPort), 2);
  EXPECT_TRUE(reader->GetFileInfo().referenceResistanceGiven);

  // The noise marker in any case.
  for (const char* marker : {"! NOISE PARAMETERS\n", "! noise parameters\n"}) {
    ASSERT_EQ(Read(std::string(kV1TwoPort) + marker + "1 2 0.5 45 0.2\n"), 2) << marker;
    EXPECT_EQ(reader->GetFileInfo().noisePoints, 1) << marker;
  }

  // Tokens the reader does not know are ignored and listed.
  ASSERT_EQ(Read(Replace(kV1TwoPort, "# GHZ", "# THz Q GHZ")), 2);
  EXPECT_EQ(reader->GetFileInfo().ignoredOptions, (std::vector<std::string>{"THZ", "Q"}));
  EXPECT_EQ(reader->GetParam(SNP_S11).GetStartFreq(), 1e9);
}

TEST_F(SnPReaderMessageTest, ComplexReferenceImpedancesAreRefused) {
  EXPECT_EQ(ErrorOf("# GHz S RI R (50+50j)\n"),
            "line 1: option R '(50+50j)': complex reference impedances are not supported");
  EXPECT_EQ(ErrorOf("# GHz S RI R 50+50j\n"),
            "line 1: option R '50+50j': complex reference impedances are not supported");
}

TEST_F(SnPReaderTest, FailedReadLeavesTheEarlierTracesAndVersionTwoReplacesThePortCount) {
  ASSERT_EQ(Read(kV1TwoPort), 2);
  reader->SetSweepType(SWEEP_POWER);
  EXPECT_EQ(reader->ReadSNPText("# GHZ\n1 x\n"), -1);
  EXPECT_EQ(reader->GetParam(SNP_S21).GetNumPoints(), 2);
  EXPECT_EQ(reader->ReadSNPText("[Version] 2.0\n# DBM RI\n[Number of Ports] 1\n[Network Data]\n"
                                "-10 1 0\n"),
            1);
  EXPECT_EQ(reader->GetSNPType(), 1);
  EXPECT_EQ(reader->GetMaxNumParams(), 1);
  EXPECT_EQ(reader->GetSweepType(), SWEEP_POWER);
  EXPECT_EQ(reader->GetResultType(), RESULT_DBM);
  EXPECT_EQ(reader->ReadSNPFile(L"/nonexistent/file.s1p"), -1);
  EXPECT_EQ(Error().rfind("cannot open the file: ", 0), 0u) << Error();  // no line to blame
  EXPECT_EQ(reader->ReadSNPText(""), -1);
}

TEST(SnPReaderEdge, OptionLineWithoutDataGivesEmptyTraces) {
  // Filling traces from an empty value array must not touch it.
  CSnPFileBase reader(2);
  EXPECT_EQ(reader.ReadSNPText("# GHz S RI R 50\n"), 0);
  for (int k = 0; k < 4; ++k) {
    EXPECT_EQ(reader.GetParam(static_cast<ESNParam>(k)).GetNumPoints(), 0);
  }
}

TEST(SnPFileName, PortCountComesFromTheExtension) {
  EXPECT_EQ(SnPPortCountFromFileName(L"dir.s4p/filter.S2P"), 2);
  EXPECT_EQ(SnPPortCountFromFileName(L"a.s12p"), 12);
  EXPECT_EQ(SnPPortCountFromFileName(L"a.s999p"), 999);
  for (const wchar_t* bad : {L"a.s0p", L"a.s1000p", L"a.sp", L"a.txt", L"s2p", L"a.s2"}) {
    EXPECT_EQ(SnPPortCountFromFileName(bad), -1) << bad;
  }
}

TEST(SNParameterS, LoopParamFollowsTheTwoPortOrderFlag) {
  CSNParameterS set(SNP_2PORT);
  const auto loop = [&](int k) { return &set.GetLoopParam(k) - &set.GetParam(SNP_S11); };
  EXPECT_EQ(loop(1), 2);
  EXPECT_EQ(loop(2), 1);
  EXPECT_EQ(loop(7), 0);
  set.Set2PortDataOrder(false);
  EXPECT_EQ(loop(1), 1);
  EXPECT_EQ(loop(3), 3);
  CSNParameterS three(SNP_3PORT);
  EXPECT_EQ(&three.GetLoopParam(5), &three.GetParam(static_cast<ESNParam>(5)));
  EXPECT_THROW(three.GetParam(static_cast<ESNParam>(9)), std::out_of_range);
  EXPECT_THROW(CSNParameterS(static_cast<SNPType>(1000)), std::invalid_argument);
  set.GetCustomParam(2).SetName(L"x");
  EXPECT_EQ(set.GetNumCustomParams(), 3);
}

}  // namespace
