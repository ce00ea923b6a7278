// When a contour counts as closed, as the help of `contour fit` says, told by `contour info`; and
// what a fit makes of the seam.

#include <cmath>
#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

using Points = std::vector<std::pair<double, double>>;

std::string ClosedOf(Points const& points, std::vector<std::string> const& more = {}) {
  std::vector<std::string> words = {"info", "-"};
  words.insert(words.end(), more.begin(), more.end());
  return FactOf(RunInProcess(words, TableOf(points)).out, "closed");
}

/// A square of side 10 with a point at every unit, counter-clockwise from the origin; its last
/// point is `gap` away from the first.
Points Square(double gap) {
  Points points;
  for (int i = 0; i < 10; ++i) points.emplace_back(i, 0);
  for (int i = 0; i < 10; ++i) points.emplace_back(10, i);
  for (int i = 0; i < 10; ++i) points.emplace_back(10 - i, 10);
  for (int i = 0; i < 10; ++i) points.emplace_back(0, 10 - i);
  points.back() = {0, gap};
  return points;
}

TEST(ClosedRule, TheLastPointMayBeTheFirstAgain) {
  Points points = Square(1.0);
  points.emplace_back(0, 0);
  EXPECT_EQ(ClosedOf(points), "yes (the last point is the first): the gap is 0");
}

TEST(ClosedRule, EndsAreNearWithinOneAndAHalfOfTheSpacingBesideThem) {
  EXPECT_EQ(ClosedOf(Square(1.0)), "yes (the ends are as near as neighbours): the gap is 1");
  EXPECT_EQ(ClosedOf(Square(1.49)), "yes (the ends are as near as neighbours): the gap is 1.49");
  EXPECT_EQ(ClosedOf(Square(1.51)),
            "no (the ends are further apart than the points next to them): the gap is 1.51");
}

TEST(ClosedRule, WhatIsSaidGoesFirst) {
  EXPECT_EQ(ClosedOf(Square(1.0), {"--closed", "no"}), "no (as asked for): the gap is 1");
  std::string const yes = ClosedOf(Square(5.0), {"--closed", "yes"});
  EXPECT_TRUE(yes.starts_with("yes (as asked for)")) << yes;
}

TEST(ClosedRule, AThinBodyThatTurnsBackBetweenItsEndsIsOpen) {
  // Out along y = 0 and back along y = 1: between the ends the contour would turn by half a turn.
  Points hairpin;
  for (int i = 0; i <= 20; ++i) hairpin.emplace_back(20 - i, 0);
  hairpin.emplace_back(-0.5, 0.5);
  for (int i = 0; i <= 20; ++i) hairpin.emplace_back(i, 1);
  EXPECT_TRUE(ClosedOf(hairpin).starts_with("no")) << ClosedOf(hairpin);
  EXPECT_TRUE(ClosedOf(hairpin, {"--closed", "yes"}).starts_with("yes"));
}

TEST(ClosedRule, TurnsAtTheSeamOfUpTo135DegreesStayClosed) {
  // A wedge with its seam in the corner: its sides leave it under `angle`, so the contour turns by
  // 180 degrees less the angle there.
  auto const wedge = [](double angle) {
    double const radians = angle * std::numbers::pi / 180.0;
    Points points;
    for (int i = 1; i <= 20; ++i) points.emplace_back(i, 0);
    int const steps = std::max(1, static_cast<int>(20.0 * radians));
    for (int i = 1; i < steps; ++i) {
      double const turn = radians * i / steps;
      points.emplace_back(20 * std::cos(turn), 20 * std::sin(turn));
    }
    for (int i = 20; i >= 1; --i) {
      points.emplace_back(i * std::cos(radians), i * std::sin(radians));
    }
    return points;
  };
  EXPECT_TRUE(ClosedOf(wedge(60.0)).starts_with("yes")) << "turns by 120 degrees";
  EXPECT_TRUE(ClosedOf(wedge(30.0)).starts_with("no")) << "turns by 150 degrees";
}

/// The report of a fit.
nlohmann::json Fitted(Points const& points, std::vector<std::string> const& more) {
  std::vector<std::string> words = {"fit", "-", "-t", "0.01", "--to", "json"};
  words.insert(words.end(), more.begin(), more.end());
  RunResult const run = RunInProcess(words, TableOf(points));
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  return nlohmann::json::parse(run.out);
}

TEST(ClosedRule, AFitIsCutOpenAtTheStartThatIsSaidElseWhereItTurnsMost) {
  EXPECT_EQ(Fitted(Square(1.0), {"--strategy", "mixed", "--start", "13"}).at("seam"), 13);
  // The corner of a drop: two lines that meet under a sharp angle, closed by an arc.
  Points drop;
  for (int i = 10; i >= 0; --i) drop.emplace_back(-i * 1.0, i * 0.5);
  for (int i = 1; i <= 10; ++i) drop.emplace_back(-i * 1.0, -i * 0.5);
  for (int i = 1; i < 10; ++i) {
    double const angle = std::numbers::pi * (1.5 - 0.1 * i);
    drop.emplace_back(-10 + 5 * std::cos(angle), 5 * std::sin(angle));
  }
  EXPECT_EQ(Fitted(drop, {"--strategy", "mixed", "--closed", "yes"}).at("seam"), 10)
      << "the point at the origin";
}

TEST(ClosedRule, AFullCircleBecomesTwoHalfCircles) {
  Points circle;
  for (int i = 0; i < 72; ++i) {
    double const angle = i * std::numbers::pi / 36.0;
    circle.emplace_back(3.0 + 10.0 * std::cos(angle), -2.0 + 10.0 * std::sin(angle));
  }
  for (char const* strategy : {"mixed", "cells", "fewest"}) {
    auto const report = Fitted(circle, {"--strategy", strategy});
    ASSERT_EQ(report.at("elements").size(), 2u) << strategy;
    EXPECT_EQ(report.at("closed"), true);
    double sweep = 0.0;
    for (auto const& element : report.at("elements")) {
      EXPECT_EQ(element.at("kind"), "arc") << strategy;
      EXPECT_NEAR(element.at("radius").get<double>(), 10.0, 0.01) << strategy;
      EXPECT_NEAR(element.at("center").at("x").get<double>(), 3.0, 0.01) << strategy;
      EXPECT_NEAR(element.at("center").at("y").get<double>(), -2.0, 0.01) << strategy;
      sweep += std::fabs(element.at("sweep").get<double>());
    }
    EXPECT_NEAR(sweep, 2.0 * std::numbers::pi, 0.01) << strategy;
  }
}

TEST(ClosedRule, EndsMeetInOnePoint) {
  for (char const* strategy : {"mixed", "fewest"}) {
    auto const report = Fitted(Square(1.0), {"--strategy", strategy});
    auto const& elements = report.at("elements");
    EXPECT_EQ(elements.front().at("start"), elements.back().at("end")) << strategy;
    // Four sides; a short line may join the ends.
    EXPECT_GE(elements.size(), 4u) << strategy;
    EXPECT_LE(elements.size(), 5u) << strategy;
  }
}

}  // namespace
}  // namespace Vorn::Cli::Testing
