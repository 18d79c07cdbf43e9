// SVG charts for `snp plot`: traces over a stimulus axis with labelled, SI-prefixed ticks and
// a legend, or reflection traces on a Smith chart grid.
#pragma once

#include <string>
#include <vector>

namespace lumenutil {

// One trace: y over x, or a reflection coefficient (x = real part, y = imaginary part) on a
// Smith chart. Points with a non-finite coordinate break the line.
struct ChartSeries {
  std::string name;
  std::vector<double> x;
  std::vector<double> y;
};

struct CartesianChart {
  std::string title;
  std::string xQuantity;  // "Frequency"
  std::string xUnit;      // "Hz"; ticks take SI prefixes when xSiPrefix is true
  bool xSiPrefix = true;
  std::string yLabel;  // "Magnitude (dB)"
  // When set, the y axis spans exactly [yMin, yMax] with ticks every yStep (phase in
  // degrees); otherwise it fits the data with round ticks.
  bool fixedY = false;
  double yMin = 0, yMax = 0, yStep = 0;
  std::vector<ChartSeries> series;
};

// A complete SVG document.
std::string RenderCartesianSvg(const CartesianChart& chart);
std::string RenderSmithSvg(const std::string& title, const std::vector<ChartSeries>& series);

}  // namespace lumenutil
