// What the help of `contour fit` promises about tolerances, strategies, limits and measurements.
// The expected numbers follow from the geometry of the points, which are made here.

#include <cmath>
#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

using nlohmann::json;
using Points = std::vector<std::pair<double, double>>;
using Words = std::vector<std::string>;

RunResult Fit(std::string const& text, Words const& more) {
  Words words = {"fit", "-"};
  words.insert(words.end(), more.begin(), more.end());
  return RunInProcess(words, text);
}

json Report(std::string const& text, Words more) {
  more.insert(more.end(), {"--to", "json"});
  RunResult const run = Fit(text, more);
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  return json::parse(run.out);
}

/// A quarter of a circle of radius 20 about the origin and a line that leaves it smoothly.
Points QuarterAndLine() {
  Points points;
  for (int i = 0; i <= 30; ++i) {
    double const angle = i * std::numbers::pi / 60.0;
    points.emplace_back(20 * std::cos(angle), 20 * std::sin(angle));
  }
  for (int i = 1; i <= 20; ++i) points.emplace_back(-i, 20);
  return points;
}

TEST(FitRules, NeighboursAreMoreThanOneAndAHalfOfBothTolerancesApart) {
  std::string const row = "0,0\n1,0\n2,0\n3,0\n";
  for (char const* strategy : {"mixed", "cells"}) {
    EXPECT_EQ(Fit(row, {"-t", "0.333", "--strategy", strategy}).code, ExitCode::Ok) << strategy;
    EXPECT_EQ(Fit(row, {"-t", "0.334", "--strategy", strategy}).code, ExitCode::PointsTooClose)
        << strategy;
  }
  EXPECT_EQ(Fit(row, {"-t", "0.9", "--strategy", "fewest"}).code, ExitCode::Ok);
  EXPECT_EQ(Fit(row, {"-t", "0.9"}).code, ExitCode::Ok) << "the usual strategy is fewest";
  EXPECT_NE(
      Fit(row, {"-t", "0.334", "--strategy", "mixed"}).err.find("ways out: --strategy fewest"),
      std::string::npos);
}

TEST(FitRules, TolerancesBySpacingAreThreeTenthsOfTheNearerDistance) {
  auto const tolerance = [](char const* cap) {
    return Report("0,0\n1,0\n3,0\n3,5\n", {"--tolerance-per-point", cap})
        .at("input")
        .at("tolerance");
  };
  EXPECT_DOUBLE_EQ(tolerance("9").at("smallest").get<double>(), 0.3);
  EXPECT_DOUBLE_EQ(tolerance("9").at("largest").get<double>(), 1.5) << "0.3 of 5";
  EXPECT_DOUBLE_EQ(tolerance("0.4").at("largest").get<double>(), 0.4);
  EXPECT_DOUBLE_EQ(tolerance("0.1").at("smallest").get<double>(), 0.1);
}

TEST(FitRules, WithoutAnyToleranceNothingIsFitted) {
  RunResult const run = Fit("0,0\n1,0\n", {});
  EXPECT_EQ(run.code, ExitCode::Usage);
  EXPECT_EQ(run.err,
            "contour: no tolerance: standard input has no column 'w' and no comment '# tolerance "
            "T'; give --tolerance T, --tolerance-column NAME or --tolerance-per-point CAP\n");
}

TEST(FitRules, LinesAndArcsAreFound) {
  for (char const* strategy : {"mixed", "fewest"}) {
    auto const report = Report(TableOf(QuarterAndLine()), {"-t", "0.001", "--strategy", strategy});
    ASSERT_EQ(report.at("elements").size(), 2u) << strategy;
    auto const& arc = report.at("elements").at(0);
    EXPECT_EQ(arc.at("kind"), "arc") << strategy;
    EXPECT_EQ(arc.at("direction"), "ccw") << strategy;
    EXPECT_NEAR(arc.at("radius").get<double>(), 20.0, 0.02) << strategy;
    EXPECT_EQ(report.at("elements").at(1).at("kind"), "line") << strategy;
    EXPECT_EQ(arc.at("end"), report.at("elements").at(1).at("start")) << strategy;
  }
}

