#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "lumen/data.h"

namespace {

// Noise records keep their own frequencies, whatever their count against the network points.
TEST(SnPNoiseData, NoiseTracesLieOnTheFrequenciesOfTheirRecords) {
  const std::string network =
      "# MHz S MA R 50\n100 0.5 0 0.1 90 0.2 0 0.4 45\n"
      "200 0.6 10 0.3 80 0.2 5 0.5 40\n! Noise Parameters\n";
  CSnPFileBase file(2);
  // Fewer records than network points: one trace value per record, none made up.
  ASSERT_EQ(file.ReadSNPText(network + "150 3 0.5 45 0.2\n"), 2);
  ASSERT_EQ(file.GetNumCustomParams(), 3);
  for (int t = 0; t < 3; ++t) {
    EXPECT_EQ(file.GetCustomParam(t).GetStimulus().GetArray(), std::vector<double>{150e6});
    EXPECT_EQ(file.GetCustomParam(t).GetData().size(), 1u);
  }
  // More records than network points: none is dropped.
  ASSERT_EQ(file.ReadSNPText(network + "50 3 0.5 45 0.2\n120 4 0.25 30 0.3\n180 5 0.1 20 0.4\n"),
            2);
  const CSNParameter& rn = file.GetCustomParam(2);
  EXPECT_EQ(rn.GetStimulus().GetArray(), (std::vector<double>{50e6, 120e6, 180e6}));
  ASSERT_EQ(rn.GetData().size(), 3u);
  EXPECT_NEAR(rn.GetData()[2].re, 0.4 * 50, 1e-5);
  EXPECT_NEAR(file.GetCustomParam(0).GetData()[1].re, std::pow(10.0, 0.4), 1e-5);
  EXPECT_EQ(file.GetFileInfo().noisePoints, 3);

  // Version 2 records are scaled by the option line's unit as well.
  ASSERT_EQ(file.ReadSNPText("[Version] 2.0\n# kHz RI\n[Number of Ports] 2\n[Network Data]\n"
                             "1 1 0 0 0 0 0 1 0\n[Noise Data]\n0.5 2 0.5 45 0.2\n[End]\n"),
            1);
  EXPECT_EQ(file.GetCustomParam(1).GetStimulus().GetArray(), std::vector<double>{500});
}

}  // namespace
