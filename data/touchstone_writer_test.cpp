#include "lumen/data/touchstone_writer.h"

#include <gtest/gtest.h>

#include <bit>
#include <charconv>
#include <cstdio>
#include <cmath>
#include <cstdint>
#include <fstream>
#include <random>
#include <sstream>
#include <string>
#include <vector>

#include "lumen/data.h"
#include "lumen/platform/lumen_exception.h"

using LumenUtility::InputArray;
using LumenUtility::SnPFrequencyUnit;
using LumenUtility::TouchstoneWriteOptions;
using LumenUtility::TouchstoneWriter;
using LumenUtility::TouchstoneWriteResult;
using LumenUtility::TsComplex;

namespace {

constexpr int kPortCounts[] = {1, 2, 3, 4, 12};
constexpr ESNPForm kForms[] = {SNP_RI, SNP_MA, SNP_DB};

std::string Write(const CSnPFileBase& set, const TouchstoneWriteOptions& options,
                  TouchstoneWriteResult* result = nullptr) {
  std::ostringstream out;
  const TouchstoneWriteResult r = TouchstoneWriter(set, options).Write(out);
  if (result) *result = r;
  return out.str();
}

CSnPFileBase Read(const std::string& text, int ports) {
  CSnPFileBase file(ports);
  const int points = file.ReadSNPText(text);
  EXPECT_GE(points, 0) << std::string(file.GetReadError().begin(), file.GetReadError().end())
                       << "\n"
                       << text.substr(0, 400);
  return file;
}

TouchstoneWriteOptions Options(int version, ESNPForm form,
                               SnPFrequencyUnit unit = LumenUtility::SNP_UNIT_HZ) {
  TouchstoneWriteOptions options;
  options.version = version;
  options.form = form;
  options.unit = unit;
  return options;
}

bool Same(float a, float b) {
  return std::bit_cast<std::uint32_t>(a) == std::bit_cast<std::uint32_t>(b);
}
bool Same(double a, double b) {
  return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

testing::AssertionResult SameTrace(const CSNParameter& a, const CSNParameter& b,
                                   const std::string& what) {
  if (a.GetStimulus().size() != b.GetStimulus().size() ||
      a.GetData().size() != b.GetData().size()) {
    return testing::AssertionFailure() << what << ": sizes differ";
  }
  for (unsigned int i = 0; i < a.GetStimulus().size(); ++i) {
    if (!Same(a.GetStimulus()[i], b.GetStimulus()[i])) {
      return testing::AssertionFailure() << what << " stimulus " << i << ": " << a.GetStimulus()[i]
                                         << " vs " << b.GetStimulus()[i];
    }
  }
  for (std::size_t i = 0; i < a.GetData().size(); ++i) {
    if (!Same(a.GetData()[i].re, b.GetData()[i].re) ||
        !Same(a.GetData()[i].im, b.GetData()[i].im)) {
      return testing::AssertionFailure()
             << what << " value " << i << ": (" << a.GetData()[i].re << ", " << a.GetData()[i].im
             << ") vs (" << b.GetData()[i].re << ", " << b.GetData()[i].im << ")";
    }
  }
  return testing::AssertionSuccess();
}

// Every matrix and noise trace of `a` and `b` holds the same bits.
testing::AssertionResult SameSet(const CSnPFileBase& a, const CSnPFileBase& b) {
  if (a.GetSNPType() != b.GetSNPType() || a.GetNumCustomParams() != b.GetNumCustomParams()) {
    return testing::AssertionFailure() << "port or noise trace counts differ";
  }
  for (int k = 0; k < a.GetMaxNumParams(); ++k) {
    const testing::AssertionResult same =
        SameTrace(a.GetParam(static_cast<ESNParam>(k)), b.GetParam(static_cast<ESNParam>(k)),
                  "matrix trace " + std::to_string(k));
    if (!same) return same;
  }
  for (int t = 0; t < a.GetNumCustomParams(); ++t) {
    const testing::AssertionResult same =
        SameTrace(a.GetCustomParam(t), b.GetCustomParam(t), "noise trace " + std::to_string(t));
    if (!same) return same;
  }
  return testing::AssertionSuccess();
}

std::string Text(double value) {
  char text[32];
  return std::string(text, std::to_chars(text, text + sizeof text, value).ptr);
}
std::string Text(float value) {
  char text[32];
  return std::string(text, std::to_chars(text, text + sizeof text, value).ptr);
}

class Random {
 public:
  explicit Random(unsigned seed) : m_engine(seed) {}
  double Uniform(double low, double high) {
    return std::uniform_real_distribution<double>(low, high)(m_engine);
  }
  int Integer(int low, int high) { return std::uniform_int_distribution<int>(low, high)(m_engine); }
  // Any finite float, subnormals, zeros of both signs and the extremes included.
  float AnyFloat() {
    for (;;) {
      const float f = std::bit_cast<float>(static_cast<std::uint32_t>(m_engine()));
      if (std::isfinite(f)) return f;
    }
  }
  double AnyDouble() {
    for (;;) {
      const std::uint64_t bits = (static_cast<std::uint64_t>(m_engine()) << 32) | m_engine();
      const double d = std::bit_cast<double>(bits);
      if (std::isfinite(d)) return d;
    }
  }
  // A float of either sign between 2^-20 and 2^20.
  float Moderate() {
    const float f = static_cast<float>(std::ldexp(Uniform(0.5, 1.0), Integer(-20, 20)));
    return Integer(0, 1) ? f : -f;
  }
  // An angle in degrees as files write them, in (-180, 180].
  float Angle() { return static_cast<float>(Uniform(-180.0, 180.0)); }

 private:
  std::mt19937 m_engine;
};

// A set of n ports on `points` arbitrary stimulus doubles with arbitrary finite floats,
// built directly rather than read.
CSnPFileBase ArbitrarySet(int n, int points, Random& random) {
  std::vector<double> x(points);
  for (double& v : x) v = random.AnyDouble();
  const InputArray stimulus(x);
  CSnPFileBase set(n);
  for (int k = 0; k < n * n; ++k) {
    CSNParameter trace(stimulus);
    trace.SetStimulus(stimulus);
    for (TsComplex& v : trace.GetData()) v = TsComplex(random.AnyFloat(), random.AnyFloat());
    set.GetParam(static_cast<ESNParam>(k)) = trace;
  }
  return set;
}

struct StimulusUnit {
  const char* token;
  double scale;  // of the values written, so that they look like that unit's numbers
};
constexpr StimulusUnit kUnits[] = {
    {"HZ", 1e9}, {"KHZ", 1e6}, {"MHZ", 1e3}, {"GHZ", 1.0}, {"SEC", 1e-9}};

// The text of a file as another program might write it, in `form` with the stimulus in
// `unit`: random values, the shortest text of each float, optional noise records.
std::string FieldFile(int n, int version, ESNPForm form, const StimulusUnit& unit, int points,
                      int noiseRecords, Random& random) {
  std::string text = "! written by the test\n";
  if (version == 2) text += "[Version] 2.0\n";
  text += std::string("# ") + unit.token + " S " + LumenUtility::SnPFormToken(form) + " R 50\n";
  if (version == 2) {
    text += "[Number of Ports] " + std::to_string(n) + "\n";
    if (n == 2) text += "[Two-Port Data Order] 12_21\n";
    text += "[Number of Frequencies] " + std::to_string(points) + "\n[Network Data]\n";
  }
  double x = random.Uniform(0.001, 2.0) * unit.scale;
  for (int p = 0; p < points; ++p) {
    x += random.Uniform(0.0001, 0.5) * unit.scale;
    text += Text(x);
    for (int pair = 0; pair < n * n; ++pair) {
      float a = 0, b = 0;
      switch (form) {
        case SNP_RI:
          a = random.Moderate();
          b = random.Moderate();
          break;
        case SNP_MA:
          a = std::fabs(random.Moderate());
          b = random.Angle();
          break;
        case SNP_DB:
          a = static_cast<float>(random.Uniform(-150.0, 30.0));
          b = random.Angle();
          break;
      }
      text += " " + Text(a) + " " + Text(b);
    }
    text += "\n";
  }
  if (noiseRecords > 0) {
    text += version == 2 ? "[Noise Data]\n" : "! Noise Parameters\n";
    double f = random.Uniform(0.0, 0.001) * unit.scale;
    for (int r = 0; r < noiseRecords; ++r) {
      f += random.Uniform(0.0001, 0.5) * unit.scale;
      text += Text(f) + " " + Text(static_cast<float>(random.Uniform(0.0, 10.0))) + " " +
              Text(static_cast<float>(random.Uniform(0.0, 1.0))) + " " + Text(random.Angle()) +
              " " + Text(static_cast<float>(random.Uniform(0.0, 2.0))) + "\n";
    }
  }
  if (version == 2) text += "[End]\n";
  return text;
}

TEST(TouchstoneWriter, RiInHzKeepsAnyFiniteTraceBitForBit) {
  Random random(11);
  for (int n : kPortCounts) {
    for (int version : {1, 2}) {
      const CSnPFileBase set = ArbitrarySet(n, n > 4 ? 15 : 200, random);
      TouchstoneWriteResult result;
      const std::string text = Write(set, Options(version, SNP_RI), &result);
      EXPECT_TRUE(SameSet(Read(text, n), set)) << n << " ports, version " << version;
      EXPECT_EQ(result.values,
                static_cast<std::size_t>(n * n * set.GetParam(SNP_S11).GetNumPoints()));
      EXPECT_EQ(result.inexactValues, 0u);
      EXPECT_EQ(result.inexactStimulus, 0u);
    }
  }
}

TEST(TouchstoneWriter, AFileWrittenInItsOwnFormAndUnitReadsBackBitForBit) {
  Random random(12);
  for (int n : kPortCounts) {
    for (int version : {1, 2}) {
      for (ESNPForm form : kForms) {
        for (const StimulusUnit& unit : kUnits) {
          const int points = n > 4 ? 6 : 40;
          const int noise = n == 2 ? random.Integer(1, 60) : 0;
          const CSnPFileBase original =
              Read(FieldFile(n, version, form, unit, points, noise, random), n);
          ASSERT_EQ(original.GetParam(SNP_S11).GetNumPoints(), points);
          TouchstoneWriteOptions options = Options(version, form);
          const SnPFileInfo& info = original.GetFileInfo();
          if (info.stimulusUnit != "SEC") {
            ASSERT_TRUE(LumenUtility::SnPUnitFromToken(info.stimulusUnit, options.unit));
          }
          TouchstoneWriteResult result;
          const std::string text = Write(original, options, &result);
          const CSnPFileBase again = Read(text, n);
          EXPECT_TRUE(SameSet(again, original))
              << n << " ports, version " << version << ", " << LumenUtility::SnPFormToken(form)
              << ", " << unit.token;
          EXPECT_EQ(result.inexactValues, 0u);
          EXPECT_EQ(result.inexactStimulus, 0u);
          // What reads back exactly is written again as the same text.
          EXPECT_EQ(Write(again, options), text);
          EXPECT_EQ(again.GetFileInfo().version, version);
          EXPECT_EQ(again.GetFileInfo().form, form);
          EXPECT_EQ(again.GetFileInfo().stimulusUnit, unit.token);
          EXPECT_EQ(again.GetResultType(), original.GetResultType());
          EXPECT_EQ(again.GetFileInfo().noisePoints, noise);
        }
      }
    }
  }
}

TEST(TouchstoneWriter, ManyTwoPortValuesReadBackInEveryForm) {
  // A larger sample of one port count, so that a value whose pair lies at the edge of the
  // neighbour search would show.
  Random random(13);
  for (ESNPForm form : kForms) {
    const CSnPFileBase original = Read(FieldFile(2, 1, form, kUnits[3], 5000, 0, random), 2);
    TouchstoneWriteResult result;
    const std::string text = Write(original, Options(1, form, LumenUtility::SNP_UNIT_GHZ), &result);
    EXPECT_TRUE(SameSet(Read(text, 2), original)) << LumenUtility::SnPFormToken(form);
    EXPECT_EQ(result.values, 20000u);
    EXPECT_EQ(result.inexactValues, 0u);
  }
}

std::vector<std::string> Tokens(const std::string& text) {
  std::vector<std::string> tokens;
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) {
    if (line.empty() || line[0] == '!' || line[0] == '#') continue;
    std::istringstream words(line);
    for (std::string word; words >> word;) tokens.push_back(word);
  }
  return tokens;
}

TEST(TouchstoneWriter, NumbersComeBackNoLongerThanTheFileWroteThem) {
  // Values of 1 to 6 significant digits, as instruments write them: the writer finds a text
  // at most as long for each, although the float parts alone would need up to nine digits.
  Random random(16);
  char buffer[32];
  const auto digits = [&](double value) {
    std::snprintf(buffer, sizeof buffer, "%.*g", random.Integer(1, 6), value);
    return std::string(buffer);
  };
  for (ESNPForm form : kForms) {
    std::string text = std::string("# GHZ S ") + LumenUtility::SnPFormToken(form) + " R 50\n";
    double x = 0.5;
    for (int p = 0; p < 2000; ++p) {
      x += random.Uniform(0.001, 0.01);
      text += digits(x);
      for (int pair = 0; pair < 4; ++pair) {
        const double a = form == SNP_DB   ? random.Uniform(-90.0, 10.0)
                         : form == SNP_MA ? random.Uniform(0.0, 1.5)
                                          : random.Uniform(-1.0, 1.0);
        const double b = form == SNP_RI ? random.Uniform(-1.0, 1.0) : random.Uniform(-180, 180);
        text += " " + digits(a) + " " + digits(b);
      }
      text += "\n";
    }
    const CSnPFileBase file = Read(text, 2);
    TouchstoneWriteResult result;
    const std::string written = Write(file, Options(1, form, LumenUtility::SNP_UNIT_GHZ), &result);
    EXPECT_EQ(result.inexactValues, 0u);
    const std::vector<std::string> before = Tokens(text);
    const std::vector<std::string> after = Tokens(written);
    ASSERT_EQ(before.size(), after.size());
    int longer = 0;
    for (std::size_t i = 0; i < before.size(); ++i) {
      if (after[i].size() > before[i].size() && ++longer <= 3) {
        ADD_FAILURE() << LumenUtility::SnPFormToken(form) << ": '" << before[i] << "' written as '"
                      << after[i] << "'";
      }
    }
    EXPECT_EQ(longer, 0);
  }
}

// The largest relative change of a value written in MA or DB that lies between the pairs
// the form can hold: half a float step of the magnitude (in dB, ln(10)/20 per dB), half a
// float step of the angle, and the rounding of both parts to float.
double FormTolerance(const TsComplex& v, ESNPForm form) {
  const double degrees = std::fabs(std::atan2(v.im, v.re) * 57.29577951308232);
  const double angleStep =
      std::nextafter(static_cast<float>(degrees), 1e30f) - static_cast<float>(degrees);
  double magnitudeStep = std::ldexp(1.0, -23);
  if (form == SNP_DB) {
    const float db = static_cast<float>(std::fabs(v.LogMag()));
    magnitudeStep = (std::nextafter(db, 1e30f) - db) * std::log(10.0) / 20.0;
  }
  return 0.5 * magnitudeStep + 0.5 * angleStep * 0.017453292519943295 + std::ldexp(1.0, -23);
}

TEST(TouchstoneWriter, OtherFormsMoveAValueByNoMoreThanTheirStepAndSaySo) {
  Random random(14);
  for (ESNPForm form : {SNP_MA, SNP_DB}) {
    CSnPFileBase set(2);
    const InputArray stimulus(1e9, 2e9, 3000, LumenUtility::Linear);
    for (int k = 0; k < 4; ++k) {
      CSNParameter trace(stimulus);
      trace.SetStimulus(stimulus);
      for (TsComplex& v : trace.GetData()) v = TsComplex(random.Moderate(), random.Moderate());
      set.GetParam(static_cast<ESNParam>(k)) = trace;
    }
    TouchstoneWriteResult result;
    const CSnPFileBase moved = Read(Write(set, Options(2, form), &result), 2);
    std::size_t changed = 0;
    double largest = 0;
    for (int k = 0; k < 4; ++k) {
      const std::vector<TsComplex>& held = set.GetParam(static_cast<ESNParam>(k)).GetData();
      const std::vector<TsComplex>& read = moved.GetParam(static_cast<ESNParam>(k)).GetData();
      for (std::size_t i = 0; i < held.size(); ++i) {
        if (Same(held[i].re, read[i].re) && Same(held[i].im, read[i].im)) continue;
        ++changed;
        const double change = (read[i] - held[i]).Mag() / held[i].Mag();
        largest = std::max(largest, change);
        ASSERT_LE(change, FormTolerance(held[i], form))
            << LumenUtility::SnPFormToken(form) << " (" << held[i].re << ", " << held[i].im << ")";
      }
    }
    EXPECT_EQ(result.inexactValues, changed);
    EXPECT_NEAR(result.largestValueChange, largest, largest * 1e-6);
    EXPECT_GT(changed, 0u) << "random RI values all fell on the grid of the form";
    // What was read is on the form's grid: written again it stays.
    TouchstoneWriteResult again;
    EXPECT_TRUE(SameSet(Read(Write(moved, Options(2, form), &again), 2), moved));
    EXPECT_EQ(again.inexactValues, 0u);
  }
}

TEST(TouchstoneWriter, StimulusInAScaledUnitMovesAtMostOneStep) {
  Random random(15);
  CSnPFileBase set(1);
  std::vector<double> x(5000);
  for (double& v : x) v = random.Uniform(1.0, 2.0) * 1e9;
  const InputArray stimulus(x);
  CSNParameter trace(stimulus);
  trace.SetStimulus(stimulus);
  set.GetParam(SNP_S11) = trace;
  for (SnPFrequencyUnit unit :
       {LumenUtility::SNP_UNIT_KHZ, LumenUtility::SNP_UNIT_MHZ, LumenUtility::SNP_UNIT_GHZ}) {
    TouchstoneWriteResult result;
    const CSnPFileBase read = Read(Write(set, Options(1, SNP_RI, unit), &result), 1);
    std::size_t moved = 0;
    for (std::size_t i = 0; i < x.size(); ++i) {
      const double y = read.GetParam(SNP_S11).GetStimulus()[i];
      if (y == x[i]) continue;
      ++moved;
      EXPECT_TRUE(y == std::nextafter(x[i], 0.0) || y == std::nextafter(x[i], 1e300)) << x[i];
    }
    EXPECT_EQ(result.inexactStimulus, moved);
    EXPECT_LE(result.largestStimulusChange, std::ldexp(1.0, -52));
    EXPECT_EQ(result.inexactValues, 0u);
  }
}

TEST(TouchstoneWriter, ZerosKeepTheirSignsInEveryForm) {
  const InputArray stimulus(std::vector<double>{1e9});
  CSnPFileBase set(2);
  const TsComplex zeros[4] = {{0.0, 0.0}, {-0.0, 0.0}, {0.0, -0.0}, {-0.0, -0.0}};
  for (int k = 0; k < 4; ++k) {
    CSNParameter trace(stimulus);
    trace.SetStimulus(stimulus);
    trace.GetData()[0] = zeros[k];
    set.GetParam(static_cast<ESNParam>(k)) = trace;
  }
  for (ESNPForm form : kForms) {
    TouchstoneWriteResult result;
    const std::string text = Write(set, Options(1, form), &result);
    EXPECT_TRUE(SameSet(Read(text, 2), set)) << text;
    EXPECT_EQ(result.inexactValues, 0u) << text;
  }
  EXPECT_EQ(Write(set, Options(1, SNP_DB)),
            "# HZ S DB R 50\n1e+09 -1000 0 -1000 -0 -1000 180 -1000 -180\n");
}

TEST(TouchstoneWriter, Version2FileListsItsKeywordsInOrder) {
  CSnPFileBase file(2);
  ASSERT_EQ(file.ReadSNPText("[Version] 2.0\n# GHz S MA R 50\n[Number of Ports] 2\n"
                             "[Two-Port Data Order] 12_21\n[Number of Frequencies] 2\n"
                             "[Number of Noise Frequencies] 1\n[Reference] 50 75\n"
                             "[Network Data]\n1.5 0.5 0 0.2 0 0.1 90 0.4 45\n"
                             "2 0.6 10 0.2 5 0.3 80 0.5 40\n"
                             "[Noise Data]\n1.75 3 0.5 45 0.2\n[End]\n"),
            2);
  TouchstoneWriteOptions options = Options(2, SNP_MA, LumenUtility::SNP_UNIT_GHZ);
  options.comment = "first\nsecond\n";
  EXPECT_EQ(Write(file, options),
            "! first\n! second\n[Version] 2.0\n# GHZ S MA R 50\n[Number of Ports] 2\n"
            "[Two-Port Data Order] 21_12\n[Number of Frequencies] 2\n"
            "[Number of Noise Frequencies] 1\n[Reference] 50 75\n[Matrix Format] Full\n"
            "[Network Data]\n1.5 0.5 0 0.1 90 0.2 0 0.4 45\n2 0.6 10 0.3 80 0.2 5 0.5 40\n"
            "[Noise Data]\n1.75 3 0.5 45 0.2\n[End]\n");
  // Version 1 keeps the pair order and puts the noise records after their marker.
  CSnPFileBase v1(2);
  ASSERT_EQ(v1.ReadSNPText("# MHz S RI R 75\n1500 1 2 3 4 5 6 7 8\n! Noise Parameters\n"
                           "1000 3 0.5 45 0.2\n"),
            1);
  EXPECT_EQ(Write(v1, Options(1, SNP_RI, LumenUtility::SNP_UNIT_MHZ)),
            "# MHZ S RI R 75\n1500 1 2 3 4 5 6 7 8\n! Noise Parameters\n1000 3 0.5 45 0.2\n");
}

TEST(TouchstoneWriter, LargeNetworksStartEachMatrixRowOnANewLineWithFourPairsALine) {
  CSnPFileBase set(5);
  const InputArray stimulus(std::vector<double>{2});
  for (int k = 0; k < 25; ++k) {
    CSNParameter trace(stimulus);
    trace.SetStimulus(stimulus);
    trace.GetData()[0] = TsComplex(k, -k);
    set.GetParam(static_cast<ESNParam>(k)) = trace;
  }
  std::string expected = "# HZ S RI R 50\n2";
  for (int row = 0; row < 5; ++row) {
    for (int column = 0; column < 5; ++column) {
      const int k = row * 5 + column;
      if (column == 4) expected += "\n";
      expected += " " + std::to_string(k) + " " + std::to_string(-k);
    }
    expected += "\n";
  }
  EXPECT_EQ(Write(set, Options(1, SNP_RI)), expected);
}

// A two-port set on `x` (Hz) whose every value is 0.5 + 0.25j.
CSnPFileBase TwoPortSet(const std::vector<double>& x) {
  const InputArray stimulus(x);
  CSnPFileBase set(2);
  for (int k = 0; k < 4; ++k) {
    CSNParameter trace(stimulus);
    trace.SetStimulus(stimulus);
    for (TsComplex& v : trace.GetData()) v = TsComplex(0.5, 0.25);
    set.GetParam(static_cast<ESNParam>(k)) = trace;
  }
  return set;
}

// The message of the LumenException that writing `set` with `options` throws; the code must
// be LUMEN_E_BOUNDS.
std::string Refusal(const CSnPFileBase& set, const TouchstoneWriteOptions& options) {
  try {
    TouchstoneWriter writer(set, options);
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetCode(), LumenUtility::LUMEN_E_BOUNDS);
    const std::wstring message = e.GetMessage();
    return std::string(message.begin(), message.end());
  }
  return "(accepted)";
}

