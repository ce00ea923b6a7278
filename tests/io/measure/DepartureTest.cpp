#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "io/FormatContours.h"
#include "vorn/io/Departure.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

TEST(DepartureOf, TheSameContourIsNoneHoweverItIsDivided) {
  EXPECT_EQ(DepartureOf({MakeLine({0, 0}, {8, 0})}, {MakeLine({0, 0}, {8, 0})}), 0.0);
  EXPECT_EQ(
      DepartureOf({MakeLine({0, 0}, {8, 0})}, {MakeLine({0, 0}, {3, 0}), MakeLine({3, 0}, {8, 0})}),
      0.0);
  EXPECT_EQ(DepartureOf({MakeLine({0, 0}, {8, 0})}, {MakeLine({8, 0}, {0, 0})}), 0.0);
}

TEST(DepartureOf, IsMeasuredBothWays) {
  std::vector<Piece> const whole = {MakeLine({0, 0}, {8, 0})};
  std::vector<Piece> const part = {MakeLine({0, 0}, {5, 0})};
  EXPECT_EQ(DepartureOf(whole, part), 3.0);
  EXPECT_EQ(DepartureOf(part, whole), 3.0);
}

TEST(DepartureOf, SeesTheRiseOfAnArcAboveItsChord) {
  // The middle of the arc is one of the places looked at.
  Piece const arc = MakeArc({5, 0}, {-5, 0}, {0, 0}, 5.0, true);
  EXPECT_NEAR(DepartureOf({arc}, {MakeLine({5, 0}, {-5, 0})}), 5.0, 1e-15);
  Piece const flat = MakeArc({3, 4}, {-3, 4}, {0, 0}, 5.0, true);
  EXPECT_NEAR(DepartureOf({flat}, {MakeLine({3, 4}, {-3, 4})}), 1.0, 1e-15);
}

TEST(DepartureOf, IsNeverMoreThanWhatAFineWalkFindsAndNotMuchLess) {
  for (std::uint64_t seed = 0; seed < 50; ++seed) {
    std::vector<Piece> const a = RandomContour(seed, 10.0).pieces;
    std::vector<Piece> b = a;
    for (Piece& piece : b) {
      piece = piece.IsArc() ? piece : MakeLine(piece.start, {piece.end.x + 0.01, piece.end.y});
    }
    double const departure = DepartureOf(a, b);
    EXPECT_LE(departure, 0.01 * (1 + 1e-9)) << seed;
    EXPECT_EQ(departure, DepartureOf(b, a)) << seed;
  }
}

TEST(DepartureOf, FollowsAShift) {
  for (std::uint64_t seed = 0; seed < 20; ++seed) {
    std::vector<Piece> const a = RandomContour(seed, 10.0).pieces;
    std::vector<Piece> b;
    for (Piece piece : a) {
      for (XY* at : {&piece.start, &piece.end, &piece.center}) at->y += 1e-4;
      b.push_back(piece);
    }
    // Some piece lies across the shift, and none leaves the other contour by more than it.
    EXPECT_LE(DepartureOf(a, b), 1e-4 * (1 + 1e-6)) << seed;
    EXPECT_GT(DepartureOf(a, b), 0.5e-4) << seed;
  }
}

}  // namespace
}  // namespace Vorn::IO
