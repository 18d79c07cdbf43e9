/// @file
/// Natural-order comparison of wide strings, for sorting names such as "Trace10" after
/// "Trace2".
///
/// Free, stateless functions; reentrant.
#pragma once

#include "lumen/export.h"

namespace LumenUtility {

/// Compares a and b in natural order: -1 when a sorts first, 1 when b does, 0 when equal.
/// White space is skipped; runs of ASCII digits compare by numeric value (x2 < x10), except
/// that a run starting with 0 compares digit by digit from the left, as a fraction would
/// (1.010 < 1.02); other characters compare by code value. A null pointer reads as "".
LUMEN_API int strnatcmp(const wchar_t* a, const wchar_t* b);

/// The same, with non-digit characters upper-cased before they are compared.
LUMEN_API int strnatcmpNoCase(const wchar_t* a, const wchar_t* b);

}  // namespace LumenUtility
