// What the help of `contour plot` promises.

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

using Words = std::vector<std::string>;

class PlotRules : public InFolder {
 protected:
  RunResult Plot(Words const& more) const {
    Words words = {"plot"};
    words.insert(words.end(), more.begin(), more.end());
    return RunInProcess(words);
  }
};

constexpr char const* kPoints = "0,0\n1,0.5\n2,-0.5\n3,0\n";
constexpr char const* kLine = "LINESTRING (0 0, 3 0)";

std::size_t CountOf(std::string const& text, std::string const& part) {
  std::size_t count = 0;
  for (std::size_t at = 0; (at = text.find(part, at)) != std::string::npos; ++at) ++count;
  return count;
}

TEST_F(PlotRules, EndingsTellTheFormatAndToTellsItForOthers) {
  std::string const points = Write("p.csv", kPoints);
  EXPECT_EQ(
      Plot({points, "-o", PathOf("a.svg"), "-o", PathOf("a.png"), "-o", PathOf("a.html")}).code,
      ExitCode::Ok);
  EXPECT_TRUE(Contents("a.svg").starts_with("<?xml"));
  EXPECT_EQ(Contents("a.png").substr(1, 3), "PNG");
  EXPECT_NE(Contents("a.html").find("<!DOCTYPE html>"), std::string::npos);
  EXPECT_EQ(Plot({points, "-o", PathOf("b.data")}).code, ExitCode::Usage);
  EXPECT_EQ(Plot({points, "-o", PathOf("b.data"), "--to", "svg"}).code, ExitCode::Ok);
  EXPECT_EQ(Contents("b.data"), Contents("a.svg"));
  EXPECT_EQ(Plot({points, "--to", "svg"}).out, Contents("a.svg"));
}

TEST_F(PlotRules, ASingleContourIsDrawnByItself) {
  for (auto const& [name, text] : std::vector<std::pair<std::string, std::string>>{
           {"c.wkt", kLine},
           {"c.nc", "G21\nG0 X0 Y0\nG1 X3 Y0\n"},
           {"c.gcode", "G21\nG0 X0 Y0\nG1 X3 Y0\n"},
           {"c.geojson", R"({"type": "LineString", "coordinates": [[0, 0], [3, 0]]})"},
           {"c.dxf",
            "0\nSECTION\n2\nENTITIES\n0\nLINE\n10\n0\n20\n0\n11\n3\n21\n0\n0\nENDSEC\n0\nEOF\n"},
           {"c.svg",
            "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"4mm\" height=\"4mm\" viewBox=\"0 0 "
            "4 "
            "4\"><path d=\"M0 0H3\"/></svg>"}}) {
    RunResult const run = Plot({Write(name, text), "-o", PathOf("a.html")});
    EXPECT_EQ(run.code, ExitCode::Ok) << name << run.err;
    EXPECT_EQ(FactOf(run.out, "pieces"), "1 line, 0 arcs") << name;
    EXPECT_EQ(FactOf(run.out, "points"), "") << name;
  }
}

TEST_F(PlotRules, AContourIsJudgedOnlyWithATolerance) {
  std::string const points = Write("p.csv", kPoints);
  std::string const line = Write("l.wkt", kLine);
  RunResult const without = Plot({points, line, "-o", PathOf("a.svg")});
  EXPECT_EQ(FactOf(without.out, "result"), "");
  EXPECT_EQ(FactOf(without.out, "deviation"), "0.5 at point 1");
  RunResult const within = Plot({points, line, "-t", "0.5", "-o", PathOf("a.svg")});
  EXPECT_EQ(FactOf(within.out, "result"), "within tolerance");
  EXPECT_EQ(FactOf(within.out, "deviation"), "0.5, 1 of the tolerance, at point 1");
  RunResult const outside = Plot({points, line, "-t", "0.25", "-o", PathOf("a.svg")});
  EXPECT_EQ(outside.code, ExitCode::Ok) << "whatever they show";
  EXPECT_EQ(FactOf(outside.out, "result"), "OUTSIDE TOLERANCE");
  RunResult const ofFile = Plot(
      {Write("t.csv", std::string("# tolerance 0.5\n") + kPoints), line, "-o", PathOf("a.svg")});
  EXPECT_EQ(FactOf(ofFile.out, "result"), "within tolerance") << "the file states it";
}

