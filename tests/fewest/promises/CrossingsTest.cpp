#include <cmath>
#include <cstdint>
#include <numbers>
#include <utility>
#include <vector>

#include "geometry/fewest/promises/Promises.h"
#include "gtest/gtest.h"
#include "support/ContourBuilder.h"
#include "support/RandomGeometry.h"

// Pieces that cross, touch and fold back, with and without a path that does the same.

namespace Vorn::Testing {
namespace {

using Promises::Measure;
using Promises::PieceRange;
using Promises::Promise;
using Promises::Violation;
using Elem = GeometryUtils::Elem;
using Point = GeometryUtils::Point;
using Pairs = std::vector<std::pair<std::size_t, std::size_t>>;

struct Case {
  std::vector<WPoint> points;
  std::vector<Elem> contour;
  std::vector<PieceRange> ranges;
  bool isClosed = false;
};

Pairs CrossingsOf(Case const& c) {
  Pairs crossings;
  for (Violation const& v : Measure({c.points, c.contour, c.ranges, c.isClosed}).violations) {
    EXPECT_NE(v.promise, Promise::WellFormed);
    if (v.promise == Promise::NotCrossing) crossings.emplace_back(v.piece, v.otherPiece);
  }
  return crossings;
}

Pairs Pair(std::size_t first, std::size_t second) { return {{first, second}}; }

std::vector<WPoint> Points(std::vector<Point> const& points, double w) {
  std::vector<WPoint> weighted;
  for (Point const& p : points) weighted.push_back({p.x, p.y, w});
  return weighted;
}

/// Points on straight sides: corner k of the path and count - 1 points after it, up to the next.
Case AlongCorners(std::vector<Point> const& corners, int count, double w) {
  Case c;
  ContourBuilder builder(corners[0].x, corners[0].y);
  for (std::size_t k = 0; k + 1 < corners.size(); ++k) {
    Point const& a = corners[k];
    Point const& b = corners[k + 1];
    auto const first = static_cast<std::int32_t>(c.points.size());
    for (int i = 0; i < count; ++i) {
      double const share = static_cast<double>(i) / count;
      c.points.push_back({a.x + share * (b.x - a.x), a.y + share * (b.y - a.y), w});
    }
    if (k + 2 == corners.size()) c.points.push_back({b.x, b.y, w});
    c.ranges.push_back({first, static_cast<std::int32_t>(c.points.size()) - 1});
    builder.To(b.x, b.y);
  }
  c.contour = builder.Build();
  return c;
}

// --- The path crosses as well --------------------------------------------------------------------

TEST(CheckCrossings, APathThatCrossesItselfMayBeFollowed) {
  for (int const count : {1, 2, 5, 50}) {
    EXPECT_TRUE(CrossingsOf(AlongCorners({{0, 0}, {10, 0}, {5, 8}, {5, -8}}, count, 0.1)).empty())
        << count;
  }
}

TEST(CheckCrossings, AFigureEightOfArcsMayBeFollowed) {
  Case c;
  double const pi = std::numbers::pi;
  auto const add = [&c](double cx, double from, double to, int count) {
    auto const first = static_cast<std::int32_t>(c.points.size());
    for (int i = 0; i < count; ++i) {
      double const t = from + (to - from) * i / count;
      c.points.push_back({cx + 5 * std::cos(t), 5 * std::sin(t), 0.05});
    }
    c.ranges.push_back({first, static_cast<std::int32_t>(c.points.size()) - 1});
  };
  // Two circles that overlap; the path changes over from one to the other at (3, -4), and crosses
  // itself at (3, 4).
  double const out = std::atan2(4.0, 3.0);
  add(0, 0.5, 2 * pi - out, 40);
  add(6, pi + out, pi + out - 5.5, 40);
  Point const start{5 * std::cos(0.5), 5 * std::sin(0.5)};
  c.contour =
      ContourBuilder(start.x, start.y)
          .Around({0, 0}, 3, -4, 1)
          .Around({6, 0}, 6 + 5 * std::cos(pi + out - 5.5), 5 * std::sin(pi + out - 5.5), -1)
          .Build();
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, ALapOverAnEarlierOneMayBeFollowed) {
  // One and a half turns on the same circle, with points on both laps that lie on no common path.
  Case c;
  std::int32_t const count = 75;
  for (std::int32_t i = 0; i <= 2 * count; ++i) {
    double const t = 3 * std::numbers::pi * i / (2 * count);
    double const r = 5 + ((i % 2 == 0) ? 0.01 : -0.01);
    c.points.push_back({r * std::cos(t), r * std::sin(t), 0.05});
  }
  Point const joint{5 * std::cos(1.5 * std::numbers::pi), 5 * std::sin(1.5 * std::numbers::pi)};
  c.contour =
      ContourBuilder(5, 0).Around({0, 0}, joint.x, joint.y, 1).Around({0, 0}, -5, 0, 1).Build();
  c.ranges = {{0, count}, {count + 1, 2 * count}};
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, AnOpenContourMayEndWhereItBegins) {
  Case c = AlongCorners({{0, 0}, {10, 0}, {10, 10}, {0, 10}, {0, 0}}, 4, 0.25);
  EXPECT_TRUE(CrossingsOf(c).empty());
  // The last side pokes through the first one, once by less than the tolerance.
  c.contour.back().end = {0.1, -0.1};
  EXPECT_TRUE(CrossingsOf(c).empty());
  c.points.back() = {0, 0.5, 0.25};
  EXPECT_EQ(CrossingsOf(c), Pair(0, 3));
}

TEST(CheckCrossings, LapsOnOneCircleAreFollowedInTimeThatTheirNumberAllows) {
  // Three arcs of the same circle, twice around, dense.
  Case c;
  std::int32_t const count = 60000;
  RandomGeometry random(4202);
  for (std::int32_t i = 0; i < count; ++i) {
    double const t = 4 * std::numbers::pi * i / (count - 1);
    double const r = 5 + random.Uniform(-0.01, 0.01);
    c.points.push_back({r * std::cos(t), r * std::sin(t), 0.02});
  }
  auto const at = [](double t) { return Point{5 * std::cos(t), 5 * std::sin(t)}; };
  Point const first = at(5.0 / 3.0 * std::numbers::pi);
  Point const second = at(10.0 / 3.0 * std::numbers::pi);
  c.contour = ContourBuilder(5, 0)
                  .Around({0, 0}, first.x, first.y, 1)
                  .Around({0, 0}, second.x, second.y, 1)
                  .Around({0, 0}, 5, 0, 1)
                  .Build();
  c.ranges = {{0, 24999}, {25000, 49999}, {50000, count - 1}};
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, ManyShortPiecesOnTwoLapsMayBeFollowed) {
  // Chords over four points: those of the second lap cross those of the first.
  Case c;
  RandomGeometry random(4203);
  ContourBuilder builder(5, 0);
  std::int32_t const count = 400;
  for (std::int32_t i = 0; i <= count; ++i) {
    double const t = 4 * std::numbers::pi * i / count;
    double const r = 5 + random.Uniform(-0.004, 0.004);
    Point const p{r * std::cos(t), r * std::sin(t)};
    c.points.push_back({p.x, p.y, 0.02});
    if (i % 4 == 3) {
      builder.To(p.x, p.y);
      c.ranges.push_back({i - 3, i});
    }
  }
  builder.To(5, 0);
  c.ranges.push_back({count, count});
  c.contour = builder.Build();
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, FarPointsBeyondACornerDoNotHideThatThePathCrosses) {
  // The last side comes from below, and its end lies below as well, seen from the second side: it
  // has crossed both.
  Case c = AlongCorners({{-10, 0}, {10, 0}, {10, 100}, {-50, 100}, {-50, -10}, {0, -10}, {31, 40}},
                        1, 0.1);
  for (Elem& elem : c.contour) elem.end.y += 0.01;
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, StrandsOnOneLineTouch) {
  // Out, back and out again beside the x axis. The third piece crosses the first at (5, 0) and runs
  // on past its tip.
  Case c = AlongCorners({{0, 0}, {10, 0}, {2, 0}, {12, 0}}, 20, 0.1);
  c.contour = ContourBuilder(0, -0.03).To(10, 0.03).To(2, 0).To(12, 0).Build();
  for (auto const& [apart, crosses] : {std::pair{0.0, true}, {0.003, true}, {0.02, false}}) {
    SCOPED_TRACE(testing::Message() << apart << " from side to side");
    for (std::size_t k = 0; k < c.ranges.size(); ++k) {
      for (std::int32_t i = c.ranges[k].first; i <= c.ranges[k].last; ++i) {
        c.points[static_cast<std::size_t>(i)].y = apart * static_cast<double>(k);
      }
    }
    EXPECT_EQ(CrossingsOf(c), crosses ? Pairs() : Pair(0, 2));
  }
}

// --- The path does not ---------------------------------------------------------------------------

TEST(CheckCrossings, PiecesThatCrossWhereThePathPassesByAreReported) {
  // The path runs up at x = 5 and turns back short of the first side; the contour overshoots.
  Case c;
  c.points = Points({{0, 0}, {5, 0}, {10, 0}, {10, 6}, {5, 6}, {5, 3}, {5, 0.5}}, 1.0);
  c.contour = ContourBuilder(0, 0).To(10, 0).To(10, 6).To(5, 6).To(5, -0.25).Build();
  c.ranges = {{0, 2}, {3, 3}, {4, 4}, {5, 6}};
  EXPECT_EQ(CrossingsOf(c), Pair(0, 3));
  c.contour.back().end = {5, 0.25};
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, ATouchCounts) {
  Case c;
  c.points = Points({{0, 0}, {5, 0}, {10, 0}, {10, 6}, {5, 6}, {5, 3}, {5, 0.5}}, 1.0);
  c.contour = ContourBuilder(0, 0).To(10, 0).To(10, 6).To(5, 6).To(5, 0).Build();
  c.ranges = {{0, 2}, {3, 3}, {4, 4}, {5, 6}};
  EXPECT_EQ(CrossingsOf(c), Pair(0, 3));
}

TEST(CheckCrossings, AnArcThatBulgesOverAGapIsReported) {
  // The points of the third side stand on both sides of a gap over which the arc of the first
  // bulges.
  Case c;
  c.points = Points({{-6, 0}, {6, 0}, {8, 1}, {4, 1}, {-4, 1}}, 0.25);
  c.contour = ContourBuilder(-6, 0)
                  .Around({0, -8}, 6, 0, -1)  // its top is at (0, 2)
                  .To(8, 1)
                  .To(-4, 1)
                  .Build();
  c.ranges = {{0, 1}, {2, 2}, {3, 4}};
  EXPECT_EQ(CrossingsOf(c), Pair(0, 2));
}

TEST(CheckCrossings, ALoopBesideAJointIsReported) {
  // A segment and an arc that cut each other at (0, 0) and meet at (8, 0).
  Case c;
  c.points = Points({{-8, 0}, {0, 0}, {8, 0}, {0, -1}, {-3, -4}}, 1.5);
  c.contour = ContourBuilder(-8, 0).To(8, 0).Around({4, -3}, -1, -3, 1).Build();
  c.ranges = {{0, 2}, {3, 4}};
  EXPECT_EQ(CrossingsOf(c), Pair(0, 1));
}

TEST(CheckCrossings, ALoopOfTwoArcsBesideTheirJointIsReported) {
  // Circles about (0, 0) and (6, 0) of radius 5 meet at (3, 4) and (3, -4). The first arc comes
  // from below through (3, -4), and the second one goes back through it.
  Case c;
  c.points = Points({{0, -5}, {5, 0}, {3, 4}, {1, 0}, {6, -5}}, 1.0);
  c.contour = ContourBuilder(0, -5).Around({0, 0}, 3, 4, 1).Around({6, 0}, 6, -5, 1).Build();
  c.ranges = {{0, 2}, {3, 4}};
  EXPECT_TRUE(CrossingsOf(c).empty()) << "the path crosses here as well";
  c.points = Points({{0, -5}, {5, 0}, {4, 3}, {4, 3}, {6, -5}}, 100.0);
  EXPECT_EQ(CrossingsOf(c), Pair(0, 1));
}

TEST(CheckCrossings, ALoopOfThePathIsNoneOfThePiecesUnlessTolerancesHideIt) {
  // The path passes (7, 0) on the way to (10, 0) and again on the way back from (9, 1). The pieces
  // lie a little beside it. Seen from the last of them (10, 0) lies behind its start, so that the
  // strands run into each other.
  std::vector<Point> const corners{{0, 0}, {10, 0}, {9, 1}, {3, -2}};
  for (int const count : {1, 3, 20}) {
    SCOPED_TRACE(testing::Message() << count << " points a side");
    Case c = AlongCorners(corners, count, 0.1);
    for (Elem& elem : c.contour) elem.end.y += 0.01;
    EXPECT_TRUE(CrossingsOf(c).empty());
    for (WPoint& p : c.points) p.w = 3.0;
    EXPECT_EQ(CrossingsOf(c), Pair(0, 2));
  }
}

TEST(CheckCrossings, SegmentsFromPointToPointMayCrossWhereThePathDoes) {
  // All within tolerance: only the segments of the path itself are taken for what they are.
  Case c = AlongCorners({{0, 0}, {10, 0}, {9, 1}, {3, -2}}, 1, 100.0);
  EXPECT_TRUE(CrossingsOf(c).empty());
  c.points[1].y += 0.01;
  EXPECT_EQ(CrossingsOf(c), Pair(0, 2));
  c.points[1].y -= 0.01;
  c.contour[2].end.x -= 0.01;
  EXPECT_EQ(CrossingsOf(c), Pair(0, 2));
}

TEST(CheckCrossings, TangentNeighboursDoNotCross) {
  Case c;
  c.points = Points({{0, 0}, {4, 0}, {9, 5}, {9, 7}, {11, 9}}, 0.5);
  c.contour = ContourBuilder(0, 0)
                  .To(4, 0)
                  .Around({4, 5}, 9, 5, 1)
                  .To(9, 7)
                  .Around({11, 7}, 11, 9, -1)
                  .Build();
  c.ranges = {{0, 0}, {1, 1}, {2, 2}, {3, 4}};
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, TangentNeighboursOfAnySizeDoNotCross) {
  RandomGeometry random(4201);
  for (int round = 0; round < 20000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 4201, round " << round);
    Point const joint = random.PointIn(-1e3, 1e3);
    double const heading = random.Uniform(-3.1, 3.1);
    ContourBuilder const builder = [&] {
      // Both circles have their centres on the normal of the joint.
      auto const along = [&](double curvature, double length) {
        double const r = 1.0 / curvature;
        Point const centre{joint.x - r * std::sin(heading), joint.y + r * std::cos(heading)};
        double const turn = length * curvature;
        return std::pair{centre, Point{centre.x + r * std::sin(heading + turn),
                                       centre.y - r * std::cos(heading + turn)}};
      };
      auto const curvature = [&] {
        double const size = std::exp2(random.Uniform(-24.0, 3.0));
        return random.Flip() ? size : -size;
      };
      double const k1 = curvature();
      double const k2 = curvature();
      auto const [centre1, start] = along(k1, -std::fmin(2.0 / std::fabs(k1), 50.0));
      auto const [centre2, end] = along(k2, std::fmin(2.0 / std::fabs(k2), 50.0));
      return ContourBuilder(start.x, start.y)
          .Around(centre1, joint.x, joint.y, k1 > 0 ? 1 : -1)
          .Around(centre2, end.x, end.y, k2 > 0 ? 1 : -1);
    }();
    Case c;
    c.contour = builder.Build();
    Point const& start = c.contour.front().end;
    Point const& end = c.contour.back().end;
    c.points = Points({start, joint, joint, end}, 1.0);
    c.ranges = {{0, 1}, {2, 3}};
    EXPECT_TRUE(CrossingsOf(c).empty());
  }
}

TEST(CheckCrossings, PiecesThatFoldBackDoNotCross) {
  Case c;
  c.points = Points({{0, 0}, {5, 0}, {10, 0}, {5, 0}, {2, 0}}, 0.5);
  c.contour = ContourBuilder(0, 0).To(10, 0).To(2, 0).Build();
  c.ranges = {{0, 2}, {3, 4}};
  EXPECT_TRUE(CrossingsOf(c).empty());
  c.points = Points({{5, 0}, {0, 5}, {-5, 0}, {0, 5}}, 0.5);
  c.contour = ContourBuilder(5, 0).Around({0, 0}, -5, 0, 1).Around({0, 0}, 0, 5, -1).Build();
  c.ranges = {{0, 2}, {3, 3}};
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, AClosedContourSharesTheJointAtItsStart) {
  Case c = AlongCorners({{0, 0}, {10, 0}, {10, 10}, {0, 10}, {0, 0}}, 3, 0.25);
  c.points.pop_back();
  c.ranges.back().last -= 1;
  c.isClosed = true;
  EXPECT_TRUE(CrossingsOf(c).empty());
  // A lens has two joints, both shared.
  c = {Points({{3, -4}, {5, 0}, {3, 4}, {1, 0}}, 0.25),
       ContourBuilder(3, -4).Around({0, 0}, 3, 4, 1).Around({6, 0}, 3, -4, 1).Build(),
       {{0, 1}, {2, 3}},
       true};
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, PiecesThatCutOffTheTipOfACuspAreReported) {
  // A side along the x axis and an arc that leads back below it. The last side passes the tip at
  // the origin on the right; its piece cuts it off.
  Case c;
  c.points = Points({{-10, 0},
                     {-5, 0},
                     {0, 0},
                     {-5, -0.635},
                     {-10, -2.68},
                     {-20, -5},
                     {-20, 5},
                     {-2, 5},
                     {0.65, -1.5}},
                    0.5);
  c.contour = ContourBuilder(-10, 0)
                  .To(0, 0)
                  .Around({0, -20}, -10, -20 + std::sqrt(300.0), 1)
                  .To(-20, -5)
                  .To(-20, 5)
                  .To(-2, 5)
                  .To(0.2, -1.5)
                  .Build();
  c.ranges = {{0, 2}, {3, 4}, {5, 5}, {6, 6}, {7, 7}, {8, 8}};
  EXPECT_EQ(CrossingsOf(c), (Pairs{{0, 5}, {1, 5}}));
  c.contour.back().end = {0.8, -1.5};
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, ASpikeThatCrossesWithinItsTolerancesIsReported) {
  // Out and back along one line: three pieces, the last of which cuts the first halfway.
  Case c;
  for (int i = 0; i <= 20; ++i) c.points.push_back({1.0 * i, 0.0, 1.0});
  for (int i = 20; i >= 0; --i) c.points.push_back({1.0 * i, 0.1, 1.0});
  c.contour = ContourBuilder(0, 0.5).To(20, -0.5).To(20, 0.5).To(0, -0.25).Build();
  c.ranges = {{0, 19}, {20, 21}, {22, 41}};
  EXPECT_EQ(CrossingsOf(c), Pair(0, 2));
  c.contour = ContourBuilder(0, -0.25).To(20, -0.5).To(20, 0.5).To(0, 0.25).Build();
  EXPECT_TRUE(CrossingsOf(c).empty());
}

TEST(CheckCrossings, ManyPiecesAreSearchedWithoutLookingAtAllPairs) {
  // A comb of 20000 teeth, then a last piece through one of them.
  std::vector<Point> corners;
  int const teeth = 20000;
  for (int i = 0; i < teeth; ++i) {
    corners.push_back({3.0 * i, 0});
    corners.push_back({3.0 * i + 1, 10});
    corners.push_back({3.0 * i + 2, 10});
    corners.push_back({3.0 * i + 2, 0});
  }
  EXPECT_TRUE(CrossingsOf(AlongCorners(corners, 1, 0.1)).empty());
}

}  // namespace
}  // namespace Vorn::Testing
