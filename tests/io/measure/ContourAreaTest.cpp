#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "io/FormatContours.h"
#include "support/RandomGeometry.h"
#include "vorn/io/ContourArea.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

ContourFile Polygon(std::vector<XY> const& corners) {
  ContourFile contour;
  contour.path = "p";
  contour.isClosed = true;
  for (std::size_t i = 0; i < corners.size(); ++i) {
    contour.pieces.push_back(MakeLine(corners[i], corners[(i + 1) % corners.size()]));
  }
  return contour;
}

ContourFile Circle(XY const& center, double radius, bool counterClockwise) {
  ContourFile contour;
  contour.isClosed = true;
  contour.pieces = MakeCircle({center.x + radius, center.y}, center, radius, counterClockwise);
  return contour;
}

struct Integrals {
  double area = 0.0;
  double momentX = 0.0;
  double momentY = 0.0;
};

/// x dy, x^2/2 dy and -y^2/2 dx along the pieces in very small steps: nothing but points of the
/// pieces goes into it.
Integrals Integrate(std::vector<Piece> const& pieces) {
  constexpr int kSteps = 2000;
  Integrals sum;
  for (Piece const& piece : pieces) {
    auto const at = [&](int step) {
      double const part = static_cast<double>(step) / kSteps;
      if (piece.IsArc()) return PointOnArc(piece, part * piece.sweep);
      return XY{piece.start.x + part * (piece.end.x - piece.start.x),
                piece.start.y + part * (piece.end.y - piece.start.y)};
    };
    for (int step = 0; step < kSteps; ++step) {
      XY const a = at(step);
      XY const b = at(step + 1);
      double const dx = b.x - a.x;
      double const dy = b.y - a.y;
      sum.area += 0.5 * (a.x + b.x) * dy;
      sum.momentX += (a.x * a.x + a.x * b.x + b.x * b.x) / 6.0 * dy;
      sum.momentY -= (a.y * a.y + a.y * b.y + b.y * b.y) / 6.0 * dx;
    }
  }
  return sum;
}

/// Corners at random distances all the way round, joined by lines and shallow arcs.
ContourFile RandomStar(std::uint64_t seed) {
  constexpr std::size_t kCorners = 12;
  Testing::RandomGeometry random(seed);
  XY const middle = random.PointIn(-50.0, 50.0);
  std::vector<XY> corners;
  for (std::size_t i = 0; i < kCorners; ++i) {
    double const angle = 2.0 * pi * static_cast<double>(i) / kCorners;
    double const reach = random.Uniform(3.0, 4.0);
    corners.push_back({middle.x + reach * std::cos(angle), middle.y + reach * std::sin(angle)});
  }
  ContourFile contour;
  contour.isClosed = true;
  for (std::size_t i = 0; i < kCorners; ++i) {
    XY const& next = corners[(i + 1) % kCorners];
    contour.pieces.push_back(random.Flip() ? MakeLine(corners[i], next)
                                           : MakeBulge(corners[i], next, random.Uniform(-.1, .3)));
  }
  return contour;
}

ContourFile Reverse(ContourFile contour) {
  std::vector<Piece> pieces;
  for (auto piece = contour.pieces.rbegin(); piece != contour.pieces.rend(); ++piece) {
    pieces.push_back(Reversed(*piece));
  }
  contour.pieces = pieces;
  return contour;
}

/// The contour as the library holds one.
std::vector<GeometryUtils::Elem> ElementsOf(ContourFile const& contour) {
  std::vector<GeometryUtils::Elem> elements;
  GeometryUtils::AddSegm(&elements, contour.pieces.front().start);
  for (Piece const& piece : contour.pieces) {
    if (piece.IsArc()) {
      GeometryUtils::AddArc(&elements, piece.start, piece.end, piece.center, piece.radius,
                            !piece.counterClockwise);
    } else {
      GeometryUtils::AddSegm(&elements, piece.end);
    }
  }
  return elements;
}

