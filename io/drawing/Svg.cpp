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
constexpr double kContourTop = 92.0;
constexpr double kPageBottom = kPageHeight - 54.0;

/// Between the frames of the contour and of the diagram: tick labels, legend, heading and strip.
constexpr double kLegendDrop = 42.0;
constexpr double kBetweenFrames = 104.0;
constexpr double kLeastDiagram = 150.0;
constexpr double kMostDiagram = 300.0;
constexpr double kLegendHeight = 66.0;

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

Scene SceneOf(Drawing const& drawing) {
  double const width = kPageWidth - kLeft - kRight;
  double const room = kPageBottom - kContourTop;
  if (!drawing.IsMeasured()) {
    double const height = room - kLegendHeight + 20.0;
    return MakeScene(drawing, {kLeft, kContourTop, width, height}, height);
  }
  double const least = room - kBetweenFrames - kMostDiagram;
  return MakeScene(drawing, {kLeft, kContourTop, width, least},
                   room - kBetweenFrames - kLeastDiagram);
}

std::string Diagram(Scene const& scene) {
  if (!scene.IsMeasured()) return "";
  double const top = scene.view.Frame().Bottom() + kBetweenFrames;
  return DeviationPlot(scene, {kLeft, top, scene.view.Frame().width, kPageBottom - top});
}

}  // namespace

std::string ToSvg(Drawing const& drawing) {
  drawing.RequireContent();
  Scene const scene = SceneOf(drawing);
  return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
         "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"297mm\" height=\"210mm\" "
         "viewBox=\"0 0 " +
         Px(kPageWidth) + " " + Px(kPageHeight) + "\">\n" + kStyle +
         "<rect x=\"-9\" y=\"-9\" width=\"110%\" height=\"110%\" fill=\"white\"/>\n<g fill=\"" +
         kTextColor + "\">\n" + Title(drawing) + ContourPlot(scene) +
         LegendRow(scene, scene.view.Frame().Bottom() + kLegendDrop) + Diagram(scene) +
         "</g>\n</svg>\n";
}

}  // namespace Vorn::IO
