// Carrying the traces of a Touchstone file onto new stimulus points, for the commands that
// resample or compare files.
#pragma once

#include "lumen/data.h"
#include "lumen/stimulus.h"

namespace lumenutil {

// Carries every matrix trace of `file` onto `target` (in the file's stimulus unit: Hz,
// seconds, dBm or points) by circular interpolation, first widening each trace with its end
// values when `holdEnds` is set. Noise traces stay as read.
//
// The library takes an old value for any new point within 0.1 stimulus units of an old one,
// a rule made for Hz. Where the smallest step of the file or of the target is below 1000
// units (a time-domain file in seconds, a power sweep in dBm), the traces are carried in a
// unit a power of ten smaller (picoseconds, millidecibels, ...) in which every step is at
// least 1000 units, so the rule only joins points that coincide; the result is on `target`
// in the file's unit.
void CarryOnto(CSnPFileBase& file, const LumenUtility::InputArray& target, bool holdEnds);

// The power of ten CarryOnto scales stimulus values by for steps as small as `smallestStep`
// (in the file's unit): 1 for steps of 1000 and more, else the least 10^k that brings the
// step to 1000 or more.
double CarryScale(double smallestStep);

}  // namespace lumenutil
