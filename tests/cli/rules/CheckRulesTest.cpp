// What the help of `contour check` promises: distances, signs, the limit, gaps, crossings.

#include <nlohmann/json.hpp>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

class CheckRules : public InFolder {
 protected:
  RunResult Check(std::string const& points, std::string const& contour,
                  std::vector<std::string> const& more = {}) const {
    std::vector<std::string> words = {"check", Write("p.csv", points), Write("c.wkt", contour)};
    words.insert(words.end(), more.begin(), more.end());
    return RunInProcess(words);
  }

  nlohmann::json Report(std::string const& points, std::string const& contour,
                        std::vector<std::string> more = {}) const {
    more.insert(more.end(), {"--json", "-"});
    return nlohmann::json::parse(Check(points, contour, more).out);
  }

  std::vector<double> Deviations(std::string const& points, std::string const& contour) const {
    std::vector<double> deviations;
    nlohmann::json const report = Report(points, contour);
    for (auto const& one : report.at("deviations")) {
      deviations.push_back(one.at("deviation").get<double>());
    }
    return deviations;
  }
};

constexpr char const* kAxis = "LINESTRING (0 0, 3 0)";

TEST_F(CheckRules, LeftOfTheSenseOfTravelIsPositive) {
  std::string const points = "0,0\n1,0.5\n2,-0.25\n";
  EXPECT_EQ(Deviations(points, kAxis), (std::vector<double>{0.0, 0.5, -0.25}));
  EXPECT_EQ(Deviations(points, "LINESTRING (3 0, 0 0)"), (std::vector<double>{0.0, -0.5, 0.25}));
  // Inside a circle that runs counter-clockwise is to its left.
  std::vector<double> const circle = Deviations("0,1\n0,3\n", "CIRCULARSTRING (2 0, 0 2, -2 0)");
  EXPECT_NEAR(circle[0], 1.0, 1e-15);
  EXPECT_NEAR(circle[1], -1.0, 1e-15);
}

TEST_F(CheckRules, PiecesAreClippedAtTheirEnds) {
  EXPECT_EQ(Deviations("7,3\n-3,4\n1,1\n", kAxis), (std::vector<double>{5.0, 5.0, 1.0}));
  // The nearest point of the full circle would be 1 away; of the half above, its end is.
  std::vector<double> const half = Deviations("0,-1\n2,-2\n", "CIRCULARSTRING (2 0, 0 2, -2 0)");
  EXPECT_NEAR(std::fabs(half[0]), std::sqrt(5.0), 1e-14);
  EXPECT_NEAR(std::fabs(half[1]), 2.0, 1e-14);
}

TEST_F(CheckRules, EveryPieceIsMeasuredAndTheNearestCounts) {
  auto const report = Report("0,0\n1,4\n9,4\n5,1\n", "LINESTRING (0 0, 10 0, 10 5, 0 5)");
  std::vector<int> pieces;
  for (auto const& one : report.at("deviations")) pieces.push_back(one.at("piece"));
  EXPECT_EQ(pieces[1], 3);
  EXPECT_EQ(pieces[3], 1);
  EXPECT_EQ(report.at("deviations").at(2).at("deviation"), 1.0);
}

TEST_F(CheckRules, AMillionthAboveOneIsWithin) {
  std::string const points = "0,0\n1,0.5\n";
  auto const code = [&](char const* tolerance) {
    return Check(points, kAxis, {"-t", tolerance}).code;
  };
  EXPECT_EQ(code("0.5"), ExitCode::Ok);
  EXPECT_EQ(code("0.4999996"), ExitCode::Ok) << "0.8 millionths above";
  EXPECT_EQ(code("0.4999994"), ExitCode::OutsideTolerance) << "1.2 millionths above";
}

TEST_F(CheckRules, WithoutAToleranceNoneIsJudged) {
  RunResult const run = Check("0,0\n1,100\n", kAxis);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_EQ(FactOf(run.out, "tolerance"), "none given: deviations are lengths");
  EXPECT_EQ(FactOf(run.out, "result"), "measured");
  EXPECT_EQ(FactOf(run.out, "outside"), "");
}

