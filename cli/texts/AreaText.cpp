#include "cli/texts/AreaText.h"

#include <algorithm>
#include <cmath>

#include "cli/texts/Columns.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr int kDigits = 10;

std::string Number(double value) { return FormatShort(value, kDigits); }

std::string PointText(XY const& point) {
  return "(" + Number(point.x) + ", " + Number(point.y) + ")";
}

std::string Heading(ContourArea const& area) {
  std::vector<Piece> const& pieces = area.contour.pieces;
  auto const arcs = static_cast<std::size_t>(std::count_if(
      pieces.begin(), pieces.end(), [](Piece const& piece) { return piece.IsArc(); }));
  std::string const& units = area.contour.units;
  std::string const outline = area.outline == 0 ? ""
                                                : ", outline " + std::to_string(area.outline) +
                                                      (area.IsHole() ? " (a hole)" : "");
  return area.contour.path + outline + ": " + Counted(pieces.size(), "piece") + ", " +
         Counted(pieces.size() - arcs, "line") + ", " + Counted(arcs, "arc") +
         (units.empty() ? "" : ", lengths in " + units) + "\n";
}

std::string CrossingText(ContourArea const& area) {
  if (!area.crossesItself) return "the contour does not cross itself";
  return "THE CONTOUR CROSSES ITSELF: the area is the sum of its loops, each with its sign";
}

}  // namespace

std::string ToText(ContourArea const& area) {
  std::string text = Heading(area);
  text += Fact("area", Number(std::fabs(area.signedArea)));
  text += Fact("signed", Number(area.signedArea) + ", positive counter-clockwise with y up");
  text += Fact("sense", SenseOf(area));
  text += Fact("perimeter", Number(area.perimeter));
  text += Fact("centroid", area.centroid ? PointText(*area.centroid) : "none");
  text += Fact("box", PointText(area.extent.low) + " to " + PointText(area.extent.high));
  text += Fact("crossing", CrossingText(area));
  for (Gap const& gap : area.gaps) text += Fact("gap", Describe(gap) + ", bridged");
  return text;
}

std::string NetText(std::vector<ContourArea> const& areas) {
  auto const holes = static_cast<std::size_t>(std::count_if(
      areas.begin(), areas.end(), [](ContourArea const& area) { return area.IsHole(); }));
  return areas.front().contour.path + ": " + Counted(areas.size(), "outline") + ", " +
         Counted(holes, "hole") + "\n" + Fact("area", Number(NetArea(areas)) + ", holes taken off");
}

}  // namespace Vorn::Cli
