// Circles through three points and the sense of three points beside exact numbers.
#include <algorithm>
#include <cmath>

#include "gtest/gtest.h"
#include "oracle/Worst.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Oracle {
namespace {

using Point = GeometryUtils::Point;

/// Three points and the exact circle through them.
struct ThreePoints {
  explicit ThreePoints(Inputs* in) : a(in->Point()), b(in->Point()), c(in->Point()) {
    // Nearly on one line, in every fourth case.
    if (in->Random().Integer(0, 3) > 0) return;
    double const t = in->Random().Uniform(-1.0, 2.0);
    c = {a.x + t * (b.x - a.x), a.y + t * (b.y - a.y)};
    c.x += (std::fabs(a.x) + 1.0) * std::exp2(in->Random().Uniform(-30.0, -5.0));
  }

  RealPoint Ab() const { return Exact(b) - Exact(a); }
  RealPoint Ac() const { return Exact(c) - Exact(a); }
  Real TwiceArea() const { return Cross(Ab(), Ac()); }

  RealPoint Centre() const {
    Real const scale = Real(2.0) * TwiceArea();
    Real const ab2 = Dot(Ab(), Ab());
    Real const ac2 = Dot(Ac(), Ac());
    return {Real(a.x) + (Ac().y * ab2 - Ab().y * ac2) / scale,
            Real(a.y) + (Ab().x * ac2 - Ac().x * ab2) / scale};
  }

  Real Radius() const { return Length(Centre() - Exact(a)); }

  Real Farthest() const {
    Real largest = 0.0;
    for (Point const& p : {a, b, c}) largest = Larger(largest, Length(Exact(p)));
    return largest;
  }

  /// How ill-conditioned the circle is: the square of the longest side over twice the area.
  Real Slimness() const {
    RealPoint const bc = Exact(c) - Exact(b);
    Real const longest2 = Larger(Dot(bc, bc), Larger(Dot(Ab(), Ab()), Dot(Ac(), Ac())));
    return longest2 / Abs(TwiceArea());
  }

  /// The largest distance of a point or the centre from the origin, times the slimness.
  Real Unit() const { return Slimness() * (Farthest() + Length(Centre())); }

  /// Slimmer ones have no digit left.
  bool SaySomething() const { return TwiceArea().Sign() != 0 && Slimness() < Real(1e12); }

  Point a;
  Point b;
  Point c;
};

/// Measured, not derived: the largest of some millions of cases and half as much again.
constexpr double kCentre = 2.0;

void NoteCircle(ThreePoints const& points, RealPoint const& centre, double radius, Worst* worst) {
  worst->Note(Length(centre - points.Centre()), points.Unit());
  worst->Note(Real(radius) - points.Radius(), points.Unit());
}

TEST(ErrorOfGetCircle, ThroughThreePointsIsBoundedByTheirSlimness) {
  ForEachCase(
      1, Worst("GetCircle(a, b, c), centre and radius", kCentre), [](Inputs& in, Worst* worst) {
        ThreePoints const points(&in);
        Point centre;
        double radius = 0.0;
        if (!points.SaySomething()) return;
        ASSERT_TRUE(GeometryUtils::GetCircle(points.a, points.b, points.c, &centre, &radius));
        NoteCircle(points, Exact(centre), radius, worst);
      });
}

TEST(ErrorOfGetCircle, ThroughSixNumbersIsBoundedByTheirSlimness) {
  ForEachCase(
      2, Worst("GetCircle(x1, ..., y3), centre and radius", kCentre), [](Inputs& in, Worst* worst) {
        ThreePoints const points(&in);
        Point centre;
        double radius = 0.0;
        if (!points.SaySomething()) return;
        ASSERT_EQ(GeometryUtils::GetCircle(points.a.x, points.a.y, points.b.x, points.b.y,
                                           points.c.x, points.c.y, &centre.x, &centre.y, &radius),
                  ErrorCode::Ok);
        NoteCircle(points, Exact(centre), radius, worst);
      });
}

TEST(ErrorOfGetCircle, WithOneToleranceIsThatOfTheCircleItself) {
  ForEachCase(
      3, Worst("GetCircle(WPoint), centre and radius", kCentre), [](Inputs& in, Worst* worst) {
        ThreePoints const points(&in);
        double const w = 0.25 * in.Positive();
        WPoint circle{};
        Point moved[3] = {points.a, points.b, points.c};
        bool ccw = false;
        if (!points.SaySomething()) return;
        if (!GeometryUtils::GetCircle(
                Testing::Weighted(points.a, w), Testing::Weighted(points.b, w),
                Testing::Weighted(points.c, w), &circle, &moved[0], &moved[1], &moved[2], &ccw)) {
          return;
        }
        RealPoint const centre{circle.x, circle.y};
        worst->Note(Length(centre - points.Centre()), points.Unit() + Real(w));
        worst->Note(Real(circle.w) - (points.Radius() + Real(w)), points.Unit() + Real(w));
      });
}

/// The products of the three cross products and, by that, what they are rounded from.
Real TermsOf(ThreePoints const& points) {
  Real sum = 0.0;
  for (auto const& [p, q] :
       {std::pair{points.a, points.b}, {points.b, points.c}, {points.c, points.a}}) {
    sum = sum + Abs(Real(p.x) * q.y) + Abs(Real(p.y) * q.x);
  }
  return sum;
}

/// Each product 1u, each difference 1u, two sums 1u each: 4u of the products, for twice the area.
TEST(ErrorOfGetArea, OfATriangleIsOneEpsOfItsProducts) {
  ForEachCase(4, Worst("GetArea(triangle)", 1.001), [](Inputs& in, Worst* worst) {
    ThreePoints const points(&in);
    double const area = GeometryUtils::GetArea({{points.a, points.b, points.c}});
    worst->Note(Real(area) + points.TwiceArea() / Real(2.0), TermsOf(points));
  });
}

/// A sense can be wrong, or missing, only where twice the area is below the error of it.
TEST(ErrorOfIsCcw, IsWrongOnlyWithinRounding) {
  ForEachCase(5, Worst("IsCcw(a, b, c), twice the area of wrong answers", 2.001),
              [](Inputs& in, Worst* worst) {
                ThreePoints const points(&in);
                bool ccw = false;
                bool const isFound =
                    GeometryUtils::IsCcw(points.a, points.b, points.c, &ccw) == ErrorCode::Ok;
                int const sense = isFound ? (ccw ? 1 : -1) : 0;
                bool const isRight = sense == points.TwiceArea().Sign();
                Real const terms = TermsOf(points);
                worst->Note(isRight ? Real(0.0) : points.TwiceArea(), terms);
                // Whole numbers of four digits are exact all the way.
                bool const isExact =
                    std::floor(points.a.x) == points.a.x && std::floor(points.b.x) == points.b.x &&
                    std::floor(points.c.x) == points.c.x && std::floor(points.a.y) == points.a.y &&
                    std::floor(points.b.y) == points.b.y && std::floor(points.c.y) == points.c.y &&
                    terms < Real(1e8);
                EXPECT_TRUE(isRight || !isExact);
              });
}

}  // namespace
}  // namespace Vorn::Oracle
