#include "io/drawing/SvgDeviation.h"

#include <algorithm>
#include <cmath>

#include "io/drawing/Style.h"
#include "io/drawing/SvgElements.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Svg {

namespace {

constexpr double kLeastColumn = 90.0;
constexpr double kLeastRow = 24.0;
constexpr double kStripHeight = 13.0;
constexpr double kLeastNumberedStrip = 9.0;
constexpr double kDigitWidth = 7.0;
constexpr double kLeastStemGap = 3.0;
constexpr double kDeviationCell = 1.0;

/// Less does not hold the title and the note side by side.
constexpr double kLeastWideHeading = 900.0;
constexpr double kHeadingLine = 16.0;

/// Maps lengths along the contour and deviations into the frame.
class Chart {
 public:
  Chart(Scene const& scene, Rect const& frame)
      : frame_(frame),
        starts_(PieceStarts(scene.drawing.pieces)),
        isRelative_(scene.drawing.HasTolerances() && !scene.drawing.IsToleranceUniform()) {
    Drawing const& drawing = scene.drawing;
    if (drawing.HasTolerances()) limit_ = isRelative_ ? 1.0 : drawing.LargestTolerance();
    double const worst = std::fabs(ValueOf(drawing.deviations[drawing.Worst()]));
    range_ = std::max(1.3 * limit_, 1.15 * worst);
    if (!(range_ > 0.0) || !std::isfinite(range_)) range_ = 1.0;
  }

  Pixel operator()(double along, double value) const {
    double const share = Length() > 0.0 ? along / Length() : 0.0;
    return {frame_.left + frame_.width * share,
            frame_.top + 0.5 * frame_.height * (1.0 - value / range_)};
  }

  double ValueOf(PointDeviation const& deviation) const {
    double const size = isRelative_ ? deviation.relative : deviation.distance;
    return deviation.isLeft ? size : -size;
  }

  Pixel PlaceOf(Scene const& scene, std::size_t point) const {
    PointDeviation const& deviation = scene.drawing.deviations[point];
    return (*this)(starts_[deviation.piece] + scene.feet[point].along, ValueOf(deviation));
  }

  Rect const& Frame() const { return frame_; }
  std::vector<double> const& Starts() const { return starts_; }
  double Length() const { return starts_.back(); }
  double Range() const { return range_; }
  double Limit() const { return limit_; }  ///< 0 without tolerances
  bool IsRelative() const { return isRelative_; }

