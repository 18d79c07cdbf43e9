// The dump text file of a DataMatrix: one line per buffer, "TsComplex,<name>,re,im,...".
// It is read by tools outside this library that expect CR LF line ends and the stream's
// default number form (general notation, 6 significant digits).
#include <charconv>
#include <filesystem>
#include <fstream>
#include <string>

#include "lumen/data/data_matrix.h"
#include "lumen/platform/text_conversion.h"

namespace LumenUtility {

namespace {

void AppendNumber(std::string& line, float value) {
  char digits[32];
  const std::to_chars_result end =
      std::to_chars(digits, digits + sizeof digits, value, std::chars_format::general, 6);
  line.append(digits, end.ptr);
}

}  // namespace

bool DataMatrix::DumpData(const char* path) const {
  std::string text;
  for (const auto& [name, buffer] : m_buffers) {
    text += "TsComplex,";
    text += WideToUtf8(name);
    for (const TsComplex& sample : buffer.m_data) {
      text += ',';
      AppendNumber(text, sample.re);
      text += ',';
      AppendNumber(text, sample.im);
    }
    text += "\r\n";
  }

  if (path == nullptr) return false;
  std::ofstream file(path, std::ios::binary | std::ios::trunc);
  if (!file) return false;
  file.write(text.data(), static_cast<std::streamsize>(text.size()));
  file.close();
  if (!file) {
    // A dump cut short by a full disk would read as a complete one. Only a regular file is
    // removed: the path may name a device.
    std::error_code ignored;
    if (std::filesystem::is_regular_file(path, ignored)) std::filesystem::remove(path, ignored);
    return false;
  }
  return true;
}

}  // namespace LumenUtility
