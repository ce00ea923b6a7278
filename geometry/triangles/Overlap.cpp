// The common part of two triangles, and of a triangle with a cell.
//
// The boundary of the overlap is walked side by side of the first triangle: at every crossing point
// the walk changes over to the other triangle and takes up that triangle's vertices for as long as
// they lie in the first. The order of the points, repeated ones included, decides the fan of
// triangles that comes out, and with it the weights of a cell's centre.

#include <array>
#include <bit>
#include <cstddef>

#include "geometry/intersections/SegmentPair.h"
#include "geometry/triangles/Ring.h"
#include "geometry/triangles/TriangleOverlap.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {
namespace {

using Cells::CrossingPoints;
using Cells::kCopiesOfContained;
using Cells::Shape;
using CrossingPoint = GeometryUtils::CrossingPoint;
using OverlappingStatus = GeometryUtils::OverlappingStatus;
using Point = GeometryUtils::Point;
using PointStatus = GeometryUtils::PointStatus;
using Triangle = GeometryUtils::Triangle;

/// The vertex or side that follows.
constexpr int kNext[3] = {1, 2, 0};

using Polygon = Cells::InlineVector<Point, 12>;

/// Where each vertex of the two triangles lies with respect to the other triangle.
using VertexStatuses = std::array<std::array<PointStatus, 3>, 2>;

bool IsInOrOn(PointStatus status) {
  return status == PointStatus::Inside || status == PointStatus::OnSide ||
         status == PointStatus::OnVertex;
}

int CountInOrOn(std::array<PointStatus, 3> const& statuses) {
  int count = 0;
  for (PointStatus const status : statuses) count += IsInOrOn(status) ? 1 : 0;
  return count;
}

bool HasUndefined(VertexStatuses const& statuses) {
  for (auto const& ofTriangle : statuses) {
    for (PointStatus const status : ofTriangle) {
      if (status == PointStatus::Undefined) return true;
    }
  }
  return false;
}

/// The walk along the boundary of the overlap of two triangles whose sides cross.
class BoundaryWalk {
 public:
  BoundaryWalk(std::array<Triangle const*, 2> const& triangles, VertexStatuses const& statuses,
               CrossingPoints const& crossings)
      : triangles_(triangles),
        statuses_(statuses),
        crossings_(crossings),
        current_(statuses[0][0] == PointStatus::Outside ? 1 : 0) {}

  Polygon& Walk() {
    int side = 0;
    std::size_t record = 0;
    while (side < 3) {
      if (record == crossings_.size() || crossings_[record].side1 != side) {
        ++side;
        continue;
      }
      CrossTo(crossings_[record]);
      if (TakeVertices(crossings_[record])) {
        record = EndOfSide(record, side);
        ++side;
        continue;
      }
      ++record;
      if (record == crossings_.size()) continue;
      CrossingPoint const& next = crossings_[record];
      if (next.side1 == side) {
        CrossTo(next);
        TakeVertices(next);
        ++record;
        ++side;
      } else if (!IsOutside((SideOf(next) + 1) % 3)) {
        // The record stays: it is examined again under its own side, and its point may come twice.
        CrossTo(next);
        ++side;
      }
    }
    return polygon_;
  }

 private:
  /// The side of the triangle now followed that a crossing point lies on.
  int SideOf(CrossingPoint const& crossing) const {
    return current_ == 0 ? crossing.side1 : crossing.side2;
  }

  bool IsOutside(int vertex) const {
    return statuses_[current_][static_cast<std::size_t>(vertex)] == PointStatus::Outside;
  }

  void CrossTo(CrossingPoint const& crossing) {
    polygon_.push_back(crossing.pt);
    current_ = 1 - current_;
  }

  /// Takes up the two vertices that follow the crossed side, as long as they are not outside the
  /// other triangle. False when already the first one is.
  bool TakeVertices(CrossingPoint const& crossing) {
    int const side = SideOf(crossing);
    int const next = (side + 1) % 3;
    if (IsOutside(next)) return false;
    polygon_.push_back(triangles_[current_]->pts[next]);
    int const afterNext = (side + 2) % 3;
    if (!IsOutside(afterNext)) polygon_.push_back(triangles_[current_]->pts[afterNext]);
    return true;
  }

  std::size_t EndOfSide(std::size_t record, int side) const {
    while (record < crossings_.size() && crossings_[record].side1 == side) ++record;
    return record;
  }

