#include "geometry/triangles/BoundaryWalk.h"

#include <cstddef>

#include "geometry/triangles/Ears.h"

namespace Vorn::Triangles {

namespace {

bool IsInOrOn(PointStatus status) {
  return status == PointStatus::Inside || status == PointStatus::OnSide ||
         status == PointStatus::OnVertex;
}

int CountInOrOn(std::array<PointStatus, 3> const& statuses) {
  int count = 0;
  for (PointStatus const status : statuses) count += IsInOrOn(status) ? 1 : 0;
  return count;
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

  OverlapPolygon& Walk() {
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
  OverlapPolygon polygon_;
};

/// The overlap of two triangles whose sides do not cross: one of them, or nothing.
void FindContained(Triangle const& first, Triangle const& second, VertexStatuses const& statuses,
                   Overlap* overlap) {
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

}  // namespace

void Divide(OverlapPolygon* polygon, Overlap* overlap) {
  CutEars(polygon->data(), static_cast<int>(polygon->size()),
          [overlap](Triangle const& ear) { overlap->parts.push_back(ear); });
  overlap->status = OverlappingStatus::Overlap;
}

void FindCommonPart(Triangle const& first, Triangle const& second, VertexStatuses const& statuses,
                    CrossingPoints const& crossings, Overlap* overlap) {
  if (crossings.empty()) {
    FindContained(first, second, statuses, overlap);
    return;
  }
  std::array<Triangle const*, 2> const triangles = {&first, &second};
  BoundaryWalk walk(triangles, statuses, crossings);
  OverlapPolygon& polygon = walk.Walk();
  if (polygon.size() >= 3) Divide(&polygon, overlap);
}

}  // namespace Vorn::Triangles
