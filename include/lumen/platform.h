// Platform base: result codes, the library exception, text conversions, files and archives,
// and the stand-ins for the host's profile, debugger output, sound, event tracing, registry,
// main window and hardware-interface library, the COM variant, and shared libraries loaded
// by module name.
#pragma once

#include "lumen/export.h"
#include "lumen/platform/error_codes.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/text_conversion.h"
#include "lumen/platform/archive.h"
#include "lumen/platform/file.h"
#include "lumen/platform/beep.h"
#include "lumen/platform/debug_output.h"
#include "lumen/platform/event_trace.h"
#include "lumen/platform/ini_profile_store.h"
#include "lumen/platform/json_trace_file_sink.h"
#include "lumen/platform/memory_trace_sink.h"
#include "lumen/platform/profile_store.h"
#include "lumen/platform/trace_manifest.h"
#include "lumen/platform/trace_session.h"
#include "lumen/platform/main_window.h"
#include "lumen/platform/registry.h"
#include "lumen/platform/rigel.h"
#include "lumen/platform/com_variant.h"
#include "lumen/platform/ole_exception.h"
#include "lumen/platform/shared_library.h"