TEST(TouchstoneWriter, RefusesSetsItCannotWriteBeforeWritingAnything) {
  const std::vector<double> x = {1e9, 2e9, 3e9};
  const TouchstoneWriteOptions v1 = Options(1, SNP_RI, LumenUtility::SNP_UNIT_GHZ);
  const TouchstoneWriteOptions v2 = Options(2, SNP_RI, LumenUtility::SNP_UNIT_GHZ);
  EXPECT_EQ(Refusal(TwoPortSet(x), Options(3, SNP_RI)),
            "Touchstone version 3 is not written; 1 or 2 is");
  EXPECT_EQ(Refusal(TwoPortSet(x), Options(1, static_cast<ESNPForm>(5))),
            "value form 5 is not RI, MA or DB");

  CSnPFileBase shorter = TwoPortSet(x);
  shorter.GetParam(SNP_S21) = TwoPortSet({1e9, 2e9}).GetParam(SNP_S21);
  EXPECT_EQ(Refusal(shorter, v1),
            "S21 has 2 points and S11 3; the traces of a file share their points");
  CSnPFileBase fewerValues = TwoPortSet(x);
  fewerValues.GetParam(SNP_S12).GetData().pop_back();
  EXPECT_EQ(Refusal(fewerValues, v1), "S12 holds 2 values on 3 stimulus points");
  CSnPFileBase moved = TwoPortSet(x);
  moved.GetParam(SNP_S22).SetStimulus(InputArray(std::vector<double>{1e9, 2.5e9, 3e9}));
  EXPECT_EQ(Refusal(moved, v1),
            "S22 lies on other stimulus points than S11: point 2 is 2.5 GHz "
            "against 2 GHz");
  CSnPFileBase nan = TwoPortSet(x);
  nan.GetParam(SNP_S21).GetData()[1].im = std::nanf("");
  EXPECT_EQ(Refusal(nan, v1), "S21 at point 2 is not a finite value");
  const CSnPFileBase infinite = TwoPortSet({1e9, INFINITY});
  EXPECT_EQ(Refusal(infinite, v2), "stimulus point 2 is not a finite value");
  EXPECT_EQ(Refusal(TwoPortSet({}), v2),
            "a Touchstone 2.0 file needs at least one network point; this set has none");
  // Version 1 has no point count to declare: an empty set is an option line alone.
  EXPECT_EQ(Write(TwoPortSet({}), v1), "# GHZ S RI R 50\n");

  CSnPFileBase references(2);
  ASSERT_EQ(references.ReadSNPText("[Version] 2.0\n# GHz RI\n[Number of Ports] 2\n"
                                   "[Reference] 50 75\n[Network Data]\n1 1 0 0 0 0 0 1 0\n"),
            1);
  EXPECT_EQ(Refusal(references, v1),
            "version 1 holds one reference resistance for all ports, "
            "but the ports have 50, 75 ohm; write version 2");
  EXPECT_EQ(Refusal(references, v2), "(accepted)");
}

