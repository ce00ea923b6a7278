#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/CellInputs.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceTriangles.h"

namespace Vorn::Testing {
namespace {

using Point = GeometryUtils::Point;
using Triangle = GeometryUtils::Triangle;
using PointStatus = GeometryUtils::PointStatus;

double AreaOf(Triangle const& t) { return GeometryUtils::GetArea(t); }

Triangle const kCcw{{{0.0, 0.0}, {4.0, 0.0}, {0.0, 4.0}}};

TEST(TriangleArea, IsNegativeForCounterClockwiseVertices) { EXPECT_EQ(AreaOf(kCcw), -8.0); }

TEST(TriangleArea, IsPositiveForClockwiseVertices) { EXPECT_EQ(AreaOf(Reversed(kCcw)), 8.0); }

TEST(TriangleArea, AddsTheThreeTermsInVertexOrder) {
  // The terms are 2^54, 1 and -2^54, so the middle one is lost when they are added in order.
  Triangle const t{{{0.0, 0x1p27}, {0x1p27, 0.0}, {0x1p27, -0x1p-27}}};
  EXPECT_EQ(AreaOf(t), 0.0);
  EXPECT_EQ(AreaOf(Rotated(t, 1)), 0.0);
  EXPECT_EQ(AreaOf(Rotated(t, 2)), 0.5);
}

TEST(TriangleArea, OfEqualVerticesIsZero) {
  EXPECT_EQ(AreaOf({{{0.3, 0.7}, {0.3, 0.7}, {0.3, 0.7}}}), 0.0);
  EXPECT_EQ(AreaOf({{{0.3, 0.7}, {1.9, -2.1}, {1.9, -2.1}}}), 0.0);
}

TEST(TriangleArea, HasTheBitsOfThePlainFormula) {
  constexpr std::uint64_t kSeed = 4101;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 20000; ++n) {
    Triangle t;
    for (auto& p : t.pts) p = {random.Wide(-20, 20), random.Wide(-20, 20)};
    ASSERT_PRED_FORMAT2(DoubleBitsEqual, AreaOf(t), Reference::Area(t));
  }
}

TEST(TriangleArea, ChangesSignWhenTheVerticesAreReversedOnAGrid) {
  RandomGeometry random(4102);
  for (int n = 0; n < 2000; ++n) {
    Triangle const t = random.GridTriangle(1000);
    EXPECT_EQ(AreaOf(Reversed(t)), -AreaOf(t));
  }
}

TEST(TriangleArea, PassesNotANumberOn) {
  EXPECT_TRUE(std::isnan(AreaOf({{{kNaN, 0.0}, {1.0, 0.0}, {0.0, 1.0}}})));
  EXPECT_TRUE(std::isnan(AreaOf({{{kInf, 0.0}, {1.0, 0.0}, {0.0, 1.0}}})));
}

TEST(IsValidTriangle, RejectsOnlyAnAreaOfExactlyZero) {
  EXPECT_TRUE(GeometryUtils::IsValidTriangle(kCcw));
  EXPECT_TRUE(GeometryUtils::IsValidTriangle(Reversed(kCcw)));
  EXPECT_FALSE(GeometryUtils::IsValidTriangle({{{0.0, 0.0}, {1.0, 1.0}, {3.0, 3.0}}}));
  EXPECT_TRUE(GeometryUtils::IsValidTriangle({{{0.0, 0.0}, {1.0, 1.0}, {3.0, Up(3.0)}}}));
}

TEST(IsValidTriangle, AcceptsTheSmallestAreaAboveZero) {
  Triangle const smallest{{{0.0, 0.0}, {0x1p-537, 0.0}, {0.0, 0x1p-536}}};
  EXPECT_EQ(AreaOf(smallest), -std::numeric_limits<double>::denorm_min());
  EXPECT_TRUE(GeometryUtils::IsValidTriangle(smallest));
}

TEST(IsValidTriangle, TreatsAnUnderflowingAreaAsZero) {
  EXPECT_FALSE(GeometryUtils::IsValidTriangle(Scaled(kCcw, 1e-170)));
}

TEST(IsValidTriangle, TreatsNotANumberAsPositive) {
  EXPECT_TRUE(GeometryUtils::IsValidTriangle({{{kNaN, 0.0}, {1.0, 0.0}, {0.0, 1.0}}}));
}

Point CenterOf(Triangle const& t) {
  Point center = kPointSentinel;
  EXPECT_TRUE(GeometryUtils::CalcCenter(t, &center));
  return center;
}

TEST(CalcCenter, GivesTheCentroidOfAProperTriangle) {
  EXPECT_SAME_POINT(CenterOf({{{0.0, 0.0}, {3.0, 0.0}, {0.0, 3.0}}}), (Point{1.0, 1.0}));
}

TEST(CalcCenter, OfTwoCoincidentVerticesIsTheMidpointOfTheMidpoints) {
  Point const p{0.0, 0.0};
  Point const q{4.0, 2.0};
  EXPECT_SAME_POINT(CenterOf({{p, p, q}}), (Point{2.0, 1.0}));
  EXPECT_SAME_POINT(CenterOf({{p, q, q}}), (Point{2.0, 1.0}));
  EXPECT_SAME_POINT(CenterOf({{q, p, q}}), (Point{2.0, 1.0}));
}

TEST(CalcCenter, OfAPointIsThePoint) {
  Point const p{0.1, -0.7};
  EXPECT_SAME_POINT(CenterOf({{p, p, p}}), p);
}

TEST(CalcCenter, UsesMediansOnlyAboveTheSmallestNormalSquaredSide) {
  auto const withShortSide = [](double side) {
    return Triangle{{{0.0, 0.0}, {side, 0.0}, {0.0, 1.0}}};
  };
  // 2^-511 squared is the smallest normal double itself, which is not above it.
  EXPECT_SAME_POINT(CenterOf(withShortSide(0x1p-511)), (Point{0x1p-513, 0.5}));
  double const justAbove = Up(0x1p-511);
  ASSERT_GT(justAbove * justAbove, std::numeric_limits<double>::min());
  EXPECT_NEAR(CenterOf(withShortSide(justAbove)).y, 1.0 / 3.0, 1e-15);
}

TEST(CalcCenter, OfCollinearVerticesStaysBetweenThem) {
  Point const center = CenterOf({{{0.0, 0.0}, {1.0, 2.0}, {5.0, 10.0}}});
  EXPECT_GT(center.x, 0.0);
  EXPECT_LT(center.x, 5.0);
  EXPECT_NEAR(center.y, 2.0 * center.x, 1e-14);
}

TEST(CalcCenter, AlwaysSucceedsOnNumbersThatAreNotFinite) {
  EXPECT_TRUE(std::isnan(CenterOf({{{kNaN, 0.0}, {1.0, 0.0}, {0.0, 1.0}}}).x));
  EXPECT_FALSE(std::isfinite(CenterOf({{{kInf, 0.0}, {1.0, 0.0}, {0.0, 1.0}}}).x));
}

TEST(CalcCenter, LiesInsideAndNearTheCentroid) {
  constexpr std::uint64_t kSeed = 4103;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int n = 0; n < 5000; ++n) {
    Triangle const t = random.TriangleIn(-10.0, 10.0);
    if (std::fabs(Reference::Area(t)) < 0.01) continue;
    Point const center = CenterOf(t);
    EXPECT_EQ(GeometryUtils::GetPointStatus(center, t), PointStatus::Inside) << Describe(t);
    EXPECT_NEAR(center.x, (t.pts[0].x + t.pts[1].x + t.pts[2].x) / 3.0, 1e-11);
    EXPECT_NEAR(center.y, (t.pts[0].y + t.pts[1].y + t.pts[2].y) / 3.0, 1e-11);
  }
}

