// What is measured of a contour is the same wherever it lies, as far as the digits of its
// coordinates allow. All coordinates here keep every bit when they are shifted.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "io/pieces/Frame.h"
#include "io/pieces/Shapes.h"
#include "support/RandomGeometry.h"
#include "vorn/io/CheckReport.h"
#include "vorn/io/ContourArea.h"
#include "vorn/io/Intersections.h"

namespace Vorn::IO {
namespace {

using Testing::RandomGeometry;

constexpr XY kShifts[] = {{1e5, -1e5}, {5e6, 5e6}, {-5e6, 0.0}, {1e8, 1e8}, {0.0, -1e8}};

/// The distance of neighbouring doubles at the shifted place.
double LastPlace(XY const& shift) {
  double const size = std::max(std::fabs(shift.x), std::fabs(shift.y));
  return std::nextafter(size, HUGE_VAL) - size;
}

ContourFile Shifted(ContourFile contour, XY const& by) {
  contour.pieces = SeenFrom({-by.x, -by.y}, std::move(contour.pieces));
  return contour;
}

ContourFile Polygon(std::vector<XY> const& corners) {
  ContourFile contour;
  contour.path = "p";
  contour.isClosed = true;
  for (std::size_t i = 0; i < corners.size(); ++i) {
    contour.pieces.push_back(MakeLine(corners[i], corners[(i + 1) % corners.size()]));
  }
  return contour;
}

ContourFile CircleOfRadius5() {
  ContourFile contour;
  contour.path = "c";
  contour.isClosed = true;
  contour.pieces = MakeCircle({5.0, 0.0}, {0.0, 0.0}, 5.0, true);
  return contour;
}

/// Whole multiples of an eighth in a square of the side 200.
ContourFile RandomPolygon(std::uint64_t seed) {
  RandomGeometry random(seed);
  std::vector<XY> corners;
  for (int i = 0; i < 9; ++i) {
    corners.push_back({random.Integer(-800, 800) / 8.0, random.Integer(-800, 800) / 8.0});
  }
  return Polygon(corners);
}

TEST(IntersectionsFarAway, ALineCutsACircleInThePointsOfPythagoras) {
  ContourFile line;
  line.pieces = {MakeLine({3.0, -8.0}, {3.0, 8.0})};
  for (XY const& shift : kShifts) {
    std::vector<Intersection> const found =
        IntersectionsOf(Shifted(CircleOfRadius5(), shift), Shifted(line, shift));
    ASSERT_EQ(found.size(), 2u) << shift.x;
    for (Intersection const& one : found) {
      EXPECT_EQ(one.kind, Intersection::Kind::Crossing);
      EXPECT_NEAR(one.at.x - shift.x, 3.0, LastPlace(shift));
      EXPECT_NEAR(std::fabs(one.at.y - shift.y), 4.0, LastPlace(shift));
    }
  }
}

TEST(IntersectionsFarAway, APolygonMeetsItselfAtTheShiftedPlaces) {
  for (std::uint64_t seed = 1; seed <= 20; ++seed) {
    ContourFile const polygon = RandomPolygon(seed);
    std::vector<Intersection> const here = SelfIntersectionsOf(polygon);
    for (XY const& shift : {kShifts[0], kShifts[1], kShifts[2]}) {
      std::vector<Intersection> const there = SelfIntersectionsOf(Shifted(polygon, shift));
      ASSERT_EQ(there.size(), here.size()) << seed << " at " << shift.x;
      for (std::size_t i = 0; i < here.size(); ++i) {
        EXPECT_EQ(there[i].kind, here[i].kind) << seed;
        EXPECT_EQ(there[i].a.piece, here[i].a.piece) << seed;
        EXPECT_EQ(there[i].b.piece, here[i].b.piece) << seed;
        EXPECT_NEAR(there[i].at.x - shift.x, here[i].at.x, LastPlace(shift)) << seed;
        EXPECT_NEAR(there[i].at.y - shift.y, here[i].at.y, LastPlace(shift)) << seed;
        EXPECT_NEAR(there[i].a.position, here[i].a.position, 1e-9) << seed;
      }
    }
  }
}

TEST(IntersectionsFarAway, OverlapsKeepTheirStretch) {
  ContourFile a;
  a.pieces = {MakeLine({0.0, 0.0}, {40.0, 30.0})};
  ContourFile b;
  b.pieces = {MakeLine({24.0, 18.0}, {80.0, 60.0})};
  for (XY const& shift : kShifts) {
    std::vector<Intersection> const found = IntersectionsOf(Shifted(a, shift), Shifted(b, shift));
    ASSERT_EQ(found.size(), 1u);
    ASSERT_TRUE(found[0].until);
    EXPECT_NEAR(found[0].at.x - shift.x, 24.0, LastPlace(shift));
    EXPECT_NEAR(found[0].until->y - shift.y, 30.0, LastPlace(shift));
  }
}

TEST(AreaFarAway, IsThatOfThePolygonAtTheOriginToTheLastBit) {
  for (std::uint64_t seed = 1; seed <= 50; ++seed) {
    ContourFile const polygon = RandomPolygon(seed);
    double const area = SignedAreaOf(polygon);
    // Sixty-fourths, so the sum of the corners' products has no rounding at all.
    EXPECT_EQ(area * 128.0, std::round(area * 128.0));
    for (XY const& shift : kShifts) {
      EXPECT_EQ(SignedAreaOf(Shifted(polygon, shift)), area) << seed << " at " << shift.x;
    }
  }
}

TEST(AreaFarAway, ACircleKeepsItsAreaAndItsCentre) {
  for (XY const& shift : kShifts) {
    ContourArea const circle = MeasureArea(Shifted(CircleOfRadius5(), shift));
    EXPECT_NEAR(circle.signedArea, 25.0 * std::acos(-1.0), 1e-13);
    ASSERT_TRUE(circle.centroid);
    EXPECT_NEAR(circle.centroid->x - shift.x, 0.0, LastPlace(shift));
    EXPECT_NEAR(circle.centroid->y - shift.y, 0.0, LastPlace(shift));
    EXPECT_FALSE(circle.crossesItself);
  }
}

TEST(CheckFarAway, DeviationsAreThoseAtTheOrigin) {
  PointFile points;
  for (double const x : {6.0, 4.5, 0.0, -7.25}) {
    points.points.push_back({x, 1.5, 0.5});
    points.lines.push_back(points.points.size());
  }
  CheckReport const here = MakeCheckReport(points, "given", CircleOfRadius5());
  for (XY const& shift : kShifts) {
    PointFile moved = points;
    for (WPoint& point : moved.points) {
      point.x += shift.x;
      point.y += shift.y;
    }
    CheckReport const there =
        MakeCheckReport(std::move(moved), "given", Shifted(CircleOfRadius5(), shift));
    EXPECT_EQ(there.outside, here.outside);
    for (std::size_t i = 0; i < points.points.size(); ++i) {
      EXPECT_NEAR(there.deviations[i].distance, here.deviations[i].distance, 1e-12) << shift.x;
    }
  }
}

TEST(OriginFor, TakingItOffKeepsEveryBitOfEveryCoordinate) {
  RandomGeometry random(7);
  for (int round = 0; round < 2000; ++round) {
    double const far = random.Wide(0, 40);
    double const size = random.Uniform(0.001, 100.0);
    Extent const extent = {{far, -far}, {far + size, size - far}};
    XY const origin = OriginFor(extent);
    for (double const x : {extent.low.x, extent.high.x, far + 0.3 * size}) {
      EXPECT_EQ((x - origin.x) + origin.x, x) << round;
    }
  }
}

TEST(OriginFor, LeavesAloneWhatHasNoSizeOrNoEnd) {
  double const infinity = std::numeric_limits<double>::infinity();
  double const nan = std::numeric_limits<double>::quiet_NaN();
  for (Extent const& extent : {Extent{{1e9, 1e9}, {1e9, 1e9}}, Extent{{1e9, 1e9}, {infinity, 2e9}},
                               Extent{{nan, 1e9}, {nan, 1e9}}, Extent{{2e9, 0.0}, {1e9, -1.0}}}) {
    XY const origin = OriginFor(extent);
    EXPECT_EQ(origin.x, 0.0);
    EXPECT_EQ(origin.y, 0.0);
  }
}

}  // namespace
}  // namespace Vorn::IO