 private:
  Rect frame_;
  std::vector<double> starts_;
  bool isRelative_;
  double limit_ = 0.0;
  double range_ = 1.0;
};

std::string Band(Chart const& chart) {
  if (!(chart.Limit() > 0.0)) return "";
  Rect const& frame = chart.Frame();
  double const top = chart(0.0, chart.Limit()).y;
  double const bottom = chart(0.0, -chart.Limit()).y;
  std::string const edge = "stroke=\"" + kBandEdgeColor + "\" stroke-width=\"1.2\"";
  return RectElement({frame.left, top, frame.width, bottom - top}, "fill=\"" + kBandColor + "\"") +
         LineElement({frame.left, top}, {frame.Right(), top}, edge) +
         LineElement({frame.left, bottom}, {frame.Right(), bottom}, edge);
}

std::string Axes(Chart const& chart) {
  Rect const& frame = chart.Frame();
  std::string svg;
  Ticks const columns =
      TicksBetween(0.0, chart.Length(), kLeastColumn * chart.Length() / frame.width);
  for (double const along : columns.values) {
    double const x = chart(along, 0.0).x;
    svg += LineElement({x, frame.Bottom()}, {x, frame.Bottom() + 4.0},
                       "stroke=\"" + kFrameColor + "\" stroke-width=\"0.9\"");
    svg += Text({x, frame.Bottom() + 16.0}, "font-size=\"11\" text-anchor=\"middle\"",
                columns.Label(along));
  }
  double const rangePerPixel = 2.0 * chart.Range() / frame.height;
  Ticks const rows = TicksBetween(-chart.Range(), chart.Range(), kLeastRow * rangePerPixel);
  for (double const value : rows.values) {
    double const y = chart(0.0, value).y;
    svg += LineElement({frame.left - 4.0, y}, {frame.left, y},
                       "stroke=\"" + kFrameColor + "\" stroke-width=\"0.9\"");
    svg += Text({frame.left - 7.0, y + 4.0}, "font-size=\"11\" text-anchor=\"end\"",
                rows.Label(value));
  }
  double const zero = chart(0.0, 0.0).y;
  return svg + LineElement({frame.left, zero}, {frame.Right(), zero},
                           "stroke=\"" + kFrameColor + "\" stroke-width=\"0.8\"");
}

/// Above the diagram a strip with the pieces by kind, numbered where there is room.
std::string Strip(Scene const& scene, Chart const& chart) {
  Rect const& frame = chart.Frame();
  double const top = frame.top - kStripHeight;
  std::string data[2];
  std::string numbers;
  for (std::size_t i = 0; i < scene.drawing.pieces.size(); ++i) {
    double const left = chart(chart.Starts()[i], 0.0).x;
    double const right = chart(chart.Starts()[i + 1], 0.0).x;
    data[scene.drawing.pieces[i].IsArc() ? 1 : 0] += "M" + Px(Pixel{left, top}) + "H" + Px(right) +
                                                     "v" + Px(kStripHeight) + "H" + Px(left) + "z";
    std::string const number = std::to_string(i + 1);
    double const needed = kDigitWidth * static_cast<double>(number.size()) + 3.0;
    if (right - left < std::max(needed, kLeastNumberedStrip)) continue;
    numbers += Text({0.5 * (left + right), frame.top - 3.0}, "", number);
  }
  return PathElement(data[0], "fill=\"" + kLineTint + "\"") +
         PathElement(data[1], "fill=\"" + kArcTint + "\"") +
         "<g font-size=\"9.5\" text-anchor=\"middle\">\n" + numbers + "</g>\n";
}

std::string Joints(Chart const& chart) {
  Rect const& frame = chart.Frame();
  std::string data;
  double before = frame.left;
  for (std::size_t i = 1; i + 1 < chart.Starts().size(); ++i) {
    double const x = chart(chart.Starts()[i], 0.0).x;
    if (x - before < 1.0) continue;
    data += "M" + Px(Pixel{x, frame.top - kStripHeight}) + "V" + Px(frame.Bottom());
    before = x;
  }
  return PathElement(
      data, "class=\"joint-lines\" fill=\"none\" stroke=\"" + kFrameColor + "\" stroke-width=\"" +
                (chart.Starts().size() > 60 ? "0.35" : "0.7") + "\" stroke-dasharray=\"2 2.5\"");
}

/// Lines from zero to each deviation, where there are few enough to tell them apart.
std::string Stems(Scene const& scene, Chart const& chart) {
  auto const count = static_cast<double>(scene.drawing.points.size());
  if (count * kLeastStemGap > chart.Frame().width) return "";
  std::string data;
  for (std::size_t i = 0; i < scene.drawing.points.size(); ++i) {
    Pixel const at = chart.PlaceOf(scene, i);
    data += "M" + Px(at) + "V" + Px(chart(0.0, 0.0).y);
  }
  return PathElement(
      data, "class=\"stems\" fill=\"none\" stroke=\"" + kWhiskerColor + "\" stroke-width=\"0.5\"");
}

std::string DeviationDots(Scene const& scene, Chart const& chart) {
  std::vector<Pixel> onLines;
  std::vector<Pixel> onArcs;
  std::string outside;
  for (std::size_t i = 0; i < scene.drawing.points.size(); ++i) {
    Pixel const at = chart.PlaceOf(scene, i);
    if (scene.IsOutside(i)) {
      outside += "M" + Px(Pixel{at.x - 2.5, at.y - 2.5}) + "l5,5m0-5l-5,5";
    } else {
      (scene.IsOnArc(i) ? onArcs : onLines).push_back(at);
    }
  }
  double const diameter = scene.drawing.points.size() > 1000 ? 1.8 : 3.0;
  return Dots(onLines, {"deviations lines", kLineColor, diameter, false, kDeviationCell}) +
         Dots(onArcs, {"deviations arcs", kArcColor, 0.86 * diameter, true, kDeviationCell}) +
         PathElement(outside, "class=\"outside\" fill=\"none\" stroke=\"" + kOutsideColor +
                                  "\" stroke-width=\"1\"");
}

std::string WithUnits(Scene const& scene, std::string const& text) {
  return scene.drawing.units.empty() ? text : text + " " + scene.drawing.units;
}

std::string Worst(Scene const& scene, Chart const& chart) {
  return CircleElement(
      chart.PlaceOf(scene, scene.drawing.Worst()), 6.0,
      "class=\"worst\" fill=\"none\" stroke=\"" + kWorstColor + "\" stroke-width=\"1.6\"");
}

/// "largest 0.0079 mm at point 84", beside the heading: inside the diagram it would hide points.
std::string LargestText(Scene const& scene, Chart const& chart) {
  std::size_t const point = scene.drawing.Worst();
  PointDeviation const& worst = scene.drawing.deviations[point];
  std::string const value = chart.IsRelative() ? FormatRelative(worst.relative)
                                               : WithUnits(scene, FormatShort(worst.distance, 4));
  return ": largest " + value + " at point " + std::to_string(point);
}

/// "Deviation [mm]", shorter where there is less room.
std::string Title(Chart const& chart, std::string const& units, bool isNarrow) {
  if (!chart.IsRelative()) return "Deviation" + units;
  return isNarrow ? "Deviation in tolerances" : "Deviation as a multiple of the point's tolerance";
}

/// The title, and what else the reader has to know: behind it, or between it and a narrow diagram.
std::string Heading(Scene const& scene, Chart const& chart) {
  Rect const& frame = chart.Frame();
  bool const isNarrow = frame.width < kLeastWideHeading;
  std::string const units = scene.drawing.units.empty() ? "" : " [" + scene.drawing.units + "]";
  double const line = frame.top - kStripHeight - 7.0;
  Pixel const noteAt{isNarrow ? frame.left : frame.Right(), line};
  std::string const anchor = isNarrow ? "start" : "end";
  return Text({frame.left, isNarrow ? line - kHeadingLine : line},
              "font-size=\"12\" font-weight=\"bold\"",
              Title(chart, units, isNarrow) + LargestText(scene, chart)) +
         Text(noteAt, "font-size=\"11\" text-anchor=\"" + anchor + "\"",
              "positive: to the left of the direction of travel; strip: pieces by kind") +
         Text({frame.left + 0.5 * frame.width, frame.Bottom() + 31.0},
              "font-size=\"11\" text-anchor=\"middle\"", "length along the contour" + units);
}

}  // namespace

std::string DeviationPlot(Scene const& scene, Rect const& frame) {
  Chart const chart(scene, frame);
  std::string const outline = "fill=\"none\" stroke=\"" + kFrameColor + "\" stroke-width=\"0.9\"";
  return "<g id=\"deviation\">\n" + Band(chart) + Strip(scene, chart) + Joints(chart) +
         Axes(chart) + Stems(scene, chart) + DeviationDots(scene, chart) + Worst(scene, chart) +
         RectElement(frame, outline) + Heading(scene, chart) + "</g>\n";
}

}  // namespace Vorn::IO::Svg
