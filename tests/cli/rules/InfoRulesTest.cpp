// What the help of `contour info` promises, and what it says of points files: the spacing rule,
// corners, noise, the suggestion; headers, separators, comments, drawings.

#include <array>
#include <cmath>
#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

using Points = std::vector<std::pair<double, double>>;

nlohmann::json Facts(std::string const& text, std::vector<std::string> const& more = {}) {
  std::vector<std::string> words = {"info", "-", "--json"};
  words.insert(words.end(), more.begin(), more.end());
  RunResult const run = RunInProcess(words, text);
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err << text.substr(0, 80);
  return run.code == ExitCode::Ok ? nlohmann::json::parse(run.out) : nlohmann::json::object();
}

/// Two straight runs of 20 points that turn by an angle between them, to the left.
std::string Turn(double degrees) {
  Points points;
  for (int i = 0; i <= 20; ++i) points.emplace_back(i, 0);
  double const angle = degrees * std::numbers::pi / 180.0;
  for (int i = 1; i <= 20; ++i) {
    points.emplace_back(20 + std::cos(angle) * i, std::sin(angle) * i);
  }
  return TableOf(points);
}

TEST(InfoRules, CornersTurnByThirtyDegreesOrMore) {
  EXPECT_EQ(Facts(Turn(29.9)).at("corners").size(), 0u);
  EXPECT_EQ(Facts(Turn(30.1)).at("corners").size(), 1u);
  RunResult const right = RunInProcess({"info", "-"}, Turn(-60.0));
  EXPECT_NE(right.out.find("            point 20 (line 21): 60.0 degrees to the right\n"),
            std::string::npos)
      << right.out;
}

TEST(InfoRules, TheLargestToleranceIsAThirdOfTheLeastSpacing) {
  EXPECT_NEAR(Facts("0,0\n1,0\n2,0\n2.6,0\n4,0\n").at("largestTolerance").get<double>(), 0.2, 2e-6);
  EXPECT_LT(Facts("0,0\n1,0\n2,0\n").at("largestTolerance").get<double>(), 1.0 / 3.0)
      << "the rule wants more, not as much";
  EXPECT_TRUE(Facts("0,0\n1,0\n1,0\n").at("largestTolerance").is_null());
}

TEST(InfoRules, PairsAreListedThatAreNotMoreThanOneAndAHalfOfBothTolerancesApart) {
  auto const pairs = [](char const* tolerance) {
    return Facts("0,0\n1,0\n3,0\n", {"-t", tolerance}).at("tolerance").at("tooClose").size();
  };
  EXPECT_EQ(pairs("0.333"), 0u);
  EXPECT_EQ(pairs("0.334"), 1u);
  EXPECT_EQ(pairs("0.667"), 2u);
  EXPECT_EQ(Facts("x,y,w\n0,0,0.1\n1,0,0.5\n3,0,1\n").at("tolerance").at("tooClose").size(), 1u)
      << "1.5 * 0.6 < 1, but 1.5 * 1.5 > 2";
}

TEST(InfoRules, DuplicatesAreFoundAnywhere) {
  auto const facts = Facts("0,0\n1,0\n2,0\n1,0\n0,0\n");
  EXPECT_EQ(facts.at("duplicates").size(), 2u);
  EXPECT_EQ(facts.at("duplicates").at(0).at("neighbours"), false);
}

/// A long scan along a circle with independent noise of about this standard deviation.
std::string Noisy(double deviation) {
  Points points;
  std::uint32_t state = 12345;
  for (int i = 0; i < 2000; ++i) {
    double sum = 0.0;
    for (int k = 0; k < 12; ++k) {
      state = state * 1664525U + 1013904223U;
      sum += static_cast<double>(state >> 8) / 16777216.0;
    }
    double const radius = 100.0 + deviation * (sum - 6.0);
    double const angle = 0.001 * i;
    points.emplace_back(radius * std::cos(angle), radius * std::sin(angle));
  }
  return TableOf(points);
}

