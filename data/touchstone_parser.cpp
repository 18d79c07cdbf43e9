#include "data/touchstone_parser.h"

#include <cmath>
#include <cstdio>
#include <string>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

// A comment holding this text (in any case) announces noise data in a version 1 file.
constexpr std::string_view kNoiseMarker = "Noise Parameters";

// Length of the well-formed UTF-8 sequence at the start of `text`, or 0.
std::size_t Utf8SequenceLength(std::string_view text) {
  const auto lead = static_cast<unsigned char>(text[0]);
  const std::size_t length = lead >= 0xF0 && lead <= 0xF4   ? 4
                             : lead >= 0xE0                 ? 3
                             : lead >= 0xC2 && lead <= 0xDF ? 2
                                                            : 0;
  if (length == 0 || length > text.size()) return 0;
  for (std::size_t i = 1; i < length; ++i) {
    if ((static_cast<unsigned char>(text[i]) & 0xC0) != 0x80) return 0;
  }
  return length;
}

std::string Quote(std::string_view token) {
  // Long tokens are cut: an error message names the culprit, it does not reprint the file.
  // Control bytes and bytes that are not UTF-8 are shown as \xNN, so a NUL or an escape
  // sequence reaches the reader of the message as text.
  constexpr std::size_t kShown = 40;
  std::string text = "'";
  const std::string_view shown = token.substr(0, kShown);
  for (std::size_t i = 0; i < shown.size();) {
    const auto byte = static_cast<unsigned char>(shown[i]);
    const std::size_t sequence = byte >= 0x80 ? Utf8SequenceLength(shown.substr(i)) : 0;
    if (sequence > 0) {
      text.append(shown.substr(i, sequence));
      i += sequence;
      continue;
    }
    if (byte < 0x20 || byte >= 0x7F) {
      static const char kHex[] = "0123456789ABCDEF";
      text += "\\x";
      text += kHex[byte >> 4];
      text += kHex[byte & 0xF];
    } else {
      text += shown[i];
    }
    ++i;
  }
  if (token.size() > kShown) text += "...";
  return text + "'";
}

}  // namespace

TouchstoneParser::TouchstoneParser(std::string_view text, int ports)
    : m_ports(ports), m_scanner(text) {}

TouchstoneParser::TouchstoneParser(TouchstoneSource& source, int ports)
    : m_ports(ports), m_scanner(source) {}

bool TouchstoneParser::Fail(const std::string& message) {
  return FailAtLine(m_scanner.Line(), message);
}

bool TouchstoneParser::FailAtLine(int line, const std::string& message) {
  m_error = "line " + std::to_string(line) + ": " + message;
  if (m_frequencyDropLine > 0) {
    // The usual cause: the noise records of a two-port file, read as more network data.
    m_error += " (the frequency drops at line " + std::to_string(m_frequencyDropLine) +
               "; noise data there needs a '! Noise Parameters' comment before it)";
  }
  return false;
}

bool TouchstoneParser::Parse(TouchstoneContent& content) {
  content = TouchstoneContent();
  content.ports = m_ports;
  m_content = &content;
  if (m_ports < 1 || m_ports > CSnPFileBase::kMaxPorts) {
    return FailAtLine(0, "a network of " + std::to_string(m_ports) + " ports is not read");
  }
  try {
    return ReadByteOrderMark() && ReadVersionAndOptionLine() && ReadKeywords() &&
           ReadNetworkData();
  } catch (const TouchstoneScanError& e) {
    m_error = e.what();
    return false;
  }
}

bool TouchstoneParser::ReadByteOrderMark() {
  const std::string_view start = m_scanner.Peek(3);
  if (start.empty()) return true;
  const auto first = static_cast<unsigned char>(start[0]);
  if (first == 0xFF || first == 0xFE) {
    return FailAtLine(1, "UTF-16 text is not read; save the file as UTF-8 or ASCII");
  }
  if (first != 0xEF) return true;
  if (start != "\xEF\xBB\xBF") {
    return FailAtLine(1, "the file starts with a broken UTF-8 byte-order mark");
  }
  m_scanner.Skip(3);
  return true;
}

