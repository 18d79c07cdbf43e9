#include "lumenutil/trace_format.h"

#include <gtest/gtest.h>

#include <cmath>
#include <complex>
#include <random>
#include <set>
#include <string>
#include <vector>

#include "lumenutil/commands.h"

using LumenUtility::TsComplex;

namespace lumenutil {
namespace {

// The format names a --help list names: the first word of each item of "a, b (x, y), or c".
std::vector<std::string> ListedNames(const std::string& help) {
  std::vector<std::string> items(1);
  int depth = 0;
  for (std::size_t i = 0; i < help.size(); ++i) {
    const char c = help[i];
    if (c == '(') ++depth;
    if (c == ')') --depth;
    if (depth == 0 && help.compare(i, 2, ", ") == 0) {
      items.emplace_back();
      ++i;
      continue;
    }
    items.back() += c;
  }
  std::vector<std::string> names;
  for (std::string item : items) {
    if (item.rfind("or ", 0) == 0) item.erase(0, 3);
    names.push_back(item.substr(0, item.find(' ')));
  }
  return names;
}

TEST(TraceFormatTable, EachCommandsHelpAndCheckTakeExactlyItsRows) {
  CLI::App app;
  AddSnpCommand(app);
  CLI::App* snp = app.get_subcommand("snp");
  const struct {
    const char* command;
    TraceFormatUse use;
  } commands[] = {{"export", kExportFormat}, {"plot", kPlotFormat}};
  for (const auto& c : commands) {
    SCOPED_TRACE(c.command);
    CLI::App* command = snp->get_subcommand(c.command);
    CLI::Option* format = command->get_option("--format");
    EXPECT_EQ(ListedNames(format->get_description()), TraceFormatNames(c.use));
    EXPECT_NE(command->help().find(format->get_description()), std::string::npos);
    for (const TraceFormatRow& row : TraceFormats()) {
      std::string value = row.name;
      const bool accepted = (*format->get_validator())(value).empty();
      EXPECT_EQ(accepted, (row.uses & c.use) != 0) << row.name;
    }
    std::string unknown = "ri2";
    EXPECT_FALSE((*format->get_validator())(unknown).empty());
  }
  EXPECT_EQ(TraceFormatHelp(kPlotFormat),
            "logmag, phase, smith, or nf (minimum noise figure of the noise data)");
}

TEST(TraceFormatTable, RowsAreNamedOnceAndServeTheirCommands) {
  std::set<std::string> names;
  for (const TraceFormatRow& row : TraceFormats()) {
    SCOPED_TRACE(row.name);
    EXPECT_TRUE(names.insert(row.name).second);
    EXPECT_NE(row.uses, 0u);
    EXPECT_EQ(&TraceFormatNamed(row.name), &row);
    // A plotted row says how; a row drawn over the stimulus has a title and an axis.
    EXPECT_EQ((row.uses & kPlotFormat) != 0, row.plot != PlotKind::kNone);
    if (row.plot != PlotKind::kNone) {
      EXPECT_STRNE(row.chartTitle, "");
    }
    if (row.plot == PlotKind::kOverStimulus || row.plot == PlotKind::kWrappedPhase) {
      EXPECT_STRNE(row.axisLabel, "");
    }
  }
  EXPECT_THROW(TraceFormatNamed("RI"), std::out_of_range);
}

TEST(TraceFormatTable, EachRowsColumnsMatchItsConversionsWidth) {
  const std::vector<TsComplex> data = {{0.5f, -0.25f}, {0, 0}, {-0.9f, 0.1f}};
  for (const TraceFormatRow& row : TraceFormats()) {
    SCOPED_TRACE(row.name);
    if (row.convert == nullptr) {
      EXPECT_EQ(row.plot, PlotKind::kNoiseFigure);
      EXPECT_TRUE(row.columns.empty());
      continue;
    }
    const std::vector<std::vector<double>> columns = row.convert(data, 50.0);
    ASSERT_EQ(columns.size(), row.columns.size());
    for (const std::vector<double>& column : columns) EXPECT_EQ(column.size(), data.size());
    EXPECT_EQ(ColumnNames(row, "S21").size(), row.columns.size());
    // The charts read the columns they draw: one over the stimulus, (re, im) on a Smith chart.
    if (row.plot == PlotKind::kOverStimulus || row.plot == PlotKind::kWrappedPhase) {
      EXPECT_EQ(columns.size(), 1u);
    }
    if (row.plot == PlotKind::kSmithChart) {
      EXPECT_EQ(columns.size(), 2u);
    }
  }
  EXPECT_EQ(ColumnNames(TraceFormatNamed("z"), "S11"),
            (std::vector<std::string>{"S11_R_ohm", "S11_X_ohm"}));
}

// Every row shows the same values: each converts back to the stored trace. The double-precision
// formats agree to 1e-9; impedance and admittance are computed in single precision, and with
// |reflection| <= 0.9 their rounding grows at most tenfold, so 1e-5 holds them.
TEST(TraceFormatTable, ConversionsAgreeWithTheStoredValues) {
  std::mt19937 random(15);
  std::uniform_real_distribution<double> magnitude(0, 0.9), angle(-3.14159, 3.14159);
  std::vector<TsComplex> data;
  for (int i = 0; i < 200; ++i) {
    const std::complex<double> v = std::polar(magnitude(random), angle(random));
    data.emplace_back(static_cast<float>(v.real()), static_cast<float>(v.imag()));
  }
  const double z0 = 75;
  const auto columns = [&](const char* name) {
    return TraceFormatNamed(name).convert(data, z0);
  };
  const auto ri = columns("ri"), ma = columns("ma"), db = columns("db");
  const auto logmag = columns("logmag"), phase = columns("phase"), uphase = columns("uphase");
  const auto swr = columns("swr"), z = columns("z"), y = columns("y");
  EXPECT_EQ(columns("smith"), ri);
  constexpr double kTolerance = 1e-9;
  for (std::size_t i = 0; i < data.size(); ++i) {
    SCOPED_TRACE(i);
    const std::complex<double> v(data[i].re, data[i].im);
    EXPECT_EQ(ri[0][i], data[i].re);  // the stored floats exactly
    EXPECT_EQ(ri[1][i], data[i].im);
    const std::complex<double> polar = std::polar(ma[0][i], ma[1][i] / kDegreesPerRadian);
    EXPECT_NEAR(std::abs(polar - v), 0, kTolerance);
    EXPECT_NEAR(db[0][i], 20 * std::log10(ma[0][i]), kTolerance);
    EXPECT_EQ(db[1][i], ma[1][i]);
    EXPECT_EQ(logmag[0][i], db[0][i]);
    EXPECT_EQ(phase[0][i], db[1][i]);
    // Unwrapped phase differs from the wrapped one by whole turns only (float precision).
    const double turns = (uphase[0][i] - phase[0][i]) / 360;
    EXPECT_NEAR(turns, std::round(turns), 1e-5);
    EXPECT_NEAR(swr[0][i], (1 + std::abs(v)) / (1 - std::abs(v)), kTolerance * swr[0][i]);
    const std::complex<double> impedance(z[0][i], z[1][i]);
    EXPECT_NEAR(std::abs((impedance - z0) / (impedance + z0) - v), 0, 1e-5);
    const std::complex<double> admittance(y[0][i], y[1][i]);
    EXPECT_NEAR(std::abs(admittance * impedance - 1.0), 0, 1e-5);
  }
}

}  // namespace
}  // namespace lumenutil
