#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Scans.h"

// Lines and arcs in any order, smooth or with corners, some of which cross: scans of every spacing
// and noise take a piece for each of them, but for the few whose corners just touch another side.

namespace Vorn::Testing {
namespace {

constexpr std::int32_t kMostPoints = 3000;

struct ScanOfShape {
  Scan scan;
  std::int32_t sides = 0;
};

/// Two to twelve lines and arcs with radii from 2 to 100. Corners turn by 23 to 126 degrees; every
/// third side beside an arc is tangential.
std::vector<NominalPiece> MakeShape(RandomGeometry* random) {
  std::vector<NominalPiece> pieces;
  for (int k = random->Integer(2, 12); k > 0; --k) {
    bool const isArc = random->Flip();
    double const radius = std::pow(10.0, random->Uniform(0.3, 2.0));
    double const curvature = isArc ? (random->Flip() ? 1.0 : -1.0) / radius : 0.0;
    double const length =
        isArc ? std::min(30.0, radius * random->Uniform(0.3, 3.0)) : random->Uniform(3.0, 20.0);
    bool const mayBeSmooth = isArc || (!pieces.empty() && pieces.back().curvature != 0.0);
    bool const isSmooth = mayBeSmooth && random->Integer(0, 2) == 0;
    double const corner = (random->Flip() ? 1.0 : -1.0) * random->Uniform(0.4, 2.2);
    pieces.push_back({length, curvature, isSmooth || pieces.empty() ? 0.0 : corner});
  }
  return pieces;
}

/// Tolerances from 0.001 to 0.05, spacings from a fifth of that to fifty times as much, noise of up
/// to 0.7 of it along the normal or, in dense scans, in x and y.
ScanOfShape ScanRandomShape(std::uint64_t seed) {
  RandomGeometry random(seed);
  std::vector<NominalPiece> const pieces = MakeShape(&random);
  auto const sides = static_cast<std::int32_t>(pieces.size());
  double const length = Walk(pieces).Length();
  double const w = std::pow(10.0, random.Uniform(-3.0, -1.3));
  double const wanted = w * std::pow(10.0, random.Uniform(-0.7, 1.7));
  double const spacing = std::clamp(wanted, length / kMostPoints, 0.5);
  double const noise = random.Uniform(0.0, 0.7);
  if (random.Flip() && spacing < 2.0 * w) {
    return {SampleDense(seed, pieces, spacing, w, noise * w), sides};
  }
  auto const count = static_cast<std::int32_t>(length / spacing) + 4 * sides;
  return {SampleWithNormalNoise(&random, pieces, count, w, noise), sides};
}

TEST(FewestPiecesOfRandomShapes, NearlyAllTakeAPieceForEachSide) {
  constexpr int kRounds = 300;
  std::int32_t sides = 0;
  std::int32_t open = 0;
  std::int32_t closed = 0;
  int moreThanSides = 0;
  for (int round = 0; round < kRounds; ++round) {
    SCOPED_TRACE(testing::Message() << "round " << round);
    ScanOfShape const shape = ScanRandomShape(static_cast<std::uint64_t>(70000 + round));
    std::int32_t const pieces = PieceCount(FitKept(shape.scan));
    // What leads back from the end to the start is one piece more.
    std::int32_t const closedPieces = PieceCount(FitKept(shape.scan, Closed())) - 1;
    sides += shape.sides;
    open += pieces;
    closed += closedPieces;
    if (std::max(pieces, closedPieces) > shape.sides) ++moreThanSides;
  }
  EXPECT_LE(moreThanSides, kRounds / 50);
  EXPECT_LE(open, 1.01 * sides);
  EXPECT_LE(closed, 1.01 * sides);
}

TEST(FewestPiecesOfRandomShapes, SharpCornersBetweenSparsePointsTakeNoPieceMore) {
  // Points 0.5 apart, fifty times the tolerance, none of them at a corner.
  for (double const turn : {0.5, 1.0, 1.6, 2.0, 2.2, 2.4}) {
    for (double const curvature : {0.0, 0.05, -0.05}) {
      for (std::uint64_t seed = 1; seed <= 5; ++seed) {
        SCOPED_TRACE(testing::Message() << turn << ", curvature " << curvature << ", " << seed);
        RandomGeometry random(seed);
        std::vector<NominalPiece> const pieces{
            {10.2, 0.0}, {8.3, curvature, turn}, {9.1, 0.0, -turn}, {7.7, curvature, turn}};
        EXPECT_LE(PieceCount(FitKept(SampleWithNormalNoise(&random, pieces, 71, 0.01, 0.3))), 4);
      }
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