bool TouchstoneParser::ReadVersionAndOptionLine() {
  TouchstoneContent& c = *m_content;
  c.info.version = 1;
  char first = m_scanner.PeekLineStart();
  if (first == '[') {
    std::string name;
    if (!m_scanner.ReadKeyword(name)) return Fail("keyword without a closing ']'");
    if (name != "VERSION") {
      return Fail("[" + name + "] before the option line; only [Version] may stand there");
    }
    const std::string_view value = m_scanner.NextToken();
    if (value != "2.0") return Fail("[Version] " + Quote(value) + " is not read; only 2.0 is");
    c.info.version = 2;
    m_scanner.SkipLine();
    first = m_scanner.PeekLineStart();
  }
  if (first != '#') return Fail("the option line (starting with '#') is missing");
  m_optionLine = m_scanner.Line();
  std::string_view line = m_scanner.RestOfLine();
  line.remove_prefix(1);
  if (!ReadOptionLine(line)) return false;
  if (c.info.version == 2 && m_scanner.PeekLineStart() == '[') {
    std::string name;
    if (!m_scanner.ReadKeyword(name)) return Fail("keyword without a closing ']'");
    if (name != "NUMBER OF PORTS") {
      return Fail("[" + name + "] where [Number of Ports] must follow the option line");
    }
    int ports = 0;
    if (!KeywordInteger("Number of Ports", ports)) return false;
    if (ports < 1 || ports > CSnPFileBase::kMaxPorts) {
      return Fail("[Number of Ports] " + std::to_string(ports) + " is outside 1 to " +
                  std::to_string(CSnPFileBase::kMaxPorts));
    }
    c.ports = ports;
    m_scanner.SkipToKeywordLine();
  }
  return true;
}

bool TouchstoneParser::ReadOptionLine(std::string_view line) {
  SnPFileInfo& info = m_content->info;
  // A comment may close the option line; its words are not options.
  line = line.substr(0, line.find('!'));
  TouchstoneScanner tokens(line);
  for (std::string_view token = tokens.NextToken(); !token.empty(); token = tokens.NextToken()) {
    const std::string option = ToUpperAscii(token);
    if (option == "HZ" || option == "KHZ" || option == "MHZ" || option == "GHZ") {
      info.stimulusUnit = option;
      info.stimulusMultiplier = option == "HZ"    ? 1.0
                                : option == "KHZ" ? 1e3
                                : option == "MHZ" ? 1e6
                                                  : 1e9;
    } else if (option == "SEC" || option == "DBM" || option == "POINT") {
      info.stimulusUnit = option;
      info.stimulusMultiplier = 1.0;
      m_content->resultTypeGiven = true;
      m_content->resultType = option == "SEC"   ? RESULT_SEC
                              : option == "DBM" ? RESULT_DBM
                                                : RESULT_POINT;
    } else if (option == "S" || option == "Y" || option == "Z" || option == "H" || option == "G") {
      info.parameter = option[0];
    } else if (option == "RI" || option == "MA" || option == "DB") {
      info.form = option == "RI" ? SNP_RI : option == "MA" ? SNP_MA : SNP_DB;
    } else if (option == "R") {
      // Some exporters write a bare R and give per-frequency impedances in comments: the
      // default of 50 ohms then stands.
      const std::string_view value = tokens.NextToken();
      if (value.empty()) continue;
      if (value.front() == '(' || value.find_first_of("jJ") != std::string_view::npos) {
        return FailAtLine(m_optionLine, "option R " + Quote(value) +
                                            ": complex reference impedances are not supported");
      }
      if (!ParseStreamDouble(value, info.referenceResistance)) {
        return FailAtLine(m_optionLine,
                          "option R needs a reference resistance, not " + Quote(value));
      }
      info.referenceResistanceGiven = true;
    } else {
      info.ignoredOptions.push_back(option);
    }
  }
  return true;
}

bool TouchstoneParser::KeywordInteger(const std::string& name, int& value) {
  const std::string_view token = m_scanner.NextToken();
  if (!ParseStreamIntPrefix(token, value)) {
    return Fail("[" + name + "] needs a whole number, not " + Quote(token));
  }
  return true;
}

bool TouchstoneParser::ReadKeywords() {
  while (m_scanner.PeekLineStart(kNoiseMarker, &m_noiseMarked) == '[') {
    std::string name;
    if (!m_scanner.ReadKeyword(name)) return Fail("keyword without a closing ']'");
    if (name == "NETWORK DATA") {
      m_scanner.SkipLine();
      return true;
    }
    if (!ReadKeywordValue(name)) return false;
    if (!m_scanner.SkipToKeywordLine()) return true;
  }
  return true;
}

