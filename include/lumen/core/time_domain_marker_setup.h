/** @file */
/// @class Interface::ITimeDomainMarkerSetup
/// Interface::ITimeDomainMarkerSetup: the settings by which time-domain markers show distance.
///
/// Only the enumerations are defined here; they select how Time2Distance and Distance2Time
/// convert between a marker's time and the length of line it corresponds to. The class holds
/// no state and is never instantiated by the library.
#pragma once

namespace Interface {

class ITimeDomainMarkerSetup {
 public:
  /// How often the signal travels the line between the reference plane and the marker.
  enum DistanceMarkerMode : int {
    DISTANCE_TRANSMISSION = 0,  ///< once (transmission measurements)
    DISTANCE_REFLECTION = 1,    ///< there and back (reflection measurements): time covers 2x
  };
  /// Unit of the distance; any other value is read as metres (hence the fixed int type).
  enum DistanceMarkerUnit : int {
    DISTANCE_METERS = 0,
    DISTANCE_FEET = 1,
    DISTANCE_INCHES = 2,
  };

 protected:
  ~ITimeDomainMarkerSetup() = default;
};

}  // namespace Interface
