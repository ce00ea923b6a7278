#include <algorithm>
#include <utility>

#include "io/drawing/Legend.h"
#include "io/drawing/Scene.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgContour.h"
#include "io/drawing/SvgDeviation.h"
#include "io/drawing/SvgElements.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

using namespace Svg;

// A4 across, at 96 pixels to the inch.
constexpr double kPageWidth = 1123.0;
constexpr double kPageHeight = 794.0;
constexpr double kLeft = 78.0;
constexpr double kRight = 34.0;
constexpr double kFullWidth = kPageWidth - kLeft - kRight;
constexpr double kContourTop = 92.0;
constexpr double kPageBottom = kPageHeight - 54.0;

/// Between the frames of the contour and of the diagram: tick labels, legend, heading and strip.
constexpr double kLegendDrop = 42.0;
constexpr double kBetweenFrames = 104.0;
constexpr double kLeastDiagram = 150.0;
constexpr double kMostDiagram = 300.0;
constexpr double kLegendHeight = 66.0;

/// A contour so many times as high as it is wide has the diagram beside it instead of below, and
/// one line for the legend at the bottom of the page. Both frames end where the other numbers of
/// the diagram and its title still fit above that line.
constexpr double kLeastTall = 1.2;
constexpr double kTallTop = 108.0;
constexpr double kTallBottom = 720.0;
constexpr double kTallLegend = 776.0;
constexpr double kLeastTallWidth = 340.0;
constexpr double kMostTallWidth = 480.0;
constexpr double kLabelWidth = 90.0;     ///< of a piece, to either side of the contour
constexpr double kBesideFrames = 78.0;   ///< for the numbers of the diagram
constexpr double kNarrowHeading = 26.0;  ///< the heading of a narrow diagram takes two lines

constexpr char const* kStyle =
    "<style>text { font-family: 'DejaVu Sans', Verdana, Arial, sans-serif; } "
    ".halo, .halo text { paint-order: stroke; stroke: white; stroke-width: 3px; "
    "stroke-linejoin: round; }</style>\n";

std::string Counts(Drawing const& drawing) {
  std::string counts;
  if (!drawing.points.empty()) counts = Counted(drawing.points.size(), "point");
  if (drawing.HasContour()) {
    if (!counts.empty()) counts += ", ";
    counts += Counted(drawing.pieces.size() - drawing.ArcCount(), "line") + " and " +
              Counted(drawing.ArcCount(), "arc");
  }
  return counts;
}

std::string FactsOf(Drawing const& drawing) {
  std::string facts = Counts(drawing);
  for (std::string const& fact : drawing.facts) {
    if (!fact.empty()) facts += ", " + fact;
  }
  if (!drawing.units.empty()) facts += "; lengths in " + drawing.units;
  return facts;
}

std::string Judgement(Drawing const& drawing) {
  if (!drawing.IsMeasured()) return "";
  std::size_t const index = drawing.Worst();
  PointDeviation const& worst = drawing.deviations[index];
  std::string text =
      drawing.verdict ? Describe(*drawing.verdict) + ": largest deviation " : "largest deviation ";
  text += FormatShort(worst.distance, 4);
  if (!drawing.units.empty()) text += " " + drawing.units;
  if (drawing.HasTolerances()) text += ", " + FormatRelative(worst.relative) + " of the tolerance,";
  return text + " at point " + std::to_string(index);
}

std::string Title(Drawing const& drawing) {
  bool const isBad = drawing.verdict && *drawing.verdict != Verdict::WithinTolerance;
  std::string const color = isBad ? kOutsideColor : (drawing.verdict ? kGoodTextColor : kTextColor);
  return Text({kLeft, 36.0}, "font-size=\"18\" font-weight=\"bold\"", drawing.title) +
         Text({kLeft, 57.0}, "font-size=\"12.5\"", FactsOf(drawing)) +
         Text({kLeft, 77.0},
              "font-size=\"12.5\" fill=\"" + color + "\"" + (isBad ? " font-weight=\"bold\"" : ""),
              Judgement(drawing));
}

/// Where contour, legend and diagram go on the page.
struct Page {
  Scene scene;
  double legendAt = 0.0;  ///< the line that the words of the legend stand on
  Rect diagram;           ///< only where something is measured
};

/// A contour without points, or points without a contour, has the page for itself.
Page PageAlone(Drawing const& drawing) {
  double const height = kPageBottom - kContourTop - kLegendHeight + 20.0;
  Scene scene = MakeScene(drawing, {kLeft, kContourTop, kFullWidth, height}, height);
  double const legendAt = scene.view.Frame().Bottom() + kLegendDrop;
  return {std::move(scene), legendAt, {}};
}

/// The diagram below the contour.
Page PageBelow(Drawing const& drawing) {
  double const room = kPageBottom - kContourTop - kBetweenFrames;
  Scene scene = MakeScene(drawing, {kLeft, kContourTop, kFullWidth, room - kMostDiagram},
                          room - kLeastDiagram);
  double const bottom = scene.view.Frame().Bottom();
  double const top = bottom + kBetweenFrames;
  return {std::move(scene), bottom + kLegendDrop, {kLeft, top, kFullWidth, kPageBottom - top}};
}

/// The diagram to the right of a tall contour, which has the height of the page.
Page PageBeside(Drawing const& drawing, Box const& box) {
  double const height = kTallBottom - kTallTop;
  double const needed = height * box.Width() / box.Height() + 2.0 * kLabelWidth;
  double const width = std::clamp(needed, kLeastTallWidth, kMostTallWidth);
  Scene scene = MakeScene(drawing, {kLeft, kTallTop, width, height}, height);
  double const left = kLeft + width + kBesideFrames;
  double const top = kTallTop + kNarrowHeading;
  return {std::move(scene), kTallLegend, {left, top, kLeft + kFullWidth - left, kTallBottom - top}};
}

Page PageOf(Drawing const& drawing) {
  if (!drawing.IsMeasured()) return PageAlone(drawing);
  Box const box = BoxAround(drawing);
  return box.Height() >= kLeastTall * box.Width() ? PageBeside(drawing, box) : PageBelow(drawing);
}

std::string Diagram(Page const& page) {
  return page.scene.IsMeasured() ? DeviationPlot(page.scene, page.diagram) : "";
}

}  // namespace

std::string ToSvg(Drawing const& drawing) {
  drawing.RequireContent();
  Page const page = PageOf(drawing);
  return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
         "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"297mm\" height=\"210mm\" "
         "viewBox=\"0 0 " +
         Px(kPageWidth) + " " + Px(kPageHeight) + "\">\n" + kStyle +
         "<rect x=\"-9\" y=\"-9\" width=\"110%\" height=\"110%\" fill=\"white\"/>\n<g fill=\"" +
         kTextColor + "\">\n" + Title(drawing) + ContourPlot(page.scene) +
         LegendRow(page.scene, page.legendAt) + Diagram(page) + "</g>\n</svg>\n";
}

}  // namespace Vorn::IO
