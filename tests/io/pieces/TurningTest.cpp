#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "io/pieces/Turning.h"
#include "support/RandomGeometry.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

TEST(TurnBetween, GoesOnInTheSenseSaid) {
  EXPECT_DOUBLE_EQ(TurnBetween(0.0, pi / 2.0, true), pi / 2.0);
  EXPECT_DOUBLE_EQ(TurnBetween(0.0, pi / 2.0, false), 1.5 * pi);
  EXPECT_DOUBLE_EQ(TurnBetween(0.75 * pi, -0.75 * pi, true), pi / 2.0);
  EXPECT_EQ(TurnBetween(1.25, 1.25, true), 0.0);
  EXPECT_EQ(TurnBetween(1.25, 1.25, false), 0.0);
}

TEST(TurnTo, IsMeasuredFromTheStartOfTheArc) {
  Piece const arc = MakeArc({1, 0}, {0, 1}, {0, 0}, 1, true);
  EXPECT_DOUBLE_EQ(TurnTo(arc, 0.0, 5.0), pi / 2.0);
  EXPECT_DOUBLE_EQ(TurnTo(arc, 0.0, -5.0), 1.5 * pi);
  EXPECT_EQ(TurnTo(arc, 3.0, 0.0), 0.0);
  EXPECT_DOUBLE_EQ(TurnTo(Reversed(arc), 5.0, 0.0), pi / 2.0);
}

TEST(TurnTo, IsNeverNegativeAndNeverAFullTurn) {
  Testing::RandomGeometry random(72);
  for (int round = 0; round < 10000; ++round) {
    Piece arc = MakeArc({1, 0}, {0, 1}, {0, 0}, 1, random.Flip());
    arc.startAngle = random.Uniform(-20.0, 20.0);
    double const polar = random.Flip()
                             ? random.Uniform(-20.0, 20.0)
                             : std::nextafter(arc.startAngle, random.Flip() ? 100.0 : -100.0);
    double const turn = TurnTo(arc, polar);
    ASSERT_GE(turn, 0.0) << round;
    ASSERT_LT(turn, 2.0 * pi) << round;
    double const back = arc.counterClockwise ? arc.startAngle + turn : arc.startAngle - turn;
    ASSERT_NEAR(std::cos(back), std::cos(polar), 1e-14) << round;
    ASSERT_NEAR(std::sin(back), std::sin(polar), 1e-14) << round;
  }
}

}  // namespace
}  // namespace Vorn::IO
