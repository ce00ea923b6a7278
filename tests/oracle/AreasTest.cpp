// Areas, overlaps of triangles and linear systems beside exact numbers.
#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>
#include <vector>

#include "gtest/gtest.h"
#include "oracle/Worst.h"
#include "vorn/GeometryUtils.h"
#include "vorn/MathUtils.h"

namespace Vorn::Oracle {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;

/// A star around a point: it does not cross itself.
std::vector<Point> Star(Inputs* in) {
  auto& random = in->Random();
  int const count = random.Integer(3, 12);
  Point const middle = in->Point();
  std::vector<Point> corners;
  for (int i = 0; i < count; ++i) {
    double const angle = (i + random.Uniform(0.1, 0.9)) * 2.0 * std::numbers::pi / count;
    double const radius = in->Positive();
    corners.push_back({middle.x + radius * std::cos(angle), middle.y + radius * std::sin(angle)});
  }
  if (random.Flip()) std::reverse(corners.begin(), corners.end());
  corners.push_back(corners.front());
  return corners;
}

struct ExactArea {
  Real twice;  ///< twice the area, positive for clockwise vertices
  Real terms;  ///< the sum of the magnitudes of (x2 - x1) * (y2 + y1)
  double count = 0.0;
};

ExactArea AreaOf(std::vector<Point> const& corners) {
  ExactArea area;
  for (std::size_t i = 1; i < corners.size(); ++i) {
    Real const term =
        (Real(corners[i].x) - corners[i - 1].x) * (Real(corners[i].y) + corners[i - 1].y);
    area.twice = area.twice + term;
    area.terms = area.terms + Abs(term);
    area.count += 1.0;
  }
  return area;
}

/// A term has two roundings of its factors and one of the product, the sum one for each term:
/// (n + 3)u of the terms for twice the area.
TEST(ErrorOfGetArea, OfASegmentContourIsBoundedByItsTerms) {
  ForEachCase(1, Worst("GetArea(contour), of (n + 3) terms", 0.2501), [](Inputs& in, Worst* worst) {
    std::vector<Point> const corners = Star(&in);
    std::vector<GeometryUtils::Elem> contour;
    for (Point const& corner : corners) GeometryUtils::AddSegm(&contour, corner);
    double area = 0.0;
    if (GeometryUtils::GetArea(contour, &area) != ErrorCode::Ok) return;
    ExactArea const exact = AreaOf(corners);
    worst->Note(Real(area) - exact.twice / Real(2.0), exact.terms * Real(exact.count + 3.0));
  });
}

/// A term is the difference of two products, 2u of them, the sum one more u for each term:
/// (n + 2)u of the products for twice the area.
TEST(ErrorOfGetArea, OfAFlatPolylineIsBoundedByItsProducts) {
  ForEachCase(2, Worst("GetArea(coords, indices), of (n + 2) products", 0.2501),
              [](Inputs& in, Worst* worst) {
                std::vector<Point> const corners = Star(&in);
                std::vector<double> coords;
                Real products = 0.0;
                for (std::size_t i = 0; i < corners.size(); ++i) {
                  coords.insert(coords.end(), {corners[i].x, corners[i].y});
                  if (i == 0) continue;
                  products = products + Abs(Real(corners[i].x) * corners[i - 1].y) +
                             Abs(Real(corners[i - 1].x) * corners[i].y);
                }
                double area = 0.0;
                auto const last = static_cast<std::int32_t>(coords.size()) - 2;
                ASSERT_EQ(GeometryUtils::GetArea(coords, {last}, &area), ErrorCode::Ok);
                ExactArea const exact = AreaOf(corners);
                worst->Note(Real(area) - exact.twice / Real(2.0),
                            products * Real(exact.count + 2.0));
              });
}

/// A lens of two arcs between two points: their own terms as above, and of the sweep, below a turn,
/// 1.1e-14 of the square of the radius.
TEST(ErrorOfGetArea, OfArcsIsBoundedByTheirTermsAndRadii) {
  ForEachCase(3, Worst("GetArea(contour), two arcs", 16.0), [](Inputs& in, Worst* worst) {
    auto& random = in.Random();
    Point const centre = in.Point();
    double const radius = in.Positive();
    Point const a = random.PointOnCircle(centre, radius);
    Point const b = random.PointOnCircle(centre, radius);
    std::vector<GeometryUtils::Elem> contour;
    GeometryUtils::AddSegm(&contour, a);
    bool const isClockwise = random.Flip();
    GeometryUtils::AddArc(&contour, a, b, centre, radius, isClockwise);
    GeometryUtils::AddArc(&contour, b, a, centre, radius, isClockwise);
    double area = 0.0;
    if (GeometryUtils::GetArea(contour, &area) != ErrorCode::Ok) return;
    // The chords cancel, and the two sectors make a whole turn.
    Real const exact = Real::Pi() * Square(Real(radius));
    Real const far = Larger(Abs(Real(centre.x)), Abs(Real(centre.y))) + Real(radius);
    worst->Note(Real(area) - (isClockwise ? exact : -exact),
                Square(Real(radius)) + Real(radius) * far);
  });
}

using Polygon = std::vector<RealPoint>;

Real TwiceArea(Polygon const& polygon) {
  Real sum = 0.0;
  for (std::size_t i = 0; i < polygon.size(); ++i) {
    sum = sum + Cross(polygon[i], polygon[(i + 1) % polygon.size()]);
  }
  return sum;
}

Polygon CounterClockwise(Triangle const& triangle) {
  Polygon polygon = {Exact(triangle.pts[0]), Exact(triangle.pts[1]), Exact(triangle.pts[2])};
  if (TwiceArea(polygon).Sign() < 0) std::swap(polygon[0], polygon[2]);
  return polygon;
}

/// The part of a convex polygon on the left of a line.
Polygon LeftOf(RealPoint const& from, RealPoint const& to, Polygon const& polygon) {
  Polygon kept;
  for (std::size_t i = 0; i < polygon.size(); ++i) {
    RealPoint const& p = polygon[i];
    RealPoint const& q = polygon[(i + 1) % polygon.size()];
    Real const sideOfP = Cross(to - from, p - from);
    Real const sideOfQ = Cross(to - from, q - from);
    if (sideOfP.Sign() >= 0) kept.push_back(p);
    if (sideOfP.Sign() * sideOfQ.Sign() < 0)
      kept.push_back(p + (sideOfP / (sideOfP - sideOfQ)) * (q - p));
  }
  return kept;
}

Real TwiceCommonArea(Triangle const& first, Triangle const& second) {
  Polygon common = CounterClockwise(first);
  Polygon const window = CounterClockwise(second);
  for (std::size_t i = 0; i < 3 && !common.empty(); ++i) {
    common = LeftOf(window[i], window[(i + 1) % 3], common);
  }
  return TwiceArea(common);
}

Real TwiceAreaOfAll(std::vector<Triangle> const& triangles) {
  Real sum = 0.0;
  for (Triangle const& triangle : triangles) sum = sum + TwiceArea(CounterClockwise(triangle));
  return sum;
}

bool AreThreeOfOne(std::vector<Triangle> const& triangles) {
  return triangles.size() == 3 &&
         std::equal(&triangles[0].pts[0], &triangles[0].pts[3], &triangles[1].pts[0],
                    [](Point const& p, Point const& q) { return p.x == q.x && p.y == q.y; });
}

int TurnOf(Triangle const& t) {
  return Cross(Exact(t.pts[1]) - Exact(t.pts[0]), Exact(t.pts[2]) - Exact(t.pts[0])).Sign();
}

/// Two triangles that turn alike.
struct TwoTriangles {
  explicit TwoTriangles(Inputs* in)
      : first{{in->Point(), in->Point(), in->Point()}},
        second{{in->Point(), in->Point(), in->Point()}} {
    if (TurnOf(first) != TurnOf(second)) std::swap(second.pts[0], second.pts[2]);
  }

