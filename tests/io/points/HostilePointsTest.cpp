// Every operation on points takes whatever a program may hand to it: far too many points in one
// place, huge ones, ones that are no numbers. It ends, and what it answers makes sense.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "vorn/io/Closure.h"
#include "vorn/io/Corners.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/LeastSquares.h"
#include "vorn/io/PathFacts.h"
#include "vorn/io/PointsInfo.h"
#include "vorn/io/Spacing.h"
#include "vorn/io/Thinning.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {
namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kHuge = 1e300;
constexpr double kTiny = std::numeric_limits<double>::denorm_min();

struct HostilePoints {
  char const* name;
  std::vector<WPoint> points;
};

void PrintTo(HostilePoints const& hostile, std::ostream* out) { *out << hostile.name; }

std::vector<HostilePoints> const kHostile = {
    {"TwoInOnePlace", {{1, 1, 0.1}, {1, 1, 0.1}}},
    {"ManyInOnePlace", std::vector<WPoint>(1000, {3, -4, 0.1})},
    {"OneNotANumber", {{0, 0, 0.1}, {kNaN, 1, 0.1}, {2, 0, 0.1}}},
    {"AllNotANumber", std::vector<WPoint>(12, {kNaN, kNaN, kNaN})},
    {"InfinitelyFar", {{0, 0, 0.1}, {kInfinity, -kInfinity, 0.1}, {1, 0, 0.1}}},
    {"Huge", {{-kHuge, -kHuge, 1}, {kHuge, kHuge, 1}, {kHuge, -kHuge, 1}, {-kHuge, kHuge, 1}}},
    {"Tiny", {{0, 0, kTiny}, {kTiny, 0, kTiny}, {kTiny, kTiny, kTiny}}},
    {"NegativeTolerances", {{0, 0, -1}, {5, 0, -1}, {5, 5, -1}}},
    {"ToleranceNotANumber", {{0, 0, kNaN}, {5, 0, kNaN}, {5, 5, kNaN}}},
    {"InfiniteTolerances", {{0, 0, kInfinity}, {5, 0, kInfinity}, {5, 5, kInfinity}}},
    {"ThereAndBack", {{0, 0, 0.1}, {9, 0, 0.1}, {0, 0, 0.1}, {9, 0, 0.1}, {0, 0, 0.1}}},
};

class Hostile : public testing::TestWithParam<HostilePoints> {
 protected:
  std::vector<WPoint> const& Points() const { return GetParam().points; }

  PointFile File() const {
    PointFile file;
    file.path = "p";
    file.points = Points();
    for (std::size_t i = 0; i < Points().size(); ++i) file.lines.push_back(i + 1);
    return file;
  }
};

TEST_P(Hostile, EndsAreJudgedAndTheUsersWordCounts) {
  EXPECT_TRUE(FindClosure(Points(), ClosedChoice::Yes).isClosed);
  EXPECT_FALSE(FindClosure(Points(), ClosedChoice::No).isClosed);
  EXPECT_FALSE(FindClosure(Points(), ClosedChoice::Auto).reason.empty());
}

TEST_P(Hostile, CornersAreWithinTheRange) {
  for (double const reach : {0.0, 1.0, kHuge, kNaN, -1.0}) {
    for (bool const isClosed : {false, true}) {
      for (Corner const& corner : FindCorners(Points(), reach, isClosed)) {
        EXPECT_LT(corner.point, Points().size());
        EXPECT_GE(corner.degrees, kLeastCorner);
        EXPECT_LE(corner.degrees, 180.0 + 1e-9);
      }
    }
  }
}

TEST_P(Hostile, DuplicatesPointBackwards) {
  std::vector<Duplicate> const found = FindDuplicates(Points());
  EXPECT_LT(found.size(), Points().size());
  for (Duplicate const& one : found) {
    EXPECT_LT(one.earlier, one.later);
    EXPECT_EQ(Points()[one.earlier].x, Points()[one.later].x);
    EXPECT_EQ(Points()[one.earlier].y, Points()[one.later].y);
  }
}

TEST_P(Hostile, CloseNeighboursAreNeighbours) {
  Closure const closure = FindClosure(Points(), ClosedChoice::Auto);
  for (ClosePair const& pair : FindClosePairs(Points(), closure)) {
    EXPECT_TRUE(pair.second == pair.first + 1 ||
                (pair.second == 0 && pair.first + 1 == Points().size()));
  }
  std::optional<double> const largest = LargestSingleTolerance(Points());
  if (!largest) return;
  EXPECT_GT(*largest, 0.0);
  std::vector<WPoint> same = Points();
  for (WPoint& point : same) point.w = *largest;
  EXPECT_FALSE(FindClosePair(same)) << *largest;
}

TEST_P(Hostile, ThinningKeepsAscendingIndicesThatAreFarEnough) {
  for (TooClose const& rule : {RuleOfTolerances(), RuleOfSpacing(0.5)}) {
    std::vector<std::size_t> kept = KeepSpaced(Points(), rule);
    for (std::size_t i = 1; i < kept.size(); ++i) EXPECT_LT(kept[i - 1], kept[i]);
    EXPECT_EQ(kept.size() + Others(kept, Points().size()).size(), Points().size());
    DropCloseToFirst(Points(), rule, &kept);
    for (std::size_t const index : kept) EXPECT_LT(index, Points().size());
  }
}

