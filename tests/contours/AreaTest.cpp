#include <cmath>
#include <vector>

#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/ContourBuilder.h"
#include "support/RandomGeometry.h"
#include "support/SampledArea.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Testing {
namespace {

using Elem = GeometryUtils::Elem;
using Point = GeometryUtils::Point;

constexpr double kPiLiteral = 3.14159265358979;
constexpr double kTwoPiLiteral = 6.28318530717958;

double AreaOf(std::vector<Elem> const& contour) {
  double area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea(contour, &area), ErrorCode::Ok);
  return area;
}

void ExpectFailure(std::vector<Elem> const& contour, ErrorCode code) {
  double area = kSentinel;
  EXPECT_EQ(GeometryUtils::GetArea(contour, &area), code);
  EXPECT_SAME_BITS(area, kSentinel);
}

TEST(GetAreaOfContour, SquareIsNegativeCounterClockwiseAndPositiveClockwise) {
  EXPECT_EQ(AreaOf(ContourBuilder(1, 1).To(4, 1).To(4, 4).To(1, 4).To(1, 1).Build()), -9.0);
  EXPECT_EQ(AreaOf(ContourBuilder(1, 1).To(1, 4).To(4, 4).To(4, 1).To(1, 1).Build()), 9.0);
}

TEST(GetAreaOfContour, OpenContourStopsItsTrapezoids) {
  // Three sides of a square: the missing side is not added.
  EXPECT_EQ(AreaOf(ContourBuilder(1, 1).To(1, 4).To(4, 4).To(4, 1).Build()), 12.0);
}

TEST(GetAreaOfContour, CircleOfTwoHalves) {
  auto const circle = [](double direction) {
    return ContourBuilder(2, 0)
        .Around({0, 0}, -2, 0, direction)
        .Around({0, 0}, 2, 0, direction)
        .Build();
  };
  EXPECT_NEAR(AreaOf(circle(1.0)), -kPiLiteral * 4.0, 1e-13);
  EXPECT_NEAR(AreaOf(circle(-1.0)), kPiLiteral * 4.0, 1e-13);
}

TEST(GetAreaOfContour, ArcIsChordsThroughTheCentreAndTwiceItsSector) {
  // A quarter from (3, 2) about (1, 2) up to (1, 4), after a segment; all terms but the sector are
  // whole numbers.
  GeometryUtils::Arc const quarter{{1, 4}, {1, 2}, 2.0, 1.0, 0.0, 1.5};
  auto const contour = ContourBuilder(3, -5).To(3, 2).Arc(quarter).Build();
  double const chords = (1.0 - 3.0) * 2.0 + (1.0 - 1.0) * 4.0 + (1.0 - 3.0) * 2.0;
  EXPECT_EQ(AreaOf(contour), (chords + 4.0 * (0.0 - 1.5)) * 0.5);
}

TEST(GetAreaOfContour, AnglesAreUnwrappedInTheArcsDirection) {
  // The arc starts and ends at its centre, where its chord terms vanish, and the segments add
  // nothing either; the sector is what is left. The check skips the arc as one of zero length.
  auto const sector = [](double direction, double startAngle, double endAngle) {
    return AreaOf(ContourBuilder(9, 0)
                      .To(5, 0)
                      .Arc({{5, 0}, {5, 0}, 1.0, direction, startAngle, endAngle})
                      .To(5, -7)
                      .To(1, 7)
                      .Build());
  };
  EXPECT_EQ(sector(1.0, 0.5, 2.0), 0.5 * (0.5 - 2.0));
  EXPECT_EQ(sector(1.0, 2.0, 0.5), 0.5 * (2.0 - (0.5 + kTwoPiLiteral)));
  EXPECT_EQ(sector(-1.0, 2.0, 0.5), 0.5 * (2.0 - 0.5));
  EXPECT_EQ(sector(-1.0, 0.5, 2.0), 0.5 * ((0.5 + kTwoPiLiteral) - 2.0));
  // Only a direction below zero is clockwise.
  EXPECT_EQ(sector(0.0, 2.0, 0.5), 0.5 * (2.0 - (0.5 + kTwoPiLiteral)));
  EXPECT_EQ(sector(-0.0, 2.0, 0.5), 0.5 * (2.0 - (0.5 + kTwoPiLiteral)));
  EXPECT_EQ(sector(kNaN, 2.0, 0.5), 0.5 * (2.0 - (0.5 + kTwoPiLiteral)));
  EXPECT_EQ(sector(1.0, 0.5, 0.5), 0.0);
}