TEST(TouchstoneWriter, RefusesNoiseDataItCannotWrite) {
  const std::string noisy =
      "[Version] 2.0\n# GHz MA R 50\n[Number of Ports] 2\n[Network Data]\n"
      "1 1 0 0 0 0 0 1 0\n2 1 0 0 0 0 0 1 0\n[Noise Data]\n"
      "3 2 0.5 45 0.2\n4 2 0.5 45 0.2\n[End]\n";
  CSnPFileBase file(2);
  ASSERT_EQ(file.ReadSNPText(noisy), 2);
  const TouchstoneWriteOptions v1 = Options(1, SNP_MA, LumenUtility::SNP_UNIT_GHZ);
  EXPECT_EQ(Refusal(file, v1),
            "version 1 noise data must start at or below the last network point (2 GHz) for a "
            "reader to tell it from network data, but it starts at 3 GHz; write version 2");
  TouchstoneWriteOptions withoutNoise = v1;
  withoutNoise.noise = false;
  const CSnPFileBase written = Read(Write(file, withoutNoise), 2);
  EXPECT_EQ(written.GetNumCustomParams(), 0);
  EXPECT_EQ(Refusal(file, Options(2, SNP_MA)), "(accepted)");

  CSnPFileBase zeroFactor = file;
  zeroFactor.GetCustomParam(0).GetData()[1] = TsComplex(0.0);
  EXPECT_EQ(Refusal(zeroFactor, Options(2, SNP_MA)),
            "NFmin at noise point 2 is 0, not a positive noise factor");
  CSnPFileBase partial = file;
  partial.GetCustomParam(2).GetData().pop_back();
  EXPECT_EQ(Refusal(partial, Options(2, SNP_MA)),
            "the noise trace Rn does not match NFmin in its points or values");
  CSnPFileBase fourTraces = file;
  fourTraces.GetCustomParam(3);
  EXPECT_EQ(Refusal(fourTraces, Options(2, SNP_MA)),
            "noise data takes three traces (NFmin, GammaOpt, Rn), not 4");
  CSnPFileBase threePorts(3);
  threePorts.GetCustomParam(0);
  EXPECT_EQ(Refusal(threePorts, Options(1, SNP_RI)),
            "noise data belongs to two-port networks; this one has 3 ports");
}

