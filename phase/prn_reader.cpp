#include "lumen/phase/prn_reader.h"

#include <algorithm>
#include <cmath>
#include <cwchar>
#include <optional>
#include <string_view>

#include "lumen/diagnostics/debug_print.h"
#include "lumen/interpolation/circular_interpolation.h"
#include "lumen/platform/file_exception.h"
#include "lumen/platform/stdio_file.h"

using LumenUtility::InputArray;
using LumenUtility::TsComplex;

namespace {

constexpr double kRadiansPerDegree = 0.01745329251994329;  // pi / 180

// The number at the start of `piece` (blanks before it allowed, text after it ignored), or
// nothing when the piece does not start with a finite number: "abc" or "inf" is no phase of
// 0 degrees or of infinity, and an overflowing frequency is no calibration point.
std::optional<double> LeadingNumber(const std::wstring& piece) {
  const wchar_t* begin = piece.c_str();
  wchar_t* end = nullptr;
  const double value = std::wcstod(begin, &end);
  if (end == begin || !std::isfinite(value)) return std::nullopt;
  return value;
}

// The first two pieces of `line` that are not empty, split at every comma.
bool FirstTwoPieces(std::wstring_view line, std::wstring& first, std::wstring& second) {
  std::wstring* const pieces[2] = {&first, &second};
  int found = 0;
  std::size_t start = 0;
  while (found < 2 && start <= line.size()) {
    const std::size_t comma = std::min(line.find(L',', start), line.size());
    if (comma > start) pieces[found++]->assign(line.substr(start, comma - start));
    start = comma + 1;
  }
  return found == 2;
}

}  // namespace

bool PrnReader::LoadFile(const std::wstring& path) {
  std::vector<double> points;
  std::vector<TsComplex> values;
  try {
    CStdioFile file(path.c_str(), CFile::modeRead | CFile::typeText);
    std::wstring line, frequencyPiece, phasePiece;
    while (file.ReadString(line)) {
      if (!FirstTwoPieces(line, frequencyPiece, phasePiece)) continue;
      const std::optional<double> frequency = LeadingNumber(frequencyPiece);
      if (!frequency || *frequency == 0.0) continue;
      const std::optional<double> phase = LeadingNumber(phasePiece);
      if (!phase) continue;
      const double radians = *phase * kRadiansPerDegree;
      points.push_back(*frequency);
      values.emplace_back(std::cos(radians), std::sin(radians));
    }
  } catch (const CFileException& error) {
    dprint(DebugPrintPhaseReference, L"PrnReader: %ls\n", error.GetErrorMessage().c_str());
    return false;
  }
  InputArray stimulus(points);
  stimulus.OptimizeRepresentation();
  m_stimulus = std::move(stimulus);
  m_values = std::move(values);
  return true;
}

std::vector<TsComplex> PrnReader::GetPhase(const InputArray& stimulus, const InputArray&,
                                           const TsComplex*) const {
  if (m_values.empty()) throw kPhaseLookupFailed;
  std::vector<TsComplex> result(stimulus.size());
  bool outOfRange = false;
  const LumenUtility::tagInterpStatus status =
      LumenUtility::CircularInterpolation(m_stimulus, m_values.data(), stimulus, result.data(),
                                          &outOfRange, LumenUtility::INTERP_CIRCULAR);
  if (status < 0) throw kPhaseLookupFailed;
  return result;
}
