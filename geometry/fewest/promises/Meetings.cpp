// Notation: coordinates are taken from the start of the first piece or, for neighbours, from their
// joint. Circles meet on their radical line n x = h (n of length 1), so that in both cases an arc
// is cut by a line: x = h n + y t, with t = n turned left, gives
//
//   y^2 - 2 g y + c = 0,   g = t d,   c = h^2 - 2 h (n d) + power,
//
// d being the centre of the arc and power that of the origin, which is almost 0.

#include "geometry/fewest/promises/Meetings.h"

#include <algorithm>
#include <cmath>

namespace Vorn::Promises {

namespace {

using Point = GeometryUtils::Point;

struct Line {
  Point normal;
  double offset;
};

double Dot(Point const& a, Point const& b) { return a.x * b.x + a.y * b.y; }
double Cross(Point const& a, Point const& b) { return a.x * b.y - a.y * b.x; }
Point Plus(Point const& a, Point const& b) { return {a.x + b.x, a.y + b.y}; }
Point Minus(Point const& a, Point const& b) { return {a.x - b.x, a.y - b.y}; }
Point Times(double factor, Point const& a) { return {factor * a.x, factor * a.y}; }
Point TurnLeft(Point const& a) { return {-a.y, a.x}; }
double Length(Point const& a) { return std::sqrt(Dot(a, a)); }

class Finder {
 public:
  Finder(DrawnPiece const& first, DrawnPiece const& second)
      : first_(first), second_(second), same_(4.0 * (RoundingOf(first) + RoundingOf(second))) {}

  /// Points nearer than this are the same: the rounding of both pieces, and as much again for that
  /// of the points computed on them.
  double SameWithin() const { return same_; }
  Meetings const& Found() const { return found_; }

  void TakeIfOnBoth(Point const& p) {
    if (!std::isfinite(p.x) || !std::isfinite(p.y)) return;
    Place const onFirst = PlaceOf(first_, p);
    Place const onSecond = PlaceOf(second_, p);
    if (onFirst.distance > same_ || onSecond.distance > same_) return;
    found_.Add({p, onFirst.along, onSecond.along});
  }

  void TakeCrossings() {
    if (first_.isArc && second_.isArc) {
      bool const isFirstSmaller = first_.radius <= second_.radius;
      DrawnPiece const& smaller = isFirstSmaller ? first_ : second_;
      CutByArc(smaller, isFirstSmaller ? second_ : first_);
    } else if (first_.isArc) {
      CutBySegment(first_, second_);
    } else if (second_.isArc) {
      CutBySegment(second_, first_);
    } else {
      CrossSegments();
    }
  }

 private:
  void CrossSegments() {
    double const det = Cross(first_.toEnd, second_.toEnd);
    if (det == 0.0) return;
    double const share = Cross(Minus(second_.start, first_.start), second_.toEnd) / det;
    TakeIfOnBoth(Plus(first_.start, Times(share, first_.toEnd)));
  }

  void CutBySegment(DrawnPiece const& arc, DrawnPiece const& segment) {
    if (segment.length == 0.0) return;
    Point const normal = Times(1.0 / segment.length, TurnLeft(segment.toEnd));
    CutByLine(arc, {normal, Dot(normal, Minus(segment.start, arc.start))});
  }

  void CutByArc(DrawnPiece const& arc, DrawnPiece const& other) {
    Point const shift = Minus(other.start, arc.start);
    Point const n = Minus(Plus(shift, other.toCentre), arc.toCentre);
    double const length = Length(n);
    if (length == 0.0) return;
    double const otherPower = Dot(shift, shift) + 2.0 * Dot(shift, other.toCentre) + other.power;
    CutByLine(arc, {Times(1.0 / length, n), (otherPower - arc.power) / (2.0 * length)});
  }