TEST_F(PlotRules, TheMagnificationIsSaidInTheLegend) {
  std::string const points = Write("p.csv", kPoints);
  std::string const line = Write("l.wkt", kLine);
  std::string const svg = Plot({points, line, "-t", "0.5", "--magnify", "50", "--to", "svg"}).out;
  EXPECT_NE(svg.find("tolerance \xC3\x97"
                     "50<"),
            std::string::npos);
  std::string const one = Plot({points, line, "-t", "0.5", "--magnify", "1", "--to", "svg"}).out;
  EXPECT_EQ(one.find("\xC3\x97"
                     "50"),
            std::string::npos);
}

TEST_F(PlotRules, PointsOnTheSamePlaceOfThePageAreDrawnOnce) {
  std::string many = "0,0\n";
  for (int i = 0; i < 5000; ++i) many += "1," + std::to_string(1e-9 * i) + "\n";
  many += "2,0\n";
  std::string const few = Plot({Write("few.csv", "0,0\n1,0\n2,0\n"), "--to", "svg"}).out;
  RunResult const run = Plot({Write("many.csv", many), "-o", PathOf("m.svg")});
  EXPECT_EQ(FactOf(run.out, "points"), "5002");
  EXPECT_LT(Contents("m.svg").size(), few.size() + 2000) << "not a mark for each of them";
}

TEST_F(PlotRules, PixelsFollowFromTheResolutionOrTheWidth) {
  std::string const points = Write("p.csv", kPoints);
  auto const size = [&](Words const& more) {
    Words words = {points, "-o", PathOf("a.png")};
    words.insert(words.end(), more.begin(), more.end());
    EXPECT_EQ(Plot(words).code, ExitCode::Ok);
    std::string const png = Contents("a.png");
    auto const number = [&](std::size_t at) {
      unsigned value = 0;
      for (std::size_t i = at; i < at + 4; ++i)
        value = value << 8U | static_cast<unsigned char>(png[i]);
      return value;
    };
    return std::pair(number(16), number(20));
  };
  // A4 is 297 mm by 210 mm, and an inch 25.4 mm.
  EXPECT_NEAR(size({"--dpi", "100"}).first, 297 / 25.4 * 100, 1.0);
  EXPECT_NEAR(size({"--dpi", "100"}).second, 210 / 25.4 * 100, 1.0);
  EXPECT_NEAR(size({}).first, 297 / 25.4 * 150, 1.0);
  EXPECT_EQ(size({"--width", "640"}).first, 640u);
}

TEST_F(PlotRules, OneOutlineMayBeDrawn) {
  std::string const two = Write("two.wkt", "MULTILINESTRING ((0 0, 3 0), (0 1, 3 1, 3 2))");
  EXPECT_EQ(FactOf(Plot({two, "-o", PathOf("a.svg")}).out, "pieces"), "3 lines, 0 arcs");
  EXPECT_EQ(FactOf(Plot({two, "--outline", "2", "-o", PathOf("a.svg")}).out, "pieces"),
            "2 lines, 0 arcs");
  EXPECT_EQ(Plot({two, "--outline", "3", "-o", PathOf("a.svg")}).code, ExitCode::Usage);
}

TEST_F(PlotRules, FieldsStandInThePage) {
  std::string const points = Write("p.csv", kPoints);
  std::string const page =
      Plot({points, "--to", "html", "--field", "part=Cam 7", "--field", "date=2026-11-30"}).out;
  EXPECT_EQ(CountOf(page, "Cam 7") > 0, true);
  EXPECT_LT(page.find("Cam 7"), page.find("2026-11-30"));
}

}  // namespace
}  // namespace Vorn::Cli::Testing