TEST(MeasureArea, OfARectangle) {
  ContourArea const area = MeasureArea(Polygon({{1, 2}, {5, 2}, {5, 5}, {1, 5}}));
  EXPECT_EQ(area.signedArea, 12.0);
  EXPECT_EQ(area.perimeter, 14.0);
  ASSERT_TRUE(area.centroid.has_value());
  EXPECT_EQ(area.centroid->x, 3.0);
  EXPECT_EQ(area.centroid->y, 3.5);
  EXPECT_EQ(area.extent.low.x, 1.0);
  EXPECT_EQ(area.extent.high.y, 5.0);
  EXPECT_FALSE(area.crossesItself);
  EXPECT_TRUE(area.gaps.empty());
  EXPECT_EQ(MeasureArea(Polygon({{1, 5}, {5, 5}, {5, 2}, {1, 2}})).signedArea, -12.0);
}

TEST(MeasureArea, OfACircleOfTwoHalves) {
  ContourArea const area = MeasureArea(Circle({10, -4}, 3.0, true));
  EXPECT_NEAR(area.signedArea, 9.0 * pi, 1e-12);
  EXPECT_NEAR(area.perimeter, 6.0 * pi, 1e-13);
  ASSERT_TRUE(area.centroid.has_value());
  EXPECT_NEAR(area.centroid->x, 10.0, 1e-13);
  EXPECT_NEAR(area.centroid->y, -4.0, 1e-13);
  EXPECT_NEAR(area.extent.low.y, -7.0, 1e-15);
  EXPECT_NEAR(MeasureArea(Circle({10, -4}, 3.0, false)).signedArea, -9.0 * pi, 1e-12);
}

TEST(MeasureArea, OfAHalfDisc) {
  ContourFile contour;
  contour.isClosed = true;
  contour.pieces = {MakeArc({2, 0}, {-2, 0}, {0, 0}, 2, true), MakeLine({-2, 0}, {2, 0})};
  ContourArea const area = MeasureArea(contour);
  EXPECT_NEAR(area.signedArea, 2.0 * pi, 1e-13);
  ASSERT_TRUE(area.centroid.has_value());
  EXPECT_NEAR(area.centroid->x, 0.0, 1e-13);
  EXPECT_NEAR(area.centroid->y, 8.0 / (3.0 * pi), 1e-13) << "4 r / 3 pi from the middle";
}

TEST(MeasureArea, FarFromTheOriginLosesNothing) {
  double const far = 1048576.0;
  ContourArea const area =
      MeasureArea(Polygon({{far, far}, {far + 4, far}, {far + 4, far + 3}, {far, far + 3}}));
  EXPECT_EQ(area.signedArea, 12.0);
  ASSERT_TRUE(area.centroid.has_value());
  EXPECT_EQ(area.centroid->x, far + 2.0);
}

TEST(MeasureArea, OfARingIsThatOfItsOutlines) {
  // Out along a slit, round the hole the other way, and back.
  ContourFile ring;
  ring.isClosed = true;
  ring.pieces = MakeCircle({5, 0}, {0, 0}, 5, true);
  ring.pieces.push_back(MakeLine({5, 0}, {2, 0}));
  for (Piece const& piece : MakeCircle({2, 0}, {0, 0}, 2, false)) ring.pieces.push_back(piece);
  ring.pieces.push_back(MakeLine({2, 0}, {5, 0}));
  EXPECT_NEAR(MeasureArea(ring).signedArea, 21.0 * pi, 1e-12);
  EXPECT_FALSE(MeasureArea(ring).crossesItself) << "a slit run along twice is no crossing";
}

TEST(MeasureArea, AgreesWithAnIntegralInSmallSteps) {
  for (std::uint64_t seed = 1; seed <= 50; ++seed) {
    ContourFile const contour = RandomStar(seed);
    ContourArea const area = MeasureArea(contour);
    ASSERT_FALSE(area.crossesItself) << "seed " << seed;
    Integrals const expected = Integrate(contour.pieces);
    EXPECT_NEAR(area.signedArea, expected.area, 2e-5) << "seed " << seed;
    ASSERT_TRUE(area.centroid.has_value());
    EXPECT_NEAR(area.centroid->x, expected.momentX / expected.area, 1e-5) << "seed " << seed;
    EXPECT_NEAR(area.centroid->y, expected.momentY / expected.area, 1e-5) << "seed " << seed;
  }
}

