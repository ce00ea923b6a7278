// Area and centre of a region bounded by lines and arcs, by Green's theorem: those of the polygon
// of the ends plus, for each arc, those of the circular segment between the arc and its chord.
//
// The library's area is not used: it adds whole sectors, which cancel for shallow arcs of huge
// circles (a rise of 0.00005 over a chord of 100 costs five digits), and it refuses contours that
// cross themselves. Tests compare the two where the library's is good.

#include "vorn/io/ContourArea.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "io/pieces/Frame.h"
#include "vorn/io/Intersections.h"
#include "vorn/io/Outlines.h"

namespace Vorn::IO {

namespace {

/// Area and first moments (area times centre), positive counter-clockwise.
struct Moments {
  double area = 0.0;
  double x = 0.0;
  double y = 0.0;

  void Add(Moments const& other) {
    area += other.area;
    x += other.x;
    y += other.y;
  }
};

/// t - sin t, also where the two nearly cancel.
double MinusSine(double t) {
  constexpr double kSmall = 0.1;
  if (t > kSmall) return t - std::sin(t);
  // Ratios of neighbouring terms of the series: 2 * 3, 4 * 5, 6 * 7, 8 * 9.
  constexpr double kRatios[] = {6.0, 20.0, 42.0, 72.0};
  double const t2 = t * t;
  return t * t2 / kRatios[0] *
         (1.0 - t2 / kRatios[1] * (1.0 - t2 / kRatios[2] * (1.0 - t2 / kRatios[3])));
}

/// The triangle from the origin to the two points.
Moments TriangleTo(XY const& a, XY const& b) {
  double const area = 0.5 * (a.x * b.y - a.y * b.x);
  return {area, area * (a.x + b.x) / 3.0, area * (a.y + b.y) / 3.0};
}

/// What lies between the arc and its chord.
Moments SegmentOf(Piece const& arc) {
  double const sign = arc.counterClockwise ? 1.0 : -1.0;
  double const area = 0.5 * arc.radius * arc.radius * MinusSine(arc.sweep);
  double const reach = arc.radius * std::sin(0.5 * arc.sweep);
  double const aboutCenter = 2.0 / 3.0 * reach * reach * reach;
  XY const middle = PointOnArc(arc, 0.5 * arc.sweep);
  XY const outwards = {(middle.x - arc.center.x) / arc.radius,
                       (middle.y - arc.center.y) / arc.radius};
  return {sign * area, sign * (area * arc.center.x + aboutCenter * outwards.x),
          sign * (area * arc.center.y + aboutCenter * outwards.y)};
}

/// Of the closed way along the pieces, over their gaps in straight lines.
Moments MomentsOf(std::vector<Piece> const& pieces) {
  Moments sum;
  XY at = pieces.back().end;
  for (Piece const& piece : pieces) {
    sum.Add(TriangleTo(at, piece.start));
    sum.Add(TriangleTo(piece.start, piece.end));
    if (piece.IsArc()) sum.Add(SegmentOf(piece));
    at = piece.end;
  }
  return sum;
}

/// The middle of the box: products of coordinates seen from here stay small.
XY MiddleOf(Extent const& extent) {
  return {0.5 * (extent.low.x + extent.high.x), 0.5 * (extent.low.y + extent.high.y)};
}

/// With a line across every gap.
ContourFile Bridged(ContourFile contour) {
  std::vector<Piece> const pieces = std::move(contour.pieces);
  contour.pieces.clear();
  XY at = pieces.back().end;
  double const tolerance = JointTolerance(pieces);
  for (Piece const& piece : pieces) {
    if (Distance(at, piece.start) > tolerance) {
      contour.pieces.push_back(MakeLine(at, piece.start));
    }
    contour.pieces.push_back(piece);
    at = piece.end;
  }
  return contour;
}

double LengthOf(ContourArea const& area) {
  double length = 0.0;
  for (Piece const& piece : area.contour.pieces) length += piece.length;
  for (Gap const& gap : area.gaps) length += gap.size;
  return length;
}

std::optional<XY> CentroidOf(Moments const& moments, XY const& origin, Extent const& extent) {
  XY const center = {origin.x + moments.x / moments.area, origin.y + moments.y / moments.area};
  bool const isKnown = center.x >= extent.low.x && center.x <= extent.high.x &&
                       center.y >= extent.low.y && center.y <= extent.high.y;
  if (!isKnown) return {};  // nothing is enclosed but rounding
  return center;
}

}  // namespace

bool IsClosed(ContourFile const& contour) {
  return contour.isClosed || ReturnsToStart(contour.pieces);
}

ContourFile Closed(ContourFile contour) {
  if (!ReturnsToStart(contour.pieces)) {
    contour.pieces.push_back(MakeLine(contour.pieces.back().end, contour.pieces.front().start));
  }
  contour.isClosed = true;
  return contour;
}

double SignedAreaOf(ContourFile const& contour) {
  return MomentsOf(SeenFrom(MiddleOf(ExtentOf(contour.pieces)), contour.pieces)).area;
}

ContourArea MeasureArea(ContourFile contour) {
  ContourArea result;
  result.contour = std::move(contour);
  result.contour.isClosed = true;
  result.gaps = FindGaps(result.contour);
  result.extent = ExtentOf(result.contour.pieces);
  result.perimeter = LengthOf(result);
  XY const origin = MiddleOf(result.extent);
  ContourFile local = result.contour;
  local.pieces = SeenFrom(origin, std::move(local.pieces));
  result.crossesItself = Tally(SelfIntersectionsOf(Bridged(local))).crossings > 0;
  Moments const moments = MomentsOf(local.pieces);
  result.signedArea = moments.area;
  if (result.IsSimple()) result.centroid = CentroidOf(moments, origin, result.extent);
  return result;
}

std::string SenseOf(ContourArea const& area) {
  if (area.signedArea == 0.0) return "none";
  return area.signedArea > 0.0 ? "counter-clockwise" : "clockwise";
}

std::vector<ContourArea> MeasureOutlines(std::vector<ContourFile> outlines) {
  std::vector<std::size_t> const depths = DepthsOf(outlines);
  std::vector<ContourArea> areas;
  for (ContourFile& outline : outlines) {
    ContourArea area = MeasureArea(std::move(outline));
    area.outline = depths.size() > 1 ? areas.size() + 1 : 0;
    area.depth = depths[areas.size()];
    areas.push_back(std::move(area));
  }
  return areas;
}

double NetArea(std::vector<ContourArea> const& areas) {
  double net = 0.0;
  for (ContourArea const& area : areas) {
    net += area.IsHole() ? -std::fabs(area.signedArea) : std::fabs(area.signedArea);
  }
  return net;
}

}  // namespace Vorn::IO
