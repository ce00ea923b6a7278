// Distances, lines and deviations beside exact numbers.
//
// Bounds are derived from u = eps/2, the relative error of one rounding; terms of u^2 are covered
// by the last digit of each bound.
#include <cmath>

#include "gtest/gtest.h"
#include "oracle/Worst.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Oracle {
namespace {

using Point = GeometryUtils::Point;

struct LineAndPoint {
  explicit LineAndPoint(Inputs* in)
      : a(in->Coordinate()),
        b(in->Coordinate()),
        c(in->Coordinate() * in->Positive()),
        p(in->Point()) {
    // The point near the line, where everything cancels, in every third case.
    if (in->Random().Integer(0, 2) == 0 && b != 0.0) p.y = -(a * p.x + c) / b;
  }
  RealLine Exactly() const { return {a, b, c}; }

  double a;
  double b;
  double c;
  Point p;
};

/// At: 1u of each product, 1u of each of two sums, so 3u of the terms; the norm 2u, the quotient
/// 1u, both of a result that is no larger than the terms over the norm: 6u = 3 eps.
TEST(ErrorOfGetDeviation, OfALineIsThreeEpsOfItsTerms) {
  ForEachCase(1, Worst("GetDeviation(a, b, c, x, y)", 3.001), [](Inputs& in, Worst* worst) {
    LineAndPoint const at(&in);
    double deviation = 0.0;
    if (!GeometryUtils::GetDeviation(at.a, at.b, at.c, at.p.x, at.p.y, &deviation)) return;
    RealLine const line = at.Exactly();
    worst->Note(Real(deviation) - Abs(line.At(Exact(at.p))) / line.Norm(),
                line.Terms(Exact(at.p)) / line.Norm());
  });
}

TEST(ErrorOfGetSignedDeviation, IsThreeEpsOfItsTerms) {
  ForEachCase(2, Worst("GetSignedDeviation", 3.001), [](Inputs& in, Worst* worst) {
    LineAndPoint const at(&in);
    double deviation = 0.0;
    if (!GeometryUtils::GetSignedDeviation(at.a, at.b, at.c, at.p.x, at.p.y, &deviation)) return;
    RealLine const line = at.Exactly();
    Real const exact = line.At(Exact(at.p)) / line.Norm();
    worst->Note(Real(deviation) - (at.c > 0.0 ? -exact : exact),
                line.Terms(Exact(at.p)) / line.Norm());
  });
}

/// Each squared distance 4u; with Q their sum, which is three halves of the base or more, and
/// T = f + b - e: T is good to 6u Q, its square over 4b to 18u Q^2/4b, f - that to another 4u f
/// plus 1u, where f <= 8/3 of Q^2/4b: some 32u of Q^2/4b, and 2u f for the root.
TEST(ErrorOfGetDeviation, OfThreePointsIsBoundedInItsSquare) {
  ForEachCase(3, Worst("GetDeviation(coords), squared", 19.0), [](Inputs& in, Worst* worst) {
    Point const a = in.Point();
    Point const b = in.Point();
    Point p = in.Point();
    if (in.Random().Integer(0, 2) == 0) p = {a.x + 0.25 * (b.x - a.x), a.y + 0.25 * (b.y - a.y)};
    double const coords[6] = {a.x, a.y, b.x, b.y, p.x, p.y};
    double deviation = 0.0;
    if (!GeometryUtils::GetDeviation(coords, &deviation)) return;
    RealPoint const base = Exact(b) - Exact(a);
    Real const base2 = Dot(base, base);
    RealPoint const toStart = Exact(p) - Exact(a);
    RealPoint const toEnd = Exact(p) - Exact(b);
    Real const all = base2 + Dot(toStart, toStart) + Dot(toEnd, toEnd);
    // Not a number stands for a square that came out below zero.
    Real const square = std::isnan(deviation) ? Real(0.0) : Square(Real(deviation));
    worst->Note(square - Square(Cross(base, toStart)) / base2, Square(all) / (Real(4.0) * base2));
  });
}

/// Difference 1u, twice in the square, product 1u, sum 1u: 4u.
TEST(ErrorOfGetDist2, IsTwoEpsOfIt) {
  ForEachCase(4, Worst("GetDist2", 2.001), [](Inputs& in, Worst* worst) {
    Point const a = in.Point();
    Point const b = in.Point();
    RealPoint const d = Exact(b) - Exact(a);
    worst->Note(Real(GeometryUtils::GetDist2(a, b)) - Dot(d, d), Dot(d, d));
  });
}

/// a and b are differences, rounded once. c: 1u of each product, 1u of their difference.
TEST(ErrorOfGetLineParameters, IsOneEpsOfTheProducts) {
  Worst differences("GetLineParameters, a and b", 0.5);
  ForEachCase(5, Worst("GetLineParameters, c", 1.001), [&](Inputs& in, Worst* worst) {
    Point const p = in.Point();
    Point const q = in.Point();
    double a = 0.0;
    double b = 0.0;
    double c = 0.0;
    if (!GeometryUtils::GetLineParameters(p.x, p.y, q.x, q.y, &a, &b, &c)) return;
    Real const first = Real(p.x) * q.y;
    Real const second = Real(p.y) * q.x;
    worst->Note(Real(c) - (first - second), Abs(first) + Abs(second));
    differences.Note(Real(a) - (Real(p.y) - q.y), Abs(Real(p.y) - q.y));
    differences.Note(Real(b) - (Real(q.x) - p.x), Abs(Real(q.x) - p.x));
  });
  differences.Check(CaseCount());
}

TEST(ErrorOfGetNormal, IsOneEpsOfTheProducts) {
  ForEachCase(6, Worst("GetNormal, nc", 1.001), [](Inputs& in, Worst* worst) {
    LineAndPoint const at(&in);
    double na = 0.0;
    double nb = 0.0;
    double nc = 0.0;
    GeometryUtils::GetNormal(at.a, at.b, at.c, at.p, &na, &nb, &nc);
    Real const first = Real(at.a) * at.p.y;
    Real const second = Real(at.b) * at.p.x;
    worst->Note(Real(nc) - (first - second), Abs(first) + Abs(second));
  });
}

/// The side with the tolerances: sum 1u and factor 1u, twice in the square, product 1u: 5u; the
/// squared distance 4u. The answer can be wrong only where both differ by less than 9u = 4.5 eps.
TEST(ErrorOfIsPointValidToFit, IsWrongOnlyWithinRounding) {
  ForEachCase(7, Worst("IsPointValidToFit, distance of wrong answers", 4.501),
              [](Inputs& in, Worst* worst) {
                WPoint const a = Testing::Weighted(in.Point(), in.Positive());
                WPoint b = Testing::Weighted(in.Point(), in.Positive());
                double const distance = std::hypot(b.x - a.x, b.y - a.y);
                if (in.Random().Flip()) b.w = std::fabs(distance / 1.5 - a.w);
                RealPoint const d = RealPoint{b.x, b.y} - RealPoint{a.x, a.y};
                Real const reach2 = Square(Real(1.5) * (Real(a.w) + b.w));
                bool const isFar = reach2 < Dot(d, d);
                bool const isRight = GeometryUtils::IsPointValidToFit(a, b) == isFar;
                worst->Note(isRight ? Real(0.0) : Dot(d, d) - reach2, Larger(reach2, Dot(d, d)));
              });
}

}  // namespace
}  // namespace Vorn::Oracle
