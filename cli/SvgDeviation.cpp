#include "cli/SvgDeviation.h"

#include <algorithm>
#include <cmath>

#include "cli/Numbers.h"
#include "cli/SvgStyle.h"

namespace Vorn::Cli::Svg {

namespace {

constexpr double kLeastRange = 1.25;
constexpr double kLeastColumn = 90.0;
constexpr double kLeastRow = 26.0;

/// Maps point numbers and relative deviations into the frame.
class Chart {
 public:
  Chart(Report const& report, Rect const& frame)
      : frame_(frame),
        lastIndex_(static_cast<double>(report.file.points.size() - 1)),
        range_(std::max(kLeastRange, 1.15 * report.remeasured.Worst().relative)) {}

  Pixel operator()(double index, double relative) const {
    return {frame_.left + kInset + (frame_.width - 2.0 * kInset) * index / lastIndex_,
            frame_.top + 0.5 * frame_.height * (1.0 - relative / range_)};
  }

  Rect const& Frame() const { return frame_; }
  double LastIndex() const { return lastIndex_; }
  double Range() const { return range_; }

 private:
  static constexpr double kInset = 8.0;

  Rect frame_;
  double lastIndex_;
  double range_;
};

std::string Band(Chart const& chart) {
  Rect const& frame = chart.Frame();
  double const top = chart(0.0, 1.0).y;
  double const bottom = chart(0.0, -1.0).y;
  std::string const edge = "stroke=\"" + kBandEdgeColor + "\"";
  return RectElement({frame.left, top, frame.width, bottom - top}, "fill=\"" + kBandColor + "\"") +
         LineElement({frame.left, top}, {frame.Right(), top}, edge) +
         LineElement({frame.left, bottom}, {frame.Right(), bottom}, edge);
}

std::string Axes(Chart const& chart) {
  Rect const& frame = chart.Frame();
  std::string svg;
  double const pointsPerPixel = chart.LastIndex() / frame.width;
  Ticks const columns =
      TicksBetween(0.0, chart.LastIndex(), std::max(1.0, kLeastColumn * pointsPerPixel));
  for (double const index : columns.values) {
    svg += Text({chart(index, 0.0).x, frame.Bottom() + 15.0},
                "font-size=\"11\" text-anchor=\"middle\"", columns.Label(index));
  }
  double const rangePerPixel = 2.0 * chart.Range() / frame.height;
  Ticks const rows =
      TicksBetween(-chart.Range(), chart.Range(), std::max(0.5, kLeastRow * rangePerPixel));
  for (double const relative : rows.values) {
    svg += Text({frame.left - 6.0, chart(0.0, relative).y + 4.0},
                "font-size=\"11\" text-anchor=\"end\"", rows.Label(relative));
  }
  double const zero = chart(0.0, 0.0).y;
  return svg + LineElement({frame.left, zero}, {frame.Right(), zero},
                           "stroke=\"" + kFrameColor + "\" stroke-width=\"0.8\"");
}

/// Dotted lines where one piece ends and the next begins, between the last and the first point.
std::string PieceBorders(Report const& report, Chart const& chart) {
  if (!report.ranges) return "";
  Rect const& frame = chart.Frame();
  std::string svg =
      "<g stroke=\"" + kFrameColor + "\" stroke-width=\"0.8\" stroke-dasharray=\"2 3\">\n";
  for (PointRange const& range : *report.ranges) {
    if (range.count == 0 || range.first == 0) continue;
    double const x = chart(static_cast<double>(range.first) - 0.5, 0.0).x;
    svg += LineElement({x, frame.top}, {x, frame.Bottom()}, "");
  }
  return svg + "</g>\n";
}

std::string DeviationDots(Report const& report, Chart const& chart) {
  std::vector<Pixel> onLines;
  std::vector<Pixel> onArcs;
  for (std::size_t i = 0; i < report.remeasured.points.size(); ++i) {
    PointDeviation const& point = report.remeasured.points[i];
    double const signedValue = point.isLeft ? point.relative : -point.relative;
    std::vector<Pixel>& dots = report.pieces[point.piece].IsArc() ? onArcs : onLines;
    dots.push_back(chart(static_cast<double>(i), signedValue));
  }
  double const diameter = report.file.points.size() > 2000 ? 1.6 : 3.0;
  return Dots(onLines, diameter, kLineColor) + Dots(onArcs, diameter, kArcColor);
}

std::string Worst(Report const& report, Chart const& chart) {
  PointDeviation const& worst = report.remeasured.Worst();
  auto const index = static_cast<double>(report.remeasured.worst);
  Pixel const at = chart(index, worst.isLeft ? worst.relative : -worst.relative);
  bool const isOnRight = index > 0.75 * chart.LastIndex();
  return CircleElement(at, 6.0,
                       "fill=\"none\" stroke=\"" + kWorstColor + "\" stroke-width=\"1.6\"") +
         Text({at.x + (isOnRight ? -10.0 : 10.0), at.y + 4.0},
              "font-size=\"11\" class=\"halo\" fill=\"" + kWorstColor + "\" text-anchor=\"" +
                  (isOnRight ? "end" : "start") + "\"",
              FormatShort(worst.relative, 4) + " at point " +
                  std::to_string(report.remeasured.worst));
}

std::string AxisTitles(Chart const& chart) {
  Rect const& frame = chart.Frame();
  double const x = frame.left - 44.0;
  double const y = frame.top + 0.5 * frame.height;
  std::string const turn =
      " transform=\"rotate(-90 " + Px(x) + " " + Px(y) + ")\" text-anchor=\"middle\"";
  return Text({x, y}, "font-size=\"11\"" + turn, "deviation / tolerance") +
         Text({frame.left + 0.5 * frame.width, frame.Bottom() + 32.0},
              "font-size=\"11\" text-anchor=\"middle\"",
              "point number; positive: to the left of the direction of travel");
}

}  // namespace

std::string DeviationPlot(Report const& report, Rect const& frame) {
  Chart const chart(report, frame);
  return "<g id=\"deviation\">\n" + RectElement(frame, "fill=\"white\"") + Band(chart) +
         PieceBorders(report, chart) + Axes(chart) + DeviationDots(report, chart) +
         Worst(report, chart) + RectElement(frame, "fill=\"none\" stroke=\"" + kFrameColor + "\"") +
         AxisTitles(chart) + "</g>\n";
}

}  // namespace Vorn::Cli::Svg
