#include "lumenutil/svg_chart.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <limits>
#include <string>
#include <unordered_set>

#include "lumenutil/snp_file.h"

namespace lumenutil {
namespace {

// Picture size in px: wide enough for a 100-column legend name, small enough for a page.
constexpr double kWidth = 960, kHeight = 600;
constexpr double kLeft = 90, kRight = 180, kTop = 50, kBottom = 70;

const char* const kColours[] = {"#1f5fa8", "#c8332b", "#2a8a3e", "#e08a0b", "#7b4bb0",
                                "#8c564b", "#d1489c", "#5f6b73", "#9a9a16", "#15a3b5"};

std::string Colour(std::size_t i) {
  return kColours[i % (sizeof kColours / sizeof *kColours)];
}

std::string Num(double v) {
  char text[32];
  std::snprintf(text, sizeof text, "%.1f", v);
  return text;
}

std::string Escape(const std::string& text) {
  std::string out;
  for (char c : text) {
    switch (c) {
      case '&':
        out += "&amp;";
        break;
      case '<':
        out += "&lt;";
        break;
      case '>':
        out += "&gt;";
        break;
      case '"':
        out += "&quot;";
        break;
      default:
        out += c;
    }
  }
  return out;
}

std::string Text(double x, double y, const std::string& text, const char* anchor,
                 const char* extra = "") {
  return "<text x=\"" + Num(x) + "\" y=\"" + Num(y) + "\" text-anchor=\"" + anchor + "\"" + extra +
         ">" + Escape(text) + "</text>\n";
}

std::string Line(double x1, double y1, double x2, double y2, const char* style) {
  return "<line x1=\"" + Num(x1) + "\" y1=\"" + Num(y1) + "\" x2=\"" + Num(x2) + "\" y2=\"" +
         Num(y2) + "\" " + style + "/>\n";
}

std::string Header(double width, double height, const std::string& title) {
  return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
         "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" +
         Num(width) + "\" height=\"" + Num(height) + "\" viewBox=\"0 0 " + Num(width) + " " +
         Num(height) +
         "\" font-family=\"DejaVu Sans, Arial, sans-serif\" font-size=\"13\">\n"
         "<rect width=\"100%\" height=\"100%\" fill=\"white\"/>\n" +
         Text(width / 2, 28, title, "middle", " font-size=\"16\" font-weight=\"bold\"");
}

constexpr double kLegendRow = 22;

// The picture's height: the chart's own, or more where a long legend needs it.
double HeightFor(std::size_t legendRows) {
  return std::max(kHeight, kTop + 12 + kLegendRow * static_cast<double>(legendRows) + 30);
}

std::string Legend(const std::vector<ChartSeries>& series, double x, double y) {
  std::string svg;
  for (std::size_t i = 0; i < series.size(); ++i) {
    const double rowY = y + kLegendRow * static_cast<double>(i);
    svg += "<line x1=\"" + Num(x) + "\" y1=\"" + Num(rowY) + "\" x2=\"" + Num(x + 28) + "\" y2=\"" +
           Num(rowY) + "\" stroke=\"" + Colour(i) + "\" stroke-width=\"2.5\"/>\n";
    svg += Text(x + 36, rowY + 4.5, series[i].name, "start");
  }
  return svg;
}

// Polylines of the points mapped to px, split where a coordinate is not finite.
//
// A trace of more points than px columns is reduced to its lowest and highest point in each
// column, in the order the trace meets them: the stroke covers the same pixels, and a
// 100,001-point trace draws about 1,400 vertices instead of 100,001. Where columns mean
// nothing (a Smith chart), a point on a px the trace has already passed adds nothing to the
// picture and is dropped; where such a run of points ends far from the last point kept, the
// line starts anew from the run's last point, so no stroke is drawn where the trace was not.
template <typename Map>
std::string Polylines(const ChartSeries& s, Map map, const std::string& colour, bool byColumn,
                      double columns) {
  std::string svg, points;
  std::size_t count = 0;
  const auto flush = [&] {
    if (count > 1) {
      svg += "<polyline fill=\"none\" stroke=\"" + colour +
             "\" stroke-width=\"1.8\" stroke-linejoin=\"round\" points=\"" + points + "\"/>\n";
    }
    points.clear();
    count = 0;
  };
  double lastX = NAN, lastY = NAN;
  const auto add = [&](double px, double py) {
    points += Num(px) + "," + Num(py) + " ";
    ++count;
    lastX = px;
    lastY = py;
  };
  const std::size_t n = std::min(s.x.size(), s.y.size());
  const bool reduce = byColumn && n > 2 * columns;
  constexpr long kNoColumn = std::numeric_limits<long>::min();
  long column = kNoColumn;
  double columnX = 0, lowY = 0, highY = 0;
  bool lowFirst = true;
  std::unordered_set<std::int64_t> passed;  // px cells a Smith trace went through
  double skippedX = 0, skippedY = 0;
  bool skipped = false;
  const auto emitColumn = [&] {
    if (column == kNoColumn) return;
    add(columnX, lowFirst ? lowY : highY);
    if (lowY != highY) add(columnX, lowFirst ? highY : lowY);
    column = kNoColumn;
  };
  for (std::size_t i = 0; i < n; ++i) {
    if (!std::isfinite(s.x[i]) || !std::isfinite(s.y[i])) {
      emitColumn();
      flush();
      skipped = false;
      continue;
    }
    const auto [px, py] = map(s.x[i], s.y[i]);
    if (!byColumn) {
      const std::int64_t cell = (std::llround(px) << 32) ^ (std::llround(py) & 0xFFFFFFFF);
      if (!passed.insert(cell).second) {
        skippedX = px;
        skippedY = py;
        skipped = true;
        continue;
      }
      // Neighbouring px are less than 3 px apart; farther means the trace went elsewhere.
      if (skipped && count > 0 && std::hypot(px - lastX, py - lastY) > 3) {
        flush();
        add(skippedX, skippedY);
      }
      skipped = false;
      add(px, py);
      continue;
    }
    if (!reduce) {
      add(px, py);
      continue;
    }
    const long c = std::lround(px);
    if (c != column) {
      emitColumn();
      column = c;
      columnX = px;
      lowY = highY = py;
      lowFirst = true;
    } else if (py < lowY) {
      lowY = py;
      lowFirst = false;  // the highest point, met earlier, comes first
    } else if (py > highY) {
      highY = py;
      lowFirst = true;
    }
  }
  emitColumn();
  flush();
  return svg;
}

// Round tick step for a span shown with about `target` ticks: 1, 2 or 5 times a power of ten.
double NiceStep(double span, int target) {
  const double raw = span / target;
  const double power = std::pow(10.0, std::floor(std::log10(raw)));
  const double fraction = raw / power;
  return (fraction <= 1 ? 1 : fraction <= 2 ? 2 : fraction <= 5 ? 5 : 10) * power;
}

struct Range {
  double low = 0, high = 0;
};

Range FiniteRange(const std::vector<ChartSeries>& series, bool useX) {
  Range r{std::numeric_limits<double>::infinity(), -std::numeric_limits<double>::infinity()};
  for (const ChartSeries& s : series) {
    for (double v : useX ? s.x : s.y) {
      if (std::isfinite(v)) {
        r.low = std::min(r.low, v);
        r.high = std::max(r.high, v);
      }
    }
  }
  if (!(r.low <= r.high)) return {0, 1};
  if (r.low == r.high) {
    const double pad = r.low == 0 ? 1 : std::fabs(r.low) * 0.05;
    return {r.low - pad, r.high + pad};
  }
  return r;
}

// Multiples of `step` within the range (at most 50, so a step lost in rounding cannot loop).
std::vector<double> Ticks(const Range& r, double step) {
  std::vector<double> ticks;
  if (!(step > 0) || !std::isfinite(step)) return ticks;
  const double first = std::ceil(r.low / step - 1e-9);
  for (int k = 0; k < 50; ++k) {
    const double tick = (first + k) * step;
    if (tick > r.high + step * 1e-9) break;
    ticks.push_back(std::fabs(tick) < step * 1e-9 ? 0.0 : tick);
  }
  return ticks;
}

}  // namespace

std::string RenderCartesianSvg(const CartesianChart& chart) {
  const double plotW = kWidth - kLeft - kRight, plotH = kHeight - kTop - kBottom;
  const Range xr = FiniteRange(chart.series, true);
  Range yr;
  double yStep;
  if (chart.fixedY) {
    yr = {chart.yMin, chart.yMax};
    yStep = chart.yStep;
  } else {
    const Range data = FiniteRange(chart.series, false);
    yStep = NiceStep(data.high - data.low, 8);
    yr = {std::floor(data.low / yStep) * yStep, std::ceil(data.high / yStep) * yStep};
  }
  const auto mapX = [&](double x) { return kLeft + (x - xr.low) / (xr.high - xr.low) * plotW; };
  const auto mapY = [&](double y) { return kTop + (yr.high - y) / (yr.high - yr.low) * plotH; };

  std::string svg = Header(kWidth, HeightFor(chart.series.size()), chart.title);
  svg += "<clipPath id=\"plot\"><rect x=\"" + Num(kLeft) + "\" y=\"" + Num(kTop) + "\" width=\"" +
         Num(plotW) + "\" height=\"" + Num(plotH) + "\"/></clipPath>\n";
  const char* grid = "stroke=\"#d9d9d9\" stroke-width=\"1\"";
  const double xStep = NiceStep(xr.high - xr.low, 8);
  for (const double tick : Ticks(xr, xStep)) {
    const double px = mapX(tick);
    svg += Line(px, kTop, px, kTop + plotH, grid);
    svg += Text(px, kTop + plotH + 20, WithUnit(tick, chart.xUnit, chart.xSiPrefix, 6), "middle");
  }
  for (const double tick : Ticks(yr, yStep)) {
    const double py = mapY(tick);
    svg += Line(kLeft, py, kLeft + plotW, py, grid);
    char label[32];
    std::snprintf(label, sizeof label, "%g", tick);
    svg += Text(kLeft - 8, py + 4.5, label, "end");
  }
  svg += "<rect x=\"" + Num(kLeft) + "\" y=\"" + Num(kTop) + "\" width=\"" + Num(plotW) +
         "\" height=\"" + Num(plotH) + "\" fill=\"none\" stroke=\"#404040\"/>\n";
  const std::string xTitle =
      chart.xUnit.empty() ? chart.xQuantity : chart.xQuantity + " (" + chart.xUnit + ")";
  svg += Text(kLeft + plotW / 2, kHeight - 22, xTitle, "middle");
  svg += Text(24, kTop + plotH / 2, chart.yLabel, "middle",
              (" transform=\"rotate(-90 24 " + Num(kTop + plotH / 2) + ")\"").c_str());
  svg += "<g clip-path=\"url(#plot)\">\n";
  for (std::size_t i = 0; i < chart.series.size(); ++i) {
    svg += Polylines(
        chart.series[i],
        [&](double x, double y) {
          return std::pair{mapX(x), mapY(y)};
        },
        Colour(i), true, plotW);
  }
  svg += "</g>\n" + Legend(chart.series, kLeft + plotW + 24, kTop + 12) + "</svg>\n";
  return svg;
}

std::string RenderSmithSvg(const std::string& title, const std::vector<ChartSeries>& series) {
  const double radius = (kHeight - kTop - 40) / 2;
  const double cx = kLeft + radius, cy = kTop + radius + 10;
  const auto map = [&](double re, double im) {
    return std::pair{cx + re * radius, cy - im * radius};
  };
  std::string svg = Header(kLeft + 2 * radius + kRight + 60, HeightFor(series.size() + 1), title);
  svg += "<clipPath id=\"unit\"><circle cx=\"" + Num(cx) + "\" cy=\"" + Num(cy) + "\" r=\"" +
         Num(radius) + "\"/></clipPath>\n";
  const char* grid = "fill=\"none\" stroke=\"#d0d0d0\" stroke-width=\"1\"";
  const double values[] = {0.2, 0.5, 1, 2, 5};
  svg += "<g clip-path=\"url(#unit)\">\n";
  for (double r : values) {
    // Constant resistance r: centre r/(1+r) on the real axis, radius 1/(1+r).
    const auto [px, py] = map(r / (1 + r), 0);
    svg += "<circle cx=\"" + Num(px) + "\" cy=\"" + Num(py) + "\" r=\"" + Num(radius / (1 + r)) +
           "\" " + grid + "/>\n";
  }
  for (double x : values) {
    // Constant reactance +-x: centre (1, +-1/x), radius 1/x.
    for (double sign : {1.0, -1.0}) {
      const auto [px, py] = map(1, sign / x);
      svg += "<circle cx=\"" + Num(px) + "\" cy=\"" + Num(py) + "\" r=\"" + Num(radius / x) +
             "\" " + grid + "/>\n";
    }
  }
  svg += "</g>\n";
  svg += Line(cx - radius, cy, cx + radius, cy, "stroke=\"#b0b0b0\" stroke-width=\"1\"");
  svg += "<circle cx=\"" + Num(cx) + "\" cy=\"" + Num(cy) + "\" r=\"" + Num(radius) +
         "\" fill=\"none\" stroke=\"#404040\" stroke-width=\"1.2\"/>\n";
  char label[16];
  for (double r : values) {
    std::snprintf(label, sizeof label, "%g", r);
    const auto [px, py] = map((r - 1) / (r + 1), 0);
    svg += Text(px + 3, py - 4, label, "start", " font-size=\"11\" fill=\"#707070\"");
  }
  for (double x : values) {
    for (double sign : {1.0, -1.0}) {
      // Where reactance sign*x meets the rim: (jx - 1)/(jx + 1).
      const double d = 1 + x * x;
      const double re = (x * x - 1) / d, im = sign * 2 * x / d;
      const auto [px, py] = map(re * 1.07, im * 1.07);
      std::snprintf(label, sizeof label, "%s%gj", sign < 0 ? "-" : "", x);
      svg += Text(px, py + 4, label, "middle", " font-size=\"11\" fill=\"#707070\"");
    }
  }
  for (std::size_t i = 0; i < series.size(); ++i) {
    svg += Polylines(series[i], map, Colour(i), false, 0);
    if (!series[i].x.empty() && std::isfinite(series[i].x[0]) && std::isfinite(series[i].y[0])) {
      const auto [px, py] = map(series[i].x[0], series[i].y[0]);
      svg += "<circle cx=\"" + Num(px) + "\" cy=\"" + Num(py) + "\" r=\"3.5\" fill=\"" + Colour(i) +
             "\"/>\n";
    }
  }
  svg += Legend(series, cx + radius + 50, kTop + 12);
  svg += Text(cx + radius + 50, kTop + 12 + kLegendRow * static_cast<double>(series.size()) + 10, "dot: first point", "start",
              " font-size=\"11\" fill=\"#707070\"");
  svg += "</svg>\n";
  return svg;
}

}  // namespace lumenutil
