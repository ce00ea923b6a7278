#include <gtest/gtest.h>

#include <numbers>

#include "io/FormatContours.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;
using std::numbers::pi;

TEST(MakeArc, AnglesSweepAndLengthFollow) {
  Piece const arc = MakeArc({4, 0}, {3, -1}, {4, -1}, 1, false);
  EXPECT_TRUE(arc.IsArc());
  EXPECT_DOUBLE_EQ(arc.startAngle, pi / 2);
  EXPECT_DOUBLE_EQ(arc.endAngle, pi);
  EXPECT_DOUBLE_EQ(arc.sweep, 1.5 * pi);
  EXPECT_DOUBLE_EQ(arc.length, 1.5 * pi);
}

TEST(MakeBulge, OneIsAHalfTurnToTheRight) {
  Piece const arc = MakeBulge({0, 0}, {2, 0}, 1.0);
  EXPECT_TRUE(arc.counterClockwise);
  EXPECT_EQ(arc.center.x, 1.0);
  EXPECT_EQ(arc.center.y, 0.0);
  EXPECT_EQ(arc.radius, 1.0);
  EXPECT_DOUBLE_EQ(arc.sweep, pi);
  EXPECT_NEAR(PointOnArc(arc, pi / 2).y, -1.0, 1e-15);  // counter-clockwise passes below
}

TEST(MakeBulge, NegativeIsClockwise) {
  double const quarter = std::tan(pi / 8);
  Piece const arc = MakeBulge({0, 1}, {1, 0}, -quarter);
  EXPECT_FALSE(arc.counterClockwise);
  EXPECT_NEAR(arc.center.x, 0.0, 1e-15);
  EXPECT_NEAR(arc.center.y, 0.0, 1e-15);
  EXPECT_NEAR(arc.radius, 1.0, 1e-15);
}

TEST(MakeBulge, NothingWorthACircleIsALine) {
  for (double const bulge : {0.0, -0.0, 1e-300, 1e-20, std::nan("")}) {
    EXPECT_FALSE(MakeBulge({0, 0}, {2, 0}, bulge).IsArc()) << bulge;
  }
  EXPECT_FALSE(MakeBulge({1, 1}, {1, 1}, 1.0).IsArc());
  EXPECT_TRUE(MakeBulge({0, 0}, {2, 0}, 1e-6).IsArc());
}

TEST(BulgeOf, UndoesMakeBulge) {
  for (double const bulge : {1.0, -1.0, 0.001, -3.0}) {
    EXPECT_DOUBLE_EQ(BulgeOf(MakeBulge({1, 2}, {4, -3}, bulge)), bulge);
  }
  EXPECT_EQ(BulgeOf(MakeLine({0, 0}, {1, 1})), 0.0);
}

TEST(MakeCircle, IsTwoHalvesFromTheStartAndBack) {
  std::vector<Piece> const halves = MakeCircle({3, 0}, {1, 0}, 2, false);
  ASSERT_EQ(halves.size(), 2u);
  EXPECT_TRUE(AreEqual(halves[0].end, {-1, 0}));
  EXPECT_TRUE(AreEqual(halves[1].end, {3, 0}));
  for (Piece const& half : halves) EXPECT_DOUBLE_EQ(half.sweep, pi);
  EXPECT_FALSE(halves[0].counterClockwise);
}

TEST(Reversed, TwiceGivesTheSamePiece) {
  Piece const arc = MakeArc({4, 0}, {3, -1}, {4, -1}, 1, false);
  Piece const reversed = Reversed(arc);
  EXPECT_TRUE(AreEqual(reversed.start, arc.end));
  EXPECT_TRUE(reversed.counterClockwise);
  EXPECT_EQ(reversed.sweep, arc.sweep);
  EXPECT_TRUE(SameBits(Reversed(reversed), arc));
}

TEST(WithoutWideArcs, HalvesOnlyWhatTurnsBeyond315Degrees) {
  auto const arc = [](double sweep) {
    return MakeArc({1, 0}, {std::cos(sweep), std::sin(sweep)}, {0, 0}, 1, true);
  };
  EXPECT_EQ(WithoutWideArcs({arc(5.49)}).size(), 1u);
  std::vector<Piece> const halves = WithoutWideArcs({arc(5.51)});
  ASSERT_EQ(halves.size(), 2u);
  EXPECT_DOUBLE_EQ(halves[0].sweep, 5.51 / 2);
  EXPECT_TRUE(AreEqual(halves[0].end, halves[1].start));
  EXPECT_TRUE(AreEqual(halves[1].end, arc(5.51).end));
}

TEST(ConnectedRuns, BreaksAtGapsWiderThanTheTolerance) {
  std::vector<Piece> const pieces = WithGap().pieces;
  EXPECT_EQ(ConnectedRuns(pieces, 0.4).size(), 2u);
  EXPECT_EQ(ConnectedRuns(pieces, 0.5).size(), 1u);
}

TEST(FaultOf, TellsWhichEndIsOffTheCircle) {
  EXPECT_FALSE(FaultOf(MakeArc({1, 0}, {0, 1}, {0, 0}, 1, true)));
  EXPECT_FALSE(FaultOf(MakeArc({1.0005, 0}, {0, 1}, {0, 0}, 1, true)));  // three digits
  EXPECT_EQ(*FaultOf(MakeArc({1.25, 0}, {0, 1}, {0, 0}, 1, true)),
            "the start is 0.25 off the circle");
  EXPECT_EQ(*FaultOf(MakeArc({1, 0}, {0, 1.5}, {0, 0}, 1, true)), "the end is 0.5 off the circle");
  EXPECT_EQ(*FaultOf(MakeArc({1, 0}, {0, 1}, {0, 0}, 0, true)), "the radius is not above 0");
  EXPECT_TRUE(FaultOf(MakeArc({1, 0}, {0, 1}, {0, 0}, std::nan(""), true)));
}

TEST(ExtentOf, ReachesToWhereArcsBulgeOut) {
  Extent const extent = ExtentOf({MakeArc({4, 0}, {3, -1}, {4, -1}, 1, false)});
  EXPECT_EQ(extent.low.x, 3.0);
  EXPECT_EQ(extent.low.y, -2.0);
  EXPECT_EQ(extent.high.x, 5.0);
  EXPECT_EQ(extent.high.y, 0.0);
}

TEST(ExtentOf, HoldsEveryPlaceOfRandomContours) {
  for (std::uint64_t seed = 0; seed < 50; ++seed) {
    std::vector<Piece> const pieces = RandomContour(seed, 10.0).pieces;
    Extent const extent = ExtentOf(pieces);
    constexpr double kRounding = 1e-12;
    for (Piece const& piece : pieces) {
      for (int i = 0; i <= 20; ++i) {
        XY const at = PointAlong(piece, i / 20.0);
        EXPECT_TRUE(at.x >= extent.low.x - kRounding && at.x <= extent.high.x + kRounding &&
                    at.y >= extent.low.y - kRounding && at.y <= extent.high.y + kRounding)
            << "seed " << seed;
      }
    }
  }
}

}  // namespace
}  // namespace Vorn::IO
