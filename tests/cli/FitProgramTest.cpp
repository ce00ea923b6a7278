#include <gtest/gtest.h>

#include <cmath>
#include <nlohmann/json.hpp>
#include <numbers>
#include <string>
#include <vector>

#include "cli/ProgramFixture.h"
#include "support/SharedData.h"

namespace Vorn::Cli::Testing {
namespace {

using nlohmann::json;

class FitProgram : public Program {
 protected:
  json Document(std::string const& name) const { return json::parse(Contents(folder_ / name)); }
};

double Coordinate(json const& element, char const* end, char const* axis) {
  return element.at(end).at(axis).get<double>();
}

double DistanceToLine(json const& line, double x, double y) {
  double const startX = Coordinate(line, "start", "x");
  double const startY = Coordinate(line, "start", "y");
  double const dx = Coordinate(line, "end", "x") - startX;
  double const dy = Coordinate(line, "end", "y") - startY;
  double const part = ((x - startX) * dx + (y - startY) * dy) / (dx * dx + dy * dy);
  double const nearest = std::min(1.0, std::max(0.0, part));
  return std::hypot(x - startX - nearest * dx, y - startY - nearest * dy);
}

/// By the angle of the point from the start of the arc, seen from its centre.
double DistanceToArc(json const& arc, double x, double y) {
  double const centerX = Coordinate(arc, "center", "x");
  double const centerY = Coordinate(arc, "center", "y");
  double const turn = arc.at("direction") == "ccw" ? 1.0 : -1.0;
  auto const from = [&](double px, double py) {
    double const angle = std::atan2(py - centerY, px - centerX);
    double const start = std::atan2(Coordinate(arc, "start", "y") - centerY,
                                    Coordinate(arc, "start", "x") - centerX);
    double const turned = turn * (angle - start);
    return turned < 0.0 ? turned + 2.0 * std::numbers::pi : turned;
  };
  double const sweep = from(Coordinate(arc, "end", "x"), Coordinate(arc, "end", "y"));
  if (from(x, y) <= sweep) {
    return std::fabs(std::hypot(x - centerX, y - centerY) - arc.at("radius").get<double>());
  }
  return std::min(std::hypot(x - Coordinate(arc, "start", "x"), y - Coordinate(arc, "start", "y")),
                  std::hypot(x - Coordinate(arc, "end", "x"), y - Coordinate(arc, "end", "y")));
}

/// The largest distance of any point from the contour over its tolerance, by formulas of the
/// test's own.
double WorstRelative(json const& elements, std::vector<WPoint> const& points) {
  double worst = 0.0;
  for (WPoint const& point : points) {
    double nearest = 1e300;
    for (json const& element : elements) {
      nearest = std::min(nearest, element.at("kind") == "arc"
                                      ? DistanceToArc(element, point.x, point.y)
                                      : DistanceToLine(element, point.x, point.y));
    }
    worst = std::max(worst, nearest / point.w);
  }
  return worst;
}

double LargestGap(json const& elements, bool isClosed) {
  double largest = 0.0;
  for (std::size_t i = isClosed ? 0 : 1; i < elements.size(); ++i) {
    json const& before = elements.at((i + elements.size() - 1) % elements.size());
    largest = std::max(
        largest,
        std::hypot(Coordinate(elements.at(i), "start", "x") - Coordinate(before, "end", "x"),
                   Coordinate(elements.at(i), "start", "y") - Coordinate(before, "end", "y")));
  }
  return largest;
}

TEST_F(FitProgram, WritesEveryFormatInOneRun) {
  Write("p.csv", Corner());
  Ended const ended = Run(
      "fit p.csv -t 0.01 --units mm -o a.json -o a.csv -o a.dxf -o a.nc -o a.wkt -o a.svg -o a.png "
      "--feed 300");
  ASSERT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("pieces      2 (proven the fewest): 2 lines, 0 arcs\n"),
            std::string::npos);
  EXPECT_NE(ended.out.find("wrote       a.json\nwrote       a.csv\nwrote       a.dxf\n"
                           "wrote       a.nc\nwrote       a.wkt\nwrote       a.svg\n"
                           "wrote       a.png\n"),
            std::string::npos)
      << ended.out;
  EXPECT_EQ(Document("a.json").at("verdict"), "within tolerance");
  EXPECT_EQ(Contents(folder_ / "a.wkt").rfind("LINESTRING", 0), 0u);
  EXPECT_NE(Contents(folder_ / "a.nc").find("F300"), std::string::npos);
  EXPECT_NE(Contents(folder_ / "a.svg").find("<svg"), std::string::npos);
  EXPECT_EQ(Contents(folder_ / "a.png").substr(1, 3), "PNG");
  for (char const* name : {"a.csv", "a.dxf", "a.nc", "a.wkt"}) {
    ASSERT_EQ(Run(std::string("convert ") + name + " -o back.json").code, 0) << name;
    json const elements = Document("back.json").at("elements");
    ASSERT_EQ(elements.size(), 2u) << name;
    EXPECT_NEAR(Coordinate(elements.at(0), "end", "x"), 10.0, 0.01) << name;
  }
}

TEST_F(FitProgram, StandardOutputHoldsTheResultAlone) {
  Write("p.csv", Corner());
  ASSERT_EQ(Run("fit p.csv -t 0.01 -o a.dxf").code, 0);
  Ended const ended = Run("fit - -t 0.01 -o - --to dxf -o a.wkt", "", "p.csv");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_EQ(ended.err, "");
  EXPECT_EQ(ended.out, Contents(folder_ / "a.dxf"));
  EXPECT_EQ(Contents(folder_ / "a.wkt").rfind("LINESTRING", 0), 0u) << "the ending goes first";
}

TEST_F(FitProgram, FormatMustBeToldWhereTheNameDoesNot) {
  Write("p.csv", Corner());
  for (std::string const arguments : {"fit p.csv -t 0.01 -o -", "fit p.csv -t 0.01 -o out.data"}) {
    Ended const ended = Run(arguments);
    EXPECT_EQ(ended.code, 2) << arguments;
    EXPECT_NE(ended.err.find("--to must say which format to write"), std::string::npos)
        << ended.err;
  }
  EXPECT_EQ(Run("fit p.csv -t 0.01 -o out.data --to csv").code, 0);
  EXPECT_EQ(Run("fit p.csv -t 0.01 -o p.csv").code, 2) << "the points would be lost";
  EXPECT_EQ(Run("fit p.csv -t 0.01 -o - -o - --to csv").code, 2);
  EXPECT_EQ(Contents(folder_ / "p.csv"), Corner());
}

TEST_F(FitProgram, DigitsAreForTheTableOnly) {
  Write("p.csv", "0,0\n1,3\n");
  Ended const ended = Run("fit p.csv -t 0.1 --strategy mixed --digits 1 -o a.json");
  EXPECT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("  3.2       2\n"), std::string::npos) << ended.out;
  EXPECT_EQ(Document("a.json").at("elements").at(0).at("length").get<double>(), std::hypot(1, 3));
  EXPECT_EQ(Run("fit p.csv -t 0.1 --digits 16").code, 2);
  EXPECT_EQ(Run("fit p.csv -t 0.1 --digits 1.5").code, 2);
}

