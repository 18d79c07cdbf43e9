#include "lumen/core/time_distance.h"

namespace LumenUtility {

namespace {

using Setup = Interface::ITimeDomainMarkerSetup;

constexpr double kSpeedOfLight = 299792458.0;  // m/s
constexpr double kFeetPerMeter = 3.2808399;
constexpr double kInchesPerMeter = 39.3700787;
constexpr double kMetersPerFoot = 0.3048;
constexpr double kMetersPerInch = 0.0254;

}  // namespace

double Time2Distance(double time, double velocityFactor, Setup::DistanceMarkerMode mode,
                     Setup::DistanceMarkerUnit unit) {
  double distance = velocityFactor * kSpeedOfLight * time;
  if (unit == Setup::DISTANCE_FEET) {
    distance *= kFeetPerMeter;
  } else if (unit == Setup::DISTANCE_INCHES) {
    distance *= kInchesPerMeter;
  }
  if (mode == Setup::DISTANCE_REFLECTION) distance *= 0.5;
  return distance;
}

double Distance2Time(double distance, double velocityFactor, Setup::DistanceMarkerMode mode,
                     Setup::DistanceMarkerUnit unit) {
  if (mode == Setup::DISTANCE_REFLECTION) distance *= 2.0;
  if (unit == Setup::DISTANCE_FEET) {
    distance *= kMetersPerFoot;
  } else if (unit == Setup::DISTANCE_INCHES) {
    distance *= kMetersPerInch;
  }
  return distance / (velocityFactor * kSpeedOfLight);
}

}  // namespace LumenUtility