TEST(CalcCenter, HasTheBitsOfTheReference) {
  constexpr std::uint64_t kSeed = 4104;
  SCOPED_TRACE(kSeed);
  for (PairKind kind : kAllPairKinds) {
    RandomGeometry random(kSeed);
    for (int n = 0; n < 5000; ++n) {
      Triangle const t = MakePair(random, kind).first;
      ASSERT_PRED_FORMAT2(PointBitsEqual, CenterOf(t), Reference::Center(t)) << Describe(t);
    }
  }
}

TEST(CalcCenter, TakesTheFirstOfEqualShortestSides) {
  RandomGeometry random(4105);
  for (int n = 0; n < 2000; ++n) {
    // Isosceles by a quarter turn, so that two sides have exactly the same squared length.
    Point const apex = random.GridPoint(50);
    Point const arm = random.PointIn(-1.0, 1.0);
    Point const turned = QuarterTurn(arm);
    Triangle const t =
        Rotated({{apex, {apex.x + arm.x, apex.y + arm.y}, {apex.x + turned.x, apex.y + turned.y}}},
                random.Integer(0, 2));
    ASSERT_PRED_FORMAT2(PointBitsEqual, CenterOf(t), Reference::Center(t)) << Describe(t);
  }
}

PointStatus StatusOf(Point const& p, Triangle const& t) {
  return GeometryUtils::GetPointStatus(p, t);
}

