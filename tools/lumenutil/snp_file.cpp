#include "lumenutil/snp_file.h"

#include <charconv>
#include <cmath>
#include <cstdio>
#include <sstream>
#include <stdexcept>

#include "lumen/core.h"
#include "lumen/platform.h"

namespace lumenutil {

CSnPFileBase ReadTouchstone(const std::string& path, int ports) {
  const std::wstring widePath = LumenUtility::Utf8ToWide(path);
  if (ports <= 0) ports = SnPPortCountFromFileName(widePath);
  if (ports <= 0) ports = 2;
  if (ports > CSnPFileBase::kMaxPorts) {
    throw std::runtime_error(path + ": " + std::to_string(ports) + " ports are too many");
  }
  CSnPFileBase file(ports);
  if (file.ReadSNPFile(widePath) < 0) {
    throw std::runtime_error(path + ": " + LumenUtility::WideToUtf8(file.GetReadError()));
  }
  return file;
}

namespace {

std::string PositionName(int row, int column) {
  char name[32];
  std::snprintf(name, sizeof name, row < 10 && column < 10 ? "S%d%d" : "S%d_%d", row, column);
  return name;
}

bool ReadIndex(const std::string& text, int& value) {
  const char* end = text.data() + text.size();
  const std::from_chars_result r = std::from_chars(text.data(), end, value);
  return !text.empty() && r.ec == std::errc() && r.ptr == end;
}

MatrixPosition ParsePosition(const std::string& text, int ports) {
  const auto fail = [&](const std::string& why) {
    return std::runtime_error("'" + text + "' " + why);
  };
  if (text.size() < 3 || (text[0] != 'S' && text[0] != 's')) {
    throw fail("is not a parameter name such as S21 or S1_10");
  }
  const std::string indices = text.substr(1);
  const std::size_t separator = indices.find('_');
  int row = 0, column = 0;
  const bool read = separator == std::string::npos
                        ? indices.size() == 2 && ReadIndex(indices.substr(0, 1), row) &&
                              ReadIndex(indices.substr(1), column)
                        : ReadIndex(indices.substr(0, separator), row) &&
                              ReadIndex(indices.substr(separator + 1), column);
  if (!read) throw fail("is not a parameter name such as S21 or S1_10");
  if (row < 1 || column < 1 || row > ports || column > ports) {
    throw fail("is not a parameter of a " + std::to_string(ports) + "-port network");
  }
  return {row, column, PositionName(row, column)};
}

}  // namespace

std::vector<MatrixPosition> SelectPositions(const std::string& list, const CSnPFileBase& file) {
  const int n = file.GetSNPType();
  std::vector<MatrixPosition> positions;
  if (list.empty()) {
    for (int k = 0; k < n * n; ++k) {
      const int index = static_cast<int>(&file.GetLoopParam(k) - &file.GetParam(SNP_S11));
      positions.push_back(
          {index / n + 1, index % n + 1, PositionName(index / n + 1, index % n + 1)});
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
  return file.GetParam(static_cast<ESNParam>((position.row - 1) * n + position.column - 1));
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
