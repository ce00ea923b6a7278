#include "cli/Pieces.h"

#include <cmath>
#include <numbers>

#include "cli/Failure.h"

namespace Vorn::Cli {

namespace {

using std::numbers::pi;

double Sweep(double startAngle, double endAngle, bool counterClockwise) {
  double const turned = counterClockwise ? endAngle - startAngle : startAngle - endAngle;
  return turned < 0.0 ? turned + 2.0 * pi : turned;
}

Piece ArcOf(GeometryUtils::Point const& start, GeometryUtils::Elem const& elem) {
  Piece piece;
  piece.kind = Piece::Kind::Arc;
  piece.start = start;
  piece.end = elem.end;
  piece.center = elem.center;
  piece.radius = elem.radius;
  piece.counterClockwise = elem.direction > 0.0;
  piece.startAngle = elem.startAngle;
  piece.endAngle = elem.endAngle;
  piece.sweep = Sweep(elem.startAngle, elem.endAngle, piece.counterClockwise);
  piece.length = piece.radius * piece.sweep;
  return piece;
}

double PolarAngle(GeometryUtils::Point const& center, GeometryUtils::Point const& point) {
  return std::atan2(point.y - center.y, point.x - center.x);
}

}  // namespace

Piece LinePiece(GeometryUtils::Point const& start, GeometryUtils::Point const& end) {
  Piece piece;
  piece.start = start;
  piece.end = end;
  piece.length = std::hypot(end.x - start.x, end.y - start.y);
  return piece;
}

Piece ArcPiece(GeometryUtils::Point const& start, GeometryUtils::Point const& end,
               GeometryUtils::Point const& center, double radius, bool counterClockwise) {
  GeometryUtils::Elem elem;
  elem.type = GeometryUtils::ElemType::Arc;
  elem.end = end;
  elem.center = center;
  elem.radius = radius;
  elem.direction = counterClockwise ? 1.0 : -1.0;
  elem.startAngle = PolarAngle(center, start);
  elem.endAngle = PolarAngle(center, end);
  return ArcOf(start, elem);
}

std::vector<Piece> PiecesOf(std::vector<GeometryUtils::Elem> const& contour) {
  std::vector<Piece> pieces;
  for (std::size_t i = 1; i < contour.size(); ++i) {
    GeometryUtils::Point const& start = contour[i - 1].end;
    switch (contour[i].type) {
      case GeometryUtils::ElemType::Segment:
        pieces.push_back(LinePiece(start, contour[i].end));
        break;
      case GeometryUtils::ElemType::Arc:
        pieces.push_back(ArcOf(start, contour[i]));
        break;
      default:
        throw Failure(ExitCode::Internal,
                      "element " + std::to_string(i) + " is neither a segment nor an arc");
    }
  }
  return pieces;
}

GeometryUtils::Point PointOnArc(Piece const& arc, double angle) {
  double const polar = arc.startAngle + (arc.counterClockwise ? angle : -angle);
  return {arc.center.x + arc.radius * std::cos(polar), arc.center.y + arc.radius * std::sin(polar)};
}

}  // namespace Vorn::Cli
