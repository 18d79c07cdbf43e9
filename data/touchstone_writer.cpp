#include "lumen/data/touchstone_writer.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <vector>

#include "data/touchstone_value_text.h"
#include "lumen/core/si_prefix.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

// The text goes to the stream in blocks of about this size: few stream calls, and a 400 MB
// file of a 12-port network never sits in memory whole.
constexpr std::size_t kBlock = std::size_t{1} << 16;
// Pairs per line in a network of three or more ports; each matrix row starts a line.
constexpr int kPairsPerLine = 4;

struct UnitEntry {
  SnPFrequencyUnit unit;
  const char* token;
  double multiplier;
};
constexpr UnitEntry kUnits[] = {{SNP_UNIT_HZ, "HZ", 1.0},
                                {SNP_UNIT_KHZ, "KHZ", 1e3},
                                {SNP_UNIT_MHZ, "MHZ", 1e6},
                                {SNP_UNIT_GHZ, "GHZ", 1e9}};

const UnitEntry* FindUnit(SnPFrequencyUnit unit) {
  for (const UnitEntry& entry : kUnits) {
    if (entry.unit == unit) return &entry;
  }
  return nullptr;
}

bool SameTokenIgnoringCase(std::string_view text, std::string_view token) {
  if (text.size() != token.size()) return false;
  for (std::size_t i = 0; i < text.size(); ++i) {
    const char c = text[i] >= 'a' && text[i] <= 'z' ? static_cast<char>(text[i] - 32) : text[i];
    if (c != token[i]) return false;
  }
  return true;
}

[[noreturn]] void Refuse(const std::string& message) {
  throw LumenException(LUMEN_E_BOUNDS, Utf8ToWide(message));
}

std::string PositionName(int row, int column) {
  char name[32];
  std::snprintf(name, sizeof name, row < 10 && column < 10 ? "S%d%d" : "S%d_%d", row, column);
  return name;
}

std::string Number(double value) {
  std::string text;
  AppendShortest(text, value);
  return text;
}

// How the stimulus appears: its option-line token, and its unit in messages.
struct StimulusWords {
  const char* token;
  const char* unit;
  bool siPrefix;  // messages show 2.5 GHz rather than 2500000000 Hz
};

StimulusWords WordsOf(ResultType type, SnPFrequencyUnit unit) {
  switch (type) {
    case RESULT_SEC:
      return {"SEC", "s", true};
    case RESULT_DBM:
      return {"DBM", "dBm", false};
    case RESULT_POINT:
      return {"POINT", "", false};
    default:
      return {FindUnit(unit)->token, "Hz", true};
  }
}

// The stimulus value `x` as messages show it: "2.5 GHz", "10 ps", "-5 dBm".
std::string StimulusText(double x, const StimulusWords& words) {
  double scale = 1.0;
  char prefix = ' ';
  if (words.siPrefix) GetSIPrefix(x, scale, prefix, 12, -15);
  // Dividing by an exact power of ten keeps 1.2e9 Hz from showing as 1.2000000000000002 GHz.
  const int exponent = static_cast<int>(std::lround(-std::log10(scale)));
  const double shown = exponent >= 0 ? x / std::pow(10.0, exponent) : x * std::pow(10.0, -exponent);
  std::string text = Number(shown);
  if (prefix == static_cast<char>(0xB5)) {
    text += " \xC2\xB5";  // micro, as UTF-8
  } else if (prefix != ' ') {
    text += std::string(" ") + prefix;
  } else if (*words.unit) {
    text += ' ';
  }
  return text + words.unit;
}

bool AllFinite(const std::vector<TsComplex>& data, std::size_t& first) {
  for (std::size_t i = 0; i < data.size(); ++i) {
    if (!std::isfinite(data[i].re) || !std::isfinite(data[i].im)) {
      first = i;
      return false;
    }
  }
  return true;
}

// The file text as it is built, and the tally of what could not be kept exactly.
class Output {
 public:
  explicit Output(std::ostream& out) : m_out(out) { m_text.reserve(kBlock + 4096); }

  const TouchstoneWriteResult& Result() const { return m_result; }

