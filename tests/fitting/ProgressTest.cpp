#include <cstdint>
#include <limits>

#include "gtest/gtest.h"
#include "support/RandomGeometry.h"
#include "support/ReferenceFitting.h"
#include "support/Transcript.h"

namespace Vorn::Testing {
namespace {

constexpr std::int32_t kIntMax = std::numeric_limits<std::int32_t>::max();

std::vector<std::int32_t> Report(std::int32_t maxPercent, std::int32_t total,
                                 std::int32_t current) {
  ProgressRecorder recorder;
  GeometryUtils::SetProgressState({&recorder, maxPercent, total}, current);
  return recorder.percents;
}

using Percents = std::vector<std::int32_t>;

TEST(SetProgressState, LowersThePercentageByTheShareThatIsLeft) {
  EXPECT_EQ(Report(100, 200, 50), Percents{25});
  EXPECT_EQ(Report(100, 200, 199), Percents{100});  // half a percent is left
  EXPECT_EQ(Report(100, 200, 198), Percents{99});
  EXPECT_EQ(Report(60, 10, 5), Percents{10});
}

TEST(SetProgressState, ReportsTheWholePercentageAtTheEndAndBeyond) {
  EXPECT_EQ(Report(80, 200, 200), Percents{80});
  EXPECT_EQ(Report(80, 200, 201), Percents{80});
  EXPECT_EQ(Report(80, 200, kIntMax), Percents{80});
}

TEST(SetProgressState, TruncatesTowardZero) {
  EXPECT_EQ(Report(100, 3, 2), Percents{67});  // 33.3 becomes 33
  EXPECT_EQ(Report(100, 3, 1), Percents{34});  // 66.6 becomes 66
}

TEST(SetProgressState, NeverReportsZero) {
  EXPECT_EQ(Report(100, 200, 0), Percents{1});
  EXPECT_EQ(Report(25, 200, 150), Percents{1});  // 25 - 25
  EXPECT_EQ(Report(0, 200, 200), Percents{1});
}

TEST(SetProgressState, ReportsNegativePercentagesAsTheyAre) {
  EXPECT_EQ(Report(10, 200, 100), Percents{-40});
  EXPECT_EQ(Report(-5, 200, 200), Percents{-5});
}

TEST(SetProgressState, ReportsNothingWithoutAListenerOrPoints) {
  EXPECT_EQ(Report(100, 0, 0), Percents{});
  EXPECT_EQ(Report(100, -7, 0), Percents{});
  EXPECT_NO_FATAL_FAILURE(GeometryUtils::SetProgressState({nullptr, 100, 200}, 50));
}

TEST(SetProgressState, AgreesWithTheReference) {
  constexpr std::uint64_t kSeed = 5201;
  SCOPED_TRACE(kSeed);
  RandomGeometry random(kSeed);
  for (int i = 0; i < 2000; ++i) {
    std::int32_t const maxPercent = random.Integer(-10, 120);
    std::int32_t const total = random.Integer(-2, 1000);
    std::int32_t const current = random.Integer(-10, 1100);
    ProgressRecorder expected;
    ReferenceFitting::SetProgressState({&expected, maxPercent, total}, current);
    ASSERT_EQ(Report(maxPercent, total, current), expected.percents)
        << maxPercent << ' ' << total << ' ' << current;
  }
}

}  // namespace
}  // namespace Vorn::Testing
