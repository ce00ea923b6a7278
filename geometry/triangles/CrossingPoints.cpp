// Where the sides of one triangle cross the sides of another.
//
// Points come out by side of the first triangle and along a side by distance from its start. A
// point found is held back until the next one on the same side tells which of the two is nearer.

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <optional>

#include "geometry/intersections/SegmentPair.h"
#include "geometry/triangles/TriangleOverlap.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Cells::Shape;
using CrossingPoint = GeometryUtils::CrossingPoint;
using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

struct Side {
  Point const& start;
  Point const& end;
};

/// The ends of the stretch that two sides of one line share.
struct Stretch {
  Point low;
  Point high;
};

/// Along the axis on which the first side is longer. Nothing when the sides only lie on one line.
std::optional<Stretch> SharedStretch(Side const& first, Side const& second) {
  bool const isAlongX =
      std::fabs(first.end.x - first.start.x) > std::fabs(first.end.y - first.start.y);
  auto const along = [isAlongX](Point const& p) { return isAlongX ? p.x : p.y; };
  double const low = std::min(along(first.start), along(first.end));
  double const high = std::max(along(first.start), along(first.end));
  if (low > along(second.start) && low > along(second.end)) return std::nullopt;
  if (along(second.start) > high && along(second.end) > high) return std::nullopt;

  Point ends[4] = {first.start, first.end, second.start, second.end};
  // Exchanges of neighbours that are strictly out of order: equal ends keep their order, and the
  // first side's come first.
  for (int last = 3; last > 0; --last) {
    for (int i = 0; i < last; ++i) {
      if (along(ends[i]) > along(ends[i + 1])) std::swap(ends[i], ends[i + 1]);
    }
  }
  return Stretch{ends[1], ends[2]};
}

/// Appends two records, the one nearer to the origin first; on equal distances the first one.
template <typename Record, typename Distance2, typename Records>
void AppendByDistance(Record const& first, Record const& second, Distance2 const& distance2,
                      Records* records) {
  bool const isSecondNearer = distance2(first) > distance2(second);
  records->push_back(isSecondNearer ? second : first);
  records->push_back(isSecondNearer ? first : second);
}

double SquaredDistance(Point const& p, Point const& q) {
  double const dx = p.x - q.x;
  double const dy = p.y - q.y;
  return dy * dy + dx * dx;
}

auto DistanceFromStartOf(Side const& side) {
  return [&side](CrossingPoint const& record) { return SquaredDistance(record.pt, side.start); };
}

/// Whether side i of the first triangle may meet side j of the second: they cross, as the
/// intersection of two segments decides it, or they are parallel and not apart. Without a branch,
/// since nearly all sides do not meet. For coordinates that are numbers.
bool MayMeet(Shape const& first, int i, Shape const& second, int j) {
  Shape::Side const& a = first.sides[i];
  Shape::Side const& b = second.sides[j];
  double const dx = first.triangle.pts[i].x - second.triangle.pts[j].x;
  double const dy = first.triangle.pts[i].y - second.triangle.pts[j].y;
  bool const areApart =
      (b.xLow > a.xHigh) | (a.xLow > b.xHigh) | (b.yLow > a.yHigh) | (a.yLow > b.yHigh);
  double const det = b.dy * a.dx - a.dy * b.dx;
  double const s = dy * b.dx - dx * b.dy;
  double const u = dy * a.dx - dx * a.dy;
  double const magnitude = std::fabs(det);
  bool const isProper = magnitude > Numeric::kZero;
  bool const isNegative = det < 0.0;
  double const alongFirst = isNegative ? -s : s;
  double const alongSecond = isNegative ? -u : u;
  bool const isInRange = (0.0 <= alongFirst) & (alongFirst <= magnitude) & (0.0 <= alongSecond) &
                         (alongSecond <= magnitude);
  return !(areApart | (isProper & !isInRange));
}

Intersections::SegmentPair PairOfSides(Side const& side, Side const& other) {
  return {{side.start, side.end}, {other.start, other.end}};
}

/// Of the records from `begin` on, more than a line can cross since sides that touch at vertices
/// report them twice, keeps the two points farthest apart.
void KeepFarthestTwo(Side const& side, int i, std::size_t begin, Cells::CrossingPoints* points) {
  std::size_t m = begin;
  std::size_t n = begin + 1;
  double farthest2 = SquaredDistance((*points)[m].pt, (*points)[n].pt);
  for (std::size_t p = begin; p < points->size(); ++p) {
    for (std::size_t q = p + 1; q < points->size(); ++q) {
      double const distance2 = SquaredDistance((*points)[p].pt, (*points)[q].pt);
      if (distance2 > farthest2) {
        farthest2 = distance2;
        m = p;
        n = q;
      }
    }
  }
  CrossingPoint fromM = (*points)[m];
  CrossingPoint fromN = (*points)[n];
  // Deliberate: the second record carries the first triangle's side in the place of the second's.
  fromM.side1 = i;
  fromN.side2 = i;
  points->resize(begin);
  AppendByDistance(fromM, fromN, DistanceFromStartOf(side), points);
}

