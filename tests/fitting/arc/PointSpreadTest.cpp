#include <cmath>
#include <utility>
#include <vector>

#include "geometry/fitting/arc/PointSpread.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/RandomGeometry.h"

// The search by groups must find what a run over all pairs finds, the choice among equals included.

namespace Vorn::Testing {
namespace {

using Fitting::FindSpread;
using Fitting::PointSpread;

PointSpread PlainSpread(std::vector<WPoint> const& points) {
  auto const distance2 = [&points](std::size_t i, std::size_t j) {
    double const dx = points[i].x - points[j].x;
    double const dy = points[i].y - points[j].y;
    return dy * dy + dx * dx;
  };
  PointSpread spread;
  spread.largest2 = spread.smallest2 = distance2(0, 1);
  for (std::size_t i = 0; i < points.size(); ++i) {
    for (std::size_t j = i + 1; j < points.size(); ++j) {
      if (distance2(i, j) > spread.largest2) {
        spread.largest2 = distance2(i, j);
        spread.i = static_cast<std::int32_t>(i);
        spread.j = static_cast<std::int32_t>(j);
      }
      if (distance2(i, j) < spread.smallest2) spread.smallest2 = distance2(i, j);
    }
  }
  return spread;
}

void ExpectPlainSpread(std::vector<WPoint> const& points) {
  PointSpread const plain = PlainSpread(points);
  PointSpread const fast = FindSpread(points);
  EXPECT_EQ(fast.i, plain.i);
  EXPECT_EQ(fast.j, plain.j);
  EXPECT_SAME_BITS(fast.largest2, plain.largest2);
  EXPECT_SAME_BITS(fast.smallest2, plain.smallest2);
}

std::vector<WPoint> CirclePoints(int count, double radius, double sweep) {
  std::vector<WPoint> points;
  for (int i = 0; i < count; ++i) {
    double const angle = sweep * i / count;
    points.push_back({3 + radius * std::cos(angle), -2 + radius * std::sin(angle), 0.1});
  }
  return points;
}

TEST(FindSpread, OfTwoPointsIsTheirDistance) {
  PointSpread const spread = FindSpread({{0, 0, 1}, {3, 4, 1}});
  EXPECT_EQ(spread.i, 0);
  EXPECT_EQ(spread.j, 1);
  EXPECT_EQ(spread.largest2, 25.0);
  EXPECT_EQ(spread.smallest2, 25.0);
}

TEST(FindSpread, AgreesWithAllPairsOnCirclesAndArcs) {
  for (int const count : {3, 15, 16, 17, 33, 100, 700}) {
    for (double const sweep : {0.3, 2.0, 3.2, 6.283185307179586}) {
      SCOPED_TRACE(testing::Message() << count << " points over " << sweep);
      ExpectPlainSpread(CirclePoints(count, 25.0, sweep));
    }
  }
}

TEST(FindSpread, FindsThePairFarthestAlongEitherAxisWhereverItStands) {
  RandomGeometry random(31);
  for (int round = 0; round < 40; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 31, round " << round);
    std::vector<WPoint> flat;
    for (int i = 0; i < 120; ++i)
      flat.push_back({random.Uniform(-9.0, 9.0), random.Uniform(-0.1, 0.1), 0.1});
    ExpectPlainSpread(flat);
    for (WPoint& p : flat) std::swap(p.x, p.y);
    ExpectPlainSpread(flat);
  }
}

TEST(FindSpread, TakesTheFirstOfEqualPairs) {
  // Corners of a grid: the two diagonals are equally long, as are all steps.
  std::vector<WPoint> grid;
  for (int y = 0; y < 20; ++y) {
    for (int x = 0; x < 20; ++x) grid.push_back({1.0 * x, 1.0 * y, 0.1});
  }
  ExpectPlainSpread(grid);
  EXPECT_EQ(FindSpread(grid).i, 0);
  EXPECT_EQ(FindSpread(grid).j, 399);
  std::vector<WPoint> const same(100, {1.5, -2.5, 0.1});
  ExpectPlainSpread(same);
  EXPECT_EQ(FindSpread(same).j, 1);
}

TEST(FindSpread, AgreesWithAllPairsOnRandomPoints) {
  RandomGeometry random(5601);
  for (int i = 0; i < 150; ++i) {
    SCOPED_TRACE(i);
    bool const isCoarse = random.Flip();
    std::vector<WPoint> points;
    for (int k = random.Integer(2, 300); k > 0; --k) {
      auto const p = isCoarse ? random.GridPoint(6) : random.PointIn(-50, 50);
      points.push_back({p.x, p.y, 0.1});
    }
    ExpectPlainSpread(points);
  }
}

TEST(FindSpread, BearsWhatIsNotANumberOrNotFinite) {
  for (double const value : {kNaN, kInf, -kInf, 1e308, -1e308, 1e-320}) {
    for (std::size_t const at : {0U, 1U, 20U, 39U}) {
      SCOPED_TRACE(testing::Message() << value << " at " << at);
      std::vector<WPoint> points = CirclePoints(40, 5.0, 6.0);
      points[at].x = value;
      ExpectPlainSpread(points);
      points[(at + 7) % 40].y = -value;
      ExpectPlainSpread(points);
    }
  }
}

}  // namespace
}  // namespace Vorn::Testing
