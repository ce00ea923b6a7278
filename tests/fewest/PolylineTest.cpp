#include <cstdint>
#include <utility>
#include <vector>

#include "geometry/fewest/Answer.h"
#include "geometry/fewest/Polyline.h"
#include "gtest/gtest.h"

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

TEST(FollowPoints, RunsFromCornerToCorner) {
  Answer const answer = Fewest::FollowPoints(Angle(), false);
  EXPECT_EQ(EndsOf(answer), (Ends{{0, 0}, {2, 0}, {2, 2}}));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 1}, {2, 5}}));
}

TEST(FollowPoints, ClosedEndsAtTheFirstPoint) {
  Answer const answer = Fewest::FollowPoints(Angle(), true);
  EXPECT_EQ(EndsOf(answer), (Ends{{0, 0}, {2, 0}, {2, 2}, {0, 0}}));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 1}, {2, 4}, {5, 5}}));
}

TEST(FollowPoints, OfOnePlaceHasNoRange) {
  std::vector<WPoint> const points(4, WPoint{3, 4, kTolerance});
  EXPECT_TRUE(Fewest::FollowPoints(points, false).ranges.empty());
  EXPECT_TRUE(Fewest::FollowPoints(points, true).ranges.empty());
}

TEST(AppendClosingSegment, LeavesAPieceOfOnePointAlone) {
  Answer answer = Fewest::FollowPoints({{0, 0, kTolerance}, {1, 0, kTolerance}}, false);
  answer.ranges = {{0, 0}};
  EXPECT_FALSE(Fewest::AppendClosingSegment(&answer));
  EXPECT_EQ(RangesOf(answer), (Ranges{{0, 0}}));
  EXPECT_EQ(answer.contour.size(), 2U);
}

TEST(AppendClosingSegment, LeavesAContourThatEndsWhereItStartsAlone) {
  Answer answer = Fewest::FollowPoints(Angle(), true);
  answer.ranges.back() = {4, 5};
  EXPECT_FALSE(Fewest::AppendClosingSegment(&answer));
  EXPECT_EQ(answer.contour.size(), 4U);
}

}  // namespace
}  // namespace Vorn::Testing
