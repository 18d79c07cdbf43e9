/// @file
/// Platform base: result codes, the library exception, text conversions, files and archives,
/// and the stand-ins for the host's profile, debugger output, sound, event tracing, registry,
/// main window and hardware-interface library, the COM variant, and shared libraries loaded by
/// module name.
///
/// LumenException carries an HRESULT and wide messages; what() gives "0xCODE: message" in UTF-8.
/// Text converts between UTF-8, UTF-16 and wide strings without throwing (ill-formed input becomes
/// U+FFFD). CFile, CMemFile and CStdioFile are files; CArchive writes and reads values in them and
/// throws CArchiveException (endOfFile when a read runs past the end).
///
/// @code
/// CMemFile file;
/// {
///   CArchive out(&file, CArchive::store);
///   out << std::int32_t{201} << std::wstring(L"S21");
/// }
/// file.SeekToBegin();
/// CArchive in(&file, CArchive::load);
/// std::int32_t points = 0;
/// in >> points;  // 201; a read past the end throws CArchiveException endOfFile
/// @endcode

/// @namespace LumenUtility
/// The library's classes and functions, except the few of the original design that stand at
/// global scope.

/// @namespace Rigel
/// Types of the hardware-interface library: parameter values, command parameters and acquisition
/// specifications.

/// @namespace Vela
/// Enumerations of the hardware-interface library's path elements.
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