/// Collects what lies on side i of the first triangle.
class SideCollector {
 public:
  SideCollector(Triangle const& first, int i, Triangle const& second, Cells::CrossingPoints* points)
      : side_{first.pts[i], first.pts[(i + 1) % 3]},
        i_(i),
        second_(second),
        points_(*points),
        begin_(points->size()) {}

  /// Takes side j of the second triangle.
  void Take(int j) {
    Side const other{second_.pts[j], second_.pts[(j + 1) % 3]};
    CrossingPoint found{{}, i_, j};
    SegmentsRelPosition const relation =
        Intersections::IntersectSegments(PairOfSides(side_, other), &found.pt);
    if (relation == SegmentsRelPosition::Intersecting) {
      if (held_) {
        AppendByDistance(*held_, found, DistanceFromStartOf(side_), &points_);
        held_.reset();
      } else {
        held_ = found;
      }
    } else if (relation == SegmentsRelPosition::Collinear) {
      if (std::optional<Stretch> const shared = SharedStretch(side_, other)) {
        AppendByDistance(CrossingPoint{shared->low, i_, j}, CrossingPoint{shared->high, i_, j},
                         DistanceFromStartOf(side_), &points_);
        // Deliberate: the ends of the stretch stand for the point that was held.
        held_.reset();
      }
    }
  }

  void Finish() {
    if (held_) points_.push_back(*held_);
    if (points_.size() - begin_ >= 3) KeepFarthestTwo(side_, i_, begin_, &points_);
  }

 private:
  Side const side_;
  int const i_;
  Triangle const& second_;
  Cells::CrossingPoints& points_;
  std::size_t const begin_;
  std::optional<CrossingPoint> held_;
};

}  // namespace

bool GeometryUtils::GetCrossingPoints(Triangle const& first, int startSide, Triangle const& second,
                                      std::vector<Point>* points) {
  int const firstSide = (startSide % 3 + 3) % 3;
  for (int turn = 0; turn < 3; ++turn) {
    int const i = (firstSide + turn) % 3;
    Point const& start = first.pts[i];
    Point const& end = first.pts[(i + 1) % 3];
    auto const distance2 = [&start](Point const& p) { return SquaredDistance(p, start); };
    std::optional<Point> held;
    for (int j = 0; j < 3; ++j) {
      Point const& otherStart = second.pts[j];
      Point const& otherEnd = second.pts[(j + 1) % 3];
      Point found;
      if (GetLineSegmentsIntersection(start.x, start.y, end.x, end.y, otherStart.x, otherStart.y,
                                      otherEnd.x, otherEnd.y, &found.x,
                                      &found.y) != SegmentsRelPosition::Intersecting) {
        continue;
      }
      if (held) {
        AppendByDistance(*held, found, distance2, points);
        held.reset();
      } else {
        held = found;
      }
    }
    if (held) points->push_back(*held);
  }
  return true;
}

void Cells::FindCrossingPoints(Shape const& first, Shape const& second, CrossingPoints* points) {
  bool const areOrdered = first.isOrdered && second.isOrdered;
  for (int i = 0; i < 3; ++i) {
    SideCollector collector(first.triangle, i, second.triangle, points);
    for (int j = 0; j < 3; ++j) {
      if (!areOrdered || MayMeet(first, i, second, j)) collector.Take(j);
    }
    collector.Finish();
  }
}

void Cells::FindCrossingPoints(Triangle const& first, Triangle const& second, unsigned mayCross,
                               CrossingPoints* points) {
  for (int i = 0; i < 3; ++i) {
    unsigned const sides = mayCross >> (3 * i) & 7U;
    if (sides == 0) continue;
    SideCollector collector(first, i, second, points);
    for (int j = 0; j < 3; ++j) {
      if ((sides >> j & 1U) != 0) collector.Take(j);
    }
    collector.Finish();
  }
}

void GeometryUtils::GetCrossingPoints(Triangle const& first, Triangle const& second,
                                      std::vector<CrossingPoint>* points) {
  Cells::CrossingPoints found;
  Cells::FindCrossingPoints(Shape(first), Shape(second), &found);
  points->insert(points->end(), found.begin(), found.end());
}

}  // namespace Vorn
