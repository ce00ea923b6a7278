#include <cmath>
#include <cstdint>
#include <utility>
#include <vector>

#include "geometry/fewest/Answer.h"
#include "geometry/fewest/Polyline.h"
#include "geometry/fewest/promises/Promises.h"
#include "gtest/gtest.h"
#include "support/RandomGeometry.h"

namespace Vorn::Testing {
namespace {

using Fewest::Answer;
using Ends = std::vector<std::pair<double, double>>;
using Ranges = std::vector<std::pair<std::int32_t, std::int32_t>>;

constexpr double kTolerance = 0.125;

Ends EndsOf(Answer const& answer) {
  Ends ends;
  for (auto const& elem : answer.contour) ends.emplace_back(elem.end.x, elem.end.y);
  return ends;
}

Ranges RangesOf(Answer const& answer) {
  Ranges ranges;
  for (auto const& range : answer.ranges) ranges.emplace_back(range.first, range.last);
  return ranges;
}

std::vector<WPoint> Angle() {
  return {{0, 0, kTolerance}, {1, 0, kTolerance}, {2, 0, kTolerance},
          {2, 1, kTolerance}, {2, 2, kTolerance}, {2, 2, kTolerance}};
}

/// No point, or every one, has to be a joint.
std::vector<char> None(std::size_t count) { return std::vector<char>(count, 0); }
std::vector<char> All(std::size_t count) { return std::vector<char>(count, 1); }

TEST(FollowPoints, StopsAtJoints) {
  Answer const answer = Fewest::FollowPoints(Angle(), false, {0, 0, 0, 1, 0, 0});
  EXPECT_EQ(EndsOf(answer), (Ends{{0, 0}, {2, 0}, {2, 1}, {2, 2}}));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 1}, {2, 2}, {3, 5}}));
}

TEST(FollowPoints, RunsFromCornerToCorner) {
  Answer const answer = Fewest::FollowPoints(Angle(), false, None(6));
  EXPECT_EQ(EndsOf(answer), (Ends{{0, 0}, {2, 0}, {2, 2}}));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 1}, {2, 5}}));
}

TEST(FollowPoints, ClosedEndsAtTheFirstPoint) {
  Answer const answer = Fewest::FollowPoints(Angle(), true, None(6));
  EXPECT_EQ(EndsOf(answer), (Ends{{0, 0}, {2, 0}, {2, 2}, {0, 0}}));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 1}, {2, 4}, {5, 5}}));
}

TEST(FollowPoints, OfOnePlaceHasNoRange) {
  std::vector<WPoint> const points(4, WPoint{3, 4, kTolerance});
  EXPECT_TRUE(Fewest::FollowPoints(points, false, None(4)).ranges.empty());
  EXPECT_TRUE(Fewest::FollowPoints(points, true, None(4)).ranges.empty());
}

TEST(FollowPoints, SkipsOnlyRepeatedPointsWhereAllAreJoints) {
  Answer const answer = Fewest::FollowPoints(Angle(), false, All(6));
  EXPECT_EQ(EndsOf(answer), (Ends{{0, 0}, {1, 0}, {2, 0}, {2, 1}, {2, 2}}));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 0}, {1, 1}, {2, 2}, {3, 5}}));
}

TEST(FollowPoints, BreaksNoPromiseWhereAllPointsAreJoints) {
  RandomGeometry random(6406);
  for (int round = 0; round < 2000; ++round) {
    SCOPED_TRACE(testing::Message() << "seed 6406, round " << round);
    bool const isGrid = random.Flip();
    double const w = std::exp2(random.Uniform(-20.0, 8.0));
    std::vector<WPoint> points{{-4.0, 0.0, w}};
    for (int i = random.Integer(1, 30); i > 0; --i) {
      auto const p = isGrid ? random.GridPoint(3) : random.PointIn(-3.0, 3.0);
      points.push_back({p.x, p.y, w * random.Uniform(0.1, 1.0)});
    }
    for (bool const isClosed : {false, true}) {
      Answer const answer = Fewest::FollowPoints(points, isClosed, All(points.size()));
      auto const report =
          Promises::Measure({points, answer.contour, answer.ranges, isClosed, 0.1, 0.0});
      EXPECT_TRUE(report.violations.empty()) << "closed " << isClosed;
      EXPECT_EQ(report.largestRatio, 0.0);
    }
  }
}

TEST(AppendClosingSegment, LeavesAPieceOfOnePointAlone) {
  Answer answer = Fewest::FollowPoints({{0, 0, kTolerance}, {1, 0, kTolerance}}, false, None(2));
  answer.ranges = {{0, 0}};
  EXPECT_FALSE(Fewest::AppendClosingSegment(&answer));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 0}}));
  EXPECT_EQ(answer.contour.size(), 2U);
}

TEST(AppendClosingSegment, LeavesAContourThatEndsWhereItStartsAlone) {
  Answer answer = Fewest::FollowPoints(Angle(), true, None(6));
  answer.ranges.back() = {4, 5};
  EXPECT_FALSE(Fewest::AppendClosingSegment(&answer));
  EXPECT_EQ(answer.contour.size(), 4U);
}

}  // namespace
}  // namespace Vorn::Testing