TEST(GetAreaOfContour, ArcTermIsFormedBeforeItIsAdded) {
  // The sum stands at 2^53, where adding 1 twice is lost but adding 2 is not.
  double const high = 0x1p52;
  auto const contour =
      ContourBuilder(0, high).To(1, high).Arc({{2, 1}, {1, 1}, 0x1p-40, 1.0, 0.25, 0.5}).Build();
  EXPECT_EQ(AreaOf(contour), 0x1p52 + 1.0);
}

TEST(GetAreaOfContour, ZeroLengthSegmentAddsNothing) {
  EXPECT_EQ(
      AreaOf(ContourBuilder(0, 0).To(3, 0).Stay().To(3, 3).Stay().Stay().To(0, 3).To(0, 0).Build()),
      -9.0);
}

TEST(GetAreaOfContour, FailingCheckIsPassedOnAndAreaUntouched) {
  ExpectFailure({}, ErrorCode::Failed);
  ExpectFailure(ContourBuilder(0, 0).Build(), ErrorCode::Failed);
  ExpectFailure(ContourBuilder(0, 0).To(1, 0).Build(), ErrorCode::Failed);
  ExpectFailure(ContourBuilder(0, 0).To(2, 2).To(2, 0).To(0, 2).To(0, 0).Build(),
                ErrorCode::SelfIntersection);
}

TEST(GetAreaOfContour, FirstElementMustBeASegment) {
  auto contour = ContourBuilder(0, 0).To(3, 0).To(3, 3).To(0, 3).Build();
  for (int const type : {1, 2, -1}) {
    contour[0].type = static_cast<GeometryUtils::ElemType>(type);
    ExpectFailure(contour, ErrorCode::Failed);
  }
}

TEST(GetAreaOfContour, InvalidElementBehindAnAcceptedTouchFails) {
  // Two arcs that touch once at their joint: the check of the first ends there, the second finds no
  // valid element after it, and so the check is content. The area is not.
  for (int const type : {2, -1}) {
    auto const contour = ContourBuilder(1, 0)
                             .Arc({{0.5, 0.75}, {0, 0}, 1.0, 1.0, 0.1, 2.0})
                             .Arc({{0, 0}, {1, 0}, 1.0, 1.0, 1.5, 3.0})
                             .OfType(type, 7, 7)
                             .Build();
    EXPECT_EQ(GeometryUtils::CheckPolySelfIntersection(contour), ErrorCode::Ok);
    ExpectFailure(contour, ErrorCode::Failed);
  }
}

TEST(GetAreaOfContour, NullOutputFails) {
  EXPECT_EQ(
      GeometryUtils::GetArea(ContourBuilder(0, 0).To(3, 0).To(3, 3).To(0, 0).Build(), nullptr),
      ErrorCode::Failed);
}

TEST(GetAreaOfContour, NotANumberAndInfinityPropagate) {
  // The odd end makes its two trapezoids not-a-numbers; nothing crosses.
  for (double const odd : {kNaN, kInf, -kInf}) {
    double area = kSentinel;
    auto const contour = ContourBuilder(0, 0).To(3, 0).To(3, 3).To(odd, 0).Build();
    ErrorCode const code = GeometryUtils::GetArea(contour, &area);
    ASSERT_EQ(code, GeometryUtils::CheckPolySelfIntersection(contour));
    if (code == ErrorCode::Ok) {
      EXPECT_FALSE(std::isfinite(area));
    } else {
      EXPECT_SAME_BITS(area, kSentinel);
    }
  }
}

