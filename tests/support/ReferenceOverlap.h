#pragma once

#include "support/ReferenceTriangles.h"

/// The plain second implementation of the division of polygons and of the overlap of triangles.
namespace Vorn::Testing::Reference {

using OverlappingStatus = GeometryUtils::OverlappingStatus;
using Cell = std::vector<Triangle>;

/// Crossing number over polygon[begin] ... polygon[end - 1]; the range must lie in the polygon.
inline bool InPolygon(Point const& p, std::vector<Point> const& polygon, int begin, int end) {
  if (begin >= end) return false;
  bool inside = false;
  Point prev = polygon[end - 1];
  for (int j = begin; j < end; ++j) {
    Point const cur = polygon[j];
    bool const above = cur.y >= p.y;
    if (above != (prev.y >= p.y)) {
      double const left = (cur.y - p.y) * (prev.x - cur.x);
      double const right = (prev.y - cur.y) * (cur.x - p.x);
      if ((left >= right) == above) inside = !inside;
    }
    prev = cur;
  }
  return inside;
}

inline bool EarIsFree(std::vector<Point> const& polygon, int start, int count, int size) {
  if (size > count || size < 3) return false;
  if (size == count) return true;
  int before = 0;
  if (start + size < count) {
    for (int j = start + size; j < count; ++j) {
      if (InPolygon(polygon[j], polygon, start, size)) return false;
    }
  } else {
    before = size + 1 + start - count;
  }
  for (int j = before; j < start; ++j) {
    if (InPolygon(polygon[j], polygon, start, size)) return false;
  }
  return true;
}

/// `earPastEnd` is set when an ear was tested whose last vertex lies past the live vertices.
inline bool Divide(std::vector<Point> polygon, int first, int count, Cell* triangles,
                   bool* earPastEnd = nullptr) {
  if (count < 3) return false;
  if (count == 3) {
    triangles->push_back({{polygon[first], polygon[first + 1], polygon[first + 2]}});
    return true;
  }
  int n = count;
  int i = 0;
  while (n >= 3) {
    if (i + 2 >= n) {
      if (earPastEnd != nullptr) *earPastEnd = true;
      return false;
    }
    if (!EarIsFree(polygon, i, n, 3)) {
      ++i;
      continue;
    }
    triangles->push_back({{polygon[i], polygon[i + 1], polygon[i + 2]}});
    --n;
    if (n < 3) return true;
    polygon.erase(polygon.begin() + i + 1);
    i = 0;
  }
  return true;
}

/// Boundary of the common part of two triangles whose sides cross.
class BoundaryWalk {
 public:
  BoundaryWalk(Triangle const& first, Triangle const& second)
      : tri_{first, second}, crossings_(Crossings(first, second)) {
    for (int v = 0; v < 3; ++v) {
      status_[0][v] = StatusOf(first.pts[v], second);
      status_[1][v] = StatusOf(second.pts[v], first);
    }
  }

  bool HasUndefined() const {
    for (auto const& ofTriangle : status_) {
      for (auto status : ofTriangle) {
        if (status == PointStatus::Undefined) return true;
      }
    }
    return false;
  }

  bool HasCrossings() const { return !crossings_.empty(); }

  int CountContained(int k) const {
    int count = 0;
    for (auto status : status_[k]) {
      bool const contained = status == PointStatus::Inside || status == PointStatus::OnSide ||
                             status == PointStatus::OnVertex;
      if (contained) ++count;
    }
    return count;
  }

  std::vector<Point> Polygon() {
    cur_ = status_[0][0] == PointStatus::Outside ? 1 : 0;
    int s = 0;
    std::size_t r = 0;
    while (s < 3) {
      if (r >= crossings_.size() || crossings_[r].side1 != s) {
        ++s;
        continue;
      }
      TakeAndFlip(crossings_[r]);
      if (AppendVerticesAfter(crossings_[r])) {
        while (r < crossings_.size() && crossings_[r].side1 == s) ++r;
        ++s;
        continue;
      }
      std::size_t const q = r + 1;
      if (q >= crossings_.size()) {
        r = q;
      } else if (crossings_[q].side1 == s) {
        TakeAndFlip(crossings_[q]);
        AppendVerticesAfter(crossings_[q]);
        r = q + 1;
        ++s;
      } else {
        int const next = (SideOnCurrent(crossings_[q]) + 1) % 3;
        if (status_[cur_][next] != PointStatus::Outside) {
          TakeAndFlip(crossings_[q]);
          ++s;
        }
        r = q;
      }
    }
    return polygon_;
  }

 private:
  int SideOnCurrent(CrossingPoint const& record) const {
    return cur_ == 0 ? record.side1 : record.side2;
  }

  void TakeAndFlip(CrossingPoint const& record) {
    polygon_.push_back(record.pt);
    cur_ = 1 - cur_;
  }

  /// Appends the next vertex, and the one after it only if the first was appended.
  bool AppendVerticesAfter(CrossingPoint const& record) {
    int const side = SideOnCurrent(record);
    int const a = (side + 1) % 3;
    int const b = (side + 2) % 3;
    if (status_[cur_][a] == PointStatus::Outside) return false;
    polygon_.push_back(tri_[cur_].pts[a]);
    if (status_[cur_][b] != PointStatus::Outside) polygon_.push_back(tri_[cur_].pts[b]);
    return true;
  }

  Triangle tri_[2];
  PointStatus status_[2][3];
  std::vector<CrossingPoint> crossings_;
  std::vector<Point> polygon_;
  int cur_ = 0;
};

inline OverlappingStatus Overlap(Triangle const& first, Triangle const& second, Cell* result) {
  BoundaryWalk walk(first, second);
  if (walk.HasUndefined()) return OverlappingStatus::OverlapFailed;
  if (!walk.HasCrossings()) {
    int const ofFirst = walk.CountContained(0);
    int const ofSecond = walk.CountContained(1);
    if (ofFirst + ofSecond == 0) return OverlappingStatus::NoOverlap;
    if (ofFirst + ofSecond != 3) return OverlappingStatus::OverlapFailed;
    if (ofFirst != 3 && ofSecond != 3) return OverlappingStatus::OverlapFailed;
    for (int copy = 0; copy < 3; ++copy) result->push_back(ofFirst == 3 ? first : second);
    return OverlappingStatus::Overlap;
  }
  auto const polygon = walk.Polygon();
  if (polygon.size() < 3) return OverlappingStatus::NoOverlap;
  Cell local;
  if (!Divide(polygon, 0, static_cast<int>(polygon.size()), &local)) {
    return OverlappingStatus::OverlapFailed;
  }
  result->insert(result->end(), local.begin(), local.end());
  return OverlappingStatus::Overlap;
}

inline OverlappingStatus Overlap(Triangle const& first, Cell const& cell, Cell* result) {
  bool any = false;
  for (auto const& triangle : cell) {
    if (Overlap(first, triangle, result) == OverlappingStatus::Overlap) any = true;
  }
  return any ? OverlappingStatus::Overlap : OverlappingStatus::NoOverlap;
}

}  // namespace Vorn::Testing::Reference
