// Members for triangles, their crossing points and overlaps, and the division of polygons.

#include <cstddef>
#include <vector>

#include "geometry/triangles/CrossingPoints.h"
#include "geometry/triangles/Ears.h"
#include "geometry/triangles/Overlap.h"
#include "geometry/triangles/PreparedTriangle.h"
#include "geometry/triangles/Triangle.h"
#include "geometry/triangles/TriangleCentre.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

using Triangles::PreparedTriangle;
using OverlappingStatus = GeometryUtils::OverlappingStatus;
using PointStatus = GeometryUtils::PointStatus;

namespace {

/// Whether begin .. begin + count - 1 are positions of a sequence of this size.
bool HoldsRange(std::size_t size, int begin, int count) {
  return begin >= 0 && count >= 0 &&
         static_cast<std::size_t>(begin) + static_cast<std::size_t>(count) <= size;
}

}  // namespace

double GeometryUtils::GetArea(Triangle const& triangle) { return Triangles::SignedArea(triangle); }

bool GeometryUtils::CalcCenter(Triangle const& triangle, Point* center) {
  *center = Triangles::InnerPoint(triangle);
  return true;
}

PointStatus GeometryUtils::GetPointStatus(Point const& p, Triangle const& triangle) {
  return PreparedTriangle(triangle).StatusOf(p);
}

void GeometryUtils::GetCrossingPoints(Triangle const& first, Triangle const& second,
                                      std::vector<CrossingPoint>* points) {
  Triangles::SidePairs const pairs =
      Triangles::PairsThatMayMeet(PreparedTriangle(first), PreparedTriangle(second));
  Triangles::CrossingPoints found;
  Triangles::FindCrossingPoints(first, second, pairs, &found);
  points->insert(points->end(), found.begin(), found.end());
}

OverlappingStatus GeometryUtils::GetOverlapping(Triangle const& first, Triangle const& second,
                                                std::vector<Triangle>* result) {
  Triangles::Overlap overlap;
  Triangles::FindOverlap(PreparedTriangle(first), PreparedTriangle(second), &overlap);
  result->insert(result->end(), overlap.parts.begin(), overlap.parts.end());
  return overlap.status;
}

OverlappingStatus GeometryUtils::GetOverlapping(Triangle const& first,
                                                std::vector<Triangle> const* cell,
                                                std::vector<Triangle>* result) {
  std::size_t const sizeBefore = result->size();
  if (cell == result) {
    std::vector<Triangle> const copy = *cell;
    Triangles::AppendOverlaps(first, copy, result);
  } else {
    Triangles::AppendOverlaps(first, *cell, result);
  }
  return result->size() > sizeBefore ? OverlappingStatus::Overlap : OverlappingStatus::NoOverlap;
}

bool GeometryUtils::ConvexPolygonDivide(std::vector<Point> const& polygon, int first, int count,
                                        std::vector<Triangle>* triangles) {
  if (count < 3 || !HoldsRange(polygon.size(), 0, count)) return false;
  if (count == 3) {
    // Deliberate: the only place where the first vertex can be chosen.
    if (!HoldsRange(polygon.size(), first, count)) return false;
    Point const* const corners = polygon.data() + first;
    triangles->push_back({{corners[0], corners[1], corners[2]}});
    return true;
  }
  std::vector<Point> ring = polygon;
  Triangles::CutEars(ring.data(), count,
                     [triangles](Triangle const& ear) { triangles->push_back(ear); });
  return true;
}

bool GeometryUtils::SimplePolygonIsValid(std::vector<Point> const& polygon, int start, int count,
                                         int size) {
  if (size > count || size < 3) return false;
  if (size == count) return true;
  if (!HoldsRange(polygon.size(), 0, count) || start < 0 || start >= count) return false;
  return Triangles::IsFreeOfOthers(polygon.data(), count, {start, size});
}

bool GeometryUtils::PointIsInsideOfPolygon(Point const& p, std::vector<Point> const& polygon,
                                           int begin, int end) {
  if (begin < 0 || begin >= end || static_cast<std::size_t>(end) > polygon.size()) return false;
  return Triangles::IsInsideRing(p, polygon.data(), begin, end);
}

}  // namespace Vorn
