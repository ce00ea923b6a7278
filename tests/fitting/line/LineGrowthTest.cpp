#include <vector>

#include "geometry/fitting/line/LineGrowth.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/Profiles.h"
#include "support/RandomGeometry.h"
#include "support/Transcript.h"

// Going back to a lower limit must leave the run that growing anew up to it makes, and report the
// same progress.

namespace Vorn::Testing {
namespace {

using Fitting::LineGrowth;
using Fitting::LineTask;

GeometryUtils::ProgressBase const kSilent;
std::vector<std::int32_t> const kNoOffenders;

/// What can be seen of a growth.
std::string Transcribe(LineGrowth const& growth, std::vector<std::int32_t> const& progress) {
  Transcript transcript;
  transcript.Add("taken", growth.Taken());
  std::optional<Elementary::Segment> const segment = growth.FindSegment();
  transcript.Add("has segment", segment.has_value());
  if (segment) {
    transcript.Add("start", segment->start);
    transcript.Add("end", segment->end);
  }
  transcript.Add("progress", progress);
  return transcript.Text();
}

/// Grows to the full length, goes back to every lower limit, down to three points, and compares.
void ExpectGrowingAgainIsGrowingAnew(std::vector<WPoint> const& points, bool isLastAttempt) {
  std::vector<std::int32_t> const offenders = {2, 5};
  ProgressRecorder recorder;
  GeometryUtils::ProgressBase const progress{&recorder, 100,
                                             static_cast<std::int32_t>(points.size())};
  LineTask const task{Fitting::RunOverAll(points), {}, isLastAttempt, progress};
  LineGrowth growth(task, offenders);
  growth.Grow(task.run.count);
  for (std::int32_t limit = growth.Taken() - 1; limit > 2; --limit) {
    SCOPED_TRACE(limit);
    recorder.percents.clear();
    growth.GrowAgain(limit);
    std::string const again = Transcribe(growth, recorder.percents);
    recorder.percents.clear();
    LineGrowth anew(task, offenders);
    anew.Grow(limit);
    ASSERT_EQ(again, Transcribe(anew, recorder.percents));
  }
}

TEST(LineGrowth, GrowingAgainIsGrowingAnew) {
  for (std::uint64_t seed = 1; seed <= 60; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    std::vector<WPoint> const points = MakeProfile(&random, random.Integer(5, 40));
    ExpectGrowingAgainIsGrowingAnew(points, random.Flip());
  }
}

TEST(LineGrowth, GrowingAgainOverRebuiltCellsIsGrowingAnew) {
  for (std::uint64_t seed = 1; seed <= 4; ++seed) {
    SCOPED_TRACE(seed);
    RandomGeometry random(seed);
    ExpectGrowingAgainIsGrowingAnew(MakeLineWithTightStart(&random, 60), true);
  }
}

TEST(LineGrowth, EndsWhereThePointsTurnBack) {
  std::vector<WPoint> const points = {{0, 0, .1}, {1, 0, .1}, {2, 0, .1}, {1, .5, .1}, {4, 0, .1}};
  LineTask const task{Fitting::RunOverAll(points), {}, true, kSilent};
  LineGrowth growth(task, kNoOffenders);
  EXPECT_EQ(growth.Grow(5), LineGrowth::End::TurnedBack);
  EXPECT_EQ(growth.Taken(), 3);
}

TEST(LineGrowth, EndsEarlyAtACorner) {
  std::vector<WPoint> const points = {{0, 0, .1}, {1, 0, .1}, {2, 0, .1}, {3, 2, .1}, {4, 4, .1}};
  LineTask const task{Fitting::RunOverAll(points), {}, true, kSilent};
  LineGrowth growth(task, kNoOffenders);
  EXPECT_EQ(growth.Grow(5), LineGrowth::End::Early);
  EXPECT_EQ(growth.Taken(), 3);
}

}  // namespace
}  // namespace Vorn::Testing
