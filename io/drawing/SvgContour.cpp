#include "io/drawing/SvgContour.h"

#include "io/drawing/Decimation.h"
#include "io/drawing/Style.h"
#include "io/drawing/SvgBand.h"
#include "io/drawing/SvgElements.h"
#include "io/drawing/SvgEnds.h"
#include "io/drawing/SvgPieces.h"
#include "io/drawing/SvgPoints.h"

namespace Vorn::IO::Svg {

namespace {

constexpr double kLeastGrid = 90.0;
constexpr double kTickText = 11.0;
constexpr double kTitleRoom = 70.0;  ///< for the title of the lower axis

std::string Grid(View const& view) {
  Rect const& frame = view.Frame();
  Box const box = view.Visible();
  double const leastStep = kLeastGrid / view.Scale();
  std::string const line = "stroke=\"" + kGridColor + "\" stroke-width=\"0.7\"";
  std::string const size = "font-size=\"" + Px(kTickText) + "\" ";
  std::string svg;
  Ticks const columns = TicksBetween(box.xMin, box.xMax, leastStep);
  for (double const x : columns.values) {
    double const at = view(x, 0.0).x;
    svg += LineElement({at, frame.top}, {at, frame.Bottom()}, line);
    if (at > frame.Right() - kTitleRoom) continue;
    svg += Text({at, frame.Bottom() + 15.0}, size + "text-anchor=\"middle\"", columns.Label(x));
  }
  Ticks const rows = TicksBetween(box.yMin, box.yMax, leastStep);
  for (double const y : rows.values) {
    double const at = view(0.0, y).y;
    svg += LineElement({frame.left, at}, {frame.Right(), at}, line);
    svg += Text({frame.left - 6.0, at + 4.0}, size + "text-anchor=\"end\"", rows.Label(y));
  }
  return svg;
}

/// "x [mm]" behind the last number of the lower axis, "y [mm]" above those of the other.
std::string AxisTitles(Scene const& scene) {
  Rect const& frame = scene.view.Frame();
  std::string const units = scene.drawing.units.empty() ? "" : " [" + scene.drawing.units + "]";
  std::string const size = "font-size=\"" + Px(kTickText) + "\" ";
  return Text({frame.Right(), frame.Bottom() + 15.0}, size + "text-anchor=\"end\"", "x" + units) +
         Text({frame.left - 6.0, frame.top - 7.0}, size + "text-anchor=\"end\"", "y" + units);
}

std::string PointsAlone(Scene const& scene) {
  return DirectionArrows(scene) + MeasuredPoints(scene) + EndsOfPoints(scene);
}

std::string FittedContour(Scene const& scene) {
  // So many points would hide the contour.
  bool const areMany = scene.drawing.points.size() > kMostExactDots;
  std::string const pieces = Pieces(scene);
  std::string const points = Whiskers(scene) + MeasuredPoints(scene);
  return (areMany ? points + pieces : pieces + points) + Joints(scene) + ContourEnds(scene) +
         OutsidePoints(scene) + WorstPoint(scene) + PieceLabels(scene);
}

}  // namespace

std::string ContourPlot(Scene const& scene) {
  Rect const& frame = scene.view.Frame();
  return "<g id=\"contour\">\n" + Grid(scene.view) + AxisTitles(scene) + "<clipPath id=\"frame\">" +
         RectElement(frame, "") + "</clipPath>\n<g clip-path=\"url(#frame)\">\n" +
         ToleranceBand(scene) + (scene.HasContour() ? FittedContour(scene) : PointsAlone(scene)) +
         "</g>\n" +
         RectElement(frame, "fill=\"none\" stroke=\"" + kFrameColor + "\" stroke-width=\"0.9\"") +
         "</g>\n";
}

}  // namespace Vorn::IO::Svg
