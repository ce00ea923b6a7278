#include <gtest/gtest.h>

#include <cmath>
#include <nlohmann/json.hpp>
#include <sstream>

#include "io/Contours.h"
#include "io/FitChoices.h"
#include "io/fit/Closing.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/FitReport.h"

namespace Vorn::IO {
namespace {

using namespace FitChoices;

/// A rectangle of 30 by 20, a point at every unit, from (12, 0) on; the first is not repeated.
std::vector<WPoint> Rectangle() {
  std::vector<WPoint> points;
  for (int i = 0; i < 100; ++i) {
    int const k = (i + 12) % 100;
    double const x = k < 30 ? k : k < 50 ? 30 : k < 80 ? 80 - k : 0;
    double const y = k < 30 ? 0 : k < 50 ? k - 30 : k < 80 ? 20 : 100 - k;
    points.push_back({x, y, 0.0});
  }
  return points;
}

FitReport FitRectangle(FitChoice const& choice) {
  return FitContour(Contours::FileWith(Rectangle()), choice, nullptr);
}

/// Cut open at the corner (30, 20).
FitChoice FromCorner(double tolerance) {
  FitChoice choice = Same(tolerance);
  choice.start = 38;
  return choice;
}

TEST(FitContour, ClosedRectangleHasFourSidesThatMeetExactly) {
  FitReport const report = FitRectangle(FromCorner(0.01));
  EXPECT_TRUE(report.closure.isClosed);
  EXPECT_EQ(report.pieces.size(), 4u);
  EXPECT_EQ(report.LineCount(), 4u);
  EXPECT_EQ(report.Gap(), 0.0);
  EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
  EXPECT_EQ(report.remeasured.points.size(), 100u);
}

TEST(FitContour, SeamIsTheFirstOfTheSharpestCornersOrTheOneGiven) {
  EXPECT_EQ(FitRectangle(Same(0.01)).seam, 18u) << "(30, 0)";
  FitChoice choice = Same(0.01);
  choice.start = 0;
  FitReport const report = FitRectangle(choice);
  EXPECT_EQ(report.seam, 0u);
  EXPECT_EQ(report.pieces.size(), 5u) << "one side is cut in two";
  EXPECT_EQ(report.Gap(), 0.0);
}

PointFile Cam() {
  std::istringstream nothing;
  return ReadPoints(std::string(CONTOUR_EXAMPLES) + "/cam.csv", nothing,
                    {ToleranceColumn::Use::IfPresent, "w"}, {});
}

TEST(FitContour, SmoothContourIsCutOpenAtAJoint) {
  // The file of the cam begins in the middle of an arc.
  auto const fit = [](std::optional<std::size_t> start) {
    FitChoice choice = Mixed();
    choice.start = start;
    return FitContour(Cam(), choice, nullptr);
  };
  FitReport const found = fit({});
  FitReport const fromFirst = fit(0);
  EXPECT_NE(found.seam, 0u);
  EXPECT_LT(found.pieces.size(), fromFirst.pieces.size());
  for (FitReport const* report : {&found, &fromFirst}) {
    EXPECT_EQ(report->verdict, Verdict::WithinTolerance);
    EXPECT_EQ(report->Gap(), 0.0);
  }
}

/// Keeps what it is told.
class Percents final : public ExecutionState {
 public:
  void SetProgress(std::int32_t percent) override { seen.push_back(percent); }
  std::vector<std::int32_t> seen;
};

TEST(FitContour, ProgressOfTwoAttemptsIsOneBar) {
  FitChoice choice = Mixed();
  Percents percents;
  FitContour(Cam(), choice, &percents);
  ASSERT_FALSE(percents.seen.empty());
  // Within an attempt the library takes back a few percent where a piece ends up shorter.
  for (std::size_t i = 1; i < percents.seen.size(); ++i) {
    EXPECT_GT(percents.seen[i], percents.seen[i - 1] - 10) << i;
  }
  EXPECT_EQ(percents.seen.back(), 100);
}

TEST(FitContour, RangesCountPointsAsTheFileDoes) {
  FitReport const report = FitRectangle(FromCorner(0.01));
  ASSERT_TRUE(report.ranges.has_value());
  std::vector<PointRange> const& ranges = *report.ranges;
  ASSERT_EQ(ranges.size(), 4u);
  EXPECT_EQ(ranges[0].first, 38u);
  EXPECT_EQ(ranges[0].count, 31u) << "both corners of the first side";
  EXPECT_EQ(ranges[1].first, 69u);
  // The corner (0, 0) is point 88; the piece goes on through the end of the file to point 17 or 18.
  EXPECT_NEAR(static_cast<double>(ranges[2].first), 88.5, 0.5);
  EXPECT_EQ((ranges[2].first + ranges[2].count) % 100, ranges[3].first);
  EXPECT_EQ(ranges[3].first + ranges[3].count, 38u) << "the seam belongs to the first piece";
  std::size_t total = 0;
  for (PointRange const& range : ranges) total += range.count;
  EXPECT_EQ(total, 100u);
}

TEST(FitContour, DeviationsNameThePointOfTheFile) {
  std::vector<WPoint> points = Rectangle();
  points[5].y = 0.12;  // (17, 0), further than the tolerance off its side
  FitReport const report = FitContour(Contours::FileWith(points), FromCorner(0.1), nullptr);
  ASSERT_EQ(report.verdict, Verdict::WithinTolerance);
  EXPECT_NEAR(static_cast<double>(report.remeasured.worst), 5.0, 1.0);
  EXPECT_NEAR(static_cast<double>(report.fit.deviationIndex), 5.0, 1.0);
}

TEST(FitContour, SaidToBeOpenIsFittedAsBefore) {
  FitChoice choice = Same(0.01);
  choice.closed = ClosedChoice::No;
  FitReport const report = FitRectangle(choice);
  EXPECT_FALSE(report.closure.isClosed);
  EXPECT_EQ(report.pieces.size(), 5u);
  EXPECT_NEAR(report.Gap(), 1.0, 0.01);
}

TEST(FitContour, CloseClosingPairIsNamedAsTheFileCountsIt) {
  std::vector<WPoint> points = Rectangle();
  points.push_back({11.9, 0.0, 0.0});
  try {
    FitContour(Contours::FileWith(points), Same(0.2), nullptr);
    FAIL() << "0.1 is too close for 0.2";
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::PointsTooClose);
    EXPECT_EQ(std::string(failure.what()),
              "part.csv: point 100 (line 102) and point 0 (line 2) are too close: distance 0.1, "
              "needed more than 0.6 (1.5 times the sum of their tolerances)\n"
              "the largest single tolerance that would pass for this file is 0.0333333");
  }
  EXPECT_EQ(FitContour(Contours::FileWith(points), Same(0.0333333), nullptr).Gap(), 0.0);
}

TEST(FitContour, TolerancePerPointFollowsTheSpacingAcrossTheSeam) {
  std::vector<WPoint> points = Rectangle();
  points.push_back({11.9, 0.0, 0.0});
  FitReport const report = FitContour(Contours::FileWith(points), PerPoint(0.2), nullptr);
  EXPECT_NEAR(report.file.points.front().w, 0.03, 1e-12);
  EXPECT_NEAR(report.file.points.back().w, 0.03, 1e-12);
  EXPECT_EQ(report.Gap(), 0.0);
}

TEST(FitContour, StartMustBeAPointOfAClosedContour) {
  auto const refusal = [](FitChoice const& choice) -> std::string {
    try {
      FitRectangle(choice);
    } catch (Failure const& failure) {
      EXPECT_EQ(failure.Kind(), FailureKind::BadArgument);
      return failure.what();
    }
    return "";
  };
  FitChoice choice = Same(0.01);
  choice.start = 100;
  EXPECT_EQ(refusal(choice), "part.csv: start 100: the points are counted from 0 to 99");
  choice.start = 3;
  choice.closed = ClosedChoice::No;
  EXPECT_EQ(refusal(choice),
            "part.csv: a start is for closed contours, and this one is open (as asked for)");
}

TEST(FitContour, ClosedNeedsThreePoints) {
  FitChoice choice = Same(0.01);
  choice.closed = ClosedChoice::Yes;
  for (std::vector<WPoint> const& points : {std::vector<WPoint>{{0, 0, 0}, {1, 0, 0}},
                                            std::vector<WPoint>{{0, 0, 0}, {1, 0, 0}, {0, 0, 0}}}) {
    EXPECT_THROW(FitContour(Contours::FileWith(points), choice, nullptr), Failure);
  }
  FitReport const report =
      FitContour(Contours::FileWith({{0, 0, 0}, {4, 0, 0}, {0, 3, 0}}), choice, nullptr);
  EXPECT_EQ(report.Gap(), 0.0);
}

TEST(FitContour, ReportsTellOfTheSeamAndTheGap) {
  FitReport const closed = FitRectangle(FromCorner(0.01));
  auto const json = nlohmann::json::parse(ToJson(closed));
  EXPECT_EQ(json.at("closed"), true);
  EXPECT_EQ(json.at("gap"), 0.0);
  EXPECT_EQ(json.at("seam"), 38);

  FitChoice choice = Same(0.01);
  choice.closed = ClosedChoice::No;
  FitReport const open = FitRectangle(choice);
  auto const openJson = nlohmann::json::parse(ToJson(open));
  EXPECT_EQ(openJson.at("closed"), false);
  EXPECT_NEAR(openJson.at("gap").get<double>(), 1.0, 0.01);
  EXPECT_TRUE(openJson.at("seam").is_null());
}

TEST(FitContour, FullCircleIsTwoArcsWithEveryStrategy) {
  std::vector<WPoint> points;
  for (int i = 0; i < 90; ++i) {
    double const angle = i * std::atan(1.0) * 8.0 / 90.0;
    double const radius = 10.0 + (i % 2 == 0 ? 0.004 : -0.004);
    points.push_back({radius * std::cos(angle), radius * std::sin(angle), 0.0});
  }
  for (auto const strategy : {Strategy::Mixed, Strategy::Cells, Strategy::Arc}) {
    FitChoice choice = Same(0.01);
    choice.strategy = strategy;
    FitReport const report = FitContour(Contours::FileWith(points), choice, nullptr);
    EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
    EXPECT_EQ(report.ArcCount(), 2u);
    EXPECT_EQ(report.pieces.size(), 2u);
    EXPECT_EQ(report.Gap(), 0.0);
    EXPECT_NEAR(report.pieces[0].radius, 10.0, 1e-3);
    auto const json = nlohmann::json::parse(ToJson(report));
    EXPECT_TRUE(json.at("deviation").at("reported").at("value").is_null());
  }
}

TEST(FitContour, AGapThatCannotBeClosedIsAVerdictAndInEveryReport) {
  FitReport report = FitRectangle(FromCorner(0.01));
  report.pieces.back().end.x += 0.25;
  report.verdict = Verdict::NotClosed;
  Drawing const drawing = DrawingOf(report);
  std::string const gap = "GAP of 0.25 at point 38 (line 40)";
  EXPECT_NE(ToSvg(drawing).find(gap), std::string::npos);
  EXPECT_NE(ToHtml(drawing).find(gap), std::string::npos);
  EXPECT_NE(ToHtml(drawing).find(Describe(Verdict::NotClosed)), std::string::npos);
  auto const json = nlohmann::json::parse(ToJson(report));
  EXPECT_EQ(json.at("verdict"), "not closed");
  EXPECT_EQ(json.at("gap"), 0.25);
  EXPECT_EQ(json.at("seam"), 38);
}

}  // namespace
}  // namespace Vorn::IO