bool TouchstoneParser::ReadKeywordValue(const std::string& name) {
  TouchstoneContent& c = *m_content;
  if (name == "TWO-PORT DATA ORDER" || name == "TWO-PORT ORDER") {
    c.twoPortOrder21 = m_scanner.NextToken() != "12_21";
  } else if (name == "NUMBER OF FREQUENCIES") {
    int count = 0;
    if (!KeywordInteger("Number of Frequencies", count)) return false;
    if (count < 1) return Fail("[Number of Frequencies] must be at least 1");
    c.info.declaredFrequencies = count;
  } else if (name == "NUMBER OF NOISE FREQUENCIES") {
    int count = 0;
    if (!KeywordInteger("Number of Noise Frequencies", count)) return false;
  } else if (name == "REFERENCE") {
    c.info.portReferences.clear();
    for (int port = 0; port < c.ports; ++port) {
      // Simulators write one value per line, each followed by a comment naming its port.
      const std::string_view token = m_scanner.NextValueToken();
      double ohms = 0.0;
      if (!ParseStreamDouble(token, ohms)) {
        return Fail("[Reference] needs one resistance per port, not " + Quote(token));
      }
      c.info.portReferences.push_back(ohms);
    }
  } else if (name == "MATRIX FORMAT") {
    const std::string layout = ToUpperAscii(m_scanner.NextToken());
    c.info.matrixFormat = layout == "LOWER"   ? SNP_MATRIX_LOWER
                          : layout == "UPPER" ? SNP_MATRIX_UPPER
                                              : SNP_MATRIX_FULL;
  }
  return true;
}

bool TouchstoneParser::ReadRecordValues(int count, int recordLine, const char* what,
                                        std::vector<float>& out) {
  for (int read = 0; read < count;) {
    const std::string_view token = m_scanner.NextValueToken();
    if (token.empty()) {
      return Fail(std::string("the file ends inside the ") + what + " that starts at line " +
                  std::to_string(recordLine) + ": " + std::to_string(count) + " values expected, " +
                  std::to_string(read) + " found");
    }
    float value = 0.0f;
    if (!ParseStreamFloat(token, value)) {
      double wide = 0.0;
      const char* problem = ParseStreamDouble(token, wide) || IsBeyondDouble(token)
                                ? " is beyond the range of a single-precision value"
                                : " is not a number";
      return Fail(Quote(token) + problem + " (in the " + what + " that starts at line " +
                  std::to_string(recordLine) + ")");
    }
    out.push_back(value);
    ++read;
  }
  return true;
}

bool TouchstoneParser::ReadNetworkData() {
  TouchstoneContent& c = *m_content;
  const bool triangle = c.info.matrixFormat != SNP_MATRIX_FULL;
  const long long n = c.ports;
  c.pairsPerPoint = static_cast<int>(triangle ? n * (n + 1) / 2 : n * n);
  const int valuesPerPoint = 2 * c.pairsPerPoint;
  for (;;) {
    const std::string_view token = m_scanner.NextValueToken(kNoiseMarker, &m_noiseMarked);
    if (token.empty()) return RequireDeclaredPoints();
    if (token.front() == '[') return RequireDeclaredPoints() && ReadDataKeyword(token);
    double stimulus = 0.0;
    if (!ReadStimulus(token, "a stimulus value", stimulus)) return false;
    const bool drop = !c.stimulus.empty() && stimulus <= c.stimulus.back();
    if (c.ports == 2 && m_noiseMarked && drop) {
      if (!RequireDeclaredPoints()) return false;
      return ReadNoiseData(true, stimulus);
    }
    const int line = m_scanner.Line();
    if (drop && c.ports == 2 && c.info.version == 1 && m_frequencyDropLine == 0) {
      m_frequencyDropLine = line;
    }
    const std::size_t first = c.values.size();
    if (!ReadRecordValues(valuesPerPoint, line, "data point", c.values)) return false;
    if (c.info.form == SNP_DB && !CheckDecibels(first, line)) return false;
    c.stimulus.push_back(stimulus);
    c.pointLines.push_back(line);
    if (c.info.declaredFrequencies > 0 &&
        c.stimulus.size() == static_cast<std::size_t>(c.info.declaredFrequencies)) {
      return ReadAfterDeclaredPoints();
    }
  }
}

