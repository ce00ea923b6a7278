#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "cli/RunInProcess.h"

namespace Vorn::Cli {
namespace {

constexpr char const* kBowTie = "LINESTRING (-4 -2, 2 1, 2 -1, -4 2, -4 -2)";

TEST(IntersectCommand, ListsTheIntersectionsOfOneContour) {
  RunResult const run = RunInProcess({"intersect", "-"}, kBowTie);
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  EXPECT_EQ(run.out,
            "standard input with itself: 1 crossing, 0 touching, 0 overlaps\n"
            "\n"
            "no      kind  x  y  to x  to y  piece of A           at  piece of B           at\n"
            " 1  crossing  0  0     -     -      1 line  4.472135955      3 line  10.94427191\n");
}

TEST(IntersectCommand, WritesCsvAndJson) {
  RunResult const csv = RunInProcess({"intersect", "-", "-o", "-"}, kBowTie);
  EXPECT_EQ(csv.out.substr(0, csv.out.find('\n')),
            "kind,x,y,to_x,to_y,piece_a,kind_a,position_a,piece_b,kind_b,position_b");
  EXPECT_NE(csv.out.find("\ncrossing,0,0,0,0,1,line,4.47213595"), std::string::npos) << csv.out;
  RunResult const run = RunInProcess({"intersect", "-", "--json"}, kBowTie);
  auto const json = nlohmann::json::parse(run.out);
  EXPECT_TRUE(json.at("b").is_null());
  ASSERT_EQ(json.at("intersections").size(), 1u);
  EXPECT_EQ(json.at("intersections").at(0).at("kind"), "crossing");
  EXPECT_EQ(json.at("intersections").at(0).at("b").at("piece"), 3);
  EXPECT_TRUE(json.at("intersections").at(0).at("until").is_null());
}

TEST(IntersectCommand, ExitsWithOneOnlyWhereAsked) {
  char const* const simple = "LINESTRING (0 0, 1 0, 1 1)";
  EXPECT_EQ(RunInProcess({"intersect", "-", "--fail-if-any"}, kBowTie).code,
            ExitCode::OutsideTolerance);
  RunResult const none = RunInProcess({"intersect", "-", "--fail-if-any"}, simple);
  EXPECT_EQ(none.code, ExitCode::Ok);
  EXPECT_EQ(none.out, "standard input with itself: no intersections\n");
}

TEST(IntersectCommand, RefusesBadInput) {
  EXPECT_EQ(RunInProcess({"intersect"}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"intersect", "-", "-"}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"intersect", "a.dxf", "-o", "a.dxf"}).code, ExitCode::Usage);
  EXPECT_EQ(RunInProcess({"intersect", "none.dxf"}).code, ExitCode::File);
  EXPECT_EQ(RunInProcess({"intersect", "-"}, "{").code, ExitCode::File);
}

}  // namespace
}  // namespace Vorn::Cli
