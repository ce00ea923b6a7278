// Standalone member: no other operation of the library uses it. The circle through three measured
// points, pushed outward by their tolerances.

#include "geometry/intersections/Circles.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <optional>

#include "geometry/elementary/CircleThrough.h"
#include "geometry/elementary/ImplicitLine.h"
#include "geometry/elementary/Sense.h"
#include "math/NumericConstants.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Elementary::Circle;
using Elementary::ImplicitLine;
using Intersections::CirclePoints;
using Point = GeometryUtils::Point;
using Points = std::array<Point, 3>;

/// Rounds of moving the points by their tolerances along the radii of the last circle.
constexpr int kShiftRounds = 3;

double LargestDifference(double a, double b, double c) {
  return std::max({std::fabs(a - b), std::fabs(a - c), std::fabs(b - c)});
}

std::optional<Circle> CircleOf(Points const& points) {
  return Elementary::CircleThrough(points[0], points[1], points[2]);
}

std::optional<bool> SenseOf(Points const& points) {
  return Elementary::IsCounterClockwise(points[0], points[1], points[2]);
}

/// The point of the circle of radius |tolerance| around p that lies on the line from the centre
/// through p: beyond p for a tolerance >= 0, before it for a negative one.
std::optional<Point> ShiftedAlongRadius(Point const& centre, Point const& p, double tolerance) {
  std::optional<ImplicitLine> const ray = Elementary::LineThrough(centre, p);
  if (!ray) return std::nullopt;
  CirclePoints const ends = Intersections::CutCircleByLine({p, std::fabs(tolerance)}, *ray);
  if (ends.count != 2) return std::nullopt;
  double const first2 = Elementary::SquaredDistance(ends.pts[0], centre);
  double const second2 = Elementary::SquaredDistance(ends.pts[1], centre);
  bool const takeFirst = tolerance >= 0.0 ? !(second2 > first2) : first2 < second2;
  return takeFirst ? ends.pts[0] : ends.pts[1];
}

/// Measured points that are moved by their tolerances, round by round.
class PushedPoints {
 public:
  PushedPoints(WPoint const& a, WPoint const& b, WPoint const& c)
      : measured_{Point{a.x, a.y}, Point{b.x, b.y}, Point{c.x, c.y}},
        tolerances_{a.w, b.w, c.w},
        moved_(measured_) {}

  /// The circle through the points where they were measured.
  std::optional<Circle> MeasuredCircle() const { return CircleOf(measured_); }

  /// Moves the points; false when there is no circle or sense on the way.
  bool Push() {
    std::optional<bool> const sense = SenseOf(measured_);
    if (!CircleOf(measured_) || !sense) return false;
    isCcw_ = *sense;
    for (int round = 0; round < kShiftRounds; ++round) {
      if (!PushOnce()) return false;
    }
    return true;
  }

  Points const& Moved() const { return moved_; }

  /// The circle through the moved points, after Push.
  Circle const& MovedCircle() const { return circle_; }

 private:
  bool PushOnce() {
    std::optional<Circle> const before = CircleOf(moved_);
    if (!before) return false;
    for (std::size_t i = 0; i < moved_.size(); ++i) {
      std::optional<Point> const shifted =
          ShiftedAlongRadius(before->centre, measured_[i], tolerances_[i]);
      if (!shifted) return false;
      moved_[i] = *shifted;
    }
    std::optional<Circle> const after = CircleOf(moved_);
    std::optional<bool> const sense = SenseOf(moved_);
    if (!after || !sense) return false;
    circle_ = *after;
    if (*sense != isCcw_) {
      // The shift turned the triangle over: from now on outward is the other way.
      for (double& tolerance : tolerances_) tolerance = -tolerance;
      isCcw_ = *sense;
    }
    return true;
  }

  Points const measured_;
  std::array<double, 3> tolerances_;
  Points moved_;
  bool isCcw_ = false;
  Circle circle_;
};

}  // namespace

bool GeometryUtils::GetCircle(WPoint const& a, WPoint const& b, WPoint const& c, WPoint* circle,
                              Point* pa, Point* pb, Point* pc, bool* ccw) {
  PushedPoints points(a, b, c);
  if (Numeric::IsZero(LargestDifference(a.w, b.w, c.w))) {
    std::optional<Circle> const measured = points.MeasuredCircle();
    if (!measured) return false;
    // Deliberate: pa, pb and pc stay as they are, and the sense is theirs.
    *circle = {measured->centre.x, measured->centre.y, measured->radius + a.w};
  } else {
    if (!points.Push()) return false;
    Circle const& pushed = points.MovedCircle();
    *circle = {pushed.centre.x, pushed.centre.y, pushed.radius};
    *pa = points.Moved()[0];
    *pb = points.Moved()[1];
    *pc = points.Moved()[2];
  }
  std::optional<bool> const sense = Elementary::IsCounterClockwise(*pa, *pb, *pc);
  if (sense) *ccw = *sense;
  return sense.has_value();
}

}  // namespace Vorn
