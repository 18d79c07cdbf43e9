// TouchstoneParser: turns the text of a Touchstone file (version 1 or 2.0) into its
// stimulus values and raw value pairs, ready to become traces.
//
// Thread-safety: one thread per object.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "data/touchstone_scanner.h"
#include "lumen/data/snp_file_base.h"

namespace LumenUtility {

// What a file holds, before conversion into traces.
struct TouchstoneContent {
  int ports = 2;
  bool twoPortOrder21 = true;    // pairs 11, 21, 12, 22 in a two-port file
  bool resultTypeGiven = false;  // the option line named SEC, DBM or POINT
  ResultType resultType = RESULT_FREQUENCY;
  SnPFileInfo info;
  int pairsPerPoint = 0;
  std::vector<double> stimulus;  // scaled to Hz (or the file's own unit), one per point
  std::vector<int> pointLines;   // line of each point's stimulus value, from 1
  std::vector<float> values;     // pairsPerPoint (a, b) pairs per point, in file order
  std::vector<float> noise;      // per noise record: 2*NFmin dB, |GammaOpt|, angle deg, Rn ohms
  std::vector<double> noiseStimulus;  // scaled like `stimulus`, one per noise record
};

class TouchstoneParser {
 public:
  // `ports`: the port count of version 1 files (version 2 files name their own). The text,
  // or the source, must outlive the parser.
  TouchstoneParser(std::string_view text, int ports);
  TouchstoneParser(TouchstoneSource& source, int ports);

  // Fills `content`; false on malformed text, with Error() saying what and where.
  bool Parse(TouchstoneContent& content);
  const std::string& Error() const { return m_error; }

 private:
  bool Fail(const std::string& message);
  bool FailAtLine(int line, const std::string& message);
  bool ReadByteOrderMark();
  bool ReadVersionAndOptionLine();
  bool ReadOptionLine(std::string_view line);
  bool ReadKeywords();
  bool ReadKeywordValue(const std::string& name);
  bool ReadNetworkData();
  bool ReadAfterDeclaredPoints();
  // Reads a stimulus value scaled to Hz (or the file's own unit); false, naming `what` was
  // expected, for a token that is not a number or a value beyond the range of a double.
  bool ReadStimulus(std::string_view token, const char* what, double& value);
  // False when a dB value of the record whose values start at `first` gives a magnitude
  // beyond the range of a float.
  bool CheckDecibels(std::size_t first, int line);
  // False when the network data ended before the count [Number of Frequencies] declares.
  bool RequireDeclaredPoints();
  // With `token` a keyword among the data: reads [End], or the [Noise Data] section that
  // follows its keyword, either of which ends the data; false for any other keyword.
  bool ReadDataKeyword(std::string_view token);
  // Reads noise records; with `haveFirst` the stimulus of the first record has already been
  // read, as `first` (scaled).
  bool ReadNoiseData(bool haveFirst, double first = 0.0);
  // Reads `count` values of one record into `out`, skipping comments; `what` names the
  // record for errors.
  bool ReadRecordValues(int count, int recordLine, const char* what, std::vector<float>& out);
  bool KeywordInteger(const std::string& name, int& value);

  int m_ports;
  TouchstoneScanner m_scanner;
  TouchstoneContent* m_content = nullptr;
  std::string m_error;
  // A "Noise Parameters" comment was met after the option line: a two-port file's data may
  // end in noise records.
  bool m_noiseMarked = false;
  // Line of the first point of a two-port version 1 file whose frequency is not above the
  // one before (0 while there is none): failures after it add a hint on noise data.
  int m_frequencyDropLine = 0;
  int m_optionLine = 0;  // line of the option line, for its errors
};

}  // namespace LumenUtility
