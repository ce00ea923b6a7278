// What the help of `contour area` promises: chains, holes, gaps, arcs, loops.

#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

constexpr double kPi = std::numbers::pi;

nlohmann::json Measured(std::string const& text, std::vector<std::string> const& more = {}) {
  std::vector<std::string> words = {"area", "-", "--json"};
  words.insert(words.end(), more.begin(), more.end());
  RunResult const run = RunInProcess(words, text);
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  return run.code == ExitCode::Ok ? nlohmann::json::parse(run.out) : nlohmann::json();
}

nlohmann::json Single(std::string const& text) {
  auto const json = Measured(text);
  EXPECT_EQ(json.at("contours").size(), 1u) << text;
  return json.at("contours").at(0);
}

TEST(AreaRules, LinesInAnyOrderAndSenseAreChained) {
  auto const square =
      Single("MULTILINESTRING ((10 0, 10 10), (0 0, 10 0), (0 10, 0 0), (0 10, 10 10))");
  EXPECT_EQ(square.at("pieces"), 4);
  EXPECT_EQ(std::fabs(square.at("signedArea").get<double>()), 100.0);
  EXPECT_EQ(square.at("perimeter"), 40.0);
  EXPECT_EQ(square.at("centroid"), (nlohmann::json{{"x", 5.0}, {"y", 5.0}}));
  EXPECT_EQ(square.at("gaps").size(), 0u);
}

TEST(AreaRules, EndsAreJoinedWithinAMillionthOfTheSize) {
  // The drawing is 100 wide; two ends of the first triangle are so far apart.
  auto const run = [](std::string const& apart) {
    return RunInProcess({"area", "-", "--json"},
                        "MULTILINESTRING ((0 0, 50 0), (50 0, 25 40), (25." + apart +
                            " 40, 0 0), (100 0, 100 10, 90 10, 100 0))");
  };
  for (char const* apart : {"0", "00009"}) {
    RunResult const near = run(apart);
    ASSERT_EQ(near.code, ExitCode::Ok) << near.err;
    EXPECT_EQ(nlohmann::json::parse(near.out).at("contours").size(), 2u) << apart;
  }
  RunResult const far = run("00012");
  EXPECT_EQ(far.code, ExitCode::Usage);
  EXPECT_NE(far.err.find("the contour is open, its ends are 0.00012 apart"), std::string::npos)
      << far.err;
}

TEST(AreaRules, AnOutlineInAnotherIsAHole) {
  std::string const frame =
      "MULTILINESTRING ((0 0, 10 0, 10 10, 0 10, 0 0), (2 2, 8 2, 8 8, 2 8, 2 2), "
      "(4 4, 6 4, 6 6, 4 6, 4 4), (20 0, 22 0, 22 2, 20 2, 20 0))";
  auto const json = Measured(frame);
  std::vector<bool> holes;
  for (auto const& contour : json.at("contours")) holes.push_back(contour.at("isHole"));
  EXPECT_EQ(holes, (std::vector<bool>{false, true, false, false})) << "an island in a hole is none";
  EXPECT_EQ(json.at("netArea"), 100.0 - 36.0 + 4.0 + 4.0);
  RunResult const text = RunInProcess({"area", "-"}, frame);
  EXPECT_NE(text.out.find("standard input, outline 2 (a hole): 4 pieces, 4 lines, 0 arcs\n"),
            std::string::npos)
      << text.out;
  EXPECT_TRUE(
      text.out.ends_with("\nstandard input: 4 outlines, 1 hole\n"
                         "area        72, holes taken off\n"))
      << text.out;
}

TEST(AreaRules, OneOutlineMayBeTaken) {
  std::string const two =
      "MULTILINESTRING ((0 0, 4 0, 4 4, 0 4, 0 0), (9 0, 10 0, 10 1, 9 1, 9 0))";
  EXPECT_EQ(Measured(two, {"--outline", "2"}).at("netArea"), 1.0);
  RunResult const none = RunInProcess({"area", "-", "--outline", "3"}, two);
  EXPECT_EQ(none.code, ExitCode::Usage);
  EXPECT_EQ(none.err, "contour: standard input: there is no outline 3, the file has 2 outlines\n");
}

TEST(AreaRules, ArcsAreMeasuredAsArcs) {
  // A stadium: two half circles of radius 2 at the ends of a square of side 4.
  auto const stadium = Single(
      "COMPOUNDCURVE ((-2 -2, 2 -2), CIRCULARSTRING (2 -2, 4 0, 2 2), (2 2, -2 2), "
      "CIRCULARSTRING (-2 2, -4 0, -2 -2))");
  EXPECT_NEAR(stadium.at("area").get<double>(), 16.0 + 4.0 * kPi, 1e-13);
  EXPECT_NEAR(stadium.at("perimeter").get<double>(), 8.0 + 4.0 * kPi, 1e-13);
  EXPECT_EQ(stadium.at("sense"), "counter-clockwise");
  auto const& box = stadium.at("box");
  EXPECT_NEAR(box.at("low").at("x").get<double>(), -4.0, 1e-15);
  EXPECT_NEAR(box.at("high").at("x").get<double>(), 4.0, 1e-15);
  EXPECT_EQ(box.at("high").at("y"), 2.0);
  // A half disc: its centroid is 4 r / (3 pi) above the diameter.
  auto const half = Single("COMPOUNDCURVE (CIRCULARSTRING (3 0, 0 3, -3 0), (-3 0, 3 0))");
  EXPECT_NEAR(half.at("area").get<double>(), 4.5 * kPi, 1e-13);
  EXPECT_NEAR(half.at("centroid").at("x").get<double>(), 0.0, 1e-14);
  EXPECT_NEAR(half.at("centroid").at("y").get<double>(), 4.0 / kPi, 1e-14);
}