  std::array<Triangle const*, 2> const& triangles_;
  VertexStatuses const& statuses_;
  CrossingPoints const& crossings_;
  std::size_t current_;
  Polygon polygon_;
};

/// The overlap of two triangles whose sides do not cross: one of them, or nothing.
void FindContained(Triangle const& first, Triangle const& second, VertexStatuses const& statuses,
                   Cells::Overlap* overlap) {
  int const firstIn = CountInOrOn(statuses[0]);
  int const secondIn = CountInOrOn(statuses[1]);
  if (firstIn + secondIn == 0) return;
  if (firstIn + secondIn != 3 || (firstIn != 3 && secondIn != 3)) {
    overlap->status = OverlappingStatus::OverlapFailed;
    return;
  }
  Triangle const& contained = firstIn == 3 ? first : second;
  for (int copy = 0; copy < kCopiesOfContained; ++copy) overlap->parts.push_back(contained);
  overlap->status = OverlappingStatus::Overlap;
}

void Divide(Polygon* polygon, Cells::Overlap* overlap) {
  Cells::CutEars(polygon->data(), static_cast<int>(polygon->size()),
                 [overlap](Triangle const& ear) { overlap->parts.push_back(ear); });
  overlap->status = OverlappingStatus::Overlap;
}

/// The overlap of two triangles whose boxes meet.
void FindCommonPart(Triangle const& first, Triangle const& second, VertexStatuses const& statuses,
                    CrossingPoints const& crossings, Cells::Overlap* overlap) {
  if (crossings.empty()) {
    FindContained(first, second, statuses, overlap);
    return;
  }
  std::array<Triangle const*, 2> const triangles = {&first, &second};
  BoundaryWalk walk(triangles, statuses, crossings);
  Polygon& polygon = walk.Walk();
  if (polygon.size() >= 3) Divide(&polygon, overlap);
}

/// The most frequent case by far: one cut, where the walk is always the same. False, and nothing
/// done, where a side ends before the other, by rounding.
bool FindOneCut(Triangle const& first, Triangle const& second, Cells::Sight const& sight,
                Cells::Overlap* overlap) {
  int const bit0 = std::countr_zero(sight.mayCross);
  int const bit1 = std::countr_zero(sight.mayCross & (sight.mayCross - 1));
  int const side0 = bit0 / 3;
  int const side1 = bit1 / 3;
  int const cut = bit0 % 3;
  auto const cross = [&](int side, Point* p) {
    Point const& start = first.pts[side];
    Point const& end = first.pts[kNext[side]];
    Point const& cutStart = second.pts[cut];
    Point const& cutEnd = second.pts[kNext[cut]];
    return Intersections::IntersectSegments({{start, end}, {cutStart, cutEnd}}, p) ==
           SegmentsRelPosition::Intersecting;
  };
  Point enter;
  Point leave;
  if (!cross(side0, &enter) || !cross(side1, &leave)) return false;

  // The walk crosses over at the first point. Where the first vertex is outside, it follows the
  // first triangle from there, and otherwise from the second point on.
  bool const isFirstInside = (sight.inside & 1U) != 0;
  int const next = kNext[isFirstInside ? side1 : side0];
  int const afterNext = kNext[next];
  bool const hasTwo = (sight.inside >> afterNext & 1U) != 0;
  Polygon polygon;
  polygon.push_back(enter);
  if (isFirstInside) polygon.push_back(leave);
  polygon.push_back(first.pts[next]);
  if (hasTwo) polygon.push_back(first.pts[afterNext]);
  if (!isFirstInside) polygon.push_back(leave);
  Divide(&polygon, overlap);
  return true;
}

}  // namespace

void Cells::FindOverlap(Shape const& first, Shape const& second, Overlap* overlap) {
  overlap->status = OverlappingStatus::NoOverlap;
  overlap->parts.clear();
  // Apart by their boxes: every vertex is outside and no side crosses another.
  if (first.IsApartFrom(second)) return;

  VertexStatuses statuses;
  for (std::size_t v = 0; v < 3; ++v) {
    statuses[0][v] = second.StatusOf(first.triangle.pts[v]);
    statuses[1][v] = first.StatusOf(second.triangle.pts[v]);
  }
  if (HasUndefined(statuses)) {
    overlap->status = OverlappingStatus::OverlapFailed;
    return;
  }
  CrossingPoints crossings;
  FindCrossingPoints(first, second, &crossings);
  FindCommonPart(first.triangle, second.triangle, statuses, crossings, overlap);
}

void Cells::FindOverlap(BoxedTriangle const& first, Shape const& second, Sight const& sight,
                        Overlap* overlap) {
  overlap->status = OverlappingStatus::NoOverlap;
  overlap->parts.clear();
  if (sight.IsOneCut() && FindOneCut(first.triangle, second.triangle, sight, overlap)) return;
  CrossingPoints crossings;
  FindCrossingPoints(first.triangle, second.triangle, sight.mayCross, &crossings);
  if (crossings.empty() && sight.inside == 0 && sight.IsSecondOutside()) return;

  VertexStatuses statuses;
  Shape const shape(first.triangle);
  for (std::size_t v = 0; v < 3; ++v) {
    bool const isInside = (sight.inside >> v & 1U) != 0;
    statuses[0][v] = isInside ? PointStatus::Inside : PointStatus::Outside;
    bool const isOutside = (sight.outside >> v & 1U) != 0;
    statuses[1][v] = isOutside ? PointStatus::Outside : shape.StatusOf(second.triangle.pts[v]);
  }
  if (HasUndefined(statuses)) {
    overlap->status = OverlappingStatus::OverlapFailed;
    return;
  }
  FindCommonPart(first.triangle, second.triangle, statuses, crossings, overlap);
}

GeometryUtils::OverlappingStatus GeometryUtils::GetOverlapping(Triangle const& first,
                                                               Triangle const& second,
                                                               std::vector<Triangle>* result) {
  Cells::Overlap overlap;
  Cells::FindOverlap(Shape(first), Shape(second), &overlap);
  result->insert(result->end(), overlap.parts.begin(), overlap.parts.end());
  return overlap.status;
}

GeometryUtils::OverlappingStatus GeometryUtils::GetOverlapping(Triangle const& first,
                                                               std::vector<Triangle> const* cell,
                                                               std::vector<Triangle>* result) {
  Shape const shape(first);
  OverlappingStatus status = OverlappingStatus::NoOverlap;
  Cells::Overlap overlap;
  // By index and to the size at the start: result may be the cell itself.
  std::size_t const size = cell->size();
  for (std::size_t i = 0; i < size; ++i) {
    Cells::FindOverlap(shape, Shape((*cell)[i]), &overlap);
    result->insert(result->end(), overlap.parts.begin(), overlap.parts.end());
    // Deliberate: a pair that could not be resolved counts like one without a common part.
    if (overlap.status == OverlappingStatus::Overlap) status = OverlappingStatus::Overlap;
  }
  return status;
}

}  // namespace Vorn
