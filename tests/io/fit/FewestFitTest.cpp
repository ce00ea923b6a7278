#include <gtest/gtest.h>

#include <cmath>
#include <nlohmann/json.hpp>
#include <numbers>

#include "io/Contours.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitContour.h"

namespace Vorn::IO {
namespace {

FitChoice Fewest(double tolerance) {
  FitChoice choice;
  choice.tolerance.same = tolerance;
  choice.strategy = Strategy::Fewest;
  return choice;
}

FitReport FitPoints(std::vector<WPoint> points, FitChoice const& choice) {
  return FitContour(Contours::FileWith(std::move(points)), choice, nullptr);
}

/// A rectangle of 30 by 20, a point at every `step`, from the middle of a side on.
std::vector<WPoint> Rectangle(double step = 1.0) {
  std::vector<WPoint> points;
  auto const count = static_cast<int>(std::lround(100.0 / step));
  for (int i = 0; i < count; ++i) {
    double const k = std::fmod(12.0 + i * step, 100.0);
    double const x = k < 30 ? k : k < 50 ? 30 : k < 80 ? 80 - k : 0;
    double const y = k < 30 ? 0 : k < 50 ? k - 30 : k < 80 ? 20 : 100 - k;
    points.push_back({x, y, 0.0});
  }
  return points;
}

/// A quarter circle of radius 10, a point at every degree.
std::vector<WPoint> Quarter() {
  std::vector<WPoint> points;
  for (int i = 0; i <= 90; ++i) {
    double const angle = i / 180.0 * std::numbers::pi;
    points.push_back({10.0 * std::cos(angle), 10.0 * std::sin(angle), 0.0});
  }
  return points;
}

/// How often the ranges cover each point.
std::vector<int> Covered(FitReport const& report) {
  std::vector<int> covered(report.file.points.size());
  for (PointRange const& range : report.ranges.value()) {
    for (std::size_t k = 0; k < range.count; ++k) ++covered[(range.first + k) % covered.size()];
  }
  return covered;
}

void ExpectNoFit(std::vector<WPoint> points, FitChoice const& choice, FailureKind kind,
                 std::string const& message) {
  try {
    FitPoints(std::move(points), choice);
    FAIL() << message;
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), kind);
    EXPECT_EQ(std::string(failure.what()), "part.csv: " + message);
  }
}

TEST(FitFewest, OpenContourComesWithProofAndRanges) {
  FitReport const report = FitPoints(Quarter(), Fewest(0.001));
  EXPECT_EQ(report.strategy, Strategy::Fewest);
  ASSERT_EQ(report.pieces.size(), 1u);
  EXPECT_TRUE(report.pieces[0].IsArc());
  EXPECT_NEAR(report.pieces[0].radius, 10.0, 0.001);
  EXPECT_EQ(report.fit.fewestPossible, 1u);
  EXPECT_TRUE(report.IsFewest());
  EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
  EXPECT_EQ(Covered(report), std::vector<int>(91, 1));
}

TEST(FitFewest, ClosedContourMeetsItselfExactlyWhereverTheFileBegins) {
  FitReport const report = FitPoints(Rectangle(), Fewest(0.01));
  EXPECT_TRUE(report.closure.isClosed);
  EXPECT_EQ(report.pieces.size(), 4u) << "the file begins in the middle of a side";
  EXPECT_EQ(report.LineCount(), 4u);
  EXPECT_EQ(report.Gap(), 0.0);
  EXPECT_EQ(report.seam, report.ranges->front().first);
  EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
  EXPECT_EQ(Covered(report), std::vector<int>(100, 1));
}

TEST(FitFewest, FullCircleComesAsTwoArcs) {
  std::vector<WPoint> points;
  for (int i = 0; i <= 72; ++i) {
    double const angle = i % 72 / 36.0 * std::numbers::pi;
    points.push_back({5.0 + 3.0 * std::cos(angle), 3.0 * std::sin(angle), 0.0});
  }
  FitReport const report = FitPoints(points, Fewest(0.001));
  ASSERT_EQ(report.pieces.size(), 2u);
  EXPECT_EQ(report.ArcCount(), 2u);
  EXPECT_EQ(report.Gap(), 0.0);
  EXPECT_EQ(report.pieces[0].radius, report.pieces[1].radius);
  EXPECT_NEAR(report.pieces[0].radius, 3.0, 1e-12);
  EXPECT_NEAR(report.pieces[0].sweep + report.pieces[1].sweep, 2.0 * std::numbers::pi, 1e-12);
  EXPECT_TRUE(report.IsFewest()) << "no closed contour has one piece";
  EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
}