TEST(GetAreaOfContour, TurnsScalesAndReversesExactlyOnGridPolygons) {
  RandomGeometry random(31);
  int accepted = 0;
  for (int round = 0; round < 3000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 31, round " << round);
    std::vector<Point> points;
    int const count = random.Integer(3, 6);
    for (int i = 0; i < count; ++i) points.push_back(random.GridPoint(20));
    points.push_back(points.front());
    auto const build = [](std::vector<Point> const& pts) {
      ContourBuilder builder(pts[0].x, pts[0].y);
      for (std::size_t i = 1; i < pts.size(); ++i) builder.To(pts[i].x, pts[i].y);
      return builder.Build();
    };
    double area = kSentinel;
    if (GeometryUtils::GetArea(build(points), &area) != ErrorCode::Ok) {
      EXPECT_SAME_BITS(area, kSentinel);
      continue;
    }
    ++accepted;
    double shoelace = 0.0;
    for (std::size_t i = 0; i + 1 < points.size(); ++i) {
      shoelace += points[i + 1].x * points[i].y - points[i].x * points[i + 1].y;
    }
    EXPECT_EQ(area, shoelace * 0.5);
    std::vector<Point> turned;
    std::vector<Point> scaled;
    for (Point const& p : points) {
      turned.push_back(QuarterTurn(p));
      scaled.push_back(Scale(p, 0.125));
    }
    EXPECT_EQ(AreaOf(build(turned)), area);
    EXPECT_EQ(AreaOf(build(scaled)), area * 0.015625);
    EXPECT_EQ(AreaOf(build({points.rbegin(), points.rend()})), -area);
  }
  EXPECT_GT(accepted, 500);
}

/// An open chain of segments and arcs with joints on a rising line, so that few cross.
std::vector<Elem> RandomChain(RandomGeometry* random) {
  ContourBuilder builder(random->Uniform(-5, 5), random->Uniform(-5, 5));
  int const count = random->Integer(2, 5);
  for (int i = 0; i < count; ++i) {
    Point const start = builder.Build().back().end;
    Point const end{start.x + random->Uniform(1, 4), start.y + random->Uniform(-2, 2)};
    if (random->Flip()) {
      builder.To(end.x, end.y);
      continue;
    }
    double const bulge = random->Uniform(-2, 2);
    Point const center{(start.x + end.x) / 2 - bulge * (end.y - start.y),
                       (start.y + end.y) / 2 + bulge * (end.x - start.x)};
    // The way round that is shorter than a half turn.
    builder.Around(center, end.x, end.y, bulge > 0 ? 1.0 : -1.0);
  }
  return builder.Build();
}

TEST(GetAreaOfContour, AgreesWithFineSamplingOfRandomContours) {
  RandomGeometry random(32);
  int accepted = 0;
  int withArcs = 0;
  for (int round = 0; round < 2000 && accepted < 150; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 32, round " << round);
    auto const contour = RandomChain(&random);
    double area = kSentinel;
    if (GeometryUtils::GetArea(contour, &area) != ErrorCode::Ok) {
      EXPECT_SAME_BITS(area, kSentinel);
      continue;
    }
    ++accepted;
    for (Elem const& elem : contour) withArcs += elem.type == GeometryUtils::ElemType::Arc ? 1 : 0;
    EXPECT_NEAR(area, SampledArea(contour, 2000), 1e-5);
  }
  EXPECT_EQ(accepted, 150);
  EXPECT_GT(withArcs, 100);
}

TEST(GetAreaOfContour, AgreesWithFineSamplingOfClosedRingsOfArcs) {
  RandomGeometry random(33);
  for (int round = 0; round < 50; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 33, round " << round);
    // Arcs about one centre, so that a joint is all that neighbours share; long ones included.
    Point const center = random.PointIn(-4, 4);
    double const radius = random.Uniform(0.5, 3);
    double const direction = random.Flip() ? 1.0 : -1.0;
    int const count = random.Integer(2, 6);
    double const turn = random.Uniform(-3, 3);
    auto const at = [&](int i) {
      double const angle = turn + direction * i * 6.0 / count;
      return Point{center.x + radius * std::cos(angle), center.y + radius * std::sin(angle)};
    };
    ContourBuilder builder(at(0).x, at(0).y);
    for (int i = 1; i < count; ++i) builder.Around(center, at(i).x, at(i).y, direction);
    builder.Around(center, at(0).x, at(0).y, direction);
    double const area = AreaOf(builder.Build());
    EXPECT_NEAR(area, SampledArea(builder.Build(), 4000), 1e-4);
    EXPECT_NEAR(std::fabs(area), kPiLiteral * radius * radius, 1e-12);
    EXPECT_EQ(area<0.0, direction> 0.0);
  }
}

}  // namespace
}  // namespace Vorn::Testing
