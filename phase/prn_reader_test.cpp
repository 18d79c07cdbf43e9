#include "lumen/phase/prn_reader.h"

#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "lumen/diagnostics/debug_print.h"
#include "lumen/platform/debug_output.h"
#include "lumen/platform/text_conversion.h"
#include "platform/temp_dir.h"

namespace {

using LumenUtility::InputArray;
using LumenUtility::TsComplex;
using LumenUtility::testutil::TempDir;

constexpr double kPi = 3.14159265358979323846;
// Unit phasors are single-precision: a few float steps.
constexpr double kPhasorTolerance = 1e-6;

class PrnReaderTest : public testing::Test {
 protected:
  std::wstring Write(const std::string& name, const std::string& text) {
    std::ofstream(dir.NarrowPath(name), std::ios::binary) << text;
    return dir.Path(name);
  }
  PrnReader Load(const std::string& text) {
    PrnReader reader;
    EXPECT_TRUE(reader.LoadFile(Write("cal.prn", text)));
    return reader;
  }
  static std::vector<double> Points(const PrnReader& reader) {
    return {reader.GetStimulus().begin(), reader.GetStimulus().end()};
  }
  static void ExpectPhasor(TsComplex value, double degrees) {
    EXPECT_NEAR(value.re, std::cos(degrees * kPi / 180), kPhasorTolerance) << degrees;
    EXPECT_NEAR(value.im, std::sin(degrees * kPi / 180), kPhasorTolerance) << degrees;
  }
  TempDir dir;
};

TEST_F(PrnReaderTest, LineExamplesGiveTheirPointsAndHeaderAndZeroLinesAreSkipped) {
  const PrnReader reader = Load("Frequency,Phase\n0,45\n1e9, 90\n2e9,,-180,x\n");
  EXPECT_EQ(Points(reader), (std::vector<double>{1e9, 2e9}));
  ASSERT_EQ(reader.GetValues().size(), 2u);
  ExpectPhasor(reader.GetValues()[0], 90);
  ExpectPhasor(reader.GetValues()[1], -180);
}

TEST_F(PrnReaderTest, LinesWithoutTwoFiniteNumbersAreSkipped) {
  const PrnReader reader = Load(
      "abc,12\n"
      "3e9,abc\n"  // no phase: not a calibration point of 0 degrees
      "4e9\n"
      ",,5e9,\n"
      "5e9, \n"
      "nan,4\n"
      "6e9,inf\n"
      "1e400,3\n"  // overflows
      "  7e9 Hz , 30 deg\n"
      "8e9,60\r\n");
  EXPECT_EQ(Points(reader), (std::vector<double>{7e9, 8e9}));
  ASSERT_EQ(reader.GetValues().size(), 2u);
  ExpectPhasor(reader.GetValues()[0], 30);
  ExpectPhasor(reader.GetValues()[1], 60);
}

TEST_F(PrnReaderTest, PointsKeepTheFileOrderAndLoadingReplacesThem) {
  PrnReader reader = Load("3e9,0\n1e9,10\n2e9,20\n");
  EXPECT_EQ(Points(reader), (std::vector<double>{3e9, 1e9, 2e9}));
  ExpectPhasor(reader.GetValues()[1], 10);
  const PrnReader copy = reader;
  EXPECT_TRUE(reader.LoadFile(Write("empty.prn", "")));
  EXPECT_TRUE(reader.GetStimulus().empty());
  EXPECT_TRUE(reader.GetValues().empty());
  EXPECT_EQ(Points(copy).size(), 3u);
  EXPECT_EQ(copy.GetValues().size(), 3u);
}

// Collects the debugger output while the phase reference slot is on.
class DebugCapture final : public LumenUtility::IDebugOutputSink {
 public:
  DebugCapture() {
    LumenUtility::SetDebugOutputSink(this);
    gDebugPrint.Lockout(false);
    gDebugPrint.SetOn(DebugPrintPhaseReference, true);
  }
  ~DebugCapture() override {
    gDebugPrint.SetOn(DebugPrintPhaseReference, false);
    gDebugPrint.Lockout(true);
    LumenUtility::SetDebugOutputSink(nullptr);
  }
  void Output(const wchar_t* text) override { output += text; }
  std::wstring output;
};

TEST_F(PrnReaderTest, FileThatCannotBeReadIsReportedToTheDebugPrintAndKeepsThePoints) {
  PrnReader reader = Load("1e9,45\n");
  const DebugCapture capture;
  EXPECT_FALSE(reader.LoadFile(dir.Path("missing.prn")));
  EXPECT_NE(capture.output.find(dir.Path("missing.prn")), std::wstring::npos) << capture.output;
  std::filesystem::create_directory(dir.NarrowPath("folder.prn"));
  EXPECT_FALSE(reader.LoadFile(dir.Path("folder.prn")));
  EXPECT_EQ(Points(reader), std::vector<double>{1e9});
  ExpectPhasor(reader.GetValues()[0], 45);
}

// A delay: phase falls by 36 degrees per GHz, 1 to 10 GHz.
std::string DelayFile() {
  std::string text = "Frequency (Hz),Phase (deg)\n";
  for (int k = 1; k <= 10; ++k) text += std::to_string(k) + "e9," + std::to_string(-36 * k) + "\n";
  return text;
}

TEST_F(PrnReaderTest, PhaseOnASweepInsideTheFileFollowsTheCalibration) {
  const PrnReader reader = Load(DelayFile());
  const InputArray sweep(1.5e9, 9.5e9, 17, LumenUtility::SegmentType(0));
  const std::vector<TsComplex> phase = reader.GetPhase(sweep, InputArray(), nullptr);
  ASSERT_EQ(phase.size(), sweep.size());
  for (unsigned k = 0; k < sweep.size(); ++k) {
    // Along the unit circle, so each phasor keeps unit magnitude; the phase is the delay's
    // within 0.01 degree.
    const double degrees = -36.0 * sweep[k] / 1e9;
    EXPECT_NEAR(std::hypot(phase[k].re, phase[k].im), 1.0, 1e-5) << k;
    EXPECT_NEAR(std::remainder(std::atan2(phase[k].im, phase[k].re) * 180 / kPi - degrees, 360),
                0.0, 0.01)
        << sweep[k];
  }
  // The file's own points give its values.
  const std::vector<TsComplex> own = reader.GetPhase(reader.GetStimulus());
  for (unsigned k = 0; k < own.size(); ++k) ExpectPhasor(own[k], -36.0 * (k + 1));
  EXPECT_TRUE(reader.GetPhase(InputArray()).empty());
}

TEST_F(PrnReaderTest, PhaseOutsideTheFileOrWithoutPointsThrowsTheLookupCode) {
  const PrnReader reader = Load(DelayFile());
  const auto expectLookupFailure = [](const PrnReader& r, const InputArray& sweep) {
    try {
      r.GetPhase(sweep);
      ADD_FAILURE() << "no exception";
    } catch (std::int32_t code) {
      EXPECT_EQ(code, static_cast<std::int32_t>(0xE802029D));
    }
  };
  expectLookupFailure(reader, InputArray(0.5e9, 5e9, 11, LumenUtility::SegmentType(0)));
  expectLookupFailure(reader, InputArray(5e9, 10.5e9, 11, LumenUtility::SegmentType(0)));
  expectLookupFailure(PrnReader(), InputArray(1e9, 2e9, 3, LumenUtility::SegmentType(0)));
  expectLookupFailure(PrnReader(), InputArray());
}

}  // namespace
