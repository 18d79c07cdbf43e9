#include "lumen/core/time_distance.h"

#include <gtest/gtest.h>

#include <cmath>

namespace LumenUtility {
namespace {

using Setup = Interface::ITimeDomainMarkerSetup;

TEST(TimeDistance, ReflectionHalvesThePathUnitsConvertAndDistance2TimeInverts) {
  EXPECT_NEAR(Time2Distance(1e-9, 1, Setup::DISTANCE_REFLECTION, Setup::DISTANCE_METERS),
              0.149896229, 1e-12);
  EXPECT_NEAR(Time2Distance(1e-9, 1, Setup::DISTANCE_TRANSMISSION, Setup::DISTANCE_METERS),
              0.299792458, 1e-12);
  EXPECT_NEAR(Time2Distance(1e-9, 0.66, Setup::DISTANCE_TRANSMISSION, Setup::DISTANCE_FEET),
              0.299792458 * 0.66 / 0.3048, 1e-9);
  EXPECT_NEAR(Time2Distance(1e-9, 0.66, Setup::DISTANCE_REFLECTION, Setup::DISTANCE_INCHES),
              0.299792458 * 0.33 / 0.0254, 1e-7);
  // An unknown unit stays in metres.
  EXPECT_EQ(Time2Distance(2e-9, 1, Setup::DISTANCE_TRANSMISSION,
                          static_cast<Setup::DistanceMarkerUnit>(7)),
            Time2Distance(2e-9, 1, Setup::DISTANCE_TRANSMISSION, Setup::DISTANCE_METERS));

  // Distance2Time inverts every mode and unit.
  for (auto mode : {Setup::DISTANCE_TRANSMISSION, Setup::DISTANCE_REFLECTION}) {
    for (auto unit : {Setup::DISTANCE_METERS, Setup::DISTANCE_FEET, Setup::DISTANCE_INCHES,
                      static_cast<Setup::DistanceMarkerUnit>(-1)}) {
      for (double time : {1e-9, -3.5e-12, 0.0, 2e-6}) {
        const double distance = Time2Distance(time, 0.7, mode, unit);
        // The unit factors are rounded to 8 and 9 digits, so the round trip agrees to 1e-7.
        EXPECT_NEAR(Distance2Time(distance, 0.7, mode, unit), time, 1e-7 * std::abs(time))
            << mode << " " << unit << " " << time;
      }
    }
  }
}

}  // namespace
}  // namespace LumenUtility
