// Why the shortcut is exact: a triangle whose vertices are clearly on one side of a chord does not
// cross it, by the argument for one side in Cutter.cpp; the side (P2, P2) has no length and is out
// of the triangle's box, as are the vertices of the chord.
#include "geometry/cells/fast/ChordCutter.h"

#include <limits>

#include "geometry/cells/fast/Parallel.h"

namespace Vorn::Cells {

namespace {

using Triangles::PreparedTriangle;

bool IsAlongASide(PreparedTriangle::Side const& side, Triangle const& triangle) {
  return IsAlong(side, Triangles::SideOf(triangle, 0)) ||
         IsAlong(side, Triangles::SideOf(triangle, 1)) ||
         IsAlong(side, Triangles::SideOf(triangle, 2));
}

}  // namespace

ChordCutter::ChordCutter(Triangle const& chord, Magnitude const& magnitude) : prepared_(chord) {
  Point const* const pts = chord.pts;
  bool const isChord = pts[1].x == pts[2].x && pts[1].y == pts[2].y;
  clear_ =
      isChord ? kClearance * ErrorBound(chord, magnitude) : std::numeric_limits<double>::infinity();
}

void ChordCutter::FindOverlapWith(BoxedTriangle const& other, Triangles::Overlap* overlap) const {
  if (IsClearlyApartFrom(other)) {
    overlap->Reset(Triangles::OverlappingStatus::NoOverlap);
  } else {
    Triangles::FindOverlap(prepared_, PreparedTriangle(other.triangle), overlap);
  }
}

bool ChordCutter::IsClearlyApartFrom(BoxedTriangle const& other) const {
  Point const& start = prepared_.triangle.pts[0];
  PreparedTriangle::Side const& along = prepared_.sides[0];
  auto const offsetOf = [&](Point const& p) {
    return (p.x - start.x) * along.dy - (p.y - start.y) * along.dx;
  };
  double const o0 = offsetOf(other.triangle.pts[0]);
  double const o1 = offsetOf(other.triangle.pts[1]);
  double const o2 = offsetOf(other.triangle.pts[2]);
  bool const isClear = ((o0 > clear_) & (o1 > clear_) & (o2 > clear_)) |
                       ((o0 < -clear_) & (o1 < -clear_) & (o2 < -clear_));
  return isClear && other.IsOutOfBox(start) && other.IsOutOfBox(prepared_.triangle.pts[1]) &&
         !IsAlongASide(along, other.triangle);
}

}  // namespace Vorn::Cells
