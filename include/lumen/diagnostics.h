/// @file
/// Diagnostics: the switchable debug print, the asynchronous beep and precise sleeps, and
/// event tracing.
///
/// dprint writes printf-style messages to 256 numbered slots through gDebugPrint, which starts
/// locked out with every slot off; the host unlocks it and chooses the devices (its console
/// object, the debugger output, a UTF-8 file). TPrint writes the events of the library's tracing
/// provider once ETWInit and EnableTPrint(true) have run; a TraceSession records them into a sink.
///
/// @code
/// gDebugPrint.Lockout(false);
/// gDebugPrint.SetOn(DebugPrintGeneral, true);
/// dprint(DebugPrintGeneral, L"sweep of %d points\n", 201);
/// 
/// LumenUtility::MemoryTraceSink sink;
/// LumenUtility::TraceSession session(LumenUtility::ETWProviderId(), 0, 0, 0, sink);
/// LumenUtility::ETWInit();
/// LumenUtility::EnableTPrint(true);
/// LumenUtility::TPrint(3, 42);  // recorded in sink
/// @endcode
#pragma once

#include "lumen/diagnostics/debug_print.h"
#include "lumen/diagnostics/event_tracing.h"
#include "lumen/diagnostics/process_utilities.h"