  void Line(const std::string& line) {
    m_text += line;
    EndLine();
  }
  void EndLine() {
    m_text += '\n';
    if (m_text.size() >= kBlock) Flush();
  }
  void Stimulus(double x, double multiplier) {
    const FileNumber<double> q = StimulusInUnit(x, multiplier);
    AppendShortest(m_text, q.text);
    if (!q.exact) {
      ++m_result.inexactStimulus;
      m_result.largestStimulusChange =
          std::max(m_result.largestStimulusChange, RelativeChange(q.readBack, x));
    }
  }
  void Pair(const TsComplex& value, ESNPForm form) {
    const FilePair pair = PairForValue(value, form);
    m_text += ' ';
    AppendShortest(m_text, pair.a);
    m_text += ' ';
    AppendShortest(m_text, pair.b);
    const double change = pair.exact ? 0.0
                          : value.re == 0 && value.im == 0
                              ? std::hypot(pair.readBack.re, pair.readBack.im)
                              : std::hypot(pair.readBack.re - static_cast<double>(value.re),
                                           pair.readBack.im - static_cast<double>(value.im)) /
                                    value.Mag();
    Tally(pair.exact, change);
  }
  // One number of a noise record that stands for a held value `held`.
  void NoiseNumber(const FileNumber<float>& number, double held) {
    m_text += ' ';
    AppendShortest(m_text, number.text);
    Tally(number.exact, RelativeChange(number.readBack, held));
  }
  void Flush() {
    errno = 0;
    m_out.write(m_text.data(), static_cast<std::streamsize>(m_text.size()));
    const int error = errno;
    m_text.clear();
    if (m_out) return;
    // A file stream fails with the reason of its system call (a full disk, a size limit).
    Refuse(error != 0 ? std::string("writing the Touchstone file failed: ") + std::strerror(error)
                      : std::string("writing the Touchstone file failed"));
  }

 private:
  static double RelativeChange(double read, double held) {
    return held == 0 ? std::fabs(read) : std::fabs(read - held) / std::fabs(held);
  }
  void Tally(bool exact, double change) {
    ++m_result.values;
    if (exact) return;
    ++m_result.inexactValues;
    m_result.largestValueChange = std::max(m_result.largestValueChange, change);
  }

  std::ostream& m_out;
  std::string m_text;
  TouchstoneWriteResult m_result;
};

}  // namespace

const char* SnPUnitToken(SnPFrequencyUnit unit) {
  const UnitEntry* entry = FindUnit(unit);
  return entry ? entry->token : "HZ";
}

double SnPUnitMultiplier(SnPFrequencyUnit unit) {
  const UnitEntry* entry = FindUnit(unit);
  return entry ? entry->multiplier : 1.0;
}

bool SnPUnitFromToken(std::string_view token, SnPFrequencyUnit& unit) {
  for (const UnitEntry& entry : kUnits) {
    if (SameTokenIgnoringCase(token, entry.token)) {
      unit = entry.unit;
      return true;
    }
  }
  return false;
}

const char* SnPFormToken(ESNPForm form) {
  return form == SNP_MA ? "MA" : form == SNP_DB ? "DB" : "RI";
}

bool SnPFormFromToken(std::string_view token, ESNPForm& form) {
  for (ESNPForm candidate : {SNP_RI, SNP_MA, SNP_DB}) {
    if (SameTokenIgnoringCase(token, SnPFormToken(candidate))) {
      form = candidate;
      return true;
    }
  }
  return false;
}

TouchstoneWriter::TouchstoneWriter(const CSnPFileBase& file, const TouchstoneWriteOptions& options)
    : m_file(file), m_options(options) {
  if (options.version != 1 && options.version != 2) {
    Refuse("Touchstone version " + std::to_string(options.version) + " is not written; 1 or 2 is");
  }
  if (options.form != SNP_RI && options.form != SNP_MA && options.form != SNP_DB) {
    Refuse("value form " + std::to_string(options.form) + " is not RI, MA or DB");
  }
  if (!FindUnit(options.unit)) Refuse("unit " + std::to_string(options.unit) + " is unknown");
  m_multiplier = file.GetResultType() == RESULT_FREQUENCY ? SnPUnitMultiplier(options.unit) : 1.0;
  CheckNetwork();
  CheckNoise();
}