TEST(MeasureArea, AgreesWithTheLibrary) {
  int compared = 0;
  for (std::uint64_t seed = 1; seed <= 50; ++seed) {
    ContourFile const contour = RandomStar(seed);
    double clockwise = 0.0;
    // With coordinates far from the origin joints of arcs may look like crossings.
    if (GeometryUtils::GetArea(ElementsOf(contour), &clockwise) != ErrorCode::Ok) continue;
    ++compared;
    EXPECT_NEAR(MeasureArea(contour).signedArea, -clockwise, 1e-6) << "seed " << seed;
  }
  EXPECT_GE(compared, 45);
}

TEST(MeasureArea, ReversingTurnsTheSignAndNothingElse) {
  for (std::uint64_t seed = 1; seed <= 20; ++seed) {
    ContourArea const area = MeasureArea(RandomStar(seed));
    ContourArea const reversed = MeasureArea(Reverse(RandomStar(seed)));
    EXPECT_GT(area.signedArea, 0.0) << "seed " << seed;
    EXPECT_NEAR(reversed.signedArea, -area.signedArea, 1e-12) << "seed " << seed;
    EXPECT_NEAR(reversed.perimeter, area.perimeter, 1e-12) << "seed " << seed;
    EXPECT_NEAR(reversed.centroid->x, area.centroid->x, 1e-12) << "seed " << seed;
  }
}

TEST(MeasureArea, ShallowArcsOfHugeCirclesKeepTheirPart) {
  // 2/3 of chord times rise, to the accuracy of a parabola: the next term is 1e-12 of it.
  ContourFile contour;
  contour.isClosed = true;
  contour.pieces = {MakeBulge({0, 0}, {100, 0}, 1e-6), MakeLine({100, 0}, {50, 40}),
                    MakeLine({50, 40}, {0, 0})};
  EXPECT_NEAR(MeasureArea(contour).signedArea, 2000.0 + 2.0 / 3.0 * 100.0 * 50e-6, 1e-9);
}

TEST(MeasureArea, OfACrossingContourIsTheSumOfItsLoops) {
  // A bow tie that crosses at (0, 0): 8 on the left run round one way, 2 on the right
  // the other.
  ContourArea const tie = MeasureArea(Polygon({{-4, -2}, {2, 1}, {2, -1}, {-4, 2}}));
  EXPECT_TRUE(tie.crossesItself);
  EXPECT_NEAR(std::fabs(tie.signedArea), 8.0 - 2.0, 1e-12);
  EXPECT_FALSE(tie.centroid.has_value());
  ContourArea const even = MeasureArea(Polygon({{0, 0}, {6, 3}, {6, 0}, {0, 3}}));
  EXPECT_TRUE(even.crossesItself);
  EXPECT_NEAR(even.signedArea, 0.0, 1e-12);
}

TEST(MeasureArea, BridgesGaps) {
  ContourFile contour = Polygon({{0, 0}, {4, 0}, {4, 3}, {0, 3}});
  contour.pieces.erase(contour.pieces.begin() + 1);
  ContourArea const area = MeasureArea(contour);
  EXPECT_EQ(area.signedArea, 12.0);
  EXPECT_EQ(area.perimeter, 14.0);
  ASSERT_EQ(area.gaps.size(), 1u);
  EXPECT_EQ(area.gaps[0].size, 3.0);
}

TEST(MeasureArea, NothingEnclosedHasNoCentroid) {
  ContourFile contour;
  contour.isClosed = true;
  contour.pieces = {MakeLine({0, 0}, {4, 1}), MakeLine({4, 1}, {0, 0})};
  ContourArea const area = MeasureArea(contour);
  EXPECT_EQ(area.signedArea, 0.0);
  EXPECT_FALSE(area.centroid.has_value());
}

TEST(Closed, AddsALineOnlyWhereTheEndsAreApart) {
  ContourFile open;
  open.pieces = {MakeLine({0, 0}, {4, 0}), MakeLine({4, 0}, {4, 3})};
  EXPECT_FALSE(IsClosed(open));
  ContourFile const closed = Closed(open);
  EXPECT_TRUE(IsClosed(closed));
  EXPECT_EQ(closed.pieces.size(), 3u);
  EXPECT_EQ(MeasureArea(closed).signedArea, 6.0);
  EXPECT_EQ(Closed(closed).pieces.size(), 3u);
}

}  // namespace
}  // namespace Vorn::IO