  void CutByLine(DrawnPiece const& arc, Line const& line) {
    Point const tangent = TurnLeft(line.normal);
    double const g = Dot(tangent, arc.toCentre);
    double const fromCentre = line.offset - Dot(line.normal, arc.toCentre);
    double const c = line.offset * (line.offset - 2.0 * Dot(line.normal, arc.toCentre)) + arc.power;
    double const quarter = g * g - c;
    if (quarter < 0.0 && std::fabs(fromCentre) - arc.radius > same_) return;
    double const root = std::sqrt(std::max(quarter, 0.0));
    double const far = g + std::copysign(root, g);
    Point const base = Plus(arc.start, Times(line.offset, line.normal));
    TakeIfOnBoth(Plus(base, Times(far, tangent)));
    if (far != 0.0) TakeIfOnBoth(Plus(base, Times(c / far, tangent)));
  }

  DrawnPiece const& first_;
  DrawnPiece const& second_;
  double same_;
  Meetings found_;
};

/// The other point in which the lines or circles of two neighbours meet: their joint, reflected.
Point OppositeOfJoint(DrawnPiece const& first, DrawnPiece const& second) {
  Point const firstCentre = Minus(first.toCentre, first.toEnd);
  Point offset{};
  if (first.isArc && second.isArc) {
    Point const n = Minus(second.toCentre, firstCentre);
    Point const side = TurnLeft(n);
    offset = Times(2.0 * Dot(firstCentre, side) / Dot(n, n), side);
  } else if (first.isArc) {
    offset =
        Times(2.0 * Dot(firstCentre, second.toEnd) / Dot(second.toEnd, second.toEnd), second.toEnd);
  } else if (second.isArc) {
    offset =
        Times(2.0 * Dot(second.toCentre, first.toEnd) / Dot(first.toEnd, first.toEnd), first.toEnd);
  }
  return Plus(second.start, offset);
}

/// Distance of p from the part of a piece between two places.
double DistanceFromPart(DrawnPiece const& piece, double from, double to, Point const& p) {
  Place const place = PlaceOf(piece, p);
  if (from <= place.along && place.along <= to) return place.distance;
  return std::min(Length(Minus(p, PointAt(piece, from))), Length(Minus(p, PointAt(piece, to))));
}

/// How far the two ways from a meeting to the joint are apart in their middles.
double WidthOfLoop(DrawnPiece const& first, DrawnPiece const& second, Meeting const& meeting) {
  Point const middleOfFirst = PointAt(first, 0.5 * (meeting.alongFirst + first.length));
  Point const middleOfSecond = PointAt(second, 0.5 * meeting.alongSecond);
  return std::max(DistanceFromPart(second, 0.0, meeting.alongSecond, middleOfFirst),
                  DistanceFromPart(first, meeting.alongFirst, first.length, middleOfSecond));
}

}  // namespace

Meetings FindMeetings(DrawnPiece const& first, DrawnPiece const& second) {
  Finder finder(first, second);
  finder.TakeCrossings();
  finder.TakeIfOnBoth(first.start);
  finder.TakeIfOnBoth(first.end);
  finder.TakeIfOnBoth(second.start);
  finder.TakeIfOnBoth(second.end);
  return finder.Found();
}

Meetings FindLoops(DrawnPiece const& first, DrawnPiece const& second) {
  Finder finder(first, second);
  finder.TakeIfOnBoth(OppositeOfJoint(first, second));
  bool const hasOtherJoint = first.start.x == second.end.x && first.start.y == second.end.y;
  if (!hasOtherJoint) {
    finder.TakeIfOnBoth(first.start);
    finder.TakeIfOnBoth(second.end);
  }
  Meetings loops;
  Meetings const& found = finder.Found();
  for (std::size_t i = 0; i < found.count; ++i) {
    Meeting const& meeting = found.list[i];
    bool const isOtherJoint =
        hasOtherJoint && Length(Minus(meeting.at, first.start)) <= finder.SameWithin();
    if (!isOtherJoint && WidthOfLoop(first, second, meeting) > finder.SameWithin())
      loops.Add(meeting);
  }
  return loops;
}

}  // namespace Vorn::Promises
