#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/RunInProcess.h"
#include "support/SharedData.h"

namespace Vorn::Cli {
namespace {

TEST(AreaCommand, TellsTheMeasures) {
  RunResult const run =
      RunInProcess({"area", "-", "--units", "mm"}, "LINESTRING (0 0, 4 0, 4 3, 0 3, 0 0)");
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  EXPECT_EQ(run.err, "");
  EXPECT_EQ(run.out,
            "standard input: 4 pieces, 4 lines, 0 arcs, lengths in mm\n"
            "area        12\n"
            "signed      12, positive counter-clockwise with y up\n"
            "sense       counter-clockwise\n"
            "perimeter   14\n"
            "centroid    (2, 1.5)\n"
            "box         (0, 0) to (4, 3)\n"
            "crossing    the contour does not cross itself\n");
}

TEST(AreaCommand, WritesEveryDigitAsJson) {
  RunResult const run =
      RunInProcess({"area", "-", "--json"}, "CIRCULARSTRING (3 0, 0 -3, -3 0, 0 3, 3 0)");
  ASSERT_EQ(run.code, ExitCode::Ok) << run.err;
  auto const json = nlohmann::json::parse(run.out);
  EXPECT_EQ(json.at("schemaVersion"), 1);
  ASSERT_EQ(json.at("contours").size(), 1u);
  auto const& area = json.at("contours").at(0);
  EXPECT_NEAR(area.at("area").get<double>(), 9.0 * std::numbers::pi, 1e-12);
  EXPECT_NEAR(area.at("signedArea").get<double>(), -9.0 * std::numbers::pi, 1e-12);
  EXPECT_EQ(area.at("sense"), "clockwise");
  EXPECT_EQ(area.at("crossesItself"), false);
  EXPECT_NEAR(area.at("centroid").at("x").get<double>(), 0.0, 1e-14);
  EXPECT_EQ(area.at("gaps").size(), 0u);
}

TEST(AreaCommand, RefusesOpenContoursUnlessTheyAreToBeClosed) {
  char const* const open = "LINESTRING (0 0, 4 0, 4 3)";
  RunResult const refused = RunInProcess({"area", "-"}, open);
  EXPECT_EQ(refused.code, ExitCode::Usage);
  EXPECT_EQ(refused.out, "");
  EXPECT_EQ(refused.err,
            "contour: standard input: the contour is open, its ends are 5 apart; --close measures "
            "it with a line between them\n");
  RunResult const closed = RunInProcess({"area", "-", "--close"}, open);
  EXPECT_EQ(closed.code, ExitCode::Ok);
  EXPECT_NE(closed.out.find("area        6\n"), std::string::npos) << closed.out;
  EXPECT_NE(closed.out.find("perimeter   12\n"), std::string::npos) << closed.out;
}

TEST(AreaCommand, SaysWhenTheContourCrossesItself) {
  RunResult const run = RunInProcess({"area", "-"}, "LINESTRING (-4 -2, 2 1, 2 -1, -4 2, -4 -2)");
  EXPECT_EQ(run.code, ExitCode::Ok);
  EXPECT_NE(run.out.find("area        6\n"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("centroid    none\n"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("crossing    THE CONTOUR CROSSES ITSELF: the area is the sum "
                         "of its loops, each with its sign\n"),
            std::string::npos)
      << run.out;
}

TEST(AreaCommand, TakesPointsAsAPolygon) {
  RunResult const run = RunInProcess({"area", "-", "--points"}, "x,y\n0,0\n4,0\n4,3\n0,3\n");
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  EXPECT_NE(run.out.find("area        12\n"), std::string::npos) << run.out;
  EXPECT_NE(run.out.find("4 lines"), std::string::npos) << run.out;
  RunResult const columns = RunInProcess({"area", "-", "--points", "--columns", "b,c"},
                                         "a,b,c\n9,0,0\n9,4,0\n9,4,3\n9,0,3\n9,0,0\n");
  EXPECT_EQ(columns.code, ExitCode::Ok) << columns.err;
  EXPECT_NE(columns.out.find("area        12\n"), std::string::npos) << columns.out;
}

TEST(AreaCommand, RefusesBadInput) {
  EXPECT_EQ(RunInProcess({"area"}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"area", "none.json"}).code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"area", "-"}, "").code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"area", "-", "-"}, "").code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"area", "-", "--points"}, "0,0\nnan,1\n").code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"area", "-", "--points", "--from", "csv"}, "").code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"area", "-", "--columns", "1,2"}, "").code, ExitCode::Usage);
}

TEST(AreaCommand, OfTheSharedCircleIsThatOfItsRadius) {
  std::optional<std::string> const folder = Testing::SharedDataFolder();
  if (!folder) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  RunResult const run = RunInProcess({"area", *folder + "/circle_r3.csv", "--points", "--json"});
  ASSERT_EQ(run.code, ExitCode::Ok) << run.err;
  auto const json = nlohmann::json::parse(run.out);
  double const expected = 9.0 * std::numbers::pi;
  EXPECT_NEAR(json.at("contours").at(0).at("area").get<double>(), expected, 0.01 * expected);
}

}  // namespace
}  // namespace Vorn::Cli