TEST_P(Hostile, AnalysisEndsAndItsSuggestionIsPositive) {
  for (ClosedChoice const closed : {ClosedChoice::Auto, ClosedChoice::Yes, ClosedChoice::No}) {
    PointsInfo const info = Analyse(Points(), closed);
    if (info.suggestion.way == Suggestion::Way::None) {
      EXPECT_FALSE(info.suggestion.reason.empty());
    } else if (std::isfinite(info.box.Diagonal())) {
      EXPECT_GT(info.suggestion.tolerance, 0.0);
    }
  }
}

TEST_P(Hostile, LeastSquaresAnswersWithNumbersOrNotAtAll) {
  std::vector<XY> places;
  for (WPoint const& point : Points()) places.push_back({point.x, point.y});
  if (auto const line = FitLine(places)) {
    EXPECT_TRUE(std::isfinite(line->at.x) && std::isfinite(line->at.y));
    EXPECT_TRUE(std::isfinite(line->direction));
    EXPECT_GE(line->scatter.formError, 0.0);
  }
  if (auto const circle = FitCircle(places)) {
    EXPECT_TRUE(std::isfinite(circle->center.x) && std::isfinite(circle->center.y));
    EXPECT_GT(circle->radius, 0.0);
  }
}

TEST_P(Hostile, DeviationsOfPiecesAreNeverNegative) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {5, 0}),
                                     MakeArc({5, 0}, {5, 4}, {5, 2}, 2.0, true)};
  Remeasured const measured = Remeasure(Points(), pieces);
  ASSERT_EQ(measured.points.size(), Points().size());
  EXPECT_LT(measured.worst, Points().size());
  for (PointDeviation const& deviation : measured.points) {
    EXPECT_LT(deviation.piece, pieces.size());
    EXPECT_FALSE(deviation.distance < 0.0);
  }
}

TEST_P(Hostile, AFitGivesPiecesOrARefusalOfTheRightKind) {
  for (ClosedChoice const closed : {ClosedChoice::Auto, ClosedChoice::Yes}) {
    for (std::optional<double> const tolerance : {std::optional<double>(0.01), {}}) {
      FitChoice choice;
      choice.tolerance.same = tolerance;
      choice.closed = closed;
      try {
        EXPECT_FALSE(FitContour(File(), choice, nullptr).pieces.empty());
      } catch (Failure const& failure) {
        EXPECT_NE(failure.Kind(), FailureKind::File) << failure.what();
        EXPECT_NE(failure.Kind(), FailureKind::Internal) << failure.what();
      }
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Points, Hostile, testing::ValuesIn(kHostile),
                         [](auto const& hostile) { return std::string(hostile.param.name); });

TEST(NoPoints, HaveNoCornersNoDuplicatesAndNoClosePair) {
  EXPECT_TRUE(FindCorners({}, 1.0).empty());
  EXPECT_TRUE(FindCorners({}, 1.0, true).empty());
  EXPECT_TRUE(FindDuplicates({}).empty());
  EXPECT_FALSE(FindClosePair({}));
  EXPECT_FALSE(FitLine({}));
  EXPECT_FALSE(FitCircle({}));
  EXPECT_TRUE(KeepSpaced({}, RuleOfSpacing(1.0)).empty());
  EXPECT_TRUE(Others({}, 0).empty());
}

TEST(OnePoint, IsItsOwnPathAndHasNoNeighbours) {
  std::vector<WPoint> const one = {{3, 4, 0.5}};
  EXPECT_FALSE(FindClosePair(one));
  EXPECT_TRUE(FindCorners(one, 1.0, true).empty());
  EXPECT_TRUE(FindDuplicates(one).empty());
  EXPECT_EQ(KeepSpaced(one, RuleOfTolerances()), std::vector<std::size_t>{0});
  EXPECT_EQ(KeepSpaced(one, RuleOfSpacing(1.0)), std::vector<std::size_t>{0});
  EXPECT_EQ(KeepEvery(one, 1.0), std::vector<std::size_t>{0});
  EXPECT_TRUE(FindOutliers(one, 3.0).empty());
  EXPECT_FALSE(FitLine({{3, 4}}));
}

TEST(NoPoints, GetNoTolerances) {
  PointFile file;
  AssignTolerances({.same = {}, .column = {}, .cap = 1.0}, &file, true);
  EXPECT_TRUE(file.points.empty());
}

TEST(NoPoints, AreAnOpenContour) {
  Closure const closure = FindClosure({}, ClosedChoice::Auto);
  EXPECT_FALSE(closure.isClosed);
  EXPECT_FALSE(closure.repeatsFirst);
}

TEST(WithoutLines, KeepsEveryOtherByteWhateverTheLineEnds) {
  EXPECT_EQ(WithoutLines("a\r\nb\nc", {2}), "a\r\nc");
  EXPECT_EQ(WithoutLines("a\nb\n", {1, 2}), "");
  EXPECT_EQ(WithoutLines("a\nb", {}), "a\nb");
  EXPECT_EQ(WithoutLines("", {}), "");
  EXPECT_EQ(WithoutLines("a\nb\n", {7}), "a\nb\n") << "no such line";
}

}  // namespace
}  // namespace Vorn::IO