TEST_F(CheckRules, PointsInOnePlaceHaveNoToleranceBySpacing) {
  RunResult const run = Check("0,0\n0,0\n2,0\n", kAxis, {"--tolerance-per-point", "1"});
  EXPECT_EQ(run.code, ExitCode::PointsTooClose);
  std::string const path = PathOf("p.csv");
  EXPECT_EQ(run.err, "contour: " + path +
                         ": point 0 (line 1) and point 1 (line 2) coincide: no tolerance can "
                         "follow from a spacing of zero\nto leave one of them out: contour "
                         "simplify " +
                         path + " --drop-close\n");
}

TEST_F(CheckRules, TolerancesBySpacingAreThreeTenthsOfIt) {
  auto const report = Report("0,0\n1,0\n3,0\n", kAxis, {"--tolerance-per-point", "0.5"});
  std::vector<double> tolerances;
  for (auto const& one : report.at("deviations")) tolerances.push_back(one.at("tolerance"));
  EXPECT_DOUBLE_EQ(tolerances[0], 0.3);
  EXPECT_DOUBLE_EQ(tolerances[1], 0.3);
  EXPECT_DOUBLE_EQ(tolerances[2], 0.5) << "0.6 would be above the cap";
}

TEST_F(CheckRules, TheWorstComeFirstAndAllInTheirOrder) {
  std::string points;
  for (int i = 0; i < 30; ++i)
    points += std::to_string(0.1 * i) + "," + std::to_string(i % 15) + "\n";
  RunResult const worst = Check(points, kAxis);
  std::size_t const table = worst.out.find("\npoint ");
  ASSERT_NE(table, std::string::npos);
  std::istringstream rows(worst.out.substr(table + 1));
  std::string row;
  std::getline(rows, row);
  std::vector<int> numbers;
  for (int point = 0; rows >> point && std::getline(rows, row);) numbers.push_back(point);
  ASSERT_EQ(numbers.size(), 10u);
  EXPECT_EQ(numbers[0] % 15, 14);
  EXPECT_EQ(numbers[1] % 15, 14);
  EXPECT_EQ(numbers[2] % 15, 13);
  EXPECT_NE(Check(points, kAxis, {"--all"}).out.find("\n   29 "), std::string::npos);
}

TEST_F(CheckRules, GapsAreListedAndNoPieces) {
  // A line from (2, 0) to (2, 4) would be crossed by the last piece.
  std::string const gap = "MULTILINESTRING ((0 0, 2 0), (2 4, 4 4, 4 2, 0 2))";
  auto const report = Report("0,0\n1,0\n", gap);
  EXPECT_EQ(report.at("gaps"),
            nlohmann::json::parse(R"([{"before": 1, "after": 2, "size": 4.0}])"));
  EXPECT_EQ(report.at("crosses"), false);
}

TEST_F(CheckRules, AnOutlineOfTheContourMayBeChosen) {
  std::string const two = "MULTILINESTRING ((0 0, 9 0), (0 5, 9 5))";
  EXPECT_EQ(Report("1,1\n2,1\n", two).at("largest").at("deviation"), 1.0);
  EXPECT_EQ(Report("1,1\n2,1\n", two, {"--outline", "2"}).at("largest").at("deviation"), -4.0);
}

TEST_F(CheckRules, TheFormatOfTheContourIsToldByNameOptionOrContent) {
  std::string const points = Write("p.csv", "0,0\n1,1\n");
  for (char const* name : {"c.wkt", "c", "c.json"}) {
    std::string const contour = Write(name, kAxis);
    RunResult const plain = RunInProcess({"check", points, contour});
    RunResult const said = RunInProcess({"check", points, contour, "--from", "wkt"});
    EXPECT_EQ(said.code, ExitCode::Ok) << said.err;
    EXPECT_EQ(plain.code, name == std::string("c.json") ? ExitCode::File : ExitCode::Ok) << name;
  }
}

TEST_F(CheckRules, BothOutputsMayBeWrittenAtOnce) {
  RunResult const run = Check("0,0\n1,1\n", kAxis,
                              {"-t", "2", "--table", PathOf("t.csv"), "--json", PathOf("r.json")});
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  EXPECT_EQ(
      Contents("t.csv"),
      "point,line,x,y,deviation,piece,tolerance,relative\n0,1,0,0,0,1,2,0\n1,2,1,1,1,1,2,0.5\n");
  EXPECT_EQ(nlohmann::json::parse(Contents("r.json")).at("result"), "within tolerance");
  EXPECT_EQ(FactOf(run.out, "result"), "within tolerance");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
