// Complex values, trace formats and numeric helpers.
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
