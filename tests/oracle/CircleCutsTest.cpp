// Common points of circles with segments, lines and each other beside exact numbers.
//
// Bounds are measured, not derived: the largest error of some millions of cases and half as much
// again. Each common point moves with the square of what is rounded over half the chord h: the
// nearer a line is to a tangent, the more.
#include <cmath>
#include <numbers>
#include <optional>

#include "gtest/gtest.h"
#include "oracle/Worst.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Oracle {
namespace {

using Point = GeometryUtils::Point;

struct RealCircle {
  RealPoint centre;
  Real radius;
};

/// The points of a line through a point that lie on a circle, as parameters along a direction.
struct Chord {
  Chord(RealCircle const& circle, RealPoint const& start, RealPoint const& along) {
    RealPoint const from = start - circle.centre;
    Real const length2 = Dot(along, along);
    middle = -Dot(along, from) / length2;
    Real const apart2 = Square(Cross(along, from)) / length2;
    half2 = Square(circle.radius) - apart2;
    if (half2.Sign() > 0) step = Sqrt(half2 / length2);
  }
  Real middle;
  Real half2;  ///< the square of half the chord; below zero for a line that passes by
  Real step;   ///< half the chord, in units of the direction
};

/// The distance of p from the nearer one of two.
Real FromNearer(RealPoint const& p, RealPoint const& a, RealPoint const& b) {
  return Smaller(Length(p - a), Length(p - b));
}

struct CircleAndSegment {
  explicit CircleAndSegment(Inputs* in)
      : centre(in->Point()), radius(in->Positive()), p(in->Point()), q(in->Point()) {
    // Points near the circle, so that most segments cut it.
    auto& random = in->Random();
    double const reach = radius * random.Uniform(0.0, 2.0);
    p = random.PointOnCircle(centre, reach);
    q = random.PointOnCircle(centre, radius * random.Uniform(0.0, 4.0));
  }
  RealCircle Circle() const { return {Exact(centre), radius}; }
  RealPoint Along() const { return Exact(q) - Exact(p); }

  Point centre;
  double radius;
  Point p;
  Point q;
};

Real LargestOf(RealPoint const& p) { return Larger(Abs(p.x), Abs(p.y)); }

/// Where the line of a segment cuts a circle, and what rounding does to it.
struct Cuts {
  explicit Cuts(CircleAndSegment const& s)
      : chord(s.Circle(), Exact(s.p), s.Along()),
        first(Exact(s.p) + (chord.middle - chord.step) * s.Along()),
        second(Exact(s.p) + (chord.middle + chord.step) * s.Along()),
        squares(Dot(Exact(s.p) - Exact(s.centre), Exact(s.p) - Exact(s.centre)) +
                Square(Real(s.radius))),
        coordinates(LargestOf(Exact(s.p)) + LargestOf(Exact(s.centre))) {}

  /// The square of half a chord below which its sign may be one of rounding.
  Real Doubtful() const { return Real(64.0 * kEps) * squares; }
  /// What the error of a common point is measured in.
  Real Unit() const { return squares / Sqrt(Abs(chord.half2)) + coordinates; }
  /// The distance of a point from the nearer common one.
  Real ErrorOf(Point const& found) const { return FromNearer(Exact(found), first, second); }

