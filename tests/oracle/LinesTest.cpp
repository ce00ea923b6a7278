// Crossings of lines and segments beside exact numbers, and the answers whether they cross.
#include <algorithm>
#include <cmath>

#include "gtest/gtest.h"
#include "oracle/Worst.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

namespace Vorn::Oracle {
namespace {

using Point = GeometryUtils::Point;

/// Lines whose determinant has fewer than 4 bits left say nothing about their crossing.
bool HasDigits(Real const& determinant, Real const& products) {
  return Abs(determinant) > Real(16.0 * kEps) * products;
}

struct TwoLines {
  explicit TwoLines(Inputs* in)
      : a1(in->Coordinate()),
        b1(in->Coordinate()),
        c1(in->Coordinate()),
        a2(in->Coordinate()),
        b2(in->Coordinate()),
        c2(in->Coordinate()) {
    // Nearly parallel, in every fourth case.
    if (in->Random().Integer(0, 3) > 0) return;
    a2 = 1.5 * a1;
    b2 = 1.5 * b1 + (std::fabs(b1) + 1.0) * std::exp2(in->Random().Uniform(-40.0, -4.0));
  }

  Real Determinant() const { return Real(a1) * b2 - Real(b1) * a2; }
  Real Products() const { return Abs(Real(a1) * b2) + Abs(Real(b1) * a2); }

  double a1, b1, c1, a2, b2, c2;
};

/// The numerator 2u of its products, the determinant 2u of its own times the result, the quotient
/// 1u; a sixteenth more, since the determinant itself is off.
TEST(ErrorOfGetLinesIntersection, IsBoundedByItsProductsOverTheDeterminant) {
  ForEachCase(1, Worst("GetLinesIntersection(a1, ..., c2)", 1.6), [](Inputs& in, Worst* worst) {
    TwoLines const l(&in);
    Real const det = l.Determinant();
    if (!HasDigits(det, l.Products())) return;
    Point at;
    ASSERT_EQ(GeometryUtils::GetLinesIntersection(l.a1, l.b1, l.c1, l.a2, l.b2, l.c2, &at.x, &at.y),
              SegmentsRelPosition::Intersecting);
    Real const x = (Real(l.b1) * l.c2 - Real(l.c1) * l.b2) / det;
    Real const y = (Real(l.c1) * l.a2 - Real(l.a1) * l.c2) / det;
    Real const xTerms = Abs(Real(l.b1) * l.c2) + Abs(Real(l.c1) * l.b2);
    Real const yTerms = Abs(Real(l.c1) * l.a2) + Abs(Real(l.a1) * l.c2);
    worst->Note(Real(at.x) - x, (xTerms + Abs(x) * l.Products()) / Abs(det));
    worst->Note(Real(at.y) - y, (yTerms + Abs(y) * l.Products()) / Abs(det));
  });
}

/// x: two differences and a quotient, 3u. y: that error times the slope, product and sum 1u each.
TEST(ErrorOfGetLinesIntersection, InSlopeFormIsBoundedByItsTerms) {
  Worst ordinate("MathUtils::GetLinesIntersection, y", 2.501);
  ForEachCase(2, Worst("MathUtils::GetLinesIntersection, x", 1.501), [&](Inputs& in, Worst* worst) {
    TwoLines const l(&in);
    double x = 0.0;
    double y = 0.0;
    if (!MathUtils::GetLinesIntersection(l.a1, l.c1, l.a2, l.c2, x, y)) return;
    Real const exact = (Real(l.c2) - l.c1) / (Real(l.a1) - l.a2);
    worst->Note(Real(x) - exact, Abs(exact));
    ordinate.Note(Real(y) - (Real(l.a1) * exact + l.c1), Abs(Real(l.a1) * exact) + Abs(Real(l.c1)));
  });
  ordinate.Check(CaseCount());
}

/// The normal's constant 2u of its products; with the crossing of the two lines 8u of the sum.
TEST(ErrorOfGetNearestPointOnLine, IsFourEpsOfItsTerms) {
  ForEachCase(3, Worst("GetNearestPointOnLine", 4.001), [](Inputs& in, Worst* worst) {
    RealLine const line{in.Coordinate(), in.Coordinate(), in.Coordinate()};
    Point const p = in.Point();
    Point foot;
    if (!GeometryUtils::GetNearestPointOnLine(line.a.ToDouble(), line.b.ToDouble(),
                                              line.c.ToDouble(), p, &foot))
      return;
    Real const t = line.At(Exact(p)) / Square(line.Norm());
    Real const unit = Abs(line.c) / line.Norm() + Abs(Real(p.x)) + Abs(Real(p.y));
    worst->Note(Real(foot.x) - (Real(p.x) - t * line.a), unit);
    worst->Note(Real(foot.y) - (Real(p.y) - t * line.b), unit);
  });
}

/// Two segments, their crossing and how far rounding moves it.
struct TwoSegments {
  explicit TwoSegments(Inputs* in)
      : a(in->Point()), b(in->Point()), c(in->Point()), d(in->Point()) {
    // An end of the one on the other or near it, in every third case.
    if (in->Random().Integer(0, 2) > 0) return;
    double const t = 0.25 * in->Random().Integer(0, 4);
    c = {a.x + t * (b.x - a.x), a.y + t * (b.y - a.y)};
  }

