#include <cmath>
#include <vector>

#include "geometry/fitting/arc/ArcSearch.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/Profiles.h"
#include "support/RandomGeometry.h"
#include "support/Transcript.h"

// What the search answers and when its fields are set. Its results are compared with the plain
// composition of the steps in the tests of GetFittingCircle2.

namespace Vorn::Testing {
namespace {

using Fitting::AfterFailure;
using Fitting::ArcSearchResult;
using Fitting::FindLongestArc;
using Fitting::RunOverAll;

GeometryUtils::ProgressBase const kSilent;

std::vector<WPoint> QuarterCircle(int count) {
  std::vector<WPoint> points;
  for (int i = 0; i < count; ++i) {
    double const angle = 1.5 * i / count;
    points.push_back({10 * std::cos(angle), 10 * std::sin(angle), 0.01});
  }
  return points;
}

TEST(FindLongestArc, FindsTheCircleThatThePointsLieOn) {
  std::vector<WPoint> const points = QuarterCircle(20);
  ArcSearchResult const result = FindLongestArc({RunOverAll(points), 3, {}, kSilent});
  ASSERT_EQ(result.code, ErrorCode::Ok);
  EXPECT_EQ(result.arc->count, 20);
  EXPECT_TRUE(result.arc->ccw);
  EXPECT_NEAR(result.arc->circle.radius, 10.0, 0.01);
  EXPECT_LE(result.arc->deviation.value, 1.0);
}

TEST(FindLongestArc, FailsWithoutAnArcWhenThereIsNoLengthToTry) {
  std::vector<WPoint> const points = QuarterCircle(5);
  ArcSearchResult const result = FindLongestArc({RunOverAll(points), 6, {}, kSilent});
  EXPECT_EQ(result.code, ErrorCode::Failed);
  EXPECT_FALSE(result.arc);
}

TEST(FindLongestArc, FailsWithoutAnArcForARunThatDoesNotExist) {
  std::vector<WPoint> const points = QuarterCircle(5);
  ArcSearchResult const result = FindLongestArc({{points, 3, 4}, 3, {}, kSilent});
  EXPECT_EQ(result.code, ErrorCode::Failed);
  EXPECT_FALSE(result.arc);
}

TEST(FindLongestArc, AStepOfARightAngleLeavesTheArcThatWasGivenUp) {
  // Three points of one circle, with two steps of 120 degrees.
  double const half = std::sqrt(0.75);
  std::vector<WPoint> const points = {{1, 0, .001}, {-.5, half, .001}, {-.5, -half, .001}};
  ArcSearchResult const result = FindLongestArc({RunOverAll(points), 3, {}, kSilent});
  EXPECT_EQ(result.code, ErrorCode::SelfIntersection);
  ASSERT_TRUE(result.arc);
  EXPECT_NEAR(result.arc->circle.radius, 1.0, 0.01);
}

TEST(FindLongestArc, AskingForTheCellChangesNothingElse) {
  int found = 0;
  for (std::uint64_t seed = 1; seed <= 60; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    std::vector<WPoint> const points = MakeProfile(&random, random.Integer(3, 25));
    auto const search = [&points, &found](AfterFailure cellUse) {
      ArcSearchResult const result = FindLongestArc({RunOverAll(points), 3, {}, kSilent, cellUse});
      Transcript transcript;
      transcript.Add("code", result.code);
      transcript.Add("has arc", result.arc.has_value());
      if (result.code == ErrorCode::Ok) ++found;
      if (result.arc) {
        transcript.Add("count", result.arc->count);
        transcript.Add("start", result.arc->start);
        transcript.Add("end", result.arc->end);
        transcript.Add("centre", result.arc->circle.centre);
        transcript.Add("radius", result.arc->circle.radius);
        transcript.Add("deviation", result.arc->deviation.value);
        transcript.Add("index", result.arc->deviation.index);
      }
      return transcript.Text();
    };
    EXPECT_EQ(search(AfterFailure::NoCell), search(AfterFailure::KeepCell));
  }
  EXPECT_GT(found, 20);
}

}  // namespace
}  // namespace Vorn::Testing
