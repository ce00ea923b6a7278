#include <algorithm>
#include <cmath>

#include "io/pieces/Turning.h"
#include "vorn/io/Pieces.h"

namespace Vorn::IO {

namespace {

Foot FootOnLine(Piece const& line, double x, double y) {
  double const alongX = line.end.x - line.start.x;
  double const alongY = line.end.y - line.start.y;
  double const length2 = alongX * alongX + alongY * alongY;
  if (!(length2 > 0.0)) return {line.start, 0.0};
  double const part =
      std::clamp(((x - line.start.x) * alongX + (y - line.start.y) * alongY) / length2, 0.0, 1.0);
  return {{line.start.x + part * alongX, line.start.y + part * alongY}, part * line.length};
}

Foot FootOnArc(Piece const& arc, double x, double y) {
  double const fromX = x - arc.center.x;
  double const fromY = y - arc.center.y;
  double const turn = TurnTo(arc, x, y);
  double const distance = std::hypot(fromX, fromY);
  if (turn <= arc.sweep && distance > 0.0) {
    double const reach = arc.radius / distance;
    return {{arc.center.x + reach * fromX, arc.center.y + reach * fromY}, turn * arc.radius};
  }
  double const toStart = std::hypot(x - arc.start.x, y - arc.start.y);
  double const toEnd = std::hypot(x - arc.end.x, y - arc.end.y);
  return toStart <= toEnd ? Foot{arc.start, 0.0} : Foot{arc.end, arc.length};
}

}  // namespace

Foot FootOn(Piece const& piece, double x, double y) {
  return piece.IsArc() ? FootOnArc(piece, x, y) : FootOnLine(piece, x, y);
}

}  // namespace Vorn::IO
