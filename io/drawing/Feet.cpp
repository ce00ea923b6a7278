#include "io/drawing/Feet.h"

#include <cmath>

namespace Vorn::IO {

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
