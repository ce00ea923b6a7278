#include <gtest/gtest.h>

#include <cmath>

#include "geometry/fewest/LineCorners.h"

// An angle of two sides of five points each, from (0, 0) to (10, 0) and on to (10, 10), of which no
// point lies in the corner.

namespace Vorn::Fewest {
namespace {

constexpr double kTolerance = 0.1;

using Point = GeometryUtils::Point;

Path Angle() {
  Path path;
  for (int k = 0; k < 5; ++k) path.points.push_back({2.0 * k, 0.0, kTolerance});
  for (int k = 1; k <= 5; ++k) path.points.push_back({10.0, 2.0 * k, kTolerance});
  path.leastTolerance = kTolerance;
  return path;
}

Chain TwoPieces() {
  Chain chain;
  chain.pieces = {{0, 5, {}, 0.0}, {5, 10, {}, 0.0}};
  return chain;
}

std::vector<BuiltPiece> Segments(std::vector<Point> const& joints) {
  std::vector<BuiltPiece> pieces;
  for (std::size_t k = 0; k + 1 < joints.size(); ++k) {
    pieces.push_back(BuildSegment(joints[k], joints[k + 1]));
  }
  return pieces;
}

void ExpectAt(Point const& p, double x, double y) {
  EXPECT_NEAR(p.x, x, 1e-14);
  EXPECT_NEAR(p.y, y, 1e-14);
}

TEST(SharpenCorners, MovesTheJointToTheCrossingAndTheEndsToTheirPoints) {
  std::vector<BuiltPiece> pieces = Segments({{0.0, 0.05}, {10.05, -0.06}, {9.93, 10.0}});
  SharpenCorners(Angle(), TwoPieces(), &pieces);
  ExpectAt(pieces[0].start, 0.0, 0.0);
  ExpectAt(pieces[0].elem.end, 10.0, 0.0);
  ExpectAt(pieces[1].start, 10.0, 0.0);
  ExpectAt(pieces[1].elem.end, 10.0, 10.0);
}

TEST(SharpenCorners, LeavesExactPiecesToTheBit) {
  std::vector<BuiltPiece> pieces = Segments({{0.0, 0.0}, {10.0, 0.0}, {10.0, 12.0}});
  SharpenCorners(Angle(), TwoPieces(), &pieces);
  EXPECT_EQ(pieces[1].start.x, 10.0);
  EXPECT_EQ(pieces[1].elem.end.y, 12.0);
}

TEST(SharpenCorners, LeavesJointsBesideArcs) {
  std::vector<BuiltPiece> pieces = Segments({{0.0, 0.05}, {10.05, -0.06}, {9.93, 10.0}});
  pieces[1] = BuildArc({10.05, -0.06}, {9.93, 10.0}, {-100.0, 5.0}, 1.0);
  SharpenCorners(Angle(), TwoPieces(), &pieces);
  EXPECT_EQ(pieces[0].elem.end.x, 10.05);
  EXPECT_EQ(pieces[1].start.x, 10.05);
  EXPECT_EQ(pieces[1].elem.end.x, 9.93);
}

TEST(SharpenCorners, LeavesTheEndsOfAPathThatIsNotFreeThere) {
  Path path = Angle();
  path.start.isFree = false;
  path.finish.isFree = false;
  // A closed path is a triangle here; its third side covers no points.
  Chain chain = TwoPieces();
  chain.pieces.push_back({10, 10, {}, 0.0});
  std::vector<BuiltPiece> pieces =
      Segments({{0.0, 0.05}, {10.05, -0.06}, {9.93, 10.0}, {0.0, 0.05}});
  SharpenCorners(path, chain, &pieces);
  ExpectAt(pieces[0].elem.end, 10.0, 0.0);
  ExpectAt(pieces[0].start, 0.0, 0.0);
  EXPECT_EQ(pieces[2].elem.end.x, pieces[0].start.x);
  EXPECT_EQ(pieces[2].elem.end.y, pieces[0].start.y);
  ExpectAt(pieces[1].elem.end, 10.0, 10.0);
}

TEST(SharpenCorners, NeverRaisesTheLargestDeviation) {
  Path path = Angle();
  double sign = 1.0;
  for (WPoint& p : path.points) {
    p.x += 0.03 * sign;
    p.y -= 0.05 * sign;
    sign = -sign;
  }
  Chain const chain = TwoPieces();
  std::vector<BuiltPiece> pieces = Segments({{0.0, 0.04}, {10.02, -0.03}, {9.96, 10.0}});
  auto const largest = [&] {
    return std::fmax(MeasurePiece(path, pieces[0], 0, 5).value,
                     MeasurePiece(path, pieces[1], 5, 10).value);
  };
  double const before = largest();
  SharpenCorners(path, chain, &pieces);
  EXPECT_LE(largest(), before);
}

TEST(SharpenCorners, LeavesNoPiecesAndOnePieceOfOnePoint) {
  std::vector<BuiltPiece> none;
  SharpenCorners(Angle(), Chain(), &none);
  EXPECT_TRUE(none.empty());
  Path path;
  path.points = {{1.0, 2.0, kTolerance}};
  path.leastTolerance = kTolerance;
  Chain chain;
  chain.pieces = {{0, 1, {}, 0.0}};
  std::vector<BuiltPiece> one = Segments({{0.99, 2.01}, {1.02, 2.03}});
  SharpenCorners(path, chain, &one);
  EXPECT_TRUE(std::isfinite(one[0].start.x));
}

}  // namespace
}  // namespace Vorn::Fewest
