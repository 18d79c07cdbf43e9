/// @file
/// Complex values, trace formats and numeric helpers.
///
/// TsComplex is the library's measurement value: two single-precision floats, real part first,
/// so arrays of it are interleaved complex data that vector routines take directly. Its members
/// and the functions of lumen/core/vector_formats.h give the analyzer's display formats (log
/// magnitude in dB, phase in radians, SWR, impedance in ohms, the unwrapped phase of a trace);
/// the other headers hold numeric helpers: SI prefixes, trace statistics, value searches,
/// natural string order and the time-to-distance conversion of time-domain markers. Nothing here
/// throws except where a function says so; an exact zero has the log magnitude -200 dB.
///
/// @code
/// const LumenUtility::TsComplex gamma(0.2, -0.1);  // a reflection coefficient
/// double dB = gamma.LogMag();                      // -13.010
/// double swr = gamma.SWR();                        // 1.5760
/// LumenUtility::TsComplex z = gamma.Impedance(LumenUtility::TsComplex(50.0));  // 73.077 - 15.385j
/// @endcode

/// @namespace MathUtil
/// Scalar numeric helpers on doubles and floats.

/// @namespace Interface
/// Interfaces of the host application whose enumerations the library uses.
#pragma once

#include "lumen/core/combinatorics.h"
#include "lumen/core/math_util.h"
#include "lumen/core/natural_compare.h"
#include "lumen/core/si_prefix.h"
#include "lumen/core/time_distance.h"
#include "lumen/core/time_domain_marker_setup.h"
#include "lumen/core/trace_stats.h"
#include "lumen/core/ts_complex.h"
#include "lumen/core/value_search.h"
#include "lumen/core/vector_formats.h"