bool TouchstoneParser::ReadStimulus(std::string_view token, const char* what, double& value) {
  if (!ParseStreamDouble(token, value)) {
    return Fail(Quote(token) + (IsBeyondDouble(token) ? " is beyond the range of a number ("
                                                      : " is not a number (") +
                what + " was expected)");
  }
  value *= m_content->info.stimulusMultiplier;
  if (!std::isfinite(value)) {
    return Fail(Quote(token) + " " + WideToUtf8(SnPUnitName(m_content->info.stimulusUnit)) +
                " is beyond the range of a stimulus value");
  }
  return true;
}

bool TouchstoneParser::CheckDecibels(std::size_t first, int line) {
  // 10^(dB/20) passes the largest float (3.4e38) above 770.6 dB.
  const std::vector<float>& values = m_content->values;
  for (std::size_t i = first; i < values.size(); i += 2) {
    if (values[i] <= 770.0f) continue;
    const TsComplex value = CSNParameter::FromPair(values[i], values[i + 1], SNP_DB);
    if (!(std::isfinite(value.re) && std::isfinite(value.im))) {
      char text[32];
      std::snprintf(text, sizeof text, "%g", values[i]);
      return FailAtLine(line, std::string("'") + text +
                                  "' dB in this data point is beyond the range of a "
                                  "single-precision value");
    }
  }
  return true;
}

bool TouchstoneParser::RequireDeclaredPoints() {
  const TouchstoneContent& c = *m_content;
  const std::size_t declared = static_cast<std::size_t>(c.info.declaredFrequencies);
  if (declared == 0 || c.stimulus.size() >= declared) return true;
  return Fail("[Number of Frequencies] declares " + std::to_string(declared) +
              " points, but the network data holds " + std::to_string(c.stimulus.size()) +
              ": the file is truncated");
}

bool TouchstoneParser::ReadAfterDeclaredPoints() {
  // Points past the declared count are not read; a [Noise Data] section still is.
  const std::string_view token = m_scanner.NextValueToken();
  if (token.empty()) return true;
  if (token.front() != '[') {
    m_content->info.extraPointsIgnored = true;
    return true;
  }
  return ReadDataKeyword(token);
}

bool TouchstoneParser::ReadDataKeyword(std::string_view token) {
  m_scanner.Rewind(token);
  std::string name;
  if (!m_scanner.ReadKeyword(name)) return Fail("keyword without a closing ']'");
  if (name == "END") return true;
  if (name == "NOISE DATA") {
    m_scanner.SkipLine();
    return ReadNoiseData(false);
  }
  return Fail("[" + name + "] is not expected among the data");
}

bool TouchstoneParser::ReadNoiseData(bool haveFirst, double first) {
  TouchstoneContent& c = *m_content;
  if (c.ports != 2) return Fail("noise data is only read for two-port networks");
  bool haveStimulus = haveFirst;
  double stimulus = first;
  for (;;) {
    if (!haveStimulus) {
      const std::string_view token = m_scanner.NextValueToken();
      if (token.empty()) return true;
      if (token.front() == '[') {
        m_scanner.Rewind(token);
        std::string name;
        if (m_scanner.ReadKeyword(name) && name == "END") return true;
        return Fail(Quote(token) + " is not expected among the noise data");
      }
      if (!ReadStimulus(token, "a noise stimulus value", stimulus)) return false;
    }
    haveStimulus = false;
    const std::size_t start = c.noise.size();
    const int line = m_scanner.Line();
    if (!ReadRecordValues(4, line, "noise record", c.noise)) return false;
    c.noise[start] *= 2.0f;
    c.noise[start + 3] = static_cast<float>(c.noise[start + 3] * c.info.referenceResistance);
    if (!std::isfinite(c.noise[start]) || !std::isfinite(c.noise[start + 3])) {
      return FailAtLine(line, "the noise record is beyond the range of single-precision values");
    }
    c.noiseStimulus.push_back(stimulus);
    ++c.info.noisePoints;
  }
}

}  // namespace LumenUtility