  Chord chord;
  RealPoint first;
  RealPoint second;
  Real squares;
  Real coordinates;
};

TEST(ErrorOfGetLineSegmentAndCircleIntersection, IsBoundedByTheChord) {
  ForEachCase(1, Worst("GetLineSegmentAndCircleIntersection", 4.0), [](Inputs& in, Worst* worst) {
    CircleAndSegment const s(&in);
    Cuts const cuts(s);
    if (cuts.chord.half2 < cuts.Doubtful()) return;
    Point found[2];
    int const count = GeometryUtils::GetLineSegmentAndCircleIntersection(
        s.p.x, s.p.y, s.q.x, s.q.y, s.centre.x, s.centre.y, s.radius, &found[0].x, &found[0].y,
        &found[1].x, &found[1].y);
    for (int i = 0; i < count; ++i) worst->Note(cuts.ErrorOf(found[i]), cuts.Unit());
    if (count == 0) worst->Note(0.0, cuts.Unit());
  });
}

/// How many points a segment has on a circle is wrong only near a tangent or at an end.
TEST(ErrorOfGetLineSegmentAndCircleIntersection, IsAWrongNumberOnlyWithinRounding) {
  ForEachCase(2, Worst("GetLineSegmentAndCircleIntersection, wrong number", 4.0),
              [](Inputs& in, Worst* worst) {
                CircleAndSegment const s(&in);
                Cuts const cuts(s);
                Chord const& chord = cuts.chord;
                if (Abs(chord.half2) < cuts.Doubtful() || Dot(s.Along(), s.Along()) < Real(1e-6))
                  return;
                Point found[2];
                int const count = GeometryUtils::GetLineSegmentAndCircleIntersection(
                    s.p.x, s.p.y, s.q.x, s.q.y, s.centre.x, s.centre.y, s.radius, &found[0].x,
                    &found[0].y, &found[1].x, &found[1].y);
                int exact = 0;
                Real nearest = 1e300;
                if (chord.half2.Sign() > 0) {
                  for (Real const& t : {chord.middle - chord.step, chord.middle + chord.step}) {
                    if (t >= Real(0.0) && t <= Real(1.0)) ++exact;
                    nearest = Smaller(nearest, Smaller(Abs(t), Abs(Real(1.0) - t)));
                  }
                }
                worst->Note(count == exact ? Real(0.0) : nearest * Length(s.Along()), cuts.Unit());
              });
}

TEST(ErrorOfGetLineAndCircleIntersection, IsBoundedByTheChord) {
  ForEachCase(3, Worst("GetLineAndCircleIntersection", 24.0), [](Inputs& in, Worst* worst) {
    CircleAndSegment const s(&in);
    double a = 0.0;
    double b = 0.0;
    double c = 0.0;
    if (!GeometryUtils::GetLineParameters(s.p.x, s.p.y, s.q.x, s.q.y, &a, &b, &c)) return;
    RealLine const line{a, b, c};
    Real const t = line.At(Exact(s.centre)) / Square(line.Norm());
    RealPoint const foot = Exact(s.centre) - t * RealPoint{line.a, line.b};
    RealPoint const along = Real(1.0) / line.Norm() * RealPoint{-line.b, line.a};
    Chord const chord(s.Circle(), foot, along);
    Real const far = LargestOf(Exact(s.centre)) + Abs(line.c) / line.Norm();
    Real const unit = s.radius * (Real(s.radius) + far) / Sqrt(Abs(chord.half2)) + far;
    if (chord.half2 < Real(64.0 * kEps) * s.radius * (Real(s.radius) + far)) return;
    Point found[2];
    int const count = GeometryUtils::GetLineAndCircleIntersection(
        a, b, c, s.centre.x, s.centre.y, s.radius, &found[0].x, &found[0].y, &found[1].x,
        &found[1].y);
    EXPECT_EQ(count, 2);
    for (int i = 0; i < count; ++i) {
      worst->Note(FromNearer(Exact(found[i]), foot - chord.step * along, foot + chord.step * along),
                  unit);
    }
  });
}

TEST(ErrorOfGetNearestPointOnCircle, IsBoundedByTheCoordinates) {
  ForEachCase(4, Worst("GetNearestPointOnCircle", 4.0), [](Inputs& in, Worst* worst) {
    CircleAndSegment const s(&in);
    Point nearest;
    if (!GeometryUtils::GetNearestPointOnCircle(s.centre, s.radius, s.p, &nearest)) return;
    RealPoint const out = Exact(s.p) - Exact(s.centre);
    RealPoint const exact = Exact(s.centre) + (Real(s.radius) / Length(out)) * out;
    worst->Note(Length(Exact(nearest) - exact), LargestOf(Exact(s.centre)) + Real(s.radius));
  });
}

struct TwoCircles {
  explicit TwoCircles(Inputs* in)
      : first(in->Point()), radius1(in->Positive()), radius2(in->Positive()) {
    double const near = std::fabs(radius1 - radius2);
    double const far = radius1 + radius2;
    second = in->Random().PointOnCircle(first, in->Random().Uniform(near, far));
  }
  Point first;
  double radius1;
  double radius2;
  Point second;
};

/// Nearly a whole circle: from one angle to nearly the same.
constexpr double kFrom = 0.0;
constexpr double kTo = -1e-9;

TEST(ErrorOfGetCircleArcAndCircleArcIntersection, IsBoundedByTheChord) {
  ForEachCase(5, Worst("GetCircleArcAndCircleArcIntersection", 2.0), [](Inputs& in, Worst* worst) {
    TwoCircles const c(&in);
    RealPoint const between = Exact(c.second) - Exact(c.first);
    Real const distance = Length(between);
    Real const r1 = c.radius1;
    Real const r2 = c.radius2;
    if (distance.Sign() == 0) return;
    Real const q = (r1 * r1 + distance * distance - r2 * r2) / (Real(2.0) * distance);
    Real const half2 = r1 * r1 - q * q;
    Real const big = Larger(r1, r2);
    Real const squares = r1 * r1 + r2 * r2 + distance * distance;
    if (half2 < Real(64.0 * kEps) * big * squares / distance) return;
    Point found[2];
    int const count = GeometryUtils::GetCircleArcAndCircleArcIntersection(
        c.first.x, c.first.y, c.radius1, 1.0, kFrom, kTo, c.second.x, c.second.y, c.radius2, 1.0,
        kFrom, kTo, &found[0].x, &found[0].y, &found[1].x, &found[1].y);
    RealPoint const unitVector = (Real(1.0) / distance) * between;
    RealPoint const side{-unitVector.y, unitVector.x};
    RealPoint const middle = Exact(c.first) + q * unitVector;
    Real const half = Sqrt(half2);
    Real const unit =
        (big / half) * squares / distance + LargestOf(Exact(c.first)) + LargestOf(Exact(c.second));
    for (int i = 0; i < count; ++i) {
      worst->Note(FromNearer(Exact(found[i]), middle - half * side, middle + half * side), unit);
    }
  });
}

TEST(ErrorOfGetLineSegmentAndCircleArcIntersection, IsThatOfTheCircle) {
  ForEachCase(6, Worst("GetLineSegmentAndCircleArcIntersection", 4.0),
              [](Inputs& in, Worst* worst) {
                CircleAndSegment const s(&in);
                Cuts const cuts(s);
                if (cuts.chord.half2 < cuts.Doubtful()) return;
                Point found[2];
                int const count = GeometryUtils::GetLineSegmentAndCircleArcIntersection(
                    s.p.x, s.p.y, s.q.x, s.q.y, s.centre.x, s.centre.y, s.radius, 1.0, kFrom, kTo,
                    &found[0].x, &found[0].y, &found[1].x, &found[1].y);
                for (int i = 0; i < count; ++i) worst->Note(cuts.ErrorOf(found[i]), cuts.Unit());
              });
}

}  // namespace
}  // namespace Vorn::Oracle
