// What the help of `contour intersect` promises: the kinds, the order, outlines, joints, gaps.

#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

class IntersectRules : public InFolder {
 protected:
  nlohmann::json Found(std::string const& a, std::string const& b,
                       std::vector<std::string> const& more = {}) const {
    std::vector<std::string> words = {"intersect", Write("a.wkt", a)};
    if (!b.empty()) words.push_back(Write("b.wkt", b));
    words.push_back("--json");
    words.insert(words.end(), more.begin(), more.end());
    RunResult const run = RunInProcess(words);
    EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
    return nlohmann::json::parse(run.out).at("intersections");
  }

  /// The kinds in their order, such as "crossing touching".
  std::string Kinds(std::string const& a, std::string const& b) const {
    std::string kinds;
    for (auto const& one : Found(a, b)) {
      kinds += (kinds.empty() ? "" : " ") + one.at("kind").get<std::string>();
    }
    return kinds;
  }
};

constexpr char const* kAxis = "LINESTRING (0 0, 10 0)";

TEST_F(IntersectRules, KindsAreToldBySides) {
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (5 -1, 5 1)"), "crossing");
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (4 -1, 5 0, 6 1)"), "crossing") << "at a corner of B";
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (4 1, 5 0, 6 1)"), "touching") << "B stays on one side";
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (5 0, 5 1)"), "touching") << "B ends there";
  EXPECT_EQ(Kinds(kAxis, "CIRCULARSTRING (3 2, 5 0, 7 2)"), "touching")
      << "they run in one direction there";
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (4 0, 6 0)"), "overlap");
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (10 0, 12 0)"), "touching") << "end at end";
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (0 1, 10 1)"), "");
}

TEST_F(IntersectRules, WhatIsNearerThanABillionthOfTheLargestCoordinateTouches) {
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (5 9.9e-9, 5 5)"), "touching");
  EXPECT_EQ(Kinds(kAxis, "LINESTRING (5 1.1e-8, 5 5)"), "");
}

TEST_F(IntersectRules, OverlapsTellTheirStretchForEachPair) {
  auto const found = Found(kAxis, "LINESTRING (2 1, 2 0, 4 0, 7 0, 7 1)");
  ASSERT_EQ(found.size(), 2u);
  EXPECT_EQ(found.at(0).at("at"), (nlohmann::json{{"x", 2.0}, {"y", 0.0}}));
  EXPECT_EQ(found.at(0).at("until"), (nlohmann::json{{"x", 4.0}, {"y", 0.0}}));
  EXPECT_EQ(found.at(0).at("b").at("piece"), 2);
  EXPECT_EQ(found.at(1).at("until"), (nlohmann::json{{"x", 7.0}, {"y", 0.0}}));
  EXPECT_EQ(found.at(1).at("b").at("piece"), 3);
}

TEST_F(IntersectRules, ArcsOfOneCircleOverlap) {
  // Half circles about the origin that share a quarter.
  auto const found = Found("CIRCULARSTRING (2 0, 0 2, -2 0)", "CIRCULARSTRING (0 2, -2 0, 0 -2)");
  ASSERT_EQ(found.size(), 1u);
  EXPECT_EQ(found.at(0).at("kind"), "overlap");
  EXPECT_NEAR(found.at(0).at("at").at("y").get<double>(), 2.0, 1e-12);
  EXPECT_NEAR(found.at(0).at("until").at("x").get<double>(), -2.0, 1e-12);
}

TEST_F(IntersectRules, PointsAreSortedAlongTheFirstContour) {
  // B comes down at 8, up at 2 and down at 5.
  auto const found = Found(kAxis, "LINESTRING (8 1, 8 -1, 2 -1, 2 1, 5 1, 5 -1)");
  ASSERT_EQ(found.size(), 3u);
  std::vector<double> const expected = {2.0, 5.0, 8.0};
  for (std::size_t i = 0; i < 3; ++i) {
    EXPECT_EQ(found.at(i).at("a").at("position"), expected[i]);
    EXPECT_EQ(found.at(i).at("at").at("x"), expected[i]);
  }
  // Along B: 1 down to the axis; 2 + 6 + 1 up at 2; then 1 + 3 + 1 to the last.
  EXPECT_EQ(found.at(2).at("b").at("position"), 1.0);
  EXPECT_EQ(found.at(0).at("b").at("position"), 9.0);
  EXPECT_EQ(found.at(1).at("b").at("position"), 14.0);
}

