#include "vorn/io/Departure.h"

#include <algorithm>

#include "vorn/io/Deviations.h"

namespace Vorn::IO {

namespace {

constexpr int kSteps = 8;

GeometryUtils::Point PointAlong(Piece const& piece, double part) {
  if (piece.IsArc()) return PointOnArc(piece, part * piece.sweep);
  return {piece.start.x + part * (piece.end.x - piece.start.x),
          piece.start.y + part * (piece.end.y - piece.start.y)};
}

/// With tolerances of 1, so that relative deviations are lengths.
std::vector<WPoint> PlacesOf(std::vector<Piece> const& pieces) {
  std::vector<WPoint> places;
  for (Piece const& piece : pieces) {
    places.push_back({piece.start.x, piece.start.y, 1.0});
    for (int i = 1; i < kSteps; ++i) {
      GeometryUtils::Point const at = PointAlong(piece, static_cast<double>(i) / kSteps);
      places.push_back({at.x, at.y, 1.0});
    }
    places.push_back({piece.end.x, piece.end.y, 1.0});
  }
  return places;
}

}  // namespace

double DepartureOf(std::vector<Piece> const& a, std::vector<Piece> const& b) {
  return std::max(Remeasure(PlacesOf(a), b).Worst().distance,
                  Remeasure(PlacesOf(b), a).Worst().distance);
}

}  // namespace Vorn::IO
