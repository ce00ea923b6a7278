// The second opinion on a fit. It shares no formula with the library: distances are taken to the
// pieces as drawn, clipped at their ends, and not to the endless lines and full circles that a
// fit works with.
#include <algorithm>
#include <cmath>
#include <limits>

#include "io/pieces/PieceIndex.h"
#include "vorn/io/Deviations.h"

namespace Vorn::IO {

namespace {

bool IsLeftOf(Piece const& piece, double x, double y) {
  if (piece.IsArc()) {
    bool const isInside = std::hypot(x - piece.center.x, y - piece.center.y) < piece.radius;
    return isInside == piece.counterClockwise;
  }
  return (piece.end.x - piece.start.x) * (y - piece.start.y) >
         (piece.end.y - piece.start.y) * (x - piece.start.x);
}

}  // namespace

Remeasured Remeasure(std::vector<WPoint> const& points, std::vector<Piece> const& pieces) {
  PieceIndex const index(pieces);
  Remeasured result;
  result.points.reserve(points.size());
  std::size_t piece = 0;
  for (WPoint const& point : points) {
    // Points come in the order of the contour: the piece of the one before is a good guess.
    PieceIndex::Nearest const nearest = index.Find(point.x, point.y, piece);
    piece = nearest.piece;
    result.points.push_back({nearest.distance, nearest.distance / point.w,
                             IsLeftOf(pieces[piece], point.x, point.y), piece});
    if (result.points.back().relative > result.Worst().relative) {
      result.worst = result.points.size() - 1;
    }
  }
  return result;
}

bool IsWithinTolerance(PointDeviation const& deviation, WPoint const& point) {
  // Both ends and the centre of a piece are rounded by at most half a last place each, in x and in
  // y; four whole ones are beyond what can come together.
  constexpr double kLastPlaces = 4.0 * std::numeric_limits<double>::epsilon();
  double const rounding = kLastPlaces * std::max(std::fabs(point.x), std::fabs(point.y));
  return deviation.distance <= kLargestRelative * point.w + rounding;
}

bool AreWithinTolerance(Remeasured const& measured, std::vector<WPoint> const& points) {
  return std::equal(measured.points.begin(), measured.points.end(), points.begin(), points.end(),
                    IsWithinTolerance);
}

}  // namespace Vorn::IO
