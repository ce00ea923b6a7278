#include "geometry/fitting/runs/CellBudget.h"
#include "gtest/gtest.h"

namespace Vorn::Fitting {
namespace {

TEST(CellBudget, HoldsExactly78125TrianglesOfALineCell) {
  EXPECT_FALSE(IsOversized(78125, kLineCellWeight));
  EXPECT_TRUE(IsOversized(78126, kLineCellWeight));
}

TEST(CellBudget, HoldsExactly19531TrianglesOfAnArcCell) {
  EXPECT_FALSE(IsOversized(19531, kArcCellWeight));
  EXPECT_TRUE(IsOversized(19532, kArcCellWeight));
}

}  // namespace
}  // namespace Vorn::Fitting