TEST_F(FitProgram, ClosedContourIsClosedInTheFilesAsWell) {
  std::string text;
  for (char const* corner : {"0,0", "4,0", "4,3", "0,3", "0,0"}) text += std::string(corner) + "\n";
  Write("p.csv", text);
  Ended const ended = Run("fit p.csv -t 0.01 --strategy mixed -o a.json -o a.dxf -o a.nc");
  ASSERT_EQ(ended.code, 0) << ended.err;
  EXPECT_NE(ended.out.find("closed      yes (the last point is the first), joined exactly at point "
                           "0 (line 1)\n"),
            std::string::npos)
      << ended.out;
  EXPECT_EQ(Document("a.json").at("closed"), true);
  EXPECT_EQ(LargestGap(Document("a.json").at("elements"), true), 0.0);
  for (char const* name : {"a.dxf", "a.nc"}) {
    ASSERT_EQ(Run(std::string("convert ") + name + " -o back.json").code, 0) << name;
    EXPECT_EQ(Document("back.json").at("closed"), true) << name;
  }
  EXPECT_EQ(Run("fit p.csv -t 0.01 --closed no -o a.json").code, 0);
  EXPECT_EQ(Document("a.json").at("closed"), false);
  EXPECT_EQ(Run("fit p.csv -t 0.01 --closed maybe").code, 2);
  EXPECT_EQ(Run("fit p.csv -t 0.01 --strategy mixed --start 5").code, 2);
  EXPECT_EQ(Run("fit p.csv -t 0.01 --strategy mixed --start 2 -o a.json").code, 0);
  EXPECT_EQ(Document("a.json").at("seam"), 2);
}

