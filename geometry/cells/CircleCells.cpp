// Cells of admissible circle centres.
//
// Every measured point is moved along its radius by its tolerance, inward and outward. The extreme
// circles pass through an inner or outer point of each of the three measured points; their centres
// are the corners of the cell.

#include <cmath>
#include <cstddef>
#include <optional>
#include <span>

#include "geometry/elementary/CircleThrough.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

constexpr int kMaxVertices = 6;

/// Which of the eight candidate points an extreme circle passes through.
enum Candidate {
  kFirstInner,
  kFirstOuter,
  kMiddleInner,
  kMiddleOuter,
  kLastInner,
  kLastOuter,
  kFirst,
  kLast,
  kCandidates
};

struct Row {
  Candidate start;
  Candidate middle;
  Candidate end;
};

// Consecutive rows differ in one choice only, so the centres come out in cyclic order. All inner
// and all outer are never extreme.
constexpr Row kBothFree[] = {
    {kFirstInner, kMiddleInner, kLastOuter}, {kFirstInner, kMiddleOuter, kLastOuter},
    {kFirstInner, kMiddleOuter, kLastInner}, {kFirstOuter, kMiddleOuter, kLastInner},
    {kFirstOuter, kMiddleInner, kLastInner}, {kFirstOuter, kMiddleInner, kLastOuter}};
constexpr Row kFirstFixed[] = {{kFirst, kMiddleInner, kLastOuter},
                               {kFirst, kMiddleOuter, kLastOuter},
                               {kFirst, kMiddleOuter, kLastInner},
                               {kFirst, kMiddleInner, kLastInner}};
constexpr Row kLastFixed[] = {{kFirstInner, kMiddleInner, kLast},
                              {kFirstInner, kMiddleOuter, kLast},
                              {kFirstOuter, kMiddleOuter, kLast},
                              {kFirstOuter, kMiddleInner, kLast}};
// Deliberate: the last row repeats the one before it. The centres of circles through both ends lie
// on one line, and a polygon needs three corners.
constexpr Row kBothFixed[] = {
    {kFirst, kMiddleInner, kLast}, {kFirst, kMiddleOuter, kLast}, {kFirst, kMiddleOuter, kLast}};

std::span<Row const> RowsFor(bool firstFixed, bool lastFixed) {
  if (firstFixed && lastFixed) return kBothFixed;
  if (firstFixed) return kFirstFixed;
  if (lastFixed) return kLastFixed;
  return kBothFree;
}

Point MovedAlongRadius(WPoint const& p, Point const& center, double newRadius, double radius) {
  return {center.x + (p.x - center.x) * newRadius / radius,
          center.y + (p.y - center.y) * newRadius / radius};
}

}  // namespace

ErrorCode GeometryUtils::GetCirclePolygon(WPoint first, WPoint middle, WPoint last, bool firstFixed,
                                          bool lastFixed, int orientation, int* vertexCount,
                                          Point2D<double>* const vertices) {
  std::optional<Point> const circumcentre =
      Elementary::PaddedCircumcentre({first.x, first.y}, {middle.x, middle.y}, {last.x, last.y});
  if (!circumcentre) return ErrorCode::Failed;
  Point const center = *circumcentre;
  double const radius = std::sqrt(GetDist2({first.x, first.y}, center));
  bool const isProperRadius = radius > Numeric::kZero;
  if (!isProperRadius) return ErrorCode::Failed;

  Point candidates[kCandidates];
  WPoint const measured[3] = {first, middle, last};
  for (int i = 0; i < 3; ++i) {
    WPoint const& p = measured[i];
    candidates[2 * i] = MovedAlongRadius(p, center, radius - p.w, radius);
    candidates[2 * i + 1] = MovedAlongRadius(p, center, radius + p.w, radius);
  }
  candidates[kFirst] = {first.x, first.y};
  candidates[kLast] = {last.x, last.y};

  bool const areEndsFree = !firstFixed && !lastFixed;
  bool const isSelecting = areEndsFree && orientation != 0;
  Point kept[kMaxVertices];
  int keptCount = 0;
  int wantedSign = orientation;
  for (Row const& row : RowsFor(firstFixed, lastFixed)) {
    Point const& start = candidates[row.start];
    Point const& mid = candidates[row.middle];
    Point const& end = candidates[row.end];
    Point rowCenter;
    double rowRadius = 0.0;
    if (!GetCircle(start, mid, end, &rowCenter, &rowRadius)) return ErrorCode::Failed;
    int const sign = Numeric::Sign(GetArea(Triangle{{start, mid, end}}));
    if (!isSelecting && keptCount == 0) wantedSign = sign;
    if (sign == wantedSign) {
      kept[keptCount++] = rowCenter;
    } else if (!isSelecting) {
      return ErrorCode::OrientationMismatch;
    }
  }
  if (areEndsFree && keptCount < 3) return ErrorCode::OrientationMismatch;

  for (int i = 0; i < keptCount; ++i) vertices[i] = {kept[i].x, kept[i].y};
  *vertexCount = keptCount;
  return ErrorCode::Ok;
}

ErrorCode GeometryUtils::GetCircleTriangles(WPoint first, WPoint middle, WPoint last,
                                            bool firstFixed, bool lastFixed, int orientation,
                                            std::vector<Triangle>* triangles) {
  Point2D<double> vertices[kMaxVertices];
  int count = 0;
  ErrorCode const code =
      GetCirclePolygon(first, middle, last, firstFixed, lastFixed, orientation, &count, vertices);
  if (code != ErrorCode::Ok) return code;
  std::vector<Point> polygon;
  for (int i = 0; i < count; ++i) polygon.push_back({vertices[i].x, vertices[i].y});
  return ConvexPolygonDivide(polygon, 0, count, triangles) ? ErrorCode::Ok : ErrorCode::Failed;
}

}  // namespace Vorn
