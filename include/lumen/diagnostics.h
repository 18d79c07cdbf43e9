// Diagnostics: the switchable debug print, the asynchronous beep and precise sleeps, and
// event tracing.
#pragma once

#include "lumen/diagnostics/debug_print.h"
#include "lumen/diagnostics/event_tracing.h"
#include "lumen/diagnostics/process_utilities.h"
