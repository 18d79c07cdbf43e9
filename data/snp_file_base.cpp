#include "lumen/data/snp_file_base.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <cwchar>
#include <memory>
#include <utility>
#include <string>

#include "data/touchstone_parser.h"
#include "lumen/data/snp_trace_names.h"
#include "lumen/platform/text_conversion.h"

using LumenUtility::InputArray;

namespace {

// Reads a descriptor in chunks, retrying reads a signal interrupted.
class DescriptorSource : public LumenUtility::TouchstoneSource {
 public:
  explicit DescriptorSource(int fd) : m_fd(fd) {}
  std::size_t Read(char* buffer, std::size_t capacity) override {
    for (;;) {
      const ssize_t got = ::read(m_fd, buffer, capacity);
      if (got >= 0) return static_cast<std::size_t>(got);
      if (errno != EINTR) {
        throw LumenUtility::TouchstoneScanError(std::string("the file cannot be read: ") +
                                                std::strerror(errno));
      }
    }
  }

 private:
  int m_fd;
};

// Index of the stored pair that holds matrix position (row, column), both from 1, in a
// triangular layout of n ports; the other triangle mirrors the stored one.
int TriangleIndex(SnPMatrixFormat format, int n, int row, int column) {
  if (format == SNP_MATRIX_LOWER) {
    return column <= row ? (row - 1) * row / 2 + column - 1 : (column - 1) * column / 2 + row - 1;
  }
  return row <= column ? (row - 1) * n - row * (row - 1) / 2 + column - 1
                       : (column - 1) * n - column * (column - 1) / 2 + row - 1;
}

}  // namespace

CSnPFileBase::CSnPFileBase(int ports)
    : CSNParameterS(static_cast<SNPType>(ports)), m_constructedPorts(ports) {}

int CSnPFileBase::ReadSNPFile(const std::wstring& path) {
  const std::string narrowPath = LumenUtility::WideToUtf8(path);
  const int fd = ::open(narrowPath.c_str(), O_RDONLY | O_CLOEXEC);
  if (fd < 0) {
    m_readError = L"cannot open the file: " + LumenUtility::Utf8ToWide(std::strerror(errno));
    return -1;
  }
  const int points = ReadSNPDescriptor(fd);
  ::close(fd);
  return points;
}

int CSnPFileBase::ReadSNPDescriptor(int fd) {
  DescriptorSource source(fd);
  LumenUtility::TouchstoneParser parser(source, static_cast<int>(GetSNPType()));
  return ReadParsed(parser);
}

int CSnPFileBase::ReadSNPText(std::string_view text) {
  LumenUtility::TouchstoneParser parser(text, static_cast<int>(GetSNPType()));
  return ReadParsed(parser);
}

int CSnPFileBase::ReadParsed(LumenUtility::TouchstoneParser& parser) {
  LumenUtility::TouchstoneContent content;
  if (!parser.Parse(content)) {
    m_readError = LumenUtility::Utf8ToWide(parser.Error());
    return -1;
  }
  const int n = content.ports;
  if (n != static_cast<int>(m_ports)) {
    m_ports = static_cast<SNPType>(n);
    m_constructedPorts = n;
    m_params.assign(static_cast<std::size_t>(n) * static_cast<std::size_t>(n), CSNParameter());
  }
  m_twoPortOrder21 = content.twoPortOrder21;
  if (content.resultTypeGiven) m_resultType = content.resultType;
  m_info = std::move(content.info);
  m_info.pointLines = std::move(content.pointLines);
  m_readError.clear();

  const InputArray stimulus(content.stimulus);
  const std::size_t points = content.stimulus.size();
  const bool noise = m_info.noisePoints > 0;
  const wchar_t* prefix = noise ? L"Noise Figure Cold Source:" : L"";

  // Noise traces of an earlier read describe another file: they go, whether or not this file
  // brings its own.
  m_customParams.clear();
  if (noise) {
    static const wchar_t* const kNoiseNames[3] = {L"NFmin", L"GammaOpt", L"Rn"};
    static const ESNPForm kNoiseForms[3] = {SNP_DB, SNP_MA, SNP_RI};
    // On the noise records' own frequencies: a noise record measured at 1.5 GHz is not
    // the network point that happens to share its index.
    const InputArray noiseStimulus(content.noiseStimulus);
    const std::size_t records = content.noiseStimulus.size();
    for (int t = 0; t < 3; ++t) {
      CSNParameter trace(noiseStimulus);
      trace.SetStimulus(noiseStimulus);
      for (std::size_t i = 0; i < records; ++i) {
        const float* record = &content.noise[4 * i];
        const float a = t == 0 ? record[0] : t == 1 ? record[1] : record[3];
        const float b = t == 1 ? record[2] : 0.0f;
        trace.GetData()[i] = CSNParameter::FromPair(a, b, kNoiseForms[t]);
      }
      trace.SetName(std::wstring(prefix) + kNoiseNames[t]);
      m_customParams.push_back(std::move(trace));
    }
  }

  const std::size_t pairs = static_cast<std::size_t>(content.pairsPerPoint);
  const SnPMatrixFormat format = m_info.matrixFormat;
  for (int k = 0; k < n * n; ++k) {
    const int row = k / n + 1;
    const int column = k % n + 1;
    const std::size_t source =
        format == SNP_MATRIX_FULL ? static_cast<std::size_t>(k)
                                  : static_cast<std::size_t>(TriangleIndex(format, n, row, column));
    CSNParameter trace(stimulus);
    trace.SetStimulus(stimulus);
    std::vector<LumenUtility::TsComplex>& data = trace.GetData();
    // Indexed rather than walked by pointer: with no points the value array is empty, and
    // even forming data() + offset on it is undefined.
    for (std::size_t i = 0; i < points; ++i) {
      const std::size_t at = 2 * (source + i * pairs);
      data[i] =
          CSNParameter::FromPair(content.values[at], content.values[at + 1], m_info.form);
    }
    // Named after the matrix position the trace lands in (for a two-port file in 11, 21,
    // 12, 22 order the second pair read is S21).
    const int position = LoopIndex(k);
    trace.SetName(prefix + LumenUtility::Utf8ToWide(SnPTraceName(position / n + 1, position % n + 1)));
    GetLoopParam(k) = std::move(trace);
  }
  return static_cast<int>(points);
}

std::wstring SnPUnitName(const std::string& unitToken) {
  static const std::pair<const char*, const wchar_t*> kNames[] = {
      {"HZ", L"Hz"},  {"KHZ", L"kHz"}, {"MHZ", L"MHz"},          {"GHZ", L"GHz"},
      {"SEC", L"s"}, {"DBM", L"dBm"}, {"POINT", L"point numbers"}};
  for (const auto& [token, name] : kNames) {
    if (unitToken == token) return name;
  }
  return LumenUtility::Utf8ToWide(unitToken);
}

int SnPPortCountFromFileName(const std::wstring& path) {
  const std::size_t dot = path.rfind(L'.');
  if (dot == std::wstring::npos) return -1;
  const std::wstring extension = path.substr(dot + 1);
  if (extension.size() < 3 || extension.size() > 5) return -1;
  if ((extension.front() != L's' && extension.front() != L'S') ||
      (extension.back() != L'p' && extension.back() != L'P')) {
    return -1;
  }
  int ports = 0;
  for (std::size_t i = 1; i + 1 < extension.size(); ++i) {
    if (extension[i] < L'0' || extension[i] > L'9') return -1;
    ports = ports * 10 + (extension[i] - L'0');
  }
  return ports >= 1 && ports <= CSnPFileBase::kMaxPorts ? ports : -1;
}
