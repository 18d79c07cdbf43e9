#include "data/touchstone_parser.h"

#include <string>

namespace LumenUtility {
namespace {

// A comment holding this text (case as written) announces noise data in a version 1 file.
constexpr std::string_view kNoiseMarker = "Noise Parameters";

std::string Quote(std::string_view token) {
  // Long tokens are cut: an error message names the culprit, it does not reprint the file.
  constexpr std::size_t kShown = 40;
  std::string text = "'" + std::string(token.substr(0, kShown));
  if (token.size() > kShown) text += "...";
  return text + "'";
}

}  // namespace

TouchstoneParser::TouchstoneParser(std::string_view text, int ports)
    : m_text(text), m_ports(ports), m_scanner(text) {}

bool TouchstoneParser::Fail(const std::string& message) {
  return FailAtLine(m_scanner.Line(), message);
}

bool TouchstoneParser::FailAtLine(int line, const std::string& message) {
  m_error = "line " + std::to_string(line) + ": " + message;
  return false;
}

bool TouchstoneParser::Parse(TouchstoneContent& content) {
  content = TouchstoneContent();
  content.ports = m_ports;
  m_content = &content;
  if (m_ports < 1 || m_ports > CSnPFileBase::kMaxPorts) {
    return FailAtLine(0, "a network of " + std::to_string(m_ports) + " ports is not read");
  }
  return ReadByteOrderMark() && ReadVersionAndOptionLine() && ReadKeywords() && ReadNetworkData();
}

bool TouchstoneParser::ReadByteOrderMark() {
  if (m_text.empty()) return true;
  const auto first = static_cast<unsigned char>(m_text[0]);
  if (first == 0xFF || first == 0xFE) {
    return FailAtLine(1, "UTF-16 text is not read; save the file as UTF-8 or ASCII");
  }
  if (first != 0xEF) return true;
  if (m_text.size() < 3 || static_cast<unsigned char>(m_text[1]) != 0xBB ||
      static_cast<unsigned char>(m_text[2]) != 0xBF) {
    return FailAtLine(1, "the file starts with a broken UTF-8 byte-order mark");
  }
  m_scanner = TouchstoneScanner(m_text.substr(3));
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
      const std::string_view value = tokens.NextToken();
      if (value.empty() || !ParseStreamDouble(value, info.referenceResistance)) {
        return Fail("option R needs a reference resistance, not " + Quote(value));
      }
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
      const std::string_view token = m_scanner.NextToken();
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
      return Fail(Quote(token) + " is not a number (in the " + what + " that starts at line " +
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
    if (token.empty()) return true;
    if (token.front() == '[') return ReadDataKeyword(token);
    double stimulus = 0.0;
    if (!ParseStreamDouble(token, stimulus)) {
      return Fail(Quote(token) + " is not a number (a stimulus value was expected)");
    }
    stimulus *= c.info.stimulusMultiplier;
    if (c.ports == 2 && m_noiseMarked && !c.stimulus.empty() && stimulus <= c.stimulus.back()) {
      return ReadNoiseData(true, stimulus);
    }
    if (!ReadRecordValues(valuesPerPoint, m_scanner.Line(), "data point", c.values)) {
      return false;
    }
    c.stimulus.push_back(stimulus);
    if (c.info.declaredFrequencies > 0 &&
        c.stimulus.size() == static_cast<std::size_t>(c.info.declaredFrequencies)) {
      return ReadAfterDeclaredPoints();
    }
  }
}

bool TouchstoneParser::ReadAfterDeclaredPoints() {
  // Points past the declared count are not read; a [Noise Data] section still is.
  const std::string_view token = m_scanner.NextValueToken();
  if (token.empty() || token.front() != '[') return true;
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
      if (!ParseStreamDouble(token, stimulus)) {
        return Fail(Quote(token) + " is not a number (a noise stimulus value was expected)");
      }
      stimulus *= c.info.stimulusMultiplier;
    }
    haveStimulus = false;
    const std::size_t start = c.noise.size();
    if (!ReadRecordValues(4, m_scanner.Line(), "noise record", c.noise)) return false;
    c.noise[start] *= 2.0f;
    c.noise[start + 3] = static_cast<float>(c.noise[start + 3] * c.info.referenceResistance);
    c.noiseStimulus.push_back(stimulus);
    ++c.info.noisePoints;
  }
}

}  // namespace LumenUtility
