#include "lumenutil/snp_file.h"

#include <unistd.h>

#include <charconv>
#include <cmath>
#include <cstdio>
#include <iostream>
#include <sstream>
#include <stdexcept>

#include "lumen/core.h"
#include "lumen/platform.h"

namespace lumenutil {

CSnPFileBase ReadTouchstone(const std::string& path, int ports) {
  const bool standardInput = path == "-";
  const std::string name = standardInput ? "standard input" : path;
  const std::wstring widePath = LumenUtility::Utf8ToWide(path);
  if (ports <= 0 && !standardInput) ports = SnPPortCountFromFileName(widePath);
  if (ports <= 0) ports = 2;
  if (ports > CSnPFileBase::kMaxPorts) {
    throw std::runtime_error(name + ": " + std::to_string(ports) + " ports are too many");
  }
  CSnPFileBase file(ports);
  const int points =
      standardInput ? file.ReadSNPDescriptor(STDIN_FILENO) : file.ReadSNPFile(widePath);
  if (points < 0) {
    throw std::runtime_error(name + ": " + LumenUtility::WideToUtf8(file.GetReadError()));
  }
  for (const std::string& token : file.GetFileInfo().ignoredOptions) {
    std::cerr << "lumenutil: warning: " << name << ": " << IgnoredOptionText(token, file)
              << '\n';
  }
  return file;
}

std::string IgnoredOptionText(const std::string& token, const CSnPFileBase& file) {
  const SnPFileInfo& info = file.GetFileInfo();
  const std::string unit = LumenUtility::WideToUtf8(SnPUnitName(info.stimulusUnit));
  const std::string text = "option '" + token + "' ignored; ";
  const bool unitLike = token.size() > 2 && token.compare(token.size() - 2, 2, "HZ") == 0;
  if (unitLike) return text + "frequencies read in " + unit;
  const char* form = info.form == SNP_RI ? "RI" : info.form == SNP_DB ? "DB" : "MA";
  return text + "the file is read as " + unit + ", " + info.parameter + "-parameters, " + form +
         ", R " + Shortest(info.referenceResistance);
}

bool IsUsableResistance(double ohms) {
  return std::isfinite(ohms) && ohms > 0;
}

double PortReference(const CSnPFileBase& file, int port, const std::string& path) {
  const SnPFileInfo& info = file.GetFileInfo();
  const bool perPort = static_cast<int>(info.portReferences.size()) >= port;
  const double ohms = perPort ? info.portReferences[port - 1] : info.referenceResistance;
  if (!IsUsableResistance(ohms)) {
    throw std::runtime_error(path + ": the reference resistance of port " + std::to_string(port) +
                             " is " + Shortest(ohms) +
                             " ohm, which is not usable: impedances and admittances need a "
                             "resistance above 0");
  }
  return ohms;
}

void RequireAscendingStimulus(const CSnPFileBase& file, const std::string& path) {
  const LumenUtility::InputArray& stimulus = file.GetParam(SNP_S11).GetStimulus();
  const std::vector<int>& lines = file.GetFileInfo().pointLines;
  const std::vector<double> x = stimulus.GetArray();
  const StimulusAxis axis = AxisOf(file.GetResultType());
  for (std::size_t i = 1; i < x.size(); ++i) {
    if (x[i] > x[i - 1]) continue;
    const std::string where =
        i < lines.size() ? "line " + std::to_string(lines[i]) : "point " + std::to_string(i + 1);
    throw std::runtime_error(path + ": " + where + ": " + WithUnit(x[i], axis.unit, axis.siPrefix) +
                             " does not ascend from " +
                             WithUnit(x[i - 1], axis.unit, axis.siPrefix) +
                             " before it; interpolating needs strictly ascending " +
                             (axis.quantity == "Frequency" ? "frequencies" : "stimulus values"));
  }
}

namespace {

MatrixPosition ParsePosition(const std::string& text, int ports) {
  const auto fail = [&](const std::string& why) {
    return std::runtime_error("'" + text + "' " + why);
  };
  int row = 0, column = 0;
  if (!SnPParseTraceName(text, row, column)) {
    throw fail("is not a parameter name such as S21 or S1_10");
  }
  if (row < 1 || column < 1 || row > ports || column > ports) {
    throw fail("is not a parameter of a " + std::to_string(ports) + "-port network");
  }
  return {row, column, SnPTraceName(row, column)};
}

}  // namespace

std::vector<MatrixPosition> SelectPositions(const std::string& list, const CSnPFileBase& file) {
  const int n = file.GetSNPType();
  std::vector<MatrixPosition> positions;
  if (list.empty()) {
    for (int k = 0; k < n * n; ++k) {
      const int index = static_cast<int>(&file.GetLoopParam(k) - &file.GetParam(SNP_S11));
      positions.push_back(
          {index / n + 1, index % n + 1, SnPTraceName(index / n + 1, index % n + 1)});
    }
    return positions;
  }
  std::stringstream items(list);
  std::string item;
  while (std::getline(items, item, ',')) {
    if (!item.empty()) positions.push_back(ParsePosition(item, n));
  }
  if (positions.empty()) throw std::runtime_error("no parameter named in '" + list + "'");
  return positions;
}

const CSNParameter& TraceAt(const CSnPFileBase& file, const MatrixPosition& position) {
  const int n = file.GetSNPType();
  return file.GetParam(static_cast<ESNParam>(SnPMatrixIndex(n, position.row, position.column)));
}

std::string Shortest(double value) {
  char text[64];
  const std::to_chars_result r = std::to_chars(text, text + sizeof text, value);
  return std::string(text, r.ptr);
}

std::string Shortest(float value) {
  char text[64];
  const std::to_chars_result r = std::to_chars(text, text + sizeof text, value);
  return std::string(text, r.ptr);
}

StimulusAxis AxisOf(ResultType type) {
  switch (type) {
    case RESULT_SEC:
      return {"Time", "s", "time_s", true, "SEC"};
    case RESULT_DBM:
      return {"Power", "dBm", "power_dBm", false, "DBM"};
    case RESULT_POINT:
      return {"Point", "", "point", false, "POINT"};
    default:
      return {"Frequency", "Hz", "frequency_Hz", true, "HZ"};
  }
}

std::string WithUnit(double value, const std::string& unit, bool siPrefix, int digits) {
  double scale = 1.0;
  char prefix = ' ';
  if (siPrefix) LumenUtility::GetSIPrefix(value, scale, prefix, 24, -24);
  char number[64];
  std::snprintf(number, sizeof number, "%.*g", digits, value * scale);
  std::string text = number;
  if (prefix == static_cast<char>(0xB5)) {
    text += " \xC2\xB5";  // micro, as UTF-8
  } else if (prefix != ' ') {
    text += std::string(" ") + prefix;
  } else if (!unit.empty()) {
    text += ' ';
  }
  return text + unit;
}

std::string Rounded(double value, int digits) {
  char text[32];
  std::snprintf(text, sizeof text, "%.*g", digits, value);
  return text;
}

std::string LowerAscii(std::string text) {
  for (char& c : text) {
    if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
  }
  return text;
}

}  // namespace lumenutil
