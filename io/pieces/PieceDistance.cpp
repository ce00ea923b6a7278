#include <algorithm>
#include <cmath>

#include "io/pieces/Turning.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

namespace {

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

double DistanceToArc(Piece const& arc, double x, double y) {
  double const toEnds = std::min(std::hypot(x - arc.start.x, y - arc.start.y),
                                 std::hypot(x - arc.end.x, y - arc.end.y));
  if (TurnTo(arc, x, y) > arc.sweep) return toEnds;
  double const fromCenter = std::hypot(x - arc.center.x, y - arc.center.y);
  return std::min(toEnds, std::fabs(fromCenter - arc.radius));
}

}  // namespace

double DistanceTo(Piece const& piece, double x, double y) {
  return piece.IsArc() ? DistanceToArc(piece, x, y) : DistanceToLine(piece, x, y);
}

}  // namespace Vorn::IO