TEST_F(FitProgram, ExamplesOfTheHelpWork) {
  Write("part.csv", Contents(std::string(CONTOUR_EXAMPLES) + "/machined_profile.csv"));
  fs::create_directory(folder_ / "scans");
  Write("scan.csv", Corner());
  Write("scans/one.csv", Corner());
  Write("scans/two.csv", Corner());
  std::string outline;
  for (int i = 0; i < 200; ++i) {
    double const angle = i * std::numbers::pi / 100.0;
    outline += std::to_string(30.0 * std::cos(angle)) + "," +
               std::to_string(20.0 * std::sin(angle)) + "\n";
  }
  Write("outline.csv", outline);
  std::string const help = Run("fit --help").out;
  std::istringstream lines(help.substr(help.find("Examples:")));
  int count = 0;
  for (std::string line; std::getline(lines, line);) {
    std::string const name = "  contour ";
    if (line.rfind(name, 0) != 0) continue;
    std::string const command = "cd '" + folder_.string() + "' && '" + CONTOUR_PROGRAM + "' " +
                                line.substr(name.size()) + " >>.log 2>&1";
    EXPECT_EQ(std::system(command.c_str()), 0) << line << '\n' << Contents(folder_ / ".log");
    ++count;
  }
  EXPECT_EQ(count, 9);
  EXPECT_TRUE(fs::exists(folder_ / "fitted" / "two.dxf"));
}

struct Measured {
  std::string name;
  double tolerance;
  bool isPerPoint;
  bool isClosed;
};

class MeasuredContour : public FitProgram, public testing::WithParamInterface<Measured> {};

TEST_P(MeasuredContour, FitsAndReadsBackWithinItsTolerance) {
  auto const data = Vorn::Testing::SharedDataFolder();
  if (!data) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  Measured const& measured = GetParam();
  std::string const path = *data + "/" + measured.name + ".csv";
  Ended const ended =
      Run("fit '" + path + (measured.isPerPoint ? "' --tolerance-per-point " : "' -t ") +
          std::to_string(measured.tolerance) + " -o a.json -o a.dxf");
  ASSERT_EQ(ended.code, 0) << ended.err;
  json const report = Document("a.json");
  EXPECT_EQ(report.at("closed"), measured.isClosed);
  EXPECT_EQ(LargestGap(report.at("elements"), measured.isClosed), 0.0);

  std::vector<WPoint> points = Vorn::Testing::ReadPoints(path);
  Vorn::Testing::SetTolerance(&points, measured.tolerance);
  if (measured.isPerPoint) {
    Vorn::Testing::SetTolerancePerPoint(&points, measured.tolerance);
    // The ends of a closed contour are one point or neighbours.
    if (measured.isClosed)
      points.front().w = points.back().w = std::min(points.front().w, points.back().w);
  }
  EXPECT_LE(WorstRelative(report.at("elements"), points), 1.0 + 1e-6);

  ASSERT_EQ(Run("convert a.dxf -o b.json").code, 0);
  json const read = Document("b.json");
  EXPECT_EQ(read.at("closed"), measured.isClosed);
  EXPECT_LE(WorstRelative(read.at("elements"), points), 1.0 + 1e-6);
}

INSTANTIATE_TEST_SUITE_P(Shared, MeasuredContour,
                         testing::Values(Measured{"rail_head_known_arcs", 0.01, false, false},
                                         Measured{"wheel_worn_a", 0.03, false, false},
                                         Measured{"rail_worn_low", 0.025, false, false},
                                         Measured{"mirror_sphere_83m", 0.00005, false, false},
                                         Measured{"hatch_boundary", 0.002, false, true},
                                         Measured{"glyph_five", 2.0, true, true},
                                         Measured{"test_track_centreline", 0.03, true, false},
                                         Measured{"gcode_letter_d", 0.015, false, true},
                                         Measured{"airfoil_clark_y", 0.0004, false, false},
                                         Measured{"circle_r3", 0.001, false, true}),
                         [](auto const& instance) { return instance.param.name; });

}  // namespace
}  // namespace Vorn::Cli::Testing
