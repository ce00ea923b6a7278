#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "cli/RunInProcess.h"
#include "support/SharedData.h"
#include "vorn/io/Spacing.h"

namespace Vorn::Cli {
namespace {

constexpr char const* kSmall = "# units mm\nx,y\n0,0\n4,0\n4,1\n4,1\n0,1\n";

TEST(InfoCommand, TellsTheFactsOnStandardOutput) {
  RunResult const run = RunInProcess({"info", "-"}, kSmall);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_EQ(run.err, "");
  EXPECT_EQ(run.out,
            "standard input, lengths in mm\n"
            "\n"
            "points      5\n"
            "columns     1 (x) and 2 (y)\n"
            "extent      x 0 to 4 (4), y 0 to 1 (1)\n"
            "length      9 from point to point\n"
            "spacing     least 0 between point 2 (line 5) and point 3 (line 6)\n"
            "            median 2.5\n"
            "            most 4 between point 0 (line 3) and point 1 (line 4)\n"
            "duplicates  1\n"
            "            point 3 (line 6) repeats point 2 (line 5)\n"
            "closed      no (the last point is not the first): the gap is 1\n"
            "corners     2 of 30 degrees or more, the sharpest first\n"
            "            point 1 (line 4): 90.0 degrees to the left\n"
            "            point 2 (line 5): 90.0 degrees to the left\n"
            "limit       mixed and cells take no tolerance: neighbours coincide\n"
            "noise       too few points to tell\n"
            "suggestion  --tolerance 0.00041 (a ten-thousandth of the size; too much for mixed and "
            "cells at this spacing)\n");
}

TEST(InfoCommand, ListsThePairsThatBreakTheRule) {
  RunResult const run = RunInProcess({"info", "-", "-t", "0.4"}, kSmall);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_NE(
      run.out.find(
          "tolerance   0.4 (given for all points): 2 of 4 pairs are too close for mixed and cells\n"
          "            point 1 (line 4) and point 2 (line 5): distance 1, needed "
          "more than 1.2\n"
          "            point 2 (line 5) and point 3 (line 6): distance 0, needed "
          "more than 1.2\n"
          "            way out: --strategy fewest, the usual one, takes them all\n"),
      std::string::npos)
      << run.out;
  EXPECT_NE(RunInProcess({"info", "-", "-t", "0.3"}, "0,0\n1,0\n2,0\n")
                .out.find("tolerance   0.3 (given for all points): no pair is too close\n"),
            std::string::npos);
}

TEST(InfoCommand, AnswersWhereNoToleranceCanFollowFromTheSpacing) {
  RunResult const run = RunInProcess({"info", "-", "--tolerance-per-point", "0.5"}, kSmall);
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_EQ(run.err, "");
  EXPECT_NE(run.out.find("tolerance   0 to 0.5 (0.3 of the spacing, at most 0.5): 1 of 4 pairs is "
                         "too close for mixed and cells\n"
                         "            point 2 (line 5) and point 3 (line 6) coincide: no tolerance "
                         "can follow from a spacing of zero\n"),
            std::string::npos)
      << run.out;
  auto const json = nlohmann::json::parse(
      RunInProcess({"info", "-", "--tolerance-per-point", "0.5", "--json"}, kSmall).out);
  EXPECT_EQ(json.at("tolerance").at("smallest"), 0.0);
  EXPECT_EQ(json.at("tolerance").at("tooClose").size(), 1u);
}

TEST(InfoCommand, ATurnAtTheSeamOfAClosedContourIsACorner) {
  std::string const square = "0,0\n2,0\n4,0\n4,2\n4,4\n2,4\n0,4\n0,2\n0,0\n";
  EXPECT_NE(RunInProcess({"info", "-"}, square).out.find("corners     4 of 30 degrees or more"),
            std::string::npos);
  EXPECT_NE(RunInProcess({"info", "-", "--closed", "no"}, square)
                .out.find("corners     3 of 30 degrees or more"),
            std::string::npos);
}

TEST(InfoCommand, CutsLongListsAndCountsTheRest) {
  std::string text;
  for (int i = 0; i < 30; ++i) text += "1,1\n";
  RunResult const run = RunInProcess({"info", "-"}, text);
  EXPECT_NE(run.out.find("duplicates  29\n"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("            and 19 more\n"), std::string::npos) << run.out;
}

TEST(InfoCommand, JsonHoldsTheListsWhole) {
  RunResult const run = RunInProcess({"info", "-", "-t", "0.4", "--json"}, kSmall);
  EXPECT_EQ(run.code, ExitCode::Ok);
  auto const json = nlohmann::json::parse(run.out);
  EXPECT_EQ(json.at("points"), 5);
  EXPECT_EQ(json.at("units"), "mm");
  EXPECT_EQ(json.at("extent").at("x"), nlohmann::json({0.0, 4.0}));
  EXPECT_EQ(json.at("spacing").at("most").at("distance"), 4.0);
  EXPECT_EQ(json.at("spacing").at("least").at("between").at(1),
            nlohmann::json({{"point", 3}, {"line", 6}}));
  EXPECT_EQ(json.at("duplicates").at(0).at("repeats").at("point"), 2);
  EXPECT_EQ(json.at("duplicates").at(0).at("neighbours"), true);
  EXPECT_EQ(json.at("tolerance").at("tooClose").size(), 2u);
  EXPECT_EQ(json.at("corners").size(), 2u);
  EXPECT_TRUE(json.at("noise").is_null());
  EXPECT_TRUE(json.at("largestTolerance").is_null());
  EXPECT_EQ(json.at("suggestion").at("option"), "--tolerance");
  EXPECT_EQ(json.at("suggestion").at("value"), 0.00041);
  EXPECT_EQ(json.at("suggestion").at("strategy"), "fewest");
}

TEST(InfoCommand, RefusesWhatItCannotRead) {
  EXPECT_EQ(RunInProcess({"info", "no/such.csv"}).code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"info", "-"}, "1,2\n").err,
            "contour: standard input: holds one point only; a contour needs two\n");
  EXPECT_EQ(RunInProcess({"info"}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"info", "-", "--columns", "1"}, kSmall).code, ExitCode::Usage);
}

