#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numbers>
#include <random>

#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Motions.h"

// Points far apart against their tolerances, as the corners of a drawing or of a tool path have
// them: two points say nothing of an arc between them.

namespace Vorn::Testing {
namespace {

constexpr double kTolerance = 0.01;

using Corners = std::vector<GeometryUtils::Point>;

Scan ScanOf(Corners const& corners) {
  Scan scan;
  for (auto const& corner : corners) scan.push_back({corner.x, corner.y, kTolerance});
  return scan;
}

Corners const kSquare{{0, 0}, {10, 0}, {10, 10}, {0, 10}};
Corners const kRectangle{{0, 0}, {100, 0}, {100, 10}, {0, 10}};
Corners const kAngle{{0, 0}, {100, 0}, {100, 40}, {50, 40}, {50, 80}, {0, 80}};
Corners const kTriangle{{0, 0}, {10, 0}, {3, 7}};
Corners const kChamfered{{0, 0},   {90, 0},  {100, 10}, {100, 50},
                         {90, 60}, {10, 60}, {0, 50},   {0, 10}};

/// Ten points on two circles by turns.
Corners Star() {
  Corners corners;
  for (int k = 0; k < 10; ++k) {
    double const radius = k % 2 == 0 ? 4.0 : 10.0;
    double const angle = 0.2 * k * std::numbers::pi;
    corners.push_back({radius * std::cos(angle), radius * std::sin(angle)});
  }
  return corners;
}

/// That the contour of a closed scan consists of its sides: one segment from each point to the
/// next, up to a distance.
void ExpectItsSides(Scan const& scan, double accuracy) {
  FewestResult const result = FitKept(scan, Closed());
  ASSERT_EQ(PieceCount(result), static_cast<std::int32_t>(scan.size()));
  EXPECT_EQ(ArcCount(result), 0);
  for (auto const& elem : result.contour) {
    double nearest = std::numeric_limits<double>::infinity();
    for (WPoint const& p : scan) {
      nearest = std::min(nearest, std::hypot(elem.end.x - p.x, elem.end.y - p.y));
    }
    EXPECT_LE(nearest, accuracy);
  }
}

TEST(FewestPiecesOfSparsePoints, APolygonComesOutAsItsSides) {
  for (Corners const& corners : {kSquare, kRectangle, kAngle, kTriangle, Star()}) {
    Scan const scan = ScanOf(corners);
    ExpectItsSides(scan, 1e-14);
    ExpectItsSides(Reversed(scan), 1e-14);
    ExpectItsSides(Magnified(scan, 1024.0), 1e-11);
  }
}

TEST(FewestPiecesOfSparsePoints, APolygonComesOutAsItsSidesHoweverItLies) {
  for (Corners const& corners : {kSquare, kRectangle, kAngle, kTriangle, Star()}) {
    for (double const angle : {0.3, 1.0, 2.0, 4.0}) {
      ExpectItsSides(Rotated(ScanOf(corners), angle), 1e-12);
      ExpectItsSides(Shifted(Rotated(ScanOf(corners), angle), 1e6, -3e5), 1e-8);
    }
  }
}

TEST(FewestPiecesOfSparsePoints, ExactCornersOfADenseSquareComeOutExactly) {
  for (int const perSide : {2, 3, 10, 40, 200}) {
    Scan scan;
    for (std::size_t side = 0; side < 4; ++side) {
      auto const& from = kSquare[side];
      auto const& to = kSquare[(side + 1) % 4];
      for (int k = 0; k < perSide; ++k) {
        double const share = static_cast<double>(k) / perSide;
        scan.push_back(
            {from.x + share * (to.x - from.x), from.y + share * (to.y - from.y), kTolerance});
      }
    }
    FewestResult const result = FitKept(scan, Closed());
    EXPECT_EQ(PieceCount(result), 4);
    EXPECT_EQ(ArcCount(result), 0);
    for (auto const& elem : result.contour) {
      EXPECT_NEAR(std::fabs(elem.end.x - 5.0), 5.0, 1e-14);
      EXPECT_NEAR(std::fabs(elem.end.y - 5.0), 5.0, 1e-14);
    }
  }
}

TEST(FewestPiecesOfSparsePoints, SegmentsAreTakenWhereTheyAreAsFew) {
  // An arc through the first points and a line would be two pieces too.
  FewestResult const result = FitKept(ScanOf({{0, 0}, {5, 0}, {10, 0}, {10, 5}, {10, 10}}));
  ASSERT_EQ(PieceCount(result), 2);
  EXPECT_EQ(ArcCount(result), 0);
  EXPECT_TRUE(result.isFewest);
  EXPECT_EQ(result.contour[0].end.x, 0.0);
  EXPECT_EQ(result.contour[0].end.y, 0.0);
  EXPECT_EQ(result.contour[1].end.x, 10.0);
  EXPECT_EQ(result.contour[1].end.y, 0.0);
  EXPECT_EQ(result.contour[2].end.x, 10.0);
  EXPECT_EQ(result.contour[2].end.y, 10.0);
}

TEST(FewestPiecesOfSparsePoints, NoisyPolygonsHaveNoArcs) {
  for (unsigned seed = 1; seed <= 20; ++seed) {
    std::mt19937 random(seed);
    std::uniform_real_distribution<double> noise(-0.8 * kTolerance, 0.8 * kTolerance);
    Scan scan;
    for (std::size_t side = 0; side < 4; ++side) {
      auto const& from = kRectangle[side];
      auto const& to = kRectangle[(side + 1) % 4];
      for (int k = 0; k < 30; ++k) {
        double const share = (k + 0.5) / 30;
        double const off = noise(random);
        bool const isLevel = from.y == to.y;
        scan.push_back({from.x + share * (to.x - from.x) + (isLevel ? 0.0 : off),
                        from.y + share * (to.y - from.y) + (isLevel ? off : 0.0), kTolerance});
      }
    }
    FewestResult const result = FitKept(scan);
    EXPECT_EQ(PieceCount(result), 4) << "seed " << seed;
    EXPECT_EQ(ArcCount(result), 0) << "seed " << seed;
  }
}

TEST(FewestPiecesOfSparsePoints, ChamfersOfARectangleAreKept) {
  FewestResult const result = FitKept(ScanOf(kChamfered), Closed());
  EXPECT_EQ(ArcCount(result), 0);
  // (0, 0), (0, 10) and (0, 50) lie on one line.
  EXPECT_EQ(PieceCount(result), 7);
  for (auto const& elem : result.contour) {
    EXPECT_GE(elem.end.x, -kTolerance);
    EXPECT_LE(elem.end.x, 100.0 + kTolerance);
    EXPECT_GE(elem.end.y, -kTolerance);
    EXPECT_LE(elem.end.y, 60.0 + kTolerance);
  }
}

double DistanceFromWay(GeometryUtils::Point const& at, WPoint const& p, WPoint const& q) {
  double const dx = q.x - p.x;
  double const dy = q.y - p.y;
  double const share =
      std::clamp(((at.x - p.x) * dx + (at.y - p.y) * dy) / (dx * dx + dy * dy), 0.0, 1.0);
  return std::hypot(at.x - p.x - share * dx, at.y - p.y - share * dy);
}

/// The largest distance of a joint from the straight way between the points beside it, in ways.
template <typename Distance>
double LargestJoint(Scan const& scan, FewestResult const& result, Distance const& distance) {
  double largest = 0.0;
  for (std::size_t k = 0; k + 1 < result.ranges.size(); ++k) {
    WPoint const& p = scan[static_cast<std::size_t>(result.ranges[k].last)];
    WPoint const& q = scan[static_cast<std::size_t>(result.ranges[k + 1].first)];
    largest = std::fmax(largest, distance(result.contour[k + 1].end, p, q));
  }
  return largest;
}

Scan RandomPlaces(unsigned seed, int count) {
  std::mt19937 random(seed);
  std::uniform_real_distribution<double> place(0.0, 100.0);
  Scan scan;
  for (int k = 0; k < count; ++k) scan.push_back({place(random), place(random), kTolerance});
  return scan;
}

TEST(FewestPiecesOfSparsePoints, JointsStayNearTheirGap) {
  for (unsigned seed = 1; seed <= 60; ++seed) {
    Scan const scan = RandomPlaces(seed, 25);
    double const excess = LargestJoint(
        scan, FitKept(scan),
        [](GeometryUtils::Point const& joint, WPoint const& p, WPoint const& q) {
          double const gap = std::hypot(q.x - p.x, q.y - p.y);
          // 1.87 where lines of three points meet, which random places hardly ever give.
          double const room = gap > 16.0 * kTolerance ? 0.134 * gap + 2.001 * kTolerance : 100.0;
          return DistanceFromWay(joint, p, q) - room;
        });
    EXPECT_LE(excess, 0.0) << "seed " << seed;
  }
}

TEST(FewestPiecesOfSparsePoints, JointsLeaveThePathBetweenPointsNoFartherThanAsked) {
  for (double const farthest : {0.0, 0.1, 1.0}) {
    FewestOptions options;
    options.farthestBetweenPoints = farthest;
    for (unsigned seed = 1; seed <= 20; ++seed) {
      Scan const scan = RandomPlaces(seed, 25);
      double const largest = LargestJoint(scan, FitKept(scan, options), DistanceFromWay);
      EXPECT_LE(largest, farthest + 2.001 * kTolerance) << "seed " << seed;
    }
    options.closed = true;
    Scan const chamfered = ScanOf(kChamfered);
    FewestResult const result = FitKept(chamfered, options);
    EXPECT_EQ(PieceCount(result), 7);
    EXPECT_LE(LargestJoint(chamfered, result, DistanceFromWay), farthest + 2.001 * kTolerance);
  }
}

}  // namespace
}  // namespace Vorn::Testing
