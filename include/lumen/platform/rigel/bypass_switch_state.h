/// @file
/// Vela::BYPASS_SWITCH_STATE: the position of a test port's bypass switch, one of the value
/// types an acquisition parameter can carry. Written as text it shows its number.
#pragma once

namespace Vela {

/// Position of a bypass switch: signal through the path element, or around it.
enum BYPASS_SWITCH_STATE { BYPASS_SWITCH_THRU = 0, BYPASS_SWITCH_BYPASSED = 1 };

}  // namespace Vela