TEST(TouchstoneWriter, AFailingStreamIsAnError) {
  const CSnPFileBase set = TwoPortSet({1e9, 2e9});
  std::ostringstream out;
  out.setstate(std::ios::badbit);
  try {
    TouchstoneWriter(set, Options(1, SNP_RI)).Write(out);
    ADD_FAILURE() << "no exception";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetCode(), LumenUtility::LUMEN_E_BOUNDS);
    EXPECT_EQ(e.GetMessage(), L"writing the Touchstone file failed");
  }
  // A file stream says why. The text goes out in blocks, so a large set meets the full
  // device while being written, not only when the stream is closed.
  std::ofstream full("/dev/full", std::ios::binary);
  if (!full) GTEST_SKIP() << "no /dev/full";
  std::vector<double> x(20000);
  for (std::size_t i = 0; i < x.size(); ++i) x[i] = 1e9 + 1e5 * static_cast<double>(i);
  try {
    TouchstoneWriter(TwoPortSet(x), Options(1, SNP_RI)).Write(full);
    ADD_FAILURE() << "no exception";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetMessage(), L"writing the Touchstone file failed: No space left on device");
  }
}

TEST(TouchstoneWriter, TokensOfUnitsAndFormsReadInAnyCase) {
  SnPFrequencyUnit unit = LumenUtility::SNP_UNIT_HZ;
  EXPECT_TRUE(LumenUtility::SnPUnitFromToken("gHz", unit));
  EXPECT_EQ(unit, LumenUtility::SNP_UNIT_GHZ);
  EXPECT_TRUE(LumenUtility::SnPUnitFromToken("khz", unit));
  EXPECT_EQ(LumenUtility::SnPUnitMultiplier(unit), 1e3);
  EXPECT_STREQ(LumenUtility::SnPUnitToken(unit), "KHZ");
  EXPECT_FALSE(LumenUtility::SnPUnitFromToken("THZ", unit));
  EXPECT_FALSE(LumenUtility::SnPUnitFromToken("SEC", unit));
  ESNPForm form = SNP_RI;
  EXPECT_TRUE(LumenUtility::SnPFormFromToken("dB", form));
  EXPECT_EQ(form, SNP_DB);
  EXPECT_FALSE(LumenUtility::SnPFormFromToken("RA", form));
}

}  // namespace