TEST(GetPointStatus, NamesEveryPlaceOfAProperTriangle) {
  for (Triangle const& t : {kCcw, Reversed(kCcw)}) {
    EXPECT_EQ(StatusOf({1.0, 1.0}, t), PointStatus::Inside);
    EXPECT_EQ(StatusOf({3.0, 3.0}, t), PointStatus::Outside);
    EXPECT_EQ(StatusOf({-1.0, 1.0}, t), PointStatus::Outside);
    EXPECT_EQ(StatusOf({2.0, 2.0}, t), PointStatus::OnSide);
    EXPECT_EQ(StatusOf({0.0, 1.0}, t), PointStatus::OnSide);
    EXPECT_EQ(StatusOf({0.0, 0.0}, t), PointStatus::OnVertex);
    EXPECT_EQ(StatusOf({4.0, 0.0}, t), PointStatus::OnVertex);
    EXPECT_EQ(StatusOf({0.0, 4.0}, t), PointStatus::OnVertex);
  }
}

TEST(GetPointStatus, IsOutsideOnASidesExtensionBeyondTheVertex) {
  Triangle const t{{{0.0, 0.0}, {2.0, 1.0}, {5.0, -1.0}}};
  EXPECT_EQ(StatusOf({4.0, 2.0}, t), PointStatus::Outside);
  // Inside the bounding box, on the line of side 0 and beyond its end.
  Triangle const wide{{{0.0, 0.0}, {2.0, 1.0}, {5.0, 4.0}}};
  EXPECT_EQ(StatusOf({4.0, 2.0}, wide), PointStatus::Outside);
  EXPECT_EQ(StatusOf({4.0, 2.0}, Reversed(wide)), PointStatus::Outside);
}

TEST(GetPointStatus, KnowsOnlyTwoPlacesOfADegenerateTriangle) {
  Triangle const flat{{{0.0, 0.0}, {2.0, 2.0}, {6.0, 6.0}}};
  EXPECT_EQ(StatusOf({1.0, 1.0}, flat), PointStatus::OnDegenerate);
  EXPECT_EQ(StatusOf({2.0, 2.0}, flat), PointStatus::OnDegenerate);
  EXPECT_EQ(StatusOf({6.0, 6.0}, flat), PointStatus::OnDegenerate);
  EXPECT_EQ(StatusOf({7.0, 7.0}, flat), PointStatus::Outside);
  EXPECT_EQ(StatusOf({1.0, 2.0}, flat), PointStatus::Outside);
  Point const p{0.1, 0.3};
  EXPECT_EQ(StatusOf(p, {{p, p, p}}), PointStatus::OnDegenerate);
  EXPECT_EQ(StatusOf({Up(0.1), 0.3}, {{p, p, p}}), PointStatus::Outside);
}

TEST(GetPointStatus, MovesToTheNextPlaceWithOneUnitInTheLastPlace) {
  EXPECT_EQ(StatusOf({1.0, std::numeric_limits<double>::denorm_min()}, kCcw), PointStatus::Inside);
  EXPECT_EQ(StatusOf({1.0, -std::numeric_limits<double>::denorm_min()}, kCcw),
            PointStatus::Outside);
  // One step inwards is rounded away in the area (8 - 2^-50 - 16 becomes -8), two steps are not.
  EXPECT_EQ(StatusOf({2.0, Down(2.0)}, kCcw), PointStatus::OnSide);
  EXPECT_EQ(StatusOf({2.0, Down(Down(2.0))}, kCcw), PointStatus::Inside);
  EXPECT_EQ(StatusOf({2.0, Up(2.0)}, kCcw), PointStatus::Outside);
}