  RealPoint Along1() const { return Exact(b) - Exact(a); }
  RealPoint Along2() const { return Exact(d) - Exact(c); }
  RealPoint Between() const { return Exact(c) - Exact(a); }
  Real Determinant() const { return Cross(Along1(), Along2()); }
  /// The sums of the magnitudes of products that the determinant and the parameters come from.
  static Real Products(RealPoint const& p, RealPoint const& q) {
    return Abs(p.x * q.y) + Abs(p.y * q.x);
  }
  Real DeterminantProducts() const { return Products(Along1(), Along2()); }
  Real AllProducts() const {
    return DeterminantProducts() + Products(Between(), Along2()) + Products(Between(), Along1());
  }
  Real Parameter1() const { return Cross(Between(), Along2()) / Determinant(); }
  Real Parameter2() const { return Cross(Between(), Along1()) / Determinant(); }

  /// How far the nearer of the four limits is, as a share of the segments: below 0 outside.
  Real Inside() const {
    Real const s = Parameter1();
    Real const u = Parameter2();
    return Smaller(Smaller(s, Real(1.0) - s), Smaller(u, Real(1.0) - u));
  }

  Point a, b, c, d;
};

/// Each parameter times the determinant: differences 2u, product 1u, sum 1u, so 4u of the products;
/// the determinant as much. The point: 4u of the products and 7u of the determinant's, times the
/// length over the determinant, a sixteenth more, and 1u of the coordinate.
TEST(ErrorOfGetLineSegmentsIntersection, IsBoundedByItsProductsOverTheDeterminant) {
  ForEachCase(4, Worst("GetLineSegmentsIntersection", 4.0), [](Inputs& in, Worst* worst) {
    TwoSegments const s(&in);
    Real const det = s.Determinant();
    if (!HasDigits(det, s.DeterminantProducts())) return;
    Point at;
    if (GeometryUtils::GetLineSegmentsIntersection(s.a.x, s.a.y, s.b.x, s.b.y, s.c.x, s.c.y, s.d.x,
                                                   s.d.y, &at.x,
                                                   &at.y) != SegmentsRelPosition::Intersecting)
      return;
    RealPoint const exact = Exact(s.a) + s.Parameter1() * s.Along1();
    Real const share = s.AllProducts() / Abs(det);
    worst->Note(Real(at.x) - exact.x, share * Abs(s.Along1().x) + Abs(exact.x));
    worst->Note(Real(at.y) - exact.y, share * Abs(s.Along1().y) + Abs(exact.y));
  });
}

/// Whether segments cross is answered wrongly only where a parameter is within its error, 4u of
/// the products over the determinant and as much of the determinant itself, of 0 or 1.
TEST(ErrorOfGetLineSegmentsIntersection, IsAWrongAnswerOnlyWithinRounding) {
  Worst plain("AreLineSegmentsIntersect, distance of wrong answers", 4.3);
  ForEachCase(5, Worst("GetLineSegmentsIntersection, of wrong answers", 4.3),
              [&](Inputs& in, Worst* worst) {
                TwoSegments const s(&in);
                Real const det = s.Determinant();
                if (!HasDigits(det, s.DeterminantProducts())) return;
                Point at;
                bool const isExact = s.Inside() >= Real(0.0);
                bool const isFound = GeometryUtils::GetLineSegmentsIntersection(
                                         s.a.x, s.a.y, s.b.x, s.b.y, s.c.x, s.c.y, s.d.x, s.d.y,
                                         &at.x, &at.y) == SegmentsRelPosition::Intersecting;
                Real const unit = s.AllProducts() / Abs(det);
                worst->Note(isFound == isExact ? Real(0.0) : s.Inside(), unit);
                // Below eps this one takes segments for parallel.
                if (Abs(det) < Real(1e-15)) return;
                bool const isCrossing = GeometryUtils::AreLineSegmentsIntersect(
                    s.a.x, s.a.y, s.b.x, s.b.y, s.c.x, s.c.y, s.d.x, s.d.y);
                plain.Note(isCrossing == isExact ? Real(0.0) : s.Inside(), unit);
              });
  plain.Check(CaseCount());
}

/// The crossing of two lines, the second one of coefficients that are off by 1u and 2u: measured,
/// the largest of some millions of cases and half as much again.
TEST(ErrorOfGetLineAndSegmentIntersection, IsBoundedByItsProductsOverTheDeterminant) {
  ForEachCase(6, Worst("GetLineAndSegmentIntersection", 2.0), [](Inputs& in, Worst* worst) {
    RealLine const line{in.Coordinate(), in.Coordinate(), in.Coordinate()};
    Point const p = in.Point();
    Point const q = in.Point();
    Point at;
    if (!GeometryUtils::GetLineAndSegmentIntersection(line.a.ToDouble(), line.b.ToDouble(),
                                                      line.c.ToDouble(), p.x, p.y, q.x, q.y, &at.x,
                                                      &at.y))
      return;
    RealLine const second{Real(p.y) - q.y, Real(q.x) - p.x, Real(p.x) * q.y - Real(p.y) * q.x};
    Real const det = line.a * second.b - line.b * second.a;
    Real const products = Abs(line.a * second.b) + Abs(line.b * second.a);
    if (!HasDigits(det, products)) return;
    Real const c2 = Abs(Real(p.x) * q.y) + Abs(Real(p.y) * q.x);
    Real const x = (line.b * second.c - line.c * second.b) / det;
    Real const y = (line.c * second.a - line.a * second.c) / det;
    worst->Note(Real(at.x) - x,
                (Abs(line.b) * c2 + Abs(line.c * second.b) + Abs(x) * products) / Abs(det));
    worst->Note(Real(at.y) - y,
                (Abs(line.a) * c2 + Abs(line.c * second.a) + Abs(y) * products) / Abs(det));
  });
}

}  // namespace
}  // namespace Vorn::Oracle