TEST(FitRules, LeastSquaresTellWhatThePointsSay) {
  auto const elements = Report(TableOf(QuarterAndLine()), {"-t", "0.001"}).at("elements");
  EXPECT_NEAR(elements.at(0).at("leastSquares").at("radius").get<double>(), 20.0, 1e-9);
  EXPECT_NEAR(elements.at(0).at("leastSquares").at("formError").get<double>(), 0.0, 1e-9);
  EXPECT_NEAR(std::fabs(elements.at(1).at("leastSquares").at("direction").get<double>()),
              std::numbers::pi, 1e-9)
      << "to the left";
  EXPECT_NEAR(elements.at(0).at("turn").get<double>(), 0.0, 0.002) << "the line goes on smoothly";
}

TEST(FitRules, AlternatingPointsHaveTheirFormErrorAndDeviation) {
  // 0.02 above and below a line in turn: from one side to the other 0.04.
  Points points;
  for (int i = 0; i < 40; ++i) points.emplace_back(i, i % 2 == 0 ? 0.02 : -0.02);
  auto const element =
      Report(TableOf(points), {"-t", "0.1", "--strategy", "fewest"}).at("elements").at(0);
  auto const& measured = element.at("leastSquares");
  EXPECT_EQ(measured.at("points"), 40);
  EXPECT_NEAR(measured.at("formError").get<double>(), 0.04, 0.004);
  EXPECT_NEAR(measured.at("standardDeviation").get<double>(), 0.02, 0.001);
}

TEST(FitRules, DeviationsCountInTolerancesOfThePoints) {
  // One point stands 0.05 off a long line; its tolerance is ten times that of the others.
  std::string text = "x,y,w\n";
  for (int i = 0; i <= 20; ++i) {
    text += std::to_string(i) + (i == 10 ? ",0.05,0.1\n" : ",0,0.01\n");
  }
  auto const report = Report(text, {"--strategy", "fewest"});
  EXPECT_EQ(report.at("counts").at("elements"), 1);
  EXPECT_LE(report.at("deviation").at("largest").at("value").get<double>(), 1.0 + 1e-6);
  EXPECT_GE(report.at("deviation").at("largest").at("value").get<double>(), 0.3);
}

TEST(FitRules, RadiiStayWithinTheirLimits) {
  std::string const text = TableOf(QuarterAndLine());
  auto const radii = [&](Words more) {
    more.insert(more.end(), {"-t", "0.05", "--strategy", "fewest"});
    std::vector<double> found;
    auto const report = Report(text, more);
    for (auto const& element : report.at("elements")) {
      if (element.at("kind") == "arc") found.push_back(element.at("radius").get<double>());
    }
    return found;
  };
  EXPECT_EQ(radii({}).size(), 1u);
  for (double const radius : radii({"--max-radius", "15"})) EXPECT_LE(radius, 15.0);
  for (double const radius : radii({"--min-radius", "20.5"})) EXPECT_GE(radius, 20.5);
}

TEST(FitRules, ArcsTurnByNoMoreThanTheLargestStepBetweenNeighbours) {
  // Six points on a circle, 60 degrees apart.
  Points hexagon;
  for (int i = 0; i < 6; ++i) {
    double const angle = i * std::numbers::pi / 3.0;
    hexagon.emplace_back(10 * std::cos(angle), 10 * std::sin(angle));
  }
  auto const radii = [&](char const* step) {
    std::vector<double> found;
    auto const report = Report(TableOf(hexagon), {"-t", "0.001", "--strategy", "fewest", "--closed",
                                                  "no", "--largest-step", step});
    for (auto const& element : report.at("elements")) {
      if (element.at("kind") == "arc") found.push_back(element.at("radius").get<double>());
    }
    return found;
  };
  std::vector<double> const wide = radii("70");
  ASSERT_EQ(wide.size(), 1u) << "all six points on one arc";
  EXPECT_NEAR(wide[0], 10.0, 0.01);
  // Neighbours are 10 apart; an arc that turns by 50 degrees between them has a radius of 11.8.
  for (double const radius : radii("50")) {
    EXPECT_GE(radius, 5.0 / std::sin(25.0 * std::numbers::pi / 180.0) - 0.01);
  }
}

