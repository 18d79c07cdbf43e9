#include <gtest/gtest.h>

#include <unistd.h>

#include <cmath>
#include <cstdio>
#include <fstream>
#include <memory>
#include <string>

#include "data/testing/snp_texts.h"
#include "lumen/data.h"
#include "lumen/platform.h"

using LumenUtility::TsComplex;
using LumenUtility::fixtures::kV1Noise;
using LumenUtility::fixtures::kV1TwoPort;
using LumenUtility::fixtures::kV2TwoPort;
using LumenUtility::fixtures::Replace;

namespace {

constexpr double kDegree = 3.14159265358979323846 / 180.0;

// A reader-test fixture: each test reads texts from memory (usually a valid one with a small
// change) into `reader`.
class SnPReaderTest : public ::testing::Test {
 protected:
  int Read(const std::string& text, int ports = 2) {
    reader = std::make_unique<CSnPFileBase>(ports);
    return reader->ReadSNPText(text);
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
  EXPECT_EQ(Error(),
            "line 10: the file ends inside the data point that starts at line 6: 32 values "
            "expected, 20 found");
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
  EXPECT_EQ(Error(), "line 1: the file starts with a broken UTF-8 byte-order mark");
  for (const char* utf16 : {"\xFF\xFE", "\xFE\xFF"}) {
    EXPECT_EQ(Read(utf16 + std::string(kV1TwoPort)), -1);
    EXPECT_EQ(Error(), "line 1: UTF-16 text is not read; save the file as UTF-8 or ASCII");
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
  // What a stream would refuse is refused (the messages are checked with the other bad input).
  for (const char* bad : {"1e39", "inf", "nan", "0x10", "1.5e", "+-1", "1,5", "."}) {
    EXPECT_TRUE(std::isnan(s11(bad))) << bad;
  }
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

TEST_F(SnPReaderTest, LoneCarriageReturnsEndLines) {
  std::string text = "! old Mac text\r# GHZ S MA R 50\r1 0.5 0 0.1 90 0.2 0 0.4 45\r"
                     "2 0.6 10 0.3 80 0.2 5 0.5 40\r";
  ASSERT_EQ(Read(text), 2) << Error();
  ExpectPolar(Value(2, 2, 1), 0.5, 40);
  EXPECT_EQ(reader->GetFileInfo().pointLines, (std::vector<int>{3, 4}));
  // Lines still count right in a mix, CR LF being one line end.
  EXPECT_EQ(Read(Replace(text, "0.3 80", "0.3 x")), -1);
  EXPECT_EQ(Error(), "line 4: 'x' is not a number (in the data point that starts at line 4)");
  EXPECT_EQ(Read("# Hz RI\r\n\r1 1 0 0 0 0 0 0 0\n\r\nx"), -1);
  EXPECT_EQ(Error(), "line 5: 'x' is not a number (a stimulus value was expected)");
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

TEST_F(SnPReaderTest, FailedReadLeavesTheEarlierTracesAndVersionTwoReplacesThePortCount) {
  ASSERT_EQ(Read(kV1TwoPort), 2);
  reader->SetSweepType(SWEEP_POWER);
  EXPECT_EQ(reader->ReadSNPText("# GHZ\n1 x\n"), -1);
  EXPECT_EQ(Error(), "line 2: 'x' is not a number (in the data point that starts at line 2)");
  EXPECT_EQ(reader->GetParam(SNP_S21).GetNumPoints(), 2);
  EXPECT_EQ(reader->ReadSNPText("[Version] 2.0\n# DBM RI\n[Number of Ports] 1\n[Network Data]\n"
                                "-10 1 0\n"),
            1);
  EXPECT_EQ(reader->GetSNPType(), 1);
  EXPECT_EQ(reader->GetMaxNumParams(), 1);
  EXPECT_EQ(reader->GetSweepType(), SWEEP_POWER);
  EXPECT_EQ(reader->GetResultType(), RESULT_DBM);
  EXPECT_EQ(reader->ReadSNPText(""), -1);
  EXPECT_EQ(Error(), "line 1: the option line (starting with '#') is missing");
  EXPECT_EQ(reader->GetSNPType(), 1);
}

// Reading by path: the same traces as the text in memory; a path that cannot be read says
// why, with no line to blame.
TEST_F(SnPReaderTest, FilesReadByPathLikeTheirText) {
  const std::string path = ::testing::TempDir() + "snp_reader_" + std::to_string(::getpid()) +
                           "_\xC2\xB5.s2p";  // a name that is not ASCII
  for (const char* text : {kV1TwoPort, kV2TwoPort, kV1Noise}) {
    ASSERT_EQ(Read(text), 2);
    const CSnPFileBase fromText = *reader;
    std::ofstream(path, std::ios::binary) << text;
    ASSERT_EQ(reader->ReadSNPFile(LumenUtility::Utf8ToWide(path)), 2) << Error();
    std::remove(path.c_str());
    ASSERT_EQ(reader->GetNumCustomParams(), fromText.GetNumCustomParams());
    for (int k = 0; k < 4; ++k) {
      const ESNParam position = static_cast<ESNParam>(k);
      EXPECT_EQ(reader->GetParam(position).GetData(), fromText.GetParam(position).GetData());
      EXPECT_EQ(reader->GetParam(position).GetStimulus(),
                fromText.GetParam(position).GetStimulus());
    }
    for (int k = 0; k < reader->GetNumCustomParams(); ++k) {
      EXPECT_EQ(reader->GetCustomParam(k).GetData(), fromText.GetCustomParam(k).GetData());
    }
    EXPECT_EQ(reader->GetFileInfo().pointLines, fromText.GetFileInfo().pointLines);
  }
  EXPECT_EQ(reader->ReadSNPFile(L"/nonexistent/file.s1p"), -1);
  EXPECT_EQ(Error(), "cannot open the file: No such file or directory");
  EXPECT_EQ(reader->ReadSNPFile(LumenUtility::Utf8ToWide(::testing::TempDir())), -1);
  EXPECT_EQ(Error(), "the file cannot be read: Is a directory");
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