TEST(InfoRules, NoiseIsWhatDiffersFromPointToPoint) {
  for (double const deviation : {0.0005, 0.005}) {
    auto const facts = Facts(Noisy(deviation));
    EXPECT_NEAR(facts.at("noise").get<double>() / deviation, 1.0, 0.15) << deviation;
  }
  // A ripple of a hundred points is shared by neighbours and is none.
  Points ripple;
  for (int i = 0; i < 2000; ++i) {
    ripple.emplace_back(0.1 * i, 0.05 * std::sin(2.0 * std::numbers::pi * i / 100.0));
  }
  EXPECT_LT(Facts(TableOf(ripple)).at("noise").get<double>(), 0.001);
}

TEST(InfoRules, TheSuggestionIsFiveTimesTheNoiseOrATenThousandthOfTheSize) {
  auto const noisy = Facts(Noisy(0.005));
  double const suggested = noisy.at("suggestion").at("value").get<double>();
  EXPECT_NEAR(suggested / (5.0 * noisy.at("noise").get<double>()), 1.0, 0.06);
  // A row of 1000 without noise: a ten-thousandth of it is 0.1.
  std::string row;
  for (int i = 0; i <= 100; ++i) row += std::to_string(10 * i) + ",0\n";
  EXPECT_NEAR(Facts(row).at("suggestion").at("value").get<double>(), 0.1, 1e-12);
  EXPECT_TRUE(Facts(row).at("suggestion").at("strategy").is_null());
}

TEST(InfoRules, ExtentLengthAndSpacingAreMeasured) {
  auto const facts = Facts("0,0\n3,4\n3,5\n-2,5\n");
  EXPECT_EQ(facts.at("points"), 4);
  EXPECT_EQ(facts.at("extent").at("x"), nlohmann::json({-2.0, 3.0}));
  EXPECT_EQ(facts.at("extent").at("y"), nlohmann::json({0.0, 5.0}));
  EXPECT_EQ(facts.at("length"), 11.0);
  EXPECT_EQ(facts.at("spacing").at("least").at("distance"), 1.0);
  EXPECT_EQ(facts.at("spacing").at("most").at("distance"), 5.0);
}

/// A points file and the second point that must be read from it.
struct File {
  std::string text;
  double x;
  double y;
};

TEST(PointsFiles, AreReadAsTheHelpSays) {
  std::vector<File> const files = {
      {"0,0\n1.5,2\n", 1.5, 2},
      {"x,y\n0,0\n1.5,2\n", 1.5, 2},
      {"y,x\n0,0\n1.5,2\n", 2, 1.5},
      {"X [mm];Z [mm]\n0;0\n1,5;2,25\n", 1.5, 2.25},
      {"n\ty\tz\n1\t0\t0\n2\t1.5\t2\n", 1.5, 2},
      {"0 0\n1.5   2\n", 1.5, 2},
      {"0;0\n1.5;2\n", 1.5, 2},
      {"0;0\n1,5;2\n", 1.5, 2},
      {"0\t0\n1,5\t2\n", 1.5, 2},
      {"# x y\n0 0 # first\n1.5 2 // last\n", 1.5, 2},
      {"Profile of a rail\nmeasured today\nx,y\n0,0\n1.5,2\n", 1.5, 2},
      {"\"x\",\"y\"\n\"0\",\"0\"\n\"1.5\",\"2\"\n", 1.5, 2},
      {"x,y\r\n0,0\r\n1.5,2\r\n", 1.5, 2},
      {"\xEF\xBB\xBFx,y\n0,0\n1.5,2\n", 1.5, 2},
      {"0,0\n\n\n1.5,2", 1.5, 2},
      {"0,0\n+1.5e0,.2E+1\n", 1.5, 2},
  };
  for (File const& file : files) {
    auto const facts = Facts(file.text);
    ASSERT_TRUE(facts.contains("extent")) << file.text;
    EXPECT_EQ(facts.at("points"), 2) << file.text;
    EXPECT_EQ(facts.at("extent").at("x"), nlohmann::json({0.0, file.x})) << file.text;
    EXPECT_EQ(facts.at("extent").at("y"), nlohmann::json({0.0, file.y})) << file.text;
  }
}

