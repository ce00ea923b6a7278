#include "vorn/io/Pieces.h"

#include <cmath>

#include "io/pieces/Turning.h"
#include "vorn/io/Failure.h"

namespace Vorn::IO {

namespace {

Piece LinePiece(GeometryUtils::Point const& start, GeometryUtils::Elem const& elem) {
  Piece piece;
  piece.start = start;
  piece.end = elem.end;
  piece.length = std::hypot(elem.end.x - start.x, elem.end.y - start.y);
  return piece;
}

Piece ArcPiece(GeometryUtils::Point const& start, GeometryUtils::Elem const& elem) {
  Piece piece;
  piece.kind = Piece::Kind::Arc;
  piece.start = start;
  piece.end = elem.end;
  piece.center = elem.center;
  piece.radius = elem.radius;
  piece.counterClockwise = elem.direction > 0.0;
  piece.startAngle = elem.startAngle;
  piece.endAngle = elem.endAngle;
  piece.sweep = TurnBetween(elem.startAngle, elem.endAngle, piece.counterClockwise);
  piece.length = piece.radius * piece.sweep;
  return piece;
}

}  // namespace

std::vector<Piece> PiecesOf(std::vector<GeometryUtils::Elem> const& contour) {
  std::vector<Piece> pieces;
  for (std::size_t i = 1; i < contour.size(); ++i) {
    GeometryUtils::Point const& start = contour[i - 1].end;
    switch (contour[i].type) {
      case GeometryUtils::ElemType::Segment:
        pieces.push_back(LinePiece(start, contour[i]));
        break;
      case GeometryUtils::ElemType::Arc:
        pieces.push_back(ArcPiece(start, contour[i]));
        break;
      default:
        throw Failure(FailureKind::Internal,
                      "element " + std::to_string(i) + " is neither a segment nor an arc");
    }
  }
  return pieces;
}

GeometryUtils::Point PointOnArc(Piece const& arc, double angle) {
  double const polar = arc.startAngle + (arc.counterClockwise ? angle : -angle);
  return {arc.center.x + arc.radius * std::cos(polar), arc.center.y + arc.radius * std::sin(polar)};
}

}  // namespace Vorn::IO
