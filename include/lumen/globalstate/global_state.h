/// @file
/// GlobalState: the process-wide instrument settings that belong to no channel or
/// measurement, their persistence, and their application to an acquisition specification.
///
/// The settings are the frequency reference ("Internal" or "External"), the polarity of the
/// index line, the equation editor's fast-processing mode and the power knob resolution, plus
/// forced values of hardware path elements. They live in one table, created on the first call
/// of any function here and kept until the process ends. Depending on the hardware's
/// capabilities (the host's INAHardwareCaps) the reference is kept in the table or read from
/// the hardware. The table, except the reference, is saved with the instrument state.
///
/// Failures are thrown as a bare HRESULT: E_INVALIDARG for a bad value or a setting the
/// hardware lacks, LUMEN_E_NO_REFERENCE_STATE when the table keeps no reference. Errors of the
/// host objects pass through unchanged.
/// Thread-safety: none; use from one thread at a time.
#pragma once

#include <cstdint>
#include <string>

#include <boost/shared_ptr.hpp>

#include "lumen/export.h"
#include "lumen/platform/archive.h"
#include "lumen/platform/error_codes.h"
#include "lumen/platform/rigel/data_acquisition_specification.h"

namespace LumenUtility {

/// The table keeps no frequency reference to change (the hardware decides it).
inline constexpr HRESULT LUMEN_E_NO_REFERENCE_STATE = MakeHResult(0xE808089D);

}  // namespace LumenUtility

namespace GlobalState {

/// Polarity of the index line: active high or active low.
enum IndexLinePolarity : int { IndexLinePositive = 0, IndexLineNegative = 1 };

/// The window message sent to the host's main window, wParam and lParam 0, after the
/// frequency reference changed.
inline constexpr std::uint32_t kReferenceChangedMessage = 0x42C;

/// Empties the settings; the reference and the forced path elements stay.
LUMEN_API void PresetGlobalState();

/// Storing: writes the settings (never the reference): the 32-bit version 1, the 32-bit count,
/// then each key and value in key order as archive strings. Loading: reads such a record and
/// replaces the settings with it only when the whole record was read and its values are valid;
/// otherwise throws and leaves the settings as they were: LumenException
/// LUMEN_E_UNKNOWN_VERSION (no message) for a version of 2 or more, CArchiveException
/// endOfFile for a record cut short, LumenException LUMEN_E_BOUNDS for an invalid value.
/// A "ReferenceState" entry is ignored. Nothing is notified.
LUMEN_API void SerializeGlobalState(CArchive& ar);

/// `state` is "Internal" or "External" in any case; the setting takes that spelling. In order:
/// the channel manager's BeginChange, the store, the hardware switched, the core notified, the
/// main window sent kReferenceChangedMessage, EndChange. EndChange follows a failure of the
/// steps between too; when the hardware refuses, the stored reference returns to what it was.
/// Throws E_INVALIDARG for another `state`, then LUMEN_E_NO_REFERENCE_STATE when the table
/// keeps no reference; nothing has changed then.
LUMEN_API void SetExternalReference(const std::wstring& state);
/// "Internal" or "External": the hardware's state where the hardware decides it, else the
/// stored one. Throws E_INVALIDARG when the table should keep it but does not.
LUMEN_API std::wstring GetExternalReference();

/// Nothing happens when `polarity` is the current one. Otherwise throws E_INVALIDARG when the
/// hardware has no index line or `polarity` is neither value; stores the setting and notifies
/// the core.
LUMEN_API void SetIndexLinePolarity(IndexLinePolarity polarity);
/// Positive unless the hardware has an index line and the negative polarity is stored.
LUMEN_API IndexLinePolarity GetIndexLinePolarity();

/// Stores the mode and notifies the core.
LUMEN_API void SetEquationEditorFastProcessingMode(bool fast);
/// False until set.
LUMEN_API bool GetEquationEditorFastProcessingMode();

/// Stores `resolution` in dB as six-decimal text (so values below 0.0000005 store as 0),
/// without notification. Throws E_INVALIDARG for a NaN or infinite resolution, which could not
/// be read back.
LUMEN_API void SetPowerKnobResolution(double resolution);
/// The stored resolution in dB; 0.1 until set.
LUMEN_API double GetPowerKnobResolution();

/// Forces path element `path` to `value`; returns the new handle (0, 1, 2, ... in order), or
/// -1 with nothing changed once 2^31 handles have been given out.
LUMEN_API int ForcePathElementValue(const std::wstring& path, const std::wstring& value);
/// True, with `value` set, when `path` (compared exactly) is forced; the lowest handle wins.
/// False leaves `value` as it was.
LUMEN_API bool IsPathForceElementValue(const std::wstring& path, std::wstring& value);
/// Ends the forcing of `handle`; an unknown handle is ignored.
LUMEN_API void UnforcePathElementValue(int handle);

/// Writes the stored reference and index polarity into the path manager's parameters of
/// `das`'s static collection and, when the registry switches the second test set on and the
/// user selected it, moves its clock source to the fixed frequency and power. Throws E_POINTER
/// for an empty `das`.
LUMEN_API void GlobalStateModifyDAS(boost::shared_ptr<Rigel::DataAcquisitionSpecification>& das);

}  // namespace GlobalState