void TouchstoneWriter::CheckNetwork() const {
  const int n = m_file.GetSNPType();
  const CSNParameter& first = m_file.GetParam(SNP_S11);
  const LumenUtility::InputArray& stimulus = first.GetStimulus();
  const StimulusWords words = WordsOf(m_file.GetResultType(), m_options.unit);
  for (int k = 0; k < n * n; ++k) {
    const CSNParameter& trace = m_file.GetParam(static_cast<ESNParam>(k));
    const std::string name = PositionName(k / n + 1, k % n + 1);
    if (trace.GetData().size() != trace.GetStimulus().size()) {
      Refuse(name + " holds " + std::to_string(trace.GetData().size()) + " values on " +
             std::to_string(trace.GetStimulus().size()) + " stimulus points");
    }
    if (trace.GetStimulus().size() != stimulus.size()) {
      Refuse(name + " has " + std::to_string(trace.GetStimulus().size()) + " points and S11 " +
             std::to_string(stimulus.size()) + "; the traces of a file share their points");
    }
    if (trace.GetStimulus() != stimulus) {
      unsigned int i = 0;
      while (trace.GetStimulus()[i] == stimulus[i]) ++i;
      Refuse(name + " lies on other stimulus points than S11: point " + std::to_string(i + 1) +
             " is " + StimulusText(trace.GetStimulus()[i], words) + " against " +
             StimulusText(stimulus[i], words));
    }
    std::size_t bad = 0;
    if (!AllFinite(trace.GetData(), bad)) {
      Refuse(name + " at point " + std::to_string(bad + 1) + " is not a finite value");
    }
  }
  for (unsigned int i = 0; i < stimulus.size(); ++i) {
    if (!std::isfinite(stimulus[i])) {
      Refuse("stimulus point " + std::to_string(i + 1) + " is not a finite value");
    }
  }
  if (m_options.version == 2 && stimulus.empty()) {
    Refuse("a Touchstone 2.0 file needs at least one network point; this set has none");
  }

  const SnPFileInfo& info = m_file.GetFileInfo();
  if (!std::isfinite(info.referenceResistance)) Refuse("the reference resistance is not finite");
  const std::vector<double>& references = info.portReferences;
  if (references.empty()) return;
  if (static_cast<int>(references.size()) != n) {
    Refuse(std::to_string(references.size()) + " per-port reference resistances for a " +
           std::to_string(n) + "-port network");
  }
  for (double r : references) {
    if (!std::isfinite(r)) Refuse("a per-port reference resistance is not finite");
  }
  if (m_options.version == 1 && std::any_of(references.begin(), references.end(),
                                            [&](double r) { return r != references.front(); })) {
    std::string list;
    for (double r : references) list += (list.empty() ? "" : ", ") + Number(r);
    Refuse("version 1 holds one reference resistance for all ports, but the ports have " + list +
           " ohm; write version 2");
  }
}

void TouchstoneWriter::CheckNoise() {
  const SnPFileInfo& info = m_file.GetFileInfo();
  m_reference = m_options.version == 1 && !info.portReferences.empty() ? info.portReferences.front()
                                                                       : info.referenceResistance;
  const int traces = m_file.GetNumCustomParams();
  if (!m_options.noise || traces == 0) return;
  const int n = m_file.GetSNPType();
  if (n != 2) {
    Refuse("noise data belongs to two-port networks; this one has " + std::to_string(n) + " ports");
  }
  if (traces != 3) {
    Refuse("noise data takes three traces (NFmin, GammaOpt, Rn), not " + std::to_string(traces));
  }
  static const char* const kNames[3] = {"NFmin", "GammaOpt", "Rn"};
  const LumenUtility::InputArray& stimulus = m_file.GetCustomParam(0).GetStimulus();
  for (int t = 0; t < 3; ++t) {
    const CSNParameter& trace = m_file.GetCustomParam(t);
    if (trace.GetStimulus() != stimulus || trace.GetData().size() != stimulus.size()) {
      Refuse(std::string("the noise trace ") + kNames[t] +
             " does not match NFmin in its points or values");
    }
    std::size_t bad = 0;
    if (!AllFinite(trace.GetData(), bad)) {
      Refuse(std::string(kNames[t]) + " at noise point " + std::to_string(bad + 1) +
             " is not a finite value");
    }
  }
  if (stimulus.empty()) return;
  for (unsigned int i = 0; i < stimulus.size(); ++i) {
    if (!std::isfinite(stimulus[i])) {
      Refuse("noise stimulus point " + std::to_string(i + 1) + " is not a finite value");
    }
    const float factor = m_file.GetCustomParam(0).GetData()[i].re;
    if (!(factor > 0)) {
      Refuse("NFmin at noise point " + std::to_string(i + 1) + " is " + Number(factor) +
             ", not a positive noise factor");
    }
  }
  if (m_reference == 0) Refuse("noise resistances cannot be normalised to a reference of 0 ohm");
  if (m_options.version == 1) {
    const LumenUtility::InputArray& network = m_file.GetParam(SNP_S11).GetStimulus();
    const StimulusWords words = WordsOf(m_file.GetResultType(), m_options.unit);
    if (network.empty()) {
      Refuse("version 1 noise data must follow network data; this set has no network points");
    }
    if (stimulus.front() > network.back()) {
      Refuse("version 1 noise data must start at or below the last network point (" +
             StimulusText(network.back(), words) +
             ") for a reader to tell it from network data, but it starts at " +
             StimulusText(stimulus.front(), words) + "; write version 2");
    }
  }
  m_writeNoise = true;
}