TEST(InfoCommand, ReadsChosenColumns) {
  RunResult const run =
      RunInProcess({"info", "-", "--columns", "b,a", "--json"}, "a;b;c\n1,5;2;x\n3;4;y\n");
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  EXPECT_EQ(nlohmann::json::parse(run.out).at("extent").at("y"), nlohmann::json({1.5, 3.0}));
}

/// The measured contours, with the spacing that their own description states.
struct SharedContour {
  char const* name;
  std::size_t points;
  double least;
  double most;
};

class InfoOfSharedData : public testing::TestWithParam<SharedContour> {};

TEST_P(InfoOfSharedData, AgreesWithTheirDescription) {
  std::optional<std::string> const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  SharedContour const& contour = GetParam();
  std::string const path = *folder + "/" + contour.name + ".csv";
  RunResult const run = RunInProcess({"info", path, "--json"});
  ASSERT_EQ(run.code, ExitCode::Ok) << run.err;
  auto const json = nlohmann::json::parse(run.out);
  EXPECT_EQ(json.at("points"), contour.points);
  double const least = json.at("spacing").at("least").at("distance").get<double>();
  double const most = json.at("spacing").at("most").at("distance").get<double>();
  EXPECT_NEAR(least / contour.least, 1.0, 1e-3);
  EXPECT_NEAR(most / contour.most, 1.0, 1e-3);
  EXPECT_NEAR(json.at("largestTolerance").get<double>() / least, 1.0 / 3.0, 1e-5);
  EXPECT_GT(json.at("noise").get<double>(), 0.0);
  // The suggestion must be one that the spacing rule lets pass, or name the strategy without it.
  auto const& suggestion = json.at("suggestion");
  RunResult const again = RunInProcess(
      {"info", path, "--json", suggestion.at("option"), suggestion.at("value").dump()});
  ASSERT_EQ(again.code, ExitCode::Ok) << again.err;
  bool const hasNoClosePair =
      nlohmann::json::parse(again.out).at("tolerance").at("tooClose").empty();
  EXPECT_EQ(hasNoClosePair, suggestion.at("strategy").is_null());
}

INSTANTIATE_TEST_SUITE_P(InfoCommand, InfoOfSharedData,
                         testing::Values(SharedContour{"rail_head_known_arcs", 801, 0.1, 0.4},
                                         SharedContour{"wheel_worn_a", 645, 0.1142, 0.6357},
                                         SharedContour{"rail_worn_low", 525, 0.08062, 0.9808},
                                         SharedContour{"mirror_sphere_83m", 241, 1, 1},
                                         SharedContour{"hatch_boundary", 1301, 0.00734, 1.769},
                                         SharedContour{"glyph_five", 153, 0.0004887, 212.2},
                                         SharedContour{"test_track_centreline", 7000, 0.001431,
                                                       0.1001},
                                         SharedContour{"gcode_letter_d", 309, 0.0499, 28.67},
                                         SharedContour{"airfoil_clark_y", 121, 0.001367, 0.02142},
                                         SharedContour{"circle_r3", 58, 0.276, 0.3496}),
                         [](auto const& instance) { return std::string(instance.param.name); });

}  // namespace
}  // namespace Vorn::Cli