TEST(FitFewest, FullCircleKeepsTheOptions) {
  std::vector<WPoint> points;
  for (int i = 0; i <= 72; ++i) {
    double const angle = i % 72 / 36.0 * std::numbers::pi;
    points.push_back({3.0 * std::cos(angle), 3.0 * std::sin(angle), 0.0});
  }
  FitChoice flat = Fewest(0.01);
  flat.fewest.largestRadius = 2.0;
  FitReport const report = FitPoints(points, flat);
  EXPECT_FALSE(report.isFullCircle);
  EXPECT_GT(report.pieces.size(), 2u);
  for (Piece const& piece : report.pieces) {
    double const radius = piece.IsArc() ? piece.radius : 0.0;
    EXPECT_LE(radius, 2.0 * (1.0 + 1e-9)) << "the circle has 3";
  }
  EXPECT_EQ(report.Gap(), 0.0);
  EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
}

TEST(FitFewest, PointsMayBeCloserThanTheirTolerances) {
  std::vector<WPoint> const points = Rectangle(0.01);
  FitReport const report = FitPoints(points, Fewest(0.05));
  EXPECT_EQ(report.pieces.size(), 4u);
  EXPECT_EQ(report.verdict, Verdict::WithinTolerance);
  FitChoice mixed = Fewest(0.05);
  mixed.strategy = Strategy::Mixed;
  EXPECT_THROW(FitPoints(points, mixed), Failure);
}

TEST(FitFewest, TakesTheOptionsOfTheService) {
  FitChoice flat = Fewest(0.1);
  flat.fewest.largestRadius = 5.0;
  FitReport const lines = FitPoints(Quarter(), flat);
  EXPECT_EQ(lines.ArcCount(), 0u) << "an arc of radius 10 comes as segments";
  EXPECT_GT(lines.LineCount(), 2u);

  FitChoice narrow = Fewest(0.001);
  narrow.fewest.largestStep = 0.5 / 180.0 * std::numbers::pi;
  EXPECT_GT(FitPoints(Quarter(), narrow).pieces.size(), 1u) << "neighbours are a degree apart";
}

TEST(FitFewest, SaysWhyThereIsNone) {
  ExpectNoFit({{0, 0, 0}, {0.01, 0, 0}, {0, 0.01, 0}}, Fewest(0.1), FailureKind::NoFit,
              "no fit: all points coincide within their tolerances");
  FitChoice wrong = Fewest(0.1);
  wrong.fewest.smallestRadius = -1.0;
  ExpectNoFit(Quarter(), wrong, FailureKind::NoFit,
              "no fit: the points, their tolerances or the options are not what the fewest pieces "
              "can take");
}

TEST(FitFewest, TakesNoStart) {
  FitChoice choice = Fewest(0.01);
  choice.start = 3;
  ExpectNoFit(
      Rectangle(), choice, FailureKind::BadArgument,
      "a start is not for the fewest pieces, which find the seam themselves: the strategy mixed "
      "takes one");
}

TEST(FitFewest, ReportsTellTheBound) {
  FitReport report = FitPoints(Rectangle(), Fewest(0.01));
  report.fit.fewestPossible = 3;
  auto const json = nlohmann::json::parse(ToJson(report));
  EXPECT_EQ(json.at("strategy"), "fewest");
  EXPECT_EQ(json.at("counts").at("elements"), 4);
  EXPECT_EQ(json.at("counts").at("fewestPossible"), 3);
  EXPECT_EQ(json.at("counts").at("isFewest"), false);
  EXPECT_EQ(json.at("elements").at(0).at("points").at("first"), report.seam);
  std::vector<std::string> const facts = DrawingOf(report).facts;
  EXPECT_NE(std::find(facts.begin(), facts.end(), "4 pieces, 3 at least"), facts.end());

  report.fit.fewestPossible = 4;
  EXPECT_EQ(nlohmann::json::parse(ToJson(report)).at("counts").at("isFewest"), true);
  std::vector<std::string> const proven = DrawingOf(report).facts;
  EXPECT_NE(std::find(proven.begin(), proven.end(), "4 pieces, proven the fewest"), proven.end());
}

TEST(FitFewest, OtherStrategiesProveNothing) {
  FitReport const report = Contours::LineAndArcReport();
  EXPECT_FALSE(report.IsFewest());
  auto const counts = nlohmann::json::parse(ToJson(report)).at("counts");
  EXPECT_TRUE(counts.at("fewestPossible").is_null());
  EXPECT_EQ(counts.at("isFewest"), false);
}

}  // namespace
}  // namespace Vorn::IO
