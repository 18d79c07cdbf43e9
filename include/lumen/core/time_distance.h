/// @file
/// Conversion between a time-domain marker's time and the length of line it corresponds to.
///
/// Free, stateless functions; reentrant.
#pragma once

#include "lumen/core/time_domain_marker_setup.h"
#include "lumen/export.h"

namespace LumenUtility {

/// Distance light covers in `time` (s) at `velocityFactor` (fraction of c, 299792458 m/s), in
/// `unit` (metres for unknown units); halved for reflection, where the signal goes out and
/// back.
LUMEN_API double Time2Distance(double time, double velocityFactor,
                               Interface::ITimeDomainMarkerSetup::DistanceMarkerMode mode,
                               Interface::ITimeDomainMarkerSetup::DistanceMarkerUnit unit);

/// The inverse of Time2Distance: the time (s) for `distance` in `unit`. A velocity factor of 0
/// gives an infinite or NaN time.
LUMEN_API double Distance2Time(double distance, double velocityFactor,
                               Interface::ITimeDomainMarkerSetup::DistanceMarkerMode mode,
                               Interface::ITimeDomainMarkerSetup::DistanceMarkerUnit unit);

}  // namespace LumenUtility
