#include "io/measure/Crossing.h"

#include <algorithm>
#include <cmath>

#include "io/pieces/Shapes.h"

namespace Vorn::IO {

namespace {

using Elem = GeometryUtils::Elem;

Elem SegmentTo(GeometryUtils::Point const& end) {
  Elem elem;
  elem.type = GeometryUtils::ElemType::Segment;
  elem.end = end;
  return elem;
}

Elem ElementOf(Piece const& piece) {
  if (!piece.IsArc()) return SegmentTo(piece.end);
  Elem elem;
  elem.type = GeometryUtils::ElemType::Arc;
  elem.end = piece.end;
  elem.center = piece.center;
  elem.radius = piece.radius;
  elem.direction = piece.counterClockwise ? 1.0 : -1.0;
  elem.startAngle = piece.startAngle;
  elem.endAngle = piece.endAngle;
  return elem;
}

bool HasLength(Elem const& elem, Elem const& before) {
  if (elem.type == GeometryUtils::ElemType::Arc) return GeometryUtils::GetArcLength(elem) > 0.0;
  return !AreEqual(elem.end, before.end);
}

/// Whether the library's test has anything to compare: more than one element, and not just two
/// segments, which share a joint.
bool IsTestable(std::vector<Elem> const& elements) {
  std::size_t segments = 0;
  std::size_t arcs = 0;
  for (std::size_t i = 1; i < elements.size(); ++i) {
    if (!HasLength(elements[i], elements[i - 1])) continue;
    ++(elements[i].type == GeometryUtils::ElemType::Arc ? arcs : segments);
  }
  return segments + arcs > 2 || (segments + arcs == 2 && arcs > 0);
}

/// In parts of the largest distance from the start to the end of an element.
constexpr double kLeadIn = 1e-6;

GeometryUtils::Point DirectionAcrossStart(std::vector<Elem> const& elements) {
  GeometryUtils::Point const& start = elements[0].end;
  Elem const& first = elements[1];
  bool const isArc = first.type == GeometryUtils::ElemType::Arc;
  GeometryUtils::Point const along{first.end.x - start.x, first.end.y - start.y};
  GeometryUtils::Point const across =
      isArc ? GeometryUtils::Point{start.x - first.center.x, start.y - first.center.y}
            : GeometryUtils::Point{along.y, -along.x};
  double const length = std::hypot(across.x, across.y);
  if (!(length > 0.0)) return {1.0, 0.0};
  return {across.x / length, across.y / length};
}

std::vector<Elem> WithLeadIn(std::vector<Elem> elements) {
  GeometryUtils::Point const start = elements.front().end;
  double size = 0.0;
  for (Elem const& elem : elements) size = std::max(size, Distance(start, elem.end));
  GeometryUtils::Point const across = DirectionAcrossStart(elements);
  double const length = kLeadIn * size;
  elements.insert(elements.begin(),
                  SegmentTo({start.x + length * across.x, start.y + length * across.y}));
  return elements;
}

}  // namespace

std::vector<Elem> ElementsOf(ContourFile const& contour) {
  std::vector<Piece> const& pieces = contour.pieces;
  double const tolerance = JointTolerance(pieces);
  std::vector<Elem> elements = {SegmentTo(pieces.front().start)};
  auto const bridgeTo = [&](GeometryUtils::Point const& start) {
    if (Distance(elements.back().end, start) > tolerance) elements.push_back(SegmentTo(start));
  };
  for (Piece const& piece : pieces) {
    bridgeTo(piece.start);
    elements.push_back(ElementOf(piece));
  }
  if (contour.isClosed) bridgeTo(pieces.front().start);
  return elements;
}

Crossing FindCrossing(std::vector<Elem> const& elements, bool endsMeet) {
  if (!IsTestable(elements)) return Crossing::NotTestable;
  switch (GeometryUtils::CheckPolySelfIntersection(endsMeet ? elements : WithLeadIn(elements))) {
    case ErrorCode::Ok:
      return Crossing::None;
    case ErrorCode::SelfIntersection:
      return Crossing::Found;
    default:
      return Crossing::NotDecidable;
  }
}

std::string Describe(Crossing crossing) {
  switch (crossing) {
    case Crossing::None:
      return "the contour does not cross itself";
    case Crossing::Found:
      return "THE CONTOUR CROSSES OR TOUCHES ITSELF";
    case Crossing::NotTestable:
      return "not tested: too few pieces to cross";
    case Crossing::NotDecidable:
      return "not decided: the test fails on a piece of this contour";
  }
  return "unknown";
}

std::optional<Enclosed> EnclosedBy(ContourFile const& contour, std::vector<Elem> const& elements) {
  double clockwise = 0.0;
  bool const isKnown =
      contour.isClosed && GeometryUtils::GetArea(elements, &clockwise) == ErrorCode::Ok;
  if (!isKnown) return {};
  return Enclosed{std::fabs(clockwise), clockwise < 0.0};
}

}  // namespace Vorn::IO
