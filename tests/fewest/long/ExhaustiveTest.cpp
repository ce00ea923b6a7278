#include <cmath>
#include <cstdint>
#include <vector>

#include "fewest/oracle/BoundOracle.h"
#include "fewest/oracle/ChainOracle.h"
#include "gtest/gtest.h"
#include "support/fewest/FewestCalls.h"
#include "support/fewest/Scans.h"

// Small scans against searches that leave nothing out: the pieces against every chain with joints
// on a grid, the bound against every division of the points.

namespace Vorn::Testing {
namespace {

std::vector<NominalPiece> RandomPieces(RandomGeometry* random) {
  std::vector<NominalPiece> pieces;
  for (int k = random->Integer(2, 4); k > 0; --k) {
    double const curvature = random->Flip() ? 0.0 : random->Uniform(-0.3, 0.3);
    double const corner = random->Flip() ? 0.0 : random->Uniform(-1.2, 1.2);
    pieces.push_back({random->Uniform(4.0, 10.0), curvature, corner});
  }
  return pieces;
}

void ExpectNoFewer(Scan const& scan) {
  FewestOptions options;
  options.effort = FewestPieces::Effort::Full;
  FewestResult const result = FitKept(scan, options);
  if (result.isFewest) return;
  auto const found = ChainOracle(scan).FindChain(PieceCount(result) - 1);
  EXPECT_FALSE(found.has_value()) << found->ranges.size() << " pieces are enough, not "
                                  << PieceCount(result);
}

TEST(FewestPiecesExhaustively, NoChainOnTheGridHasFewerPiecesOnNoisyProfiles) {
  RandomGeometry random(8101);
  for (int round = 0; round < 30; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 8101, round " << round);
    auto const pieces = RandomPieces(&random);
    double const noise = random.Uniform(0.3, 1.0);
    ExpectNoFewer(SampleWithNormalNoise(&random, pieces, random.Integer(12, 60), 0.1, noise));
  }
}

TEST(FewestPiecesExhaustively, NoChainOnTheGridHasFewerPiecesOnFreeForms) {
  for (double const w : {0.02, 0.01, 0.005}) {
    SCOPED_TRACE(testing::Message() << "w " << w);
    ExpectNoFewer(MakeClothoid(12.0, 0.8, 40, w));
  }
}

TEST(FewestPiecesExhaustively, NoChainOnTheGridHasFewerPiecesOnRandomWalks) {
  RandomGeometry random(8102);
  for (int round = 0; round < 20; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 8102, round " << round);
    Scan scan;
    double heading = 0.0;
    GeometryUtils::Point at;
    for (int i = random.Integer(8, 30); i > 0; --i) {
      scan.push_back({at.x, at.y, 0.15});
      heading += random.Uniform(-0.5, 0.5);
      at = {at.x + std::cos(heading), at.y + std::sin(heading)};
    }
    ExpectNoFewer(scan);
  }
}

TEST(FewestPiecesExhaustively, TheBoundIsTheLeastOfAllDivisions) {
  RandomGeometry random(8103);
  for (int round = 0; round < 30; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 8103, round " << round);
    auto const pieces = RandomPieces(&random);
    Scan const scan = SampleWithNormalNoise(&random, pieces, random.Integer(12, 24), 0.1,
                                            random.Uniform(0.3, 1.2));
    EXPECT_EQ(FitKept(scan).fewestPossible, LeastNumberOfRuns(scan));
  }
}

}  // namespace
}  // namespace Vorn::Testing