TEST_F(IntersectRules, PositionsOnArcsAreLengths) {
  auto const found = Found("CIRCULARSTRING (2 0, 0 2, -2 0)", "LINESTRING (0 0, 0 5)");
  ASSERT_EQ(found.size(), 1u);
  EXPECT_EQ(found.at(0).at("kind"), "crossing");
  EXPECT_EQ(found.at(0).at("a").at("kind"), "arc");
  EXPECT_NEAR(found.at(0).at("a").at("position").get<double>(), std::numbers::pi, 1e-14);
  EXPECT_NEAR(found.at(0).at("b").at("position").get<double>(), 2.0, 1e-14);
}

TEST_F(IntersectRules, JointsOfNeighboursAreNoneOfAContourWithItself) {
  EXPECT_EQ(Kinds("LINESTRING (0 0, 4 0, 4 3, 0 3, 0 0)", ""), "") << "the last meets the first";
  EXPECT_EQ(Kinds("COMPOUNDCURVE ((-2 0, 2 0), CIRCULARSTRING (2 0, 0 2, -2 0))", ""), "");
  EXPECT_EQ(Kinds("LINESTRING (0 0, 4 0, 4 2, 2 2, 2 0)", ""), "touching") << "the end on a side";
  EXPECT_EQ(Kinds("LINESTRING (0 0, 4 0, 1 0)", ""), "overlap") << "straight back";
}

TEST_F(IntersectRules, GapsAreNotBridged) {
  std::string const gap = "MULTILINESTRING ((0 0, 4 0), (6 0, 10 0))";
  EXPECT_EQ(Kinds(gap, "LINESTRING (5 -1, 5 1)"), "");
  EXPECT_EQ(Kinds(gap, "LINESTRING (3 -1, 3 1)"), "crossing");
}

TEST_F(IntersectRules, OutlinesAreTakenTogetherOrOneOfEither) {
  std::string const two = "MULTILINESTRING ((0 0, 10 0), (0 5, 10 5))";
  std::string const other = "MULTILINESTRING ((2 -1, 2 6), (8 -1, 8 6))";
  EXPECT_EQ(Found(two, other).size(), 4u);
  EXPECT_EQ(Found(two, other, {"--outline", "2"}).size(), 2u);
  EXPECT_EQ(Found(two, other, {"--outline-b", "1"}).size(), 2u);
  auto const one = Found(two, other, {"--outline", "2", "--outline-b", "2"});
  ASSERT_EQ(one.size(), 1u);
  EXPECT_EQ(one.at(0).at("at"), (nlohmann::json{{"x", 8.0}, {"y", 5.0}}));
  RunResult const none =
      RunInProcess({"intersect", PathOf("a.wkt"), PathOf("b.wkt"), "--outline-b", "3"});
  EXPECT_EQ(none.code, ExitCode::Usage);
  EXPECT_EQ(none.err,
            "contour: " + PathOf("b.wkt") + ": there is no outline 3, the file has 2 outlines\n");
}

TEST_F(IntersectRules, ExitCodeOneIsOnRequestOnly) {
  std::string const a = Write("a.wkt", kAxis);
  std::string const b = Write("b.wkt", "LINESTRING (5 -1, 5 1)");
  EXPECT_EQ(RunInProcess({"intersect", a, b}).code, ExitCode::Ok);
  EXPECT_EQ(RunInProcess({"intersect", a, b, "--fail-if-any"}).code, ExitCode::OutsideTolerance);
  EXPECT_EQ(RunInProcess({"intersect", a, "--fail-if-any"}).code, ExitCode::Ok);
  RunResult const table = RunInProcess({"intersect", a, b, "-o", PathOf("i.csv"), "--fail-if-any"});
  EXPECT_EQ(table.code, ExitCode::OutsideTolerance);
  EXPECT_NE(table.out.find("1 crossing, 0 touching, 0 overlaps"), std::string::npos);
  EXPECT_EQ(Contents("i.csv"),
            "kind,x,y,to_x,to_y,piece_a,kind_a,position_a,piece_b,kind_b,position_b\n"
            "crossing,5,0,5,0,1,line,5,1,line,1\n");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
