/// @file
/// Rigel::CPDimension: the command parameters of one dynamic dimension of an acquisition
/// specification, the settings that change from one step of the acquisition to the next (one
/// sweep segment, for example). It is a collection like the static part of the acquisition setup.
///
/// Thread-safety: confine to one thread. Ownership: as CPCollection.
#pragma once

#include "lumen/platform/rigel/cp_collection.h"

namespace Rigel {

class CPDimension : public CPCollection {};

}  // namespace Rigel