TouchstoneWriteResult TouchstoneWriter::Write(std::ostream& stream) const {
  Output out(stream);
  const int n = m_file.GetSNPType();
  const SnPFileInfo& info = m_file.GetFileInfo();
  const bool v2 = m_options.version == 2;
  const CSNParameter& first = m_file.GetParam(SNP_S11);
  const LumenUtility::InputArray& stimulus = first.GetStimulus();
  const unsigned int noisePoints = m_writeNoise ? m_file.GetCustomParam(0).GetStimulus().size() : 0;

  std::string_view comment = m_options.comment;
  while (!comment.empty()) {
    const std::size_t end = std::min(comment.find('\n'), comment.size());
    std::string_view line = comment.substr(0, end);
    if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
    out.Line("! " + std::string(line));
    comment.remove_prefix(std::min(end + 1, comment.size()));
  }
  if (v2) out.Line("[Version] 2.0");
  out.Line(std::string("# ") + WordsOf(m_file.GetResultType(), m_options.unit).token + ' ' +
           info.parameter + ' ' + SnPFormToken(m_options.form) + " R " + Number(m_reference));
  if (v2) {
    out.Line("[Number of Ports] " + std::to_string(n));
    // Pairs go in 11, 21, 12, 22 order in both versions.
    if (n == 2) out.Line("[Two-Port Data Order] 21_12");
    out.Line("[Number of Frequencies] " + std::to_string(stimulus.size()));
    if (noisePoints > 0) out.Line("[Number of Noise Frequencies] " + std::to_string(noisePoints));
    if (!info.portReferences.empty()) {
      std::string line = "[Reference]";
      for (double r : info.portReferences) line += ' ' + Number(r);
      out.Line(line);
    }
    out.Line("[Matrix Format] Full");
    out.Line("[Network Data]");
  }

  const auto value = [&](int row, int column, unsigned int i) -> const TsComplex& {
    return m_file.GetParam(static_cast<ESNParam>((row - 1) * n + column - 1)).GetData()[i];
  };
  for (unsigned int i = 0; i < stimulus.size(); ++i) {
    out.Stimulus(stimulus[i], m_multiplier);
    if (n <= 2) {
      for (int column = 1; column <= n; ++column) {
        for (int row = 1; row <= n; ++row) out.Pair(value(row, column, i), m_options.form);
      }
      out.EndLine();
      continue;
    }
    for (int row = 1; row <= n; ++row) {
      for (int column = 1; column <= n; ++column) {
        // Continuation lines start with the blank before their first pair.
        if (column > 1 && (column - 1) % kPairsPerLine == 0) out.EndLine();
        out.Pair(value(row, column, i), m_options.form);
      }
      out.EndLine();
    }
  }

  if (noisePoints > 0) {
    out.Line(v2 ? "[Noise Data]" : "! Noise Parameters");
    const CSNParameter& nf = m_file.GetCustomParam(0);
    const CSNParameter& gamma = m_file.GetCustomParam(1);
    const CSNParameter& rn = m_file.GetCustomParam(2);
    for (unsigned int i = 0; i < noisePoints; ++i) {
      out.Stimulus(nf.GetStimulus()[i], m_multiplier);
      // The traces hold the noise factor 10^(NFmin/10), GammaOpt as a complex value and Rn
      // in ohms; their imaginary parts carry nothing and are not written.
      const float factor = nf.GetData()[i].re;
      out.NoiseNumber(NoiseFigureDb(factor), factor);
      out.Pair(gamma.GetData()[i], SNP_MA);
      const float ohms = rn.GetData()[i].re;
      out.NoiseNumber(NormalisedResistance(ohms, m_reference), ohms);
      out.EndLine();
    }
  }
  if (v2) out.Line("[End]");
  out.Flush();
  return out.Result();
}

}  // namespace LumenUtility
