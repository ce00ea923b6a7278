#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <random>

#include "io/pieces/Flattening.h"
#include "io/pieces/Shapes.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

/// How far the place is from the chain of chords.
double FromChords(XY const& place, std::vector<XY> const& chain) {
  double nearest = 1e300;
  for (std::size_t i = 1; i < chain.size(); ++i) {
    nearest = std::min(nearest, DistanceTo(MakeLine(chain[i - 1], chain[i]), place.x, place.y));
  }
  return nearest;
}

/// The curve at t by Bernstein's polynomials, weights and all.
XY OnCurve(BezierCurve const& curve, double t) {
  std::size_t const degree = curve.size() - 1;
  XY sum;
  double weights = 0.0;
  double choose = 1.0;
  for (std::size_t i = 0; i <= degree; ++i) {
    double const part = choose * std::pow(t, static_cast<double>(i)) *
                        std::pow(1.0 - t, static_cast<double>(degree - i)) * curve[i].weight;
    sum = {sum.x + part * curve[i].at.x, sum.y + part * curve[i].at.y};
    weights += part;
    choose = choose * static_cast<double>(degree - i) / static_cast<double>(i + 1);
  }
  return {sum.x / weights, sum.y / weights};
}

std::vector<XY> ChainOf(BezierCurve const& curve, double tolerance) {
  std::vector<XY> chain = {curve.front().at};
  EXPECT_TRUE(AppendChords(curve, tolerance, kMostChords, &chain));
  return chain;
}

TEST(AppendChords, NoPointOfARandomCurveIsFurtherThanTheTolerance) {
  std::mt19937 random(20250101);
  std::uniform_real_distribution<double> coordinate(-10.0, 10.0);
  std::uniform_real_distribution<double> weight(0.2, 5.0);
  for (int round = 0; round < 200; ++round) {
    BezierCurve curve(2 + static_cast<std::size_t>(round) % 5);
    for (ControlPoint& control : curve) {
      control.at = {coordinate(random), coordinate(random)};
      if (round % 2 == 0) control.weight = weight(random);
    }
    double const tolerance = round % 3 == 0 ? 0.5 : 0.01;
    std::vector<XY> const chain = ChainOf(curve, tolerance);
    for (int i = 0; i <= 100; ++i) {
      EXPECT_LE(FromChords(OnCurve(curve, i / 100.0), chain), tolerance + 1e-12) << round;
    }
    EXPECT_TRUE(AreEqual(chain.back(), curve.back().at));
  }
}

TEST(AppendChords, AStraightCurveIsOneChord) {
  EXPECT_EQ(ChainOf({{{0, 0}}, {{1, 0}}, {{2, 0}}, {{3, 0}}}, 1e-9).size(), 2u);
}

TEST(AppendChords, ACurveThatIsOnePointIsOneChord) {
  EXPECT_EQ(ChainOf({{{1, 1}}, {{1, 1}}, {{1, 1}}}, 1e-9).size(), 2u);
}

TEST(AppendChords, ChordsOfAnArcAreAsFewAsTheToleranceAllows) {
  // A chord of 2 a lies radius * (1 - cos a) below its arc: 1 - cos(pi / 8) = 0.0761.
  Piece const arc = MakeArc({1, 0}, {-1, 0}, {0, 0}, 1.0, true);
  std::vector<XY> chain = {arc.start};
  ASSERT_TRUE(AppendChords(arc, 0.0762, kMostChords, &chain));
  ASSERT_EQ(chain.size(), 5u);
  EXPECT_NEAR(chain[1].x, std::sqrt(0.5), 1e-15);
  EXPECT_NEAR(chain[1].y, std::sqrt(0.5), 1e-15);
  EXPECT_TRUE(AreEqual(chain.back(), {-1, 0}));
  chain.resize(1);
  ASSERT_TRUE(AppendChords(arc, 0.0760, kMostChords, &chain));
  EXPECT_EQ(chain.size(), 6u);
}

TEST(AppendChords, EvenAWideToleranceKeepsTheShapeOfACircle) {
  std::vector<XY> chain = {{1, 0}};
  for (Piece const& half : MakeCircle({1, 0}, {0, 0}, 1.0, true)) {
    ASSERT_TRUE(AppendChords(half, 1e9, kMostChords, &chain));
  }
  EXPECT_EQ(chain.size(), 5u);
}

TEST(AppendChords, StopsAtTheMostChords) {
  std::vector<XY> chain = {{1, 0}};
  EXPECT_FALSE(AppendChords(MakeArc({1, 0}, {-1, 0}, {0, 0}, 1.0, true), 1e-12, 1000, &chain));
  BezierCurve const curve = {{{0, 0}}, {{1, 1}}, {{2, 0}}};
  EXPECT_FALSE(AppendChords(curve, 1e-12, 1000, &chain));
  EXPECT_LE(chain.size(), 1001u);
}

TEST(AppendChords, AToleranceOfNothingEnds) {
  std::vector<XY> chain = {{0, 0}};
  EXPECT_FALSE(AppendChords(BezierCurve{{{0, 0}}, {{1, 1}}, {{2, 0}}}, 0.0, 1000, &chain));
}

TEST(CurvesOf, AnEllipseIsMetWhereItsFormulaSays) {
  EllipseArc const arc = {{3, 4}, {5, 1}, {-0.5, 2.5}, 0.3, 5.1};
  std::vector<BezierCurve> const curves = CurvesOf(arc);
  ASSERT_EQ(curves.size(), 4u);
  for (BezierCurve const& curve : curves) {
    for (int i = 0; i <= 10; ++i) {
      // In coordinates along the half axes every point is 1 away from the centre.
      XY const at = OnCurve(curve, i / 10.0);
      double const determinant = 5.0 * 2.5 + 0.5 * 1.0;
      double const u = ((at.x - 3) * 2.5 + (at.y - 4) * 0.5) / determinant;
      double const v = ((at.y - 4) * 5.0 - (at.x - 3) * 1.0) / determinant;
      EXPECT_NEAR(std::hypot(u, v), 1.0, 1e-14);
    }
  }
  EXPECT_NEAR(curves.back().back().at.x, 3 + 5 * std::cos(5.1) - 0.5 * std::sin(5.1), 1e-14);
}

TEST(AppendChords, CurvesAreRefusedUnlessAskedFor) {
  Flattening none;
  std::vector<Piece> pieces;
  std::vector<BezierCurve> const curves = {{{{0, 0}}, {{1, 1}}, {{2, 0}}}};
  auto const complaint = AppendChords(curves, &none, &pieces);
  ASSERT_TRUE(complaint);
  EXPECT_NE(complaint->find("a curve that is no arc of a circle"), std::string::npos);
  Flattening some = {0.1, 3};
  ASSERT_TRUE(AppendChords(curves, &some, &pieces));
  some = {0.1, 100};
  EXPECT_FALSE(AppendChords(curves, &some, &pieces));
  EXPECT_EQ(some.chordsLeft, 100 - pieces.size());
}

}  // namespace
}  // namespace Vorn::IO