TEST(PointsFiles, ColumnsAreChosenByNameOrNumber) {
  std::string const text = "id,east,north,w\n1,0,0,0.5\n2,3,4,0.5\n";
  for (std::string const columns : {"east,north", "2,3", "EAST,3", "2,north"}) {
    auto const facts = Facts(text, {"--columns", columns});
    EXPECT_EQ(facts.at("length"), 5.0) << columns;
  }
  EXPECT_EQ(Facts(text, {"--columns", "3,2"}).at("extent").at("x"), nlohmann::json({0.0, 4.0}));
  auto const weighted = Facts("a,b,c\n0,0,0.1\n3,4,0.2\n", {"--columns", "1,2,3"});
  EXPECT_EQ(weighted.at("tolerance").at("largest"), 0.2);
  for (std::string const bad : {"east,south", "2,9"}) {
    EXPECT_EQ(RunInProcess({"info", "-", "--columns", bad}, text).code, ExitCode::File) << bad;
  }
}

TEST(PointsFiles, UnitsAndTolerancesStandInComments) {
  auto const facts = Facts("# units inch\n# tolerance 0.25\n0,0\n3,4\n");
  EXPECT_EQ(facts.at("units"), "inch");
  EXPECT_EQ(facts.at("tolerance").at("smallest"), 0.25);
  EXPECT_EQ(Facts("# units inch\n0,0\n3,4\n", {"--units", "mm"}).at("units"), "mm");
  EXPECT_EQ(Facts("# tolerance 0.25\n0,0\n3,4\n", {"-t", "0.5"}).at("tolerance").at("smallest"),
            0.5);
  EXPECT_EQ(Facts("# tolerance 9\nx,y,w\n0,0,0.5\n3,4,1\n").at("tolerance").at("largest"), 1.0)
      << "the column counts before the comment";
}

TEST(PointsFiles, MayBeDrawings) {
  EXPECT_EQ(Facts("LINESTRING (0 0, 3 4, 3 5)").at("points"), 3);
  EXPECT_EQ(Facts("G21\nG0 X0 Y0\nG1 X3 Y4\nG1 X3 Y5\n", {"--points-from", "gcode"}).at("points"),
            3);
  EXPECT_EQ(
      Facts(R"({"type": "LineString", "coordinates": [[0, 0], [3, 4], [3, 5]]})").at("length"),
      6.0);
  std::string const arc = "CIRCULARSTRING (5 0, 0 5, -5 0)";
  RunResult const refused = RunInProcess({"info", "-"}, arc);
  EXPECT_EQ(refused.code, ExitCode::File) << refused.err;
  auto const chords = Facts(arc, {"--flatten", "0.01"});
  EXPECT_GT(chords.at("points").get<int>(), 20);
  EXPECT_NEAR(chords.at("length").get<double>(), 5.0 * std::numbers::pi, 0.05);
}

TEST(PointsFiles, OfSeveralOutlinesOneIsChosen) {
  std::string const two = "MULTILINESTRING ((0 0, 3 4), (10 0, 16 8, 16 9))";
  RunResult const all = RunInProcess({"info", "-"}, two);
  EXPECT_EQ(all.code, ExitCode::Usage);
  EXPECT_EQ(all.err, "contour: standard input: holds 2 outlines: --outline N takes one of them\n");
  EXPECT_EQ(Facts(two, {"--outline", "1"}).at("length"), 5.0);
  EXPECT_EQ(Facts(two, {"--outline", "2"}).at("length"), 11.0);
  RunResult const none = RunInProcess({"info", "-", "--outline", "3"}, two);
  EXPECT_EQ(none.code, ExitCode::Usage);
  EXPECT_EQ(none.err, "contour: standard input: there is no outline 3, the file has 2 outlines\n");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
