/// @file
/// Event tracing: timing and state events of the analyzer software, written with low cost to
/// the tracing provider {532E117B-E9BD-4FE9-B3BA-B009375F889B} when a trace session records it.
///
/// Nothing is written until the host calls ETWInit() and EnableTPrint(true) and a session
/// (LumenUtility::TraceSession, "lumen/platform/trace_session.h") enables the provider with a
/// level and keywords the event matches. Every event has level 16 and channel 16; its
/// keyword is 0x8000000000000000 with the bits of its group (ETWManifest() names them).
///
///   LumenUtility::ETWInit();
///   LumenUtility::EnableTPrint(true);
///   LumenUtility::JsonTraceFileSink file(L"sweep.json", &LumenUtility::ETWManifest());
///   LumenUtility::TraceSession session(LumenUtility::ETWProviderId(), 0, 0, 0, file);
///   LumenUtility::TPrint(3, channel);  // ChannelSweepStart
///
/// Thread-safety: TPrint, EnableTPrint and IsTPrintEnabled may be called from any thread.
/// ETWInit and ETWReset must not overlap TPrint calls (the host calls them at start-up and
/// shut-down). Ownership: the tracing object lives from ETWInit to ETWReset.
#pragma once

#include <cstdint>

#include "lumen/export.h"
#include "lumen/platform/event_trace.h"
#include "lumen/platform/trace_manifest.h"

namespace LumenUtility {

/// Creates the tracing object if there is none: TPrint disabled, the event table filled on
/// first use, the provider registered (silently not, when registration fails).
LUMEN_API void ETWInit();
/// Releases the tracing object, which unregisters the provider. The event table stays.
LUMEN_API void ETWReset();
/// Switches TPrint on or off; does nothing without a tracing object.
LUMEN_API void EnableTPrint(bool enabled);
/// Whether TPrint is on; false without a tracing object.
LUMEN_API bool IsTPrintEnabled();

///@{
/// Writes event `id` (1 to 98; others are ignored) with the payload of its kind: nothing,
/// the value (4 bytes), the text (UTF-16 with its terminating zero) or the value and then the
/// text. A missing value is 0, a missing text empty, a null text "NULL"; arguments the
/// event's kind does not carry are ignored. 8-bit texts are UTF-8 and are converted only when
/// the event is written.
LUMEN_API void TPrint(short id);
LUMEN_API void TPrint(short id, std::int32_t value);
LUMEN_API void TPrint(short id, const wchar_t* text);
LUMEN_API void TPrint(short id, const char* text);
LUMEN_API void TPrint(short id, std::int32_t value, const wchar_t* text);
LUMEN_API void TPrint(short id, std::int32_t value, const char* text);
///@}

/// The provider's GUID, {532E117B-E9BD-4FE9-B3BA-B009375F889B}.
LUMEN_API const GUID& ETWProviderId();
/// The names of the provider's events, tasks, keyword groups and payload fields, for
/// JsonTraceFileSink.
LUMEN_API const TraceManifest& ETWManifest();

}  // namespace LumenUtility
