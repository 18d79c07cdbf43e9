/// @file
/// Error numbers for error codes.
///
/// Remote-control and user-facing layers report failures as small signed error numbers
/// rather than the 32-bit codes the components return. FromHRESULT is the one place that
/// turns the one into the other.
#pragma once

#include "lumen/export.h"
#include "lumen/platform/error_codes.h"

/// Returns the error number of hr (-400 to 3027), or -200 when hr has none. All 32 bits
/// count: codes that differ only in the severity bit are different codes. Pure: no state, no
/// allocation, no exception; callable from any thread.
LUMEN_API int FromHRESULT(HRESULT hr);

namespace LumenUtility {
/// The error number of every code without an entry of its own.
inline constexpr int kUnmappedErrorNumber = -200;
}  // namespace LumenUtility
