// The second opinion on a fit. It shares no formula with the library: distances are taken to the
// pieces as drawn, clipped at their ends, and not to the endless lines and full circles that a
// fit works with.
#include "cli/Remeasure.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "cli/PieceIndex.h"

namespace Vorn::Cli {

namespace {

using std::numbers::pi;

double DistanceToLine(Piece const& line, double x, double y) {
  double const alongX = line.end.x - line.start.x;
  double const alongY = line.end.y - line.start.y;
  double const fromX = x - line.start.x;
  double const fromY = y - line.start.y;
  double const length2 = alongX * alongX + alongY * alongY;
  if (!(length2 > 0.0)) return std::hypot(fromX, fromY);
  double const part = std::clamp((fromX * alongX + fromY * alongY) / length2, 0.0, 1.0);
  return std::hypot(fromX - part * alongX, fromY - part * alongY);
}

/// Radians turned from the start of the arc to the direction of (x, y), in [0, 2 pi).
double TurnTo(Piece const& arc, double x, double y) {
  double const polar = std::atan2(y - arc.center.y, x - arc.center.x);
  double turn =
      std::fmod(arc.counterClockwise ? polar - arc.startAngle : arc.startAngle - polar, 2.0 * pi);
  return turn < 0.0 ? turn + 2.0 * pi : turn;
}

double DistanceToArc(Piece const& arc, double x, double y) {
  double const toEnds = std::min(std::hypot(x - arc.start.x, y - arc.start.y),
                                 std::hypot(x - arc.end.x, y - arc.end.y));
  if (TurnTo(arc, x, y) > arc.sweep) return toEnds;
  double const fromCenter = std::hypot(x - arc.center.x, y - arc.center.y);
  return std::min(toEnds, std::fabs(fromCenter - arc.radius));
}

bool IsLeftOf(Piece const& piece, double x, double y) {
  if (piece.IsArc()) {
    bool const isInside = std::hypot(x - piece.center.x, y - piece.center.y) < piece.radius;
    return isInside == piece.counterClockwise;
  }
  return (piece.end.x - piece.start.x) * (y - piece.start.y) >
         (piece.end.y - piece.start.y) * (x - piece.start.x);
}

}  // namespace

double DistanceTo(Piece const& piece, double x, double y) {
  return piece.IsArc() ? DistanceToArc(piece, x, y) : DistanceToLine(piece, x, y);
}

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

}  // namespace Vorn::Cli