TEST(GetPointStatus, DoesNotTellSignedZerosApart) {
  EXPECT_EQ(StatusOf({-0.0, -0.0}, kCcw), PointStatus::OnVertex);
  EXPECT_EQ(StatusOf({1.0, -0.0}, kCcw), PointStatus::OnSide);
}

/// Exact classification of grid points, by whole numbers.
class GridTriangle {
 public:
  GridTriangle(std::array<int, 3> const& x, std::array<int, 3> const& y) : x_(x), y_(y) {}

  PointStatus Classify(int px, int py) const {
    int vertexHits = 0;
    bool onSide = false;
    for (int i = 0; i < 3; ++i) {
      vertexHits += x_[i] == px && y_[i] == py ? 1 : 0;
      onSide = onSide || OnSide(i, px, py);
    }
    int const own = Turn(x_[0], y_[0], x_[1], y_[1], x_[2], y_[2]);
    if (own == 0) return onSide ? PointStatus::OnDegenerate : PointStatus::Outside;
    if (vertexHits > 0) return PointStatus::OnVertex;
    if (onSide) return PointStatus::OnSide;
    for (int i = 0; i < 3; ++i) {
      int const k = (i + 1) % 3;
      if (Turn(px, py, x_[i], y_[i], x_[k], y_[k]) * own <= 0) return PointStatus::Outside;
    }
    return PointStatus::Inside;
  }

 private:
  static int Turn(int ax, int ay, int bx, int by, int cx, int cy) {
    return (bx - ax) * (cy - ay) - (by - ay) * (cx - ax);
  }

  bool OnSide(int i, int px, int py) const {
    int const k = (i + 1) % 3;
    // On the segment exactly when p is on its line and both ends lie in opposite directions.
    int const along = (x_[i] - px) * (x_[k] - px) + (y_[i] - py) * (y_[k] - py);
    return Turn(px, py, x_[i], y_[i], x_[k], y_[k]) == 0 && along <= 0;
  }

  std::array<int, 3> x_;
  std::array<int, 3> y_;
};

TEST(GetPointStatus, IsExactForEveryTriangleAndPointOfAGrid) {
  constexpr int kSide = 4;
  constexpr int kCells = kSide * kSide;
  int wrong = 0;
  for (int code = 0; code < kCells * kCells * kCells; ++code) {
    int const a = code % kCells;
    int const b = code / kCells % kCells;
    int const c = code / kCells / kCells;
    GridTriangle const exact({a % kSide, b % kSide, c % kSide}, {a / kSide, b / kSide, c / kSide});
    Triangle t;
    t.pts[0] = {double(a % kSide), double(a / kSide)};
    t.pts[1] = {double(b % kSide), double(b / kSide)};
    t.pts[2] = {double(c % kSide), double(c / kSide)};
    for (int p = 0; p < kCells; ++p) {
      Point const point{double(p % kSide), double(p / kSide)};
      if (StatusOf(point, t) != exact.Classify(p % kSide, p / kSide)) ++wrong;
    }
  }
  EXPECT_EQ(wrong, 0);
}

TEST(GetPointStatus, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 4106;
  SCOPED_TRACE(kSeed);
  for (PairKind kind : kAllPairKinds) {
    RandomGeometry random(kSeed);
    for (int n = 0; n < 5000; ++n) {
      auto const pair = MakePair(random, kind);
      for (auto const& p : pair.first.pts) {
        ASSERT_EQ(StatusOf(p, pair.second), Reference::StatusOf(p, pair.second))
            << Describe(pair.first) << " " << Describe(pair.second);
      }
    }
  }
}

TEST(GetPointStatus, CountsANotANumberAsPositive) {
  // No comparison with a not-a-number rejects the point, and no side counts as hit: the own sign
  // is -1, every other sign +1.
  EXPECT_EQ(StatusOf({kNaN, 1.0}, kCcw), PointStatus::Outside);
  // Here the own sign is +1 as well.
  EXPECT_EQ(StatusOf({kNaN, 1.0}, Reversed(kCcw)), PointStatus::Inside);
}

}  // namespace
}  // namespace Vorn::Testing
