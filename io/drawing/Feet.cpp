#include "io/drawing/Feet.h"

#include <algorithm>
#include <cmath>

#include "io/pieces/Turning.h"

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

GeometryUtils::Point PlaceOn(Piece const& piece, double along) {
  double const part = piece.length > 0.0 ? along / piece.length : 0.0;
  if (piece.IsArc()) return PointOnArc(piece, part * piece.sweep);
  return {std::lerp(piece.start.x, piece.end.x, part), std::lerp(piece.start.y, piece.end.y, part)};
}

std::vector<Foot> FeetOf(Drawing const& drawing) {
  std::vector<Foot> feet;
  feet.reserve(drawing.deviations.size());
  for (std::size_t i = 0; i < drawing.deviations.size(); ++i) {
    WPoint const& point = drawing.points[i];
    feet.push_back(FootOn(drawing.pieces[drawing.deviations[i].piece], point.x, point.y));
  }
  return feet;
}

GeometryUtils::Point Magnified(WPoint const& point, Foot const& foot, double times) {
  if (times == 1.0) return {point.x, point.y};
  return {foot.at.x + times * (point.x - foot.at.x), foot.at.y + times * (point.y - foot.at.y)};
}

std::vector<double> PieceStarts(std::vector<Piece> const& pieces) {
  std::vector<double> starts = {0.0};
  starts.reserve(pieces.size() + 1);
  for (Piece const& piece : pieces) starts.push_back(starts.back() + piece.length);
  return starts;
}

}  // namespace Vorn::IO
