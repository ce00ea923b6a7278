#include "geometry/triangles/CrossingPoints.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "geometry/intersections/SegmentPair.h"
#include "math/NumericConstants.h"

namespace Vorn::Triangles {

namespace {

using Elementary::SquaredDistance;

/// Every pair of sides.
constexpr SidePairs kAllPairs = 0x1FF;

/// The bits of one side of the first triangle, shifted down.
constexpr SidePairs kOneSide = 0x7;

/// The ends of the stretch that two sides of one line share.
struct Stretch {
  Point low;
  Point high;
};

/// Along the axis on which the first side is longer. Nothing when the sides only lie on one line.
std::optional<Stretch> SharedStretch(Segment const& first, Segment const& second) {
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

/// Appends two records, the one nearer to the start first; on equal distances the first one.
void AppendByDistance(CrossingPoint const& first, CrossingPoint const& second, Point const& start,
                      CrossingPoints* points) {
  bool const isSecondNearer = SquaredDistance(first.pt, start) > SquaredDistance(second.pt, start);
  points->push_back(isSecondNearer ? second : first);
  points->push_back(isSecondNearer ? first : second);
}

/// Whether side i of the first triangle may meet side j of the second. The steps are those of
/// IntersectSegments, without a branch, since nearly all sides do not meet. For coordinates that
/// are numbers.
bool MayMeet(PreparedTriangle const& first, int i, PreparedTriangle const& second, int j) {
  PreparedTriangle::Side const& a = first.sides[i];
  PreparedTriangle::Side const& b = second.sides[j];
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

/// The positions of the two points farthest apart from `begin` on, of which there must be two or
/// more; the first such pair of equals.
std::pair<std::size_t, std::size_t> FarthestTwo(CrossingPoints const& points, std::size_t begin) {
  std::pair<std::size_t, std::size_t> farthest{begin, begin + 1};
  double farthest2 = SquaredDistance(points[begin].pt, points[begin + 1].pt);
  for (std::size_t p = begin; p < points.size(); ++p) {
    for (std::size_t q = p + 1; q < points.size(); ++q) {
      double const distance2 = SquaredDistance(points[p].pt, points[q].pt);
      if (distance2 > farthest2) {
        farthest2 = distance2;
        farthest = {p, q};
      }
    }
  }
  return farthest;
}

/// Of the records of side i from `begin` on, more than a line can cross since sides that touch at
/// vertices report them twice, keeps the two points farthest apart.
void KeepFarthestTwo(Point const& start, int i, std::size_t begin, CrossingPoints* points) {
  auto const [m, n] = FarthestTwo(*points, begin);
  CrossingPoint fromM = (*points)[m];
  CrossingPoint fromN = (*points)[n];
  // Deliberate: the second record carries the first triangle's side in the place of the second's.
  fromM.side1 = i;
  fromN.side2 = i;
  points->resize(begin);
  AppendByDistance(fromM, fromN, start, points);
}

/// Takes what side i of the first triangle and side j of the second have in common.
void TakeCommonPoints(Triangle const& first, int i, Triangle const& second, int j,
                      SidePoints* points) {
  Segment const side = SideOf(first, i);
  Segment const other = SideOf(second, j);
  Point common;
  SegmentsRelPosition const relation = Intersections::IntersectSegments({side, other}, &common);
  if (relation == SegmentsRelPosition::Intersecting) {
    points->TakeCrossing({common, i, j});
  } else if (relation == SegmentsRelPosition::Collinear) {
    if (std::optional<Stretch> const shared = SharedStretch(side, other)) {
      points->TakeStretch({shared->low, i, j}, {shared->high, i, j});
    }
  }
}

}  // namespace

void SidePoints::TakeCrossing(CrossingPoint const& found) {
  if (held_) {
    AppendByDistance(*held_, found, start_, &points_);
    held_.reset();
  } else {
    held_ = found;
  }
}

void SidePoints::TakeStretch(CrossingPoint const& end1, CrossingPoint const& end2) {
  AppendByDistance(end1, end2, start_, &points_);
  held_.reset();
}

void SidePoints::Finish() {
  if (held_) points_.push_back(*held_);
  held_.reset();
}

SidePairs PairsThatMayMeet(PreparedTriangle const& first, PreparedTriangle const& second) {
  if (!first.isOrdered || !second.isOrdered) return kAllPairs;
  SidePairs pairs = 0;
  for (int i = 0; i < 3; ++i) {
    for (int j = 0; j < 3; ++j) {
      pairs |= (MayMeet(first, i, second, j) ? 1U : 0U) << (3 * i + j);
    }
  }
  return pairs;
}

void FindCrossingPoints(Triangle const& first, Triangle const& second, SidePairs pairs,
                        CrossingPoints* points) {
  for (int i = 0; i < 3; ++i) {
    SidePairs const ofSide = pairs >> (3 * i) & kOneSide;
    if (ofSide == 0) continue;
    std::size_t const begin = points->size();
    SidePoints onSide(first.pts[i], points);
    for (int j = 0; j < 3; ++j) {
      if ((ofSide >> j & 1U) != 0) TakeCommonPoints(first, i, second, j, &onSide);
    }
    onSide.Finish();
    if (points->size() - begin > kKeptOnSide) KeepFarthestTwo(first.pts[i], i, begin, points);
  }
}

}  // namespace Vorn::Triangles
