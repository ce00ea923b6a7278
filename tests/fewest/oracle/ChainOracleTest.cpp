#include <cstdint>
#include <vector>

#include "fewest/oracle/BoundOracle.h"
#include "fewest/oracle/ChainOracle.h"
#include "gtest/gtest.h"
#include "support/fewest/Scans.h"

// The oracles of bound and pieces themselves, on shapes whose least number of pieces is known.

namespace Vorn::Testing {
namespace {

std::int32_t PiecesOf(Scan const& scan) {
  auto const found = ChainOracle(scan).FindChain(20);
  if (!found) return -1;
  auto const check = CheckPromises<ChainOracle::Found::Range>(
      {scan, found->contour, found->ranges, false, 1.0472});
  EXPECT_TRUE(check.complaints.empty()) << check.Text();
  return static_cast<std::int32_t>(found->ranges.size());
}

TEST(ChainOracle, FindsTheOnePieceOfALineOrAnArc) {
  RandomGeometry random(5201);
  EXPECT_EQ(PiecesOf(SampleWithNormalNoise(&random, {{10.0, 0.0}}, 12, 0.05, 0.4)), 1);
  EXPECT_EQ(PiecesOf(SampleWithNormalNoise(&random, {{20.0, 0.2}}, 24, 0.05, 0.4)), 1);
}

TEST(ChainOracle, FindsThePiecesOfAnAngleAndOfARoundedOne) {
  RandomGeometry random(5202);
  EXPECT_EQ(
      PiecesOf(SampleWithNormalNoise(&random, {{10.0, 0.0}, {10.0, 0.0, 1.0}}, 20, 0.05, 0.4)), 2);
  EXPECT_EQ(PiecesOf(SampleWithNormalNoise(&random, {{8.0, 0.0}, {6.0, 0.25}, {8.0, 0.0}}, 36, 0.05,
                                           0.4)),
            3);
}

TEST(BoundOracle, FindsTheRunsOfAnAngleAndOfARoundedOne) {
  RandomGeometry random(5203);
  EXPECT_EQ(LeastNumberOfRuns(SampleWithNormalNoise(&random, {{10.0, 0.0}}, 12, 0.05, 0.4)), 1);
  EXPECT_EQ(LeastNumberOfRuns(
                SampleWithNormalNoise(&random, {{10.0, 0.0}, {10.0, 0.0, 1.0}}, 16, 0.05, 0.4)),
            2);
}

}  // namespace
}  // namespace Vorn::Testing
