#include <gtest/gtest.h>

#include "geometry/fewest/Candidates.h"
#include "support/fewest/Programmes.h"

namespace Vorn::Fewest {
namespace {

using Testing::ProgrammeOf;

constexpr Circle kAlongX{0.0, 0.0, 1.0, 0.0};

/// Points above the line along x, at distances that repeat 1, 3, 3, 2 tolerances.
Columns Heights() {
  Columns columns;
  for (int i = 0; i < 16; ++i) columns.Append({1.0 * i, i % 4 == 0 ? 1.0 : i % 4 < 3 ? 3.0 : 2.0});
  return columns;
}

TEST(Candidates, AreTheRowsAboveTheLimitAndTheFirstOfTheWorstIsTold) {
  Columns const columns = Heights();
  Programme programme = ProgrammeOf(columns);
  Candidates candidates;
  EXPECT_EQ(candidates.FindWorst(programme, kAlongX).index, -1);
  Columns::Worst const worst = candidates.FindWorstOfAll(programme, kAlongX, 1.0);
  EXPECT_EQ(worst.index, 1);
  EXPECT_EQ(worst.value, 3.0);
  EXPECT_EQ(candidates.FindWorst(programme, kAlongX).index, 1);
  EXPECT_EQ(candidates.FindWorst(programme, kAlongX).value, 3.0);
}

TEST(Candidates, PayFrom512RowsOn) {
  Programme programme;
  programme.first = 10;
  programme.last = 521;
  EXPECT_FALSE(Candidates::ArePaying(programme));
  programme.last = 522;
  EXPECT_TRUE(Candidates::ArePaying(programme));
}

TEST(Candidates, OutsideTheRunArePassedOver) {
  Columns const columns = Heights();
  Programme programme = ProgrammeOf(columns);
  Candidates candidates;
  candidates.FindWorstOfAll(programme, kAlongX, 1.0);
  programme.first = 3;
  EXPECT_EQ(candidates.FindWorst(programme, kAlongX).index, 5);
  programme.last = 5;
  EXPECT_EQ(candidates.FindWorst(programme, kAlongX).index, 3) << "the one at 4 is not above 1";
  candidates.Clear();
  EXPECT_EQ(candidates.FindWorst(programme, kAlongX).index, -1);
}

}  // namespace
}  // namespace Vorn::Fewest