  /// No triangle is a line, no vertex lies on the line of a side of the other triangle and no two
  /// sides are parallel, all by more than rounding.
  bool AreInGeneralPosition() const {
    return TurnOf(first) != 0 && TurnOf(second) != 0 && AreApart(first, second) &&
           AreApart(second, first);
  }

  Real LargestCoordinate() const {
    Real largest = 0.0;
    for (Triangle const& t : {first, second}) {
      for (Point const& p : t.pts)
        largest = Larger(largest, Larger(Abs(Real(p.x)), Abs(Real(p.y))));
    }
    return largest;
  }

  Triangle first;
  Triangle second;

 private:
  static bool IsAboveRounding(RealPoint const& p, RealPoint const& q, Real const& size2) {
    return Abs(Cross(p, q)) > Real(16.0 * kEps) * size2;
  }

  bool AreApart(Triangle const& ofSides, Triangle const& other) const {
    Real const size2 = Square(LargestCoordinate());
    for (int i = 0; i < 3; ++i) {
      RealPoint const from = Exact(ofSides.pts[i]);
      RealPoint const side = Exact(ofSides.pts[(i + 1) % 3]) - from;
      for (int j = 0; j < 3; ++j) {
        RealPoint const at = Exact(other.pts[j]);
        if (!IsAboveRounding(side, at - from, size2)) return false;
        if (!IsAboveRounding(side, Exact(other.pts[(j + 1) % 3]) - at, size2)) return false;
      }
    }
    return true;
  }
};

/// Measured, not derived: the largest of some millions of cases and half as much again.
TEST(ErrorOfGetOverlapping, IsBoundedByTheCoordinatesInGeneralPosition) {
  ForEachCase(
      4, Worst("GetOverlapping, area, of the largest square", 8.0), [](Inputs& in, Worst* worst) {
        TwoTriangles const both(&in);
        if (!both.AreInGeneralPosition()) return;
        std::vector<Triangle> common;
        ASSERT_NE(GeometryUtils::GetOverlapping(both.first, both.second, &common),
                  GeometryUtils::OverlappingStatus::OverlapFailed);
        // A triangle inside the other one comes three times.
        Real const copies = AreThreeOfOne(common) ? 3.0 : 1.0;
        worst->Note(TwiceAreaOfAll(common) / copies - TwiceCommonArea(both.first, both.second),
                    Square(both.LargestCoordinate()));
      });
}

/// |A x - b| over |A| |x| + |b|, each row by itself. Measured, the largest of some millions of
/// cases and half as much again.
TEST(ErrorOfLinearEquationSystemSolve, LeavesAResidueOfFewEps) {
  constexpr int kMost = 6;
  ForEachCase(5, Worst("LinearEquationSystemSolve, residue of a row", 2.0),
              [](Inputs& in, Worst* worst) {
                int const n = in.Random().Integer(1, kMost);
                std::vector<double> matrix(static_cast<std::size_t>(n * n));
                std::vector<double> rhs(static_cast<std::size_t>(n));
                for (double& value : matrix) value = in.Random().Uniform(-1.0, 1.0);
                for (double& value : rhs) value = in.Random().Uniform(-1.0, 1.0);
                // Two rows that nearly agree, in every third system.
                if (n > 1 && in.Random().Integer(0, 2) == 0) {
                  for (int j = 0; j < n; ++j)
                    matrix[n + j] = matrix[j] * (1.0 + 1e-8 * in.Random().Unit());
                }
                std::vector<double> scratch = matrix;
                std::vector<double> scratchRhs = rhs;
                std::vector<double> solution(rhs.size());
                if (!MathUtils::LinearEquationSystemSolve(n, scratch.data(), scratchRhs.data(),
                                                          solution.data()))
                  return;
                Real largest = 0.0;
                for (double const value : solution) largest = Larger(largest, Abs(Real(value)));
                for (int i = 0; i < n; ++i) {
                  Real sum = -Real(rhs[i]);
                  for (int j = 0; j < n; ++j) sum = sum + Real(matrix[n * i + j]) * solution[j];
                  worst->Note(sum, Real(static_cast<double>(n)) * largest + Abs(Real(rhs[i])));
                }
              });
}

}  // namespace
}  // namespace Vorn::Oracle