TEST(AreaRules, GapsAreBridgedAndListed) {
  std::string const gap =
      "# closed yes\ntype,start_x,start_y,end_x,end_y\nline,0,0,3,0\nline,4,0,4,4\nline,4,4,0,4\n"
      "line,0,4,0,0\n";
  auto const json = Single(gap);
  EXPECT_EQ(json.at("area"), 16.0) << "the bridge lies on the side of the square";
  EXPECT_EQ(json.at("perimeter"), 16.0);
  EXPECT_EQ(json.at("gaps"), nlohmann::json::parse(R"([{"before": 1, "after": 2, "size": 1.0}])"));
  EXPECT_EQ(FactOf(RunInProcess({"area", "-"}, gap).out, "gap"),
            "pieces 1 and 2 do not meet: the gap is 1, bridged");
}

TEST(AreaRules, LoopsCountWithTheirSense) {
  // 20 counter-clockwise, and a loop of 1 behind the crossing at (1, 0) that runs clockwise.
  auto const loop = Single("LINESTRING (0 0, 5 0, 5 5, 1 5, 1 -1, 0 -1, 0 0)");
  EXPECT_EQ(loop.at("signedArea"), 19.0);
  EXPECT_EQ(loop.at("crossesItself"), true);
  EXPECT_TRUE(loop.at("centroid").is_null());
  auto const eight = Single("LINESTRING (0 0, 2 2, 2 0, 0 2, 0 0)");
  EXPECT_EQ(eight.at("area"), 0.0);
}

TEST(AreaRules, APathThatComesBackToItsStartIsSeveralOutlines) {
  auto const json = Measured("LINESTRING (0 0, 4 3, 4 -3, 0 0, -2 1, -2 -1, 0 0)");
  ASSERT_EQ(json.at("contours").size(), 2u);
  EXPECT_EQ(json.at("contours").at(0).at("signedArea"), -12.0);
  EXPECT_EQ(json.at("contours").at(1).at("signedArea"), 2.0);
}

TEST(AreaRules, TheSenseIsThatOfThePieces) {
  EXPECT_EQ(Single("LINESTRING (0 0, 1 0, 1 1, 0 0)").at("sense"), "counter-clockwise");
  auto const clockwise = Single("LINESTRING (0 0, 1 1, 1 0, 0 0)");
  EXPECT_EQ(clockwise.at("sense"), "clockwise");
  EXPECT_EQ(clockwise.at("signedArea"), -0.5);
  EXPECT_EQ(clockwise.at("area"), 0.5);
}

class AreaFiles : public InFolder {};

TEST_F(AreaFiles, EachIsMeasuredAndTheUnitsAreSaid) {
  std::string const a = Write("a.wkt", "LINESTRING (0 0, 2 0, 2 2, 0 2, 0 0)");
  std::string const b = Write("b.wkt", "LINESTRING (0 0, 3 0, 3 3, 0 3, 0 0)");
  RunResult const run = RunInProcess({"area", a, b, "--units", "inch"});
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  EXPECT_LT(run.out.find("area        4\n"), run.out.find("area        9\n"));
  EXPECT_NE(run.out.find(a + ": 4 pieces, 4 lines, 0 arcs, lengths in inch\n"), std::string::npos)
      << run.out;
  auto const json = nlohmann::json::parse(RunInProcess({"area", a, b, "--json"}).out);
  EXPECT_EQ(json.at("contours").size(), 2u);
  EXPECT_EQ(json.at("netArea"), 13.0);
}

TEST_F(AreaFiles, OneThatFailsStopsAll) {
  std::string const a = Write("a.wkt", "LINESTRING (0 0, 2 0, 2 2, 0 2, 0 0)");
  RunResult const run = RunInProcess({"area", a, PathOf("none.wkt")});
  EXPECT_EQ(run.code, ExitCode::File);
  RunResult const open = RunInProcess({"area", a, Write("o.wkt", "LINESTRING (0 0, 3 4)")});
  EXPECT_EQ(open.code, ExitCode::Usage);
  EXPECT_NE(open.err.find("the contour is open, its ends are 5 apart"), std::string::npos)
      << open.err;
}

}  // namespace
}  // namespace Vorn::Cli::Testing
