/// @file
/// Names of calibration error terms.
///
/// Every module spells an error term's name through these functions, so that names written
/// by one module are found by another: "Directivity(1,1)", "ResponseTracking(R2)",
/// "Ch1_SourcePowerCorrection(1)". Port, receiver and term-position arguments are 0-based;
/// names carry them 1-based (or as letters). A prefix is put directly in front of the term
/// name, with no separator.
///
/// Thread-safety: pure functions, callable from any thread.
#pragma once

#include <string>

#include "lumen/export.h"

namespace LumenUtility {

/// The error-term vocabulary, in its fixed order, closed by an empty entry. "TranmissionTracking"
/// is spelled that way in every stored calibration and must stay so; the colon of
/// "PowerAdapter:" belongs to the name.
inline constexpr int kETermNameCount = 12;
/// The error-term names, kETermNameCount of them, then a null pointer.
LUMEN_API extern const wchar_t* const gETermNames[kETermNameCount + 1];

/// term(i+1,j+1), for example Directivity(1,1) or LoadMatch(2,1).
LUMEN_API std::wstring eterm_name(const std::wstring& term, int i, int j);
/// term(i+1).
LUMEN_API std::wstring eterm_name(const std::wstring& term, int i);

/// Reference receiver of port (0-based): prefix + "ResponseTracking(R<port+1>)".
LUMEN_API std::wstring reference_eterm_name(int port, const std::wstring& prefix);
/// Test receiver of port: prefix + "ResponseTracking(<letter>)", the letter 'A' + port
/// (port 0 to 25 gives A to Z).
LUMEN_API std::wstring test_rcv_eterm_name(int port, const std::wstring& prefix);
///@{
/// The same two names for instruments whose receivers are called a1, a2... (reference) and
/// b1, b2... (test): prefix + "ResponseTracking(a<port+1>)" and "ResponseTracking(b<port+1>)".
LUMEN_API std::wstring reference_eterm_name_Kestrel(int port, const std::wstring& prefix);
LUMEN_API std::wstring test_rcv_eterm_name_Kestrel(int port, const std::wstring& prefix);
///@}
/// Source power calibration of port: prefix + "SourcePowerCorrection(<port+1>)".
LUMEN_API std::wstring src_cal_eterm_name(int port, const std::wstring& prefix);

}  // namespace LumenUtility
