/// @file
/// Global instrument state: the process-wide settings and the typed values of acquisition
/// parameters they are applied through.
///
/// The functions of namespace GlobalState keep the frequency reference, the index line polarity,
/// the equation editor mode, the power knob resolution and forced path elements, save them with
/// the instrument state and apply them to an acquisition specification. Failures are thrown as a
/// bare HRESULT: E_INVALIDARG for a value that is not allowed, LUMEN_E_NO_REFERENCE_STATE when
/// the hardware keeps the reference. GPScalar, GPArray and GPRef are the typed parameter values.
///
/// @code
/// GlobalState::SetPowerKnobResolution(0.25);  // dB
/// int handle = GlobalState::ForcePathElementValue(L"Port1Bypass", L"Thru");
/// std::wstring value;
/// bool forced = GlobalState::IsPathForceElementValue(L"Port1Bypass", value);  // true, "Thru"
/// GlobalState::UnforcePathElementValue(handle);
/// @endcode

/// @namespace GlobalState
/// The process-wide instrument settings.
#pragma once

#include "lumen/globalstate/global_state.h"
#include "lumen/globalstate/gp_array.h"
#include "lumen/globalstate/gp_ref.h"
#include "lumen/globalstate/gp_scalar.h"
#include "lumen/platform/rigel.h"
