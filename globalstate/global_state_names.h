// The names the global state works with: its setting keys and values, the hardware element
// and parameter names of an acquisition specification, and the registry values of the second
// test set.
#pragma once

namespace LumenUtility::GlobalStateNames {

// Setting keys; "ReferenceState" is kept apart from the others and never saved.
inline constexpr wchar_t kReferenceState[] = L"ReferenceState";
inline constexpr wchar_t kIndexPolarity[] = L"IndexPolarity";
inline constexpr wchar_t kEquationEditorFastProcessing[] = L"EquationEditorFastProcessing";
inline constexpr wchar_t kPowerKnobResolution[] = L"PowerKnobResolution";

// Setting values.
inline constexpr wchar_t kInternal[] = L"Internal";
inline constexpr wchar_t kExternal[] = L"External";
inline constexpr wchar_t kNegative[] = L"Negative";
inline constexpr wchar_t kTrue[] = L"True";
inline constexpr wchar_t kFalse[] = L"False";

// Hardware elements and their parameters.
inline constexpr wchar_t kPathManager[] = L"Path_Manager";
inline constexpr wchar_t kRefSel[] = L"RefSel";
inline constexpr wchar_t kSourcePrefix[] = L"RFSrc";        // followed by the port - 1
inline constexpr wchar_t kPortBypassPrefix[] = L"PrtBP";    // followed by the port
inline constexpr wchar_t kFreq[] = L"Freq";
inline constexpr wchar_t kPower[] = L"Power";
inline constexpr wchar_t kPortState[] = L"PortState";
inline constexpr wchar_t kPortControlSrc[] = L"PortControlSrc";

// The registry key of the analyzer and the second test set's values in it.
inline constexpr wchar_t kAnalyzerKey[] =
    L"HKEY_LOCAL_MACHINE\\SOFTWARE\\Corvane\\Network Analyzer\\";
inline constexpr wchar_t kT2Mode[] = L"T2Mode";
inline constexpr wchar_t kT2ClockPort[] = L"T2ClockPort";
inline constexpr wchar_t kT2Name[] = L"T2Name";

// The factory key of the host's channel manager.
inline constexpr wchar_t kChannelsManager[] = L"CHANNELS_MANAGER";

}  // namespace LumenUtility::GlobalStateNames