TEST(FitRules, NoPieceLeavesTheStraightPathByMoreThanIsAllowed) {
  // Between neighbours of the quarter an arc bulges by 20 * (1 - cos 1.5 degrees) = 0.00685.
  std::string const text = TableOf(QuarterAndLine());
  auto const radii = [&](char const* between) {
    std::vector<double> found;
    auto const report =
        Report(text, {"-t", "0.0001", "--strategy", "fewest", "--between", between});
    for (auto const& element : report.at("elements")) {
      if (element.at("kind") == "arc") found.push_back(element.at("radius").get<double>());
    }
    return found;
  };
  ASSERT_EQ(radii("0.008").size(), 1u);
  EXPECT_NEAR(radii("0.008")[0], 20.0, 0.01);
  // Over a chord c an arc of radius r bulges by about c * c / (8 r).
  double const chord = 40.0 * std::sin(std::numbers::pi / 120.0);
  for (double const radius : radii("0.005")) {
    EXPECT_LE(chord * chord / (8.0 * radius), 0.005 + 2.0 * 0.0001);
  }
}

TEST(FitRules, TheFewestPiecesComeWithTheirBound) {
  RunResult const run = Fit(TableOf(QuarterAndLine()), {"-t", "0.001", "--strategy", "fewest"});
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  auto const report = Report(TableOf(QuarterAndLine()), {"-t", "0.001", "--strategy", "fewest"});
  EXPECT_EQ(report.at("counts").at("fewestPossible"), 2);
  EXPECT_EQ(report.at("counts").at("isFewest"), true);
}

TEST(FitRules, FieldsStandInTheirOrder) {
  auto const report = Report(
      "0,0\n1,0\n", {"-t", "0.1", "--field", "z=1", "--field", "a=2=3", "--field", "empty="});
  EXPECT_EQ(report.at("fields").size(), 3u);
  RunResult const run =
      Fit("0,0\n1,0\n", {"-t", "0.1", "--field", "z=1", "--field", "a=2=3", "--field", "empty="});
  EXPECT_LT(run.out.find("\nz           1\n"), run.out.find("\na           2=3\n")) << run.out;
}

TEST(FitRules, DigitsAreThoseOfTheTable) {
  auto const row = [](char const* digits) {
    std::string const out =
        Fit("0,0\n1,3\n", {"-t", "0.1", "--strategy", "mixed", "--digits", digits}).out;
    std::size_t const at = out.find("\n 1  line");
    return out.substr(at + 1, out.find('\n', at + 1) - at - 1);
  };
  EXPECT_NE(row("0").find("  3       2"), std::string::npos) << row("0");
  EXPECT_NE(row("5").find("  3.16228       2"), std::string::npos) << row("5");
  EXPECT_NE(row("15").find("  3.162277660168380       2"), std::string::npos) << row("15");
}

TEST(FitRules, ContoursThatStopEarlyAreWrittenWithCodeFive) {
  // Points in one place behind a line: the spacing rule cannot be met, and nothing is written.
  RunResult const close = Fit("0,0\n1,0\n1,0\n", {"-t", "0.1", "--strategy", "mixed"});
  EXPECT_EQ(close.code, ExitCode::PointsTooClose);
  EXPECT_EQ(close.out, "");
  RunResult const none = Fit("0,0\n3,4\n", {"-t", "0.1", "--strategy", "arc"});
  EXPECT_EQ(none.code, ExitCode::NoFit);
  EXPECT_EQ(none.out, "");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
